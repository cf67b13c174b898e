// What the library does, counted: in the whole process, by functions that take the place of others.
#pragma once

#include <cstdint>

namespace growth {

struct counts {
    /// Basic blocks of the library that ran, and sixteenths of the bytes that memcpy, strlen and their like went over:
    /// about what a wide load takes in.
    std::uint64_t work = 0;
    std::uint64_t allocations = 0;
    /// The most bytes of the heap that were in use at once.
    std::uint64_t peak = 0;
};

/// Begins anew; the peak at what is in use now.
void restart();
/// What has been counted since.
counts counted();

} // namespace growth
