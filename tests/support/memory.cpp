#include "tests/support/memory.h"

#include <malloc.h>

#include <cstdlib>
#include <new>

namespace support {

bool counts_memory() {
    const std::int64_t before = bytes_asked;
    ::operator delete(::operator new(1));
    return bytes_asked != before;
}

} // namespace support

#if defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define HQF_NO_OPERATORS
#endif
#endif
#if !defined(HQF_NO_OPERATORS) && !defined(__SANITIZE_THREAD__)
// Not inlined: Valgrind finds them by name.
[[gnu::noinline]] void* operator new(std::size_t size) {
    void* const block = support::memory_is_out.exchange(false) ? nullptr : std::malloc(size == 0 ? 1 : size);
    if (block == nullptr) throw std::bad_alloc();
    support::bytes_asked += static_cast<std::int64_t>(size);
    support::bytes_in_use += static_cast<std::int64_t>(malloc_usable_size(block));
    return block;
}
[[gnu::noinline]] void operator delete(void* block) noexcept {
    support::bytes_in_use -= static_cast<std::int64_t>(malloc_usable_size(block));
    std::free(block);
}
[[gnu::noinline]] void operator delete(void* block, std::size_t) noexcept {
    operator delete(block);
}
#endif
