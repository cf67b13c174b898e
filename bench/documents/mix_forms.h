/// The 27 forms of a colour with values in their ranges.
#pragma once

#include "bench/documents/random_values.h"
#include "hqf/hqf.h"

namespace hqf_bench {

constexpr unsigned int form_count = 27;

/// Fills `space` as form `form`, 0 to `form_count` - 1.
void fill_form(hqf_v2::sg_ColorSpace& space, unsigned int form, random_values& values);

} // namespace hqf_bench
