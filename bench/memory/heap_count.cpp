/// The executable's malloc is the one that every shared library finds (ELF symbol interposition). It forwards to
/// glibc's under the names that glibc exports for this, and counts what the blocks really take.

#include "bench/memory/heap_count.h"

#include <malloc.h>

#include <atomic>
#include <cerrno>
#include <cstdlib>

extern "C" {
void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* block, std::size_t size);
void* __libc_memalign(std::size_t alignment, std::size_t size);
void __libc_free(void* block);
}

namespace {

std::atomic<std::size_t> in_use{0};
std::atomic<std::size_t> peak{0};

/// The usable bytes and the length field in front of them.
std::size_t block_bytes(void* block) {
    return block == nullptr ? 0 : malloc_usable_size(block) + sizeof(std::size_t);
}

void* count(void* block) {
    const std::size_t bytes = block_bytes(block);
    const std::size_t now = in_use.fetch_add(bytes, std::memory_order_relaxed) + bytes;
    std::size_t most = peak.load(std::memory_order_relaxed);
    while (now > most && !peak.compare_exchange_weak(most, now, std::memory_order_relaxed)) {
    }
    return block;
}

void discount(std::size_t bytes) {
    in_use.fetch_sub(bytes, std::memory_order_relaxed);
}

} // namespace

extern "C" {

void* malloc(std::size_t size) {
    return count(__libc_malloc(size));
}

void* calloc(std::size_t number, std::size_t size) {
    return count(__libc_calloc(number, size));
}

void* realloc(void* block, std::size_t size) {
    // While it is moved, old and new block exist at the same time; where the allocator can grow it or remap its pages
    // they do not. The peak counts one block, as the allocator's own statistics do.
    const std::size_t before = block_bytes(block);
    void* moved = __libc_realloc(block, size);
    if (moved == nullptr && size != 0) return nullptr;
    discount(before);
    return count(moved);
}

void free(void* block) {
    discount(block_bytes(block));
    __libc_free(block);
}

void* memalign(std::size_t alignment, std::size_t size) {
    return count(__libc_memalign(alignment, size));
}

void* aligned_alloc(std::size_t alignment, std::size_t size) {
    return count(__libc_memalign(alignment, size));
}

int posix_memalign(void** block, std::size_t alignment, std::size_t size) {
    void* made = __libc_memalign(alignment, size);
    if (made == nullptr) return ENOMEM;
    *block = count(made);
    return 0;
}

} // extern "C"

namespace hqf_bench {

std::size_t heap_bytes() {
    return in_use.load(std::memory_order_relaxed);
}
std::size_t heap_peak_bytes() {
    return peak.load(std::memory_order_relaxed);
}
void restart_heap_peak() {
    peak.store(in_use.load(std::memory_order_relaxed), std::memory_order_relaxed);
}

} // namespace hqf_bench
