// The operators new and delete of the programs that link test_memory: they count, and fail when a test says so.
#pragma once

#include <atomic>
#include <cstdint>

namespace support {

inline std::atomic<std::int64_t> bytes_asked = 0;  ///< given back or not
inline std::atomic<std::int64_t> bytes_in_use = 0; ///< of blocks, as the allocator sizes them
inline std::atomic<bool> memory_is_out = false;    ///< the next allocation fails, and that one alone

/// Whether the operators in use are these: the thread sanitizer lets nobody replace its own, and Valgrind puts its own
/// in the place of any.
bool counts_memory();

} // namespace support
