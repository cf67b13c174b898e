/// Digits eight at a time, in one register: for numbers and dates in their common forms, of which a large document has
/// hundreds of thousands. For machines that store the low byte first; others take the long road.
#pragma once

#include <bit>
#include <cstdint>
#include <cstring>

namespace hqf {

inline constexpr bool has_low_byte_first = std::endian::native == std::endian::little;

inline std::uint64_t load_eight(const char* text) {
    std::uint64_t eight = 0;
    std::memcpy(&eight, text, sizeof eight);
    return eight;
}

/// A high bit in each byte that differs from `form` by more than a digit does: where the form has '0', any digit may
/// stand, and `slack` has 0x76; where it has another character, that one must, and `slack` has 0x7F. Behind the first
/// such byte other bits may be wrong.
constexpr std::uint64_t differences(std::uint64_t eight, std::uint64_t form, std::uint64_t slack) {
    const std::uint64_t difference = eight ^ form;
    return ((difference + slack) | difference) & 0x8080808080808080;
}

/// A high bit in each byte that is no digit, up to the first of them that is not ASCII.
constexpr std::uint64_t non_digits(std::uint64_t eight) {
    return differences(eight, 0x3030303030303030, 0x7676767676767676);
}
/// The place of the first byte with a bit; 8 without any.
constexpr unsigned int first_place(std::uint64_t bits) {
    return static_cast<unsigned int>(std::countr_zero(bits)) / 8;
}

/// How many digits the eight characters begin with.
constexpr unsigned int leading_digits(std::uint64_t eight) {
    return first_place(non_digits(eight));
}

/// The value of the first `count` characters, which are digits; from 1 to 8.
constexpr std::uint64_t digits_value(std::uint64_t eight, unsigned int count) {
    // The first digit has the highest place and lies in the lowest byte: zeros move in before it.
    eight = (eight & 0x0F0F0F0F0F0F0F0F) << (8 * (8 - count));
    eight = (eight * (10 * (1 << 8) + 1)) >> 8 & 0x00FF00FF00FF00FF;
    eight = (eight * (100 * (std::uint64_t{1} << 16) + 1)) >> 16 & 0x0000FFFF0000FFFF;
    return (eight * (10000 * (std::uint64_t{1} << 32) + 1)) >> 32;
}

} // namespace hqf
