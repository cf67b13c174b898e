#include "hqf/platform/pages.h"

#include <cstdint>
#include <cstdlib>

#if defined(__linux__)
#include <sys/mman.h>
#endif

namespace hqf {

namespace {

constexpr std::size_t large_page = std::size_t{2} << 20;

} // namespace

void* allocate_for_filling(std::size_t size) noexcept {
    if (size < large_page || size > SIZE_MAX - large_page) return std::malloc(size);
    void* const block = std::aligned_alloc(large_page, (size + large_page - 1) / large_page * large_page);
    if (block != nullptr) expect_filling(block, size);
    return block;
}

void expect_filling(void* block, std::size_t size) noexcept {
#if defined(__linux__)
    // Advice is taken for whole pages only; those at the edges belong to others as well.
    const auto begin = (reinterpret_cast<std::uintptr_t>(block) + large_page - 1) / large_page * large_page;
    const auto end = (reinterpret_cast<std::uintptr_t>(block) + size) / large_page * large_page;
    if (begin < end) static_cast<void>(madvise(reinterpret_cast<void*>(begin), end - begin, MADV_HUGEPAGE));
#else
    static_cast<void>(block);
    static_cast<void>(size);
#endif
}

} // namespace hqf
