#include "hqf/frame/checks.h"

namespace hqf::frame {

lmx::elmx_error check_value(double value, const facets* rules) {
    return rules == nullptr ? lmx::err_no_error : check_range(value, *rules, rules->setter_checks_minimum);
}

lmx::elmx_error check_value(const std::wstring& value, const facets* rules) {
    if (rules == nullptr) return lmx::err_no_error;
    if (rules->texts != nullptr && rules->texts->number_of(value) == 0)
        return lmx::err_value_does_not_match_enumerations;
    if (rules->minimum_length >= 0 && value.size() < static_cast<std::size_t>(rules->minimum_length))
        return lmx::err_length_too_short;
    if (rules->maximum_length >= 0 && value.size() > static_cast<std::size_t>(rules->maximum_length))
        return lmx::err_length_too_long;
    return lmx::err_no_error;
}

} // namespace hqf::frame
