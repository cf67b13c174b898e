/// What a caller of the exports needs and no class operation gives in a form that can cross: the exports hqf_ forward
/// here.
#pragma once

#include <string>

#include "hqf/model/Revision.h"
#include "hqf/values/c_binary.h"

namespace hqf::flat {

/// The parts of a wildcard entry. They throw `std::out_of_range` from the size on.
std::string any_namespace(const hqf_v2::Revision& revision, unsigned int index);
std::string any_name(const hqf_v2::Revision& revision, unsigned int index);
std::string any_value(const hqf_v2::Revision& revision, unsigned int index);

/// Copies the first bytes, as many as both sides have, and gives their number.
unsigned int copy_bytes(const lmx::c_binary& from, unsigned char* buffer, unsigned int size);

} // namespace hqf::flat
