// The functions that count: the callback of -fsanitize-coverage=trace-pc, the memory functions of C, and malloc. The
// executable's definitions are those that the shared libraries find, too, so that what std::string does inside of its
// library counts.

#include "tests/growth/counters.h"

#include <malloc.h>

#include <algorithm>
#include <cstddef>
#include <cwchar>

namespace {

std::uint64_t blocks, bytes, allocations, in_use, peak, in_use_at_start;

void* taken(void* block) {
    if (block == nullptr) return nullptr;
    ++allocations;
    in_use += malloc_usable_size(block);
    peak = std::max(peak, in_use);
    return block;
}

void given_back(void* block) {
    if (block != nullptr) in_use -= malloc_usable_size(block);
}

template<class unit>
unit* copy(unit* to, const unit* from, std::size_t count) {
    bytes += count * sizeof(unit);
    for (std::size_t i = 0; i < count; ++i)
        to[i] = from[i];
    return to;
}

template<class unit>
unit* move(unit* to, const unit* from, std::size_t count) {
    if (to <= from) return copy(to, from, count);
    bytes += count * sizeof(unit);
    while (count-- != 0)
        to[count] = from[count];
    return to;
}

template<class unit>
unit* fill(unit* to, unit value, std::size_t count) {
    bytes += count * sizeof(unit);
    for (std::size_t i = 0; i < count; ++i)
        to[i] = value;
    return to;
}

/// The first unit that is `value` or, where that ends the search, zero; the end if there is none.
template<bool is_text, class unit>
const unit* search(const unit* from, unit value, std::size_t count) {
    const unit* at = from;
    while (count-- != 0 && *at != value && !(is_text && *at == 0))
        ++at;
    bytes += static_cast<std::size_t>(at - from) * sizeof(unit);
    return at;
}

template<bool is_text, class unit>
int compare(const unit* a, const unit* b, std::size_t count) {
    std::size_t i = 0;
    while (i < count && a[i] == b[i] && !(is_text && a[i] == 0))
        ++i;
    bytes += i * sizeof(unit);
    return i == count || a[i] == b[i] ? 0 : a[i] < b[i] ? -1 : 1;
}

using byte = unsigned char;
constexpr std::size_t no_limit = static_cast<std::size_t>(-1);

} // namespace

namespace growth {

void restart() {
    blocks = bytes = allocations = 0;
    peak = in_use_at_start = in_use;
}

counts counted() {
    return {blocks + bytes / 16, allocations, peak - in_use_at_start};
}

} // namespace growth

extern "C" {

void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* block, std::size_t size);
void* __libc_memalign(std::size_t alignment, std::size_t size);
void __libc_free(void* block);

void __sanitizer_cov_trace_pc() {
    ++blocks;
}

void* malloc(std::size_t size) {
    return taken(__libc_malloc(size));
}
void* calloc(std::size_t count, std::size_t size) {
    return taken(__libc_calloc(count, size));
}
void* realloc(void* block, std::size_t size) {
    // Counted as if it always moved.
    bytes += block == nullptr ? 0 : malloc_usable_size(block);
    given_back(block);
    return taken(__libc_realloc(block, size));
}
void* aligned_alloc(std::size_t alignment, std::size_t size) {
    return taken(__libc_memalign(alignment, size));
}
void free(void* block) {
    given_back(block);
    __libc_free(block);
}

void* memcpy(void* to, const void* from, std::size_t count) {
    return copy(static_cast<byte*>(to), static_cast<const byte*>(from), count);
}
void* memmove(void* to, const void* from, std::size_t count) {
    return move(static_cast<byte*>(to), static_cast<const byte*>(from), count);
}
void* memset(void* to, int value, std::size_t count) {
    return fill(static_cast<byte*>(to), static_cast<byte>(value), count);
}
int memcmp(const void* a, const void* b, std::size_t count) {
    return compare<false>(static_cast<const byte*>(a), static_cast<const byte*>(b), count);
}
void* memchr(const void* from, int value, std::size_t count) {
    const byte* const begin = static_cast<const byte*>(from);
    const byte* const found = search<false>(begin, static_cast<byte>(value), count);
    return found == begin + count ? nullptr : const_cast<byte*>(found);
}
std::size_t strlen(const char* text) {
    return static_cast<std::size_t>(search<true>(text, '\0', no_limit) - text);
}
char* strchr(const char* text, int value) {
    const char* const found = search<true>(text, static_cast<char>(value), no_limit);
    return *found == static_cast<char>(value) ? const_cast<char*>(found) : nullptr;
}
int strcmp(const char* a, const char* b) {
    return compare<true>(reinterpret_cast<const byte*>(a), reinterpret_cast<const byte*>(b), no_limit);
}
wchar_t* wmemcpy(wchar_t* to, const wchar_t* from, std::size_t count) {
    return copy(to, from, count);
}
wchar_t* wmemmove(wchar_t* to, const wchar_t* from, std::size_t count) {
    return move(to, from, count);
}
wchar_t* wmemset(wchar_t* to, wchar_t value, std::size_t count) {
    return fill(to, value, count);
}
int wmemcmp(const wchar_t* a, const wchar_t* b, std::size_t count) {
    return compare<false>(a, b, count);
}
std::size_t wcslen(const wchar_t* text) {
    return static_cast<std::size_t>(search<true>(text, L'\0', no_limit) - text);
}

} // extern "C"
