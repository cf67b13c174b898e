// Memory that runs out when a test says so.

#include <cstdlib>
#include <new>
#include <utility>

#include "support.h"

namespace flat_test {

bool memory_is_out = false;

bool can_run_out_of_memory() {
    memory_is_out = true;
    try {
        ::operator delete(::operator new(1));
    } catch (const std::bad_alloc&) {
        return true;
    }
    return memory_is_out = false;
}

} // namespace flat_test

// The thread sanitizer has operators of its own and lets nobody replace them.
#if defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define HQF_NO_FAILURES
#endif
#endif
#if !defined(HQF_NO_FAILURES)
// No caller in this file has them inlined: Valgrind puts its own in their place by name.
[[gnu::noinline]] void* operator new(std::size_t size) {
    const bool fails = std::exchange(flat_test::memory_is_out, false);
    void* const block = fails ? nullptr : std::malloc(size == 0 ? 1 : size);
    return block != nullptr ? block : throw std::bad_alloc();
}

[[gnu::noinline]] void operator delete(void* block) noexcept {
    std::free(block);
}

[[gnu::noinline]] void operator delete(void* block, std::size_t) noexcept {
    std::free(block);
}
#endif
