/// The heap of the whole program, counted: `heap_count.cpp` takes the place of malloc and its sisters, in the shared
/// libraries too.
#pragma once

#include <cstddef>

namespace hqf_bench {

/// Bytes in use, with the allocator's own header of each block.
std::size_t heap_bytes();

/// The most that was in use since the last `restart_heap_peak`.
std::size_t heap_peak_bytes();

/// Lets the peak begin again at what is in use now.
void restart_heap_peak();

} // namespace hqf_bench
