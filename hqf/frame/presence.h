/// Whether an object has what is mandatory, for the two who ask: is_occurs_ok() of every class, and the writer at each
/// element that it writes.
#pragma once

#include <bit>
#include <cstdint>

#include "hqf/frame/list.h"
#include "hqf/frame/rows.h"

namespace hqf::frame {

/// Whether all rows that have a bit are there.
inline bool are_there(std::uint32_t bits, const row* rows, const void* object) {
    for (; bits != 0; bits &= bits - 1) {
        const row& r = rows[std::countr_zero(bits)];
        if (r.is_list() ? member_at<list_base>(object, r.value).size() == 0 : !member_at<bool>(object, r.flag))
            return false;
    }
    return true;
}

inline bool has_mandatory_members(const class_rows& rows, const void* object) {
    if (rows.slot != 0) return member_at<int>(object, rows.slot) != rows.none();
    return rows.is_nil(object) || (are_there(rows.needed_attributes, rows.attributes, object) &&
                                   are_there(rows.needed_rows, rows.rows, object));
}

} // namespace hqf::frame
