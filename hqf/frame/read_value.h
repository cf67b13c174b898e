/// From the text of a value to the member: lexical check, facets, conversion, range. The one place that knows the
/// order.
#pragma once

#include "hqf/frame/rows.h"

namespace hqf::frame {

/// Where a value goes to.
struct value_target {
    kind what;
    const facets* rules;
    void* value;
};

/// White space of a value: text without rules is preserved, every other type without rules is collapsed.
inline lmx::elmx_whitespace whitespace_of(kind what, const facets* rules) {
    if (rules != nullptr) return rules->whitespace;
    return what == kind::text || what == kind::text_list ? lmx::preserve : lmx::collapse;
}

/// Checks and converts the text in the reader's value buffer. Each failure is reported with `item`; where the handler
/// lets reading go on, the value is stored all the same.
///
/// \returns 0, or what the handler made of the first failure that it didn't turn into 0
lmx::elmx_error convert_value(const value_target& target, lmx::c_xml_reader& reader, const std::string& item);

} // namespace hqf::frame
