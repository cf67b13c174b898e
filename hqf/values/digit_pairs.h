/// Digits two at a time on the way out, for numbers and dates.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace hqf {

/// The digits of the numbers from 00 to 99.
inline constexpr auto digit_pairs = [] {
    std::array<char, 200> pairs{};
    for (int i = 0; i < 100; ++i) {
        pairs[static_cast<std::size_t>(2 * i)] = static_cast<char>('0' + i / 10);
        pairs[static_cast<std::size_t>(2 * i + 1)] = static_cast<char>('0' + i % 10);
    }
    return pairs;
}();

/// Writes a number below 100 with two digits.
inline char* put_pair(char* out, std::uint64_t value) {
    std::memcpy(out, digit_pairs.data() + 2 * value, 2);
    return out + 2;
}

} // namespace hqf
