/// Numbers of at most seven characters besides the sign, which most measured values are, in one register.
#pragma once

#include <cstdint>

#include "hqf/values/eight_digits.h"

namespace hqf {

/// Powers of ten that a double holds exactly: a quotient or product of two exact numbers is the nearest double.
inline constexpr double exact_powers[] = {1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,  1e8,  1e9,  1e10, 1e11,
                                          1e12, 1e13, 1e14, 1e15, 1e16, 1e17, 1e18, 1e19, 1e20, 1e21, 1e22};

/// The number at `begin`, if it has only a few digits, with at most one point, which stands between digits.
///
/// \returns the end of the form; null for any other, with nothing said about it. Precondition: 9 bytes can be read.
inline const char* scan_few_digits(const char* begin, double& value) {
    if constexpr (!has_low_byte_first) return nullptr;
    const bool negative = *begin == '-';
    const char* const text = begin + (negative ? 1 : 0);
    std::uint64_t eight = load_eight(text);
    std::uint64_t others = non_digits(eight);
    if (others == 0) return nullptr;
    const unsigned int whole = first_place(others);
    if (whole == 0) return nullptr;
    unsigned int digits = whole, fraction = 0;
    if (text[whole] == '.') {
        others &= others - 1;
        if (others == 0) return nullptr;
        digits = first_place(others) - 1;
        fraction = digits - whole;
        if (fraction == 0) return nullptr;
        // Without the point, what stands behind it moves up.
        const std::uint64_t before = (std::uint64_t{1} << 8 * whole) - 1;
        eight = (eight & before) | (eight >> 8 & ~before);
    }
    const auto magnitude = static_cast<double>(static_cast<std::int64_t>(digits_value(eight, digits)));
    value = (negative ? -magnitude : magnitude) / exact_powers[fraction];
    return text + digits + (fraction == 0 ? 0 : 1);
}

} // namespace hqf
