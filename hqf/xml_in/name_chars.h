#pragma once

#include <array>

/// What counts as white space and as part of a name. Wider than XML 1.0, 2.3 on purpose: nothing above ASCII is judged.

namespace hqf {

/// Also vertical tab and form feed. False for -1, the end of input.
constexpr bool is_white_space(int c) {
    return c == ' ' || (c >= 9 && c <= 13);
}

namespace name_chars {
enum : unsigned char { start = 1, part = 2 };

constexpr std::array<unsigned char, 256> make_table() {
    std::array<unsigned char, 256> table{};
    for (unsigned c = 0; c < 256; ++c) {
        const bool is_letter = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
        const bool is_digit = c >= '0' && c <= '9';
        if (is_letter || c == '_' || c == ':' || c > 127)
            table[c] = start | part;
        else if (is_digit || c == '.' || c == '-')
            table[c] = part;
    }
    return table;
}

inline constexpr std::array<unsigned char, 256> table = make_table();
} // namespace name_chars

/// Whether a name can start with this byte. Takes 0 to 255, or -1, for which it is false.
constexpr bool is_name_start(int c) {
    return c >= 0 && (name_chars::table[static_cast<unsigned>(c)] & name_chars::start) != 0;
}

/// Whether a name can go on with this byte. Takes 0 to 255, or -1, for which it is false.
constexpr bool is_name_char(int c) {
    return c >= 0 && (name_chars::table[static_cast<unsigned>(c)] & name_chars::part) != 0;
}

} // namespace hqf
