#pragma once

#include <cstdint>
#include <cstring>

/// The steps from which the lexical checks and the assignments from text are made. Each moves a cursor over what it
/// recognises and stays inside the text, whose end is given: the same code judges a string and a span of a document.
///
/// Only the ASCII digits are digits and only the six ASCII characters are whitespace, whatever the locale says.

namespace lmx {

constexpr bool is_digit(char c) {
    return c >= '0' && c <= '9';
}
constexpr bool is_space(char c) {
    return c == ' ' || (c >= '\t' && c <= '\r');
}

/// Moves over digits; gives how many.
constexpr unsigned int scan_digits(const char*& cursor, const char* end) {
    const char* const begin = cursor;
    while (cursor != end && is_digit(*cursor))
        ++cursor;
    return static_cast<unsigned int>(cursor - begin);
}

/// Moves over one sign; false when none stands here.
constexpr bool scan_sign(const char*& cursor, const char* end) {
    if (cursor == end || (*cursor != '-' && *cursor != '+')) return false;
    ++cursor;
    return true;
}

/// Moves over one character; false when another one stands here.
constexpr bool scan_literal(const char*& cursor, const char* end, char literal) {
    if (cursor == end || *cursor != literal) return false;
    ++cursor;
    return true;
}

/// Moves over a text; otherwise the cursor stays. The empty text always stands here.
inline bool scan_literal(const char*& cursor, const char* end, const char* literal) {
    const std::size_t size = std::strlen(literal);
    if (static_cast<std::size_t>(end - cursor) < size || std::memcmp(cursor, literal, size) != 0) return false;
    cursor += size;
    return true;
}

/// Moves over digits and an optional point with digits; gives how many characters. A lone point gives 0.
constexpr unsigned int scan_number(const char*& cursor, const char* end) {
    const char* const begin = cursor;
    unsigned int digits = scan_digits(cursor, end);
    if (scan_literal(cursor, end, '.')) digits += scan_digits(cursor, end);
    if (digits == 0) cursor = begin;
    return static_cast<unsigned int>(cursor - begin);
}

/// Moves over digits and gives how many; `out` gets their value, modulo 2 to the power 32.
constexpr unsigned int scan_unsigned(const char*& cursor, const char* end, std::uint32_t& out) {
    const char* const begin = cursor;
    for (out = 0; cursor != end && is_digit(*cursor); ++cursor)
        out = out * 10 + static_cast<std::uint32_t>(*cursor - '0');
    return static_cast<unsigned int>(cursor - begin);
}

/// Moves over digits and an optional point with digits, and gives how many characters, the point included.
///
/// Accumulates in single precision: the sum of rounded steps, not the nearest `float` to the text, is the value of
/// seconds, and stored values must not depend on the road by which they were read.
constexpr unsigned int scan_seconds(const char*& cursor, const char* end, float& out) {
    const char* const begin = cursor;
    for (out = 0; cursor != end && is_digit(*cursor); ++cursor)
        out = out * 10.0f + static_cast<float>(*cursor - '0');
    if (scan_literal(cursor, end, '.'))
        for (float weight = 0.1f; cursor != end && is_digit(*cursor); ++cursor, weight /= 10.0f)
            out += static_cast<float>(*cursor - '0') * weight;
    return static_cast<unsigned int>(cursor - begin);
}

} // namespace lmx
