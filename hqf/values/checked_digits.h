#pragma once

#include <cstdint>

/// Numbers of 32 bits made digit by digit, which wrap and say so. The limits are those of the interface, whatever width
/// the platform's `long` has.

namespace hqf {

/// Magnitude of a signed number: at most 2147483647, also where a minus stands before it.
struct signed_digits {
    std::uint32_t value = 0;
    bool overflow = false;

    constexpr void add(char digit) {
        const auto d = static_cast<std::uint32_t>(digit - '0');
        overflow = overflow || value > 214748364 || 2147483647 - value * 10 < d;
        value = value * 10 + d;
    }

    constexpr std::int32_t with_sign(bool negative) const {
        return static_cast<std::int32_t>(negative ? 0 - value : value);
    }
};

/// An unsigned number, at most 4294967295.
struct unsigned_digits {
    std::uint32_t value = 0;
    bool overflow = false;

    constexpr void add(char digit) {
        const auto d = static_cast<std::uint32_t>(digit - '0');
        overflow = overflow || value > 429496729 || 4294967295 - value * 10 < d;
        value = value * 10 + d;
    }
};

/// Multiplies by ten for each of `count` missing digits. A value of 0 ends it: wrapping reaches that within 32 steps,
/// however large the count.
template<class digits>
constexpr void add_zeros(digits& number, std::int64_t count) {
    for (; count > 0 && number.value != 0; --count)
        number.add('0');
}

} // namespace hqf
