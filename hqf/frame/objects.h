/// What every model class can do with its members as a whole: copy, swap, compare, count. Each is written once and
/// driven by the class's rows.
#pragma once

#include "hqf/frame/rows.h"

namespace hqf::frame {

/// Copies the members of `from` into `to`, which is newly made. Mandatory members count as set in the copy; a nil
/// source gives a nil copy and nothing else is taken from it.
void copy_members(const class_rows& rows, void* to, const void* from);

void swap_members(const class_rows& rows, void* a, void* b) noexcept;

/// The same is set, and to the same values; NaN equals NaN, and -0.0 differs from 0.0. What is unset or absent in both,
/// and what stands in two nil objects, plays no part.
bool equal_members(const class_rows& rows, const void* a, const void* b);

/// All mandatory members are set, each list has its minimum, a choice has an option; a nil object passes.
bool is_occurs_ok(const class_rows& rows, const void* object);

/// Destroys what a choice's slot owns and selects none.
void release_choice(const class_rows& rows, void* object);

/// Makes option `index` of a choice the chosen one, with empty storage. Keeps what it holds if it is chosen already.
void choose_option(const class_rows& rows, void* object, int index);
/// The same, but always with empty storage: what is read is new.
void choose_new_option(const class_rows& rows, void* object, int index);

} // namespace hqf::frame
