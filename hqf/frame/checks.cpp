#include "hqf/frame/checks.h"

namespace hqf::frame {

lmx::elmx_error check_range(double value, const facets& rules, bool with_minimum) {
    // The comparisons are put so that NaN, which compares false with everything, fails the minimum and passes the
    // maximum.
    if (rules.has_minimum && with_minimum &&
        !(rules.minimum_is_exclusive ? value > rules.minimum : value >= rules.minimum))
        return lmx::err_value_less_than_specified_minimum;
    if (rules.has_maximum && (rules.maximum_is_exclusive ? value >= rules.maximum : value > rules.maximum))
        return lmx::err_value_greater_than_specified_maximum;
    return lmx::err_no_error;
}

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
