/// The allocator of platform strings.

#include "hqf/flat/platform_strings.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <new>

#include "hqf/flat/hqf_flat.h"

namespace {

using length_type = std::uint32_t;

/// What lies before the first unit. It is as large as the alignment of a block, so that the units keep it; the length
/// is its last field.
constexpr std::size_t head = alignof(std::max_align_t);
static_assert(head >= sizeof(length_type));

char* new_string(const void* bytes, std::size_t size) {
    if (size > std::numeric_limits<length_type>::max()) return nullptr;
    auto* const block = static_cast<char*>(std::calloc(1, head + size + sizeof(wchar_t)));
    if (block == nullptr) return nullptr;
    char* const text = block + head;
    const auto length = static_cast<length_type>(size);
    std::memcpy(text - sizeof length, &length, sizeof length);
    if (bytes != nullptr && size > 0) std::memcpy(text, bytes, size);
    return text;
}

/// A wide string's bytes lie aligned for its units, because `head` is.
wchar_t* as_wide(void* text) {
    return static_cast<wchar_t*>(text);
}

} // namespace

wchar_t* SysAllocStringLen(const wchar_t* text, uint32_t size) {
    return as_wide(new_string(text, std::size_t{size} * sizeof(wchar_t)));
}

char* SysAllocStringByteLen(const char* text, uint32_t size) {
    return new_string(text, size);
}

void SysFreeString(void* text) {
    if (text != nullptr) std::free(static_cast<char*>(text) - head);
}

uint32_t SysStringByteLen(const void* text) {
    length_type length = 0;
    if (text != nullptr) std::memcpy(&length, static_cast<const char*>(text) - sizeof length, sizeof length);
    return length;
}

uint32_t SysStringLen(const void* text) {
    return SysStringByteLen(text) / static_cast<uint32_t>(sizeof(wchar_t));
}

namespace hqf::flat {

namespace {

template<class text_type>
uint32_t checked_size(const text_type& text) {
    if (text.size() > std::numeric_limits<uint32_t>::max()) throw std::bad_alloc();
    return static_cast<uint32_t>(text.size());
}

template<class unit>
unit* made(unit* string) {
    return string != nullptr ? string : throw std::bad_alloc();
}

} // namespace

wchar_t* platform_string(const std::wstring& text) {
    return made(SysAllocStringLen(text.data(), checked_size(text)));
}

char* platform_string(const std::string& text) {
    return made(SysAllocStringByteLen(text.data(), checked_size(text)));
}

} // namespace hqf::flat
