#pragma once

#include <cstddef>
#include <string>

/// Changing between UTF-8 and UTF-16 on spans, for the roads in and out of a document; the functions of text.h stand on
/// these and share their rules.

namespace hqf {

/// The most bytes that are read as one character: the two halves of a surrogate pair, encoded each for itself.
inline constexpr std::size_t longest_character = 6;

/// The most wide elements that a character gives.
inline constexpr std::ptrdiff_t longest_pair = 2;

/// Writes the UTF-16 form of bytes of UTF-8 from `next` on, as long as there is room for any character before `limit`,
/// and moves `next` over them, up to a character that is none or is cut off. Gives the end of what was written.
wchar_t* write_wide(wchar_t* out, const wchar_t* limit, const char*& next, const char* end);

/// Appends the UTF-16 form of `size` bytes of UTF-8, up to a character that is none or is cut off. Gives the place that
/// it got to.
const char* append_wide(std::wstring& out, const char* data, std::size_t size);

/// Writes the UTF-8 form of wide elements from `next` on, whole characters as far as they fit before `limit`, and moves
/// `next` over them. Gives the end of what was written.
char* write_utf8(char* out, const char* limit, const wchar_t*& next, const wchar_t* end);

/// Appends the UTF-8 form of `size` wide elements.
void append_utf8(std::string& out, const wchar_t* data, std::size_t size);

inline void assign_wide(std::wstring& out, const char* data, std::size_t size) {
    out.clear();
    append_wide(out, data, size);
}

inline void assign_utf8(std::string& out, const wchar_t* data, std::size_t size) {
    out.clear();
    append_utf8(out, data, size);
}

/// Takes apart the UTF-8 sequence at `in`, which isn't the end, and gives its length; 0 when it is none or is cut off.
/// Overlong forms and surrogates pass.
std::size_t decode_sequence(const char* in, const char* end, char32_t& value);

/// Encodes a character from 0 to U+10FFFF, surrogates included, without a NUL; gives the end of what was written.
char* encode_utf8(char32_t c, char* out);

/// The element as a character: itself up to U+10FFFF, otherwise U+FFFD. A 32-bit `wchar_t` can hold anything, and its
/// low byte must not reach a document unchecked.
constexpr char32_t to_character(wchar_t element) {
    const auto c = static_cast<char32_t>(element);
    return c <= 0x10FFFF ? c : 0xFFFD;
}

constexpr bool is_high_surrogate(char32_t c) {
    return c >= 0xD800 && c <= 0xDBFF;
}
constexpr bool is_low_surrogate(char32_t c) {
    return c >= 0xDC00 && c <= 0xDFFF;
}

/// The character of a surrogate pair.
constexpr char32_t join_surrogates(char32_t high, char32_t low) {
    return (((high & 0x3FF) + 0x40) << 10) | (low & 0x3FF);
}

} // namespace hqf
