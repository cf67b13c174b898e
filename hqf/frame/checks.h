/// What a setter does with a value: the checks of the member's facets, then the store. The texts that the reader meets
/// have a longer row of checks, in hqf/frame/read_value.cpp.
#pragma once

#include <type_traits>

#include "hqf/frame/rows.h"

namespace hqf::frame {

/// \returns 0, 37 below the minimum or for NaN where there is one, 36 above the maximum. `with_minimum` false leaves
/// the minimum untested.
inline lmx::elmx_error check_range(double value, const facets& rules, bool with_minimum) {
    // The comparisons are put so that NaN, which compares false with everything, fails the minimum and passes the
    // maximum.
    if (rules.has_minimum && with_minimum &&
        !(rules.minimum_is_exclusive ? value > rules.minimum : value >= rules.minimum))
        return lmx::err_value_less_than_specified_minimum;
    if (rules.has_maximum && (rules.maximum_is_exclusive ? value >= rules.maximum : value > rules.maximum))
        return lmx::err_value_greater_than_specified_maximum;
    return lmx::err_no_error;
}

/// The checks of a setter, in this order: enumeration 38, minimum 37, maximum 36, minimum length 20, maximum length 19.
/// Rules may be null.
lmx::elmx_error check_value(const std::wstring& value, const facets* rules);
lmx::elmx_error check_value(double value, const facets* rules);
template<class value_type>
lmx::elmx_error check_value(const value_type& value, const facets* rules) {
    if constexpr (std::is_arithmetic_v<value_type> && !std::is_same_v<value_type, bool>)
        return check_value(static_cast<double>(value), rules);
    else
        return lmx::err_no_error;
}

/// Stores a value in a single member: checked, or not at all.
template<class value_type>
lmx::elmx_error store(value_member<value_type>& member, const value_type& value, const facets* rules = nullptr) {
    const lmx::elmx_error error = check_value(value, rules);
    if (error != lmx::err_no_error) return error;
    member.value = value;
    member.set = true;
    return lmx::err_no_error;
}

/// The same for an enumerated text, whose rules are its literals.
inline lmx::elmx_error store(value_member<enumerated>& member, const std::wstring& value, const facets* rules) {
    const lmx::elmx_error error = check_value(value, rules);
    if (error != lmx::err_no_error) return error;
    member.value.set_text(value, *rules->texts);
    member.set = true;
    return lmx::err_no_error;
}

/// The same for the body of a class that can be nil: a value ends that.
template<class member_type, class value_type>
lmx::elmx_error store(value_member<member_type>& member, bool& nil, const value_type& value,
                      const facets* rules = nullptr) {
    const lmx::elmx_error error = store(member, value, rules);
    if (error == lmx::err_no_error) nil = false;
    return error;
}

/// Stores the literal of a number from 1 up through `set`; false for any other number.
template<class setter>
bool store_literal(const literals& texts, int number, setter&& set) {
    return number >= 1 && number <= texts.count && set(texts.wide[number - 1]) == lmx::err_no_error;
}

} // namespace hqf::frame
