#include "hqf/values/number_text.h"

#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <locale>
#include <ostream>

#include "hqf/values/digit_pairs.h"

namespace hqf {

namespace {

char* put(char* out, const char* text) {
    const std::size_t size = std::strlen(text);
    std::memcpy(out, text, size);
    return out + size;
}

/// The numbers that are written by name; null for any other.
template<class number>
const char* name_of(number value) {
    if (std::isnan(value)) return "NaN";
    if (value == 0) return std::signbit(value) ? "-0.0" : "0.0";
    if (std::isinf(value)) return value < 0 ? "-INF" : "INF";
    return nullptr;
}

char* put_digits(char* out, std::uint64_t value) {
    if (value < 10) {
        *out = static_cast<char>('0' + value);
        return out + 1;
    }
    if (value < 100) return put_pair(out, value);
    if (value < 1000) {
        *out = static_cast<char>('0' + value / 100);
        return put_pair(out + 1, value % 100);
    }
    return std::to_chars(out, out + 20, value).ptr;
}

/// Writes exactly `count` digits.
template<int count>
char* put_fixed_digits(char* out, std::uint64_t value) {
    if constexpr (count % 2 == 1) {
        constexpr std::uint64_t first = count == 1 ? 1 : count == 3 ? 100 : 10000;
        *out = static_cast<char>('0' + value / first);
        return put_fixed_digits<count - 1>(out + 1, value % first);
    } else {
        for (int i = count - 2; i >= 0; i -= 2) {
            put_pair(out + i, value % 100);
            value /= 100;
        }
        return out + count;
    }
}

/// Writes the decimal fraction `scaled` / `power`, which is ten to the power `decimals`, without zeros at its end.
template<int decimals, std::uint64_t power>
char* put_decimal(char* out, std::uint64_t scaled) {
    out = put_digits(out, scaled / power);
    const std::uint64_t fraction = scaled % power;
    if (fraction == 0) return out;
    *out++ = '.';
    out = put_fixed_digits<decimals>(out, fraction);
    while (out[-1] == '0')
        --out;
    return out;
}

/// Writes `value` if it is the nearest double to a decimal with so many places; gives null if not.
template<int decimals, std::uint64_t power>
char* put_with_decimals(char* out, double value) {
    constexpr double most_digits = 1e14;
    constexpr auto scale = static_cast<double>(power);
    const double scaled = value * scale + 0.5;
    if (!(scaled < most_digits)) return nullptr;
    const auto whole = static_cast<std::int64_t>(scaled);
    return static_cast<double>(whole) / scale == value
               ? put_decimal<decimals, power>(out, static_cast<std::uint64_t>(whole))
               : nullptr;
}

/// Writes a positive number that is the nearest double to a decimal of at most 14 digits; gives null for any other.
///
/// Such a decimal lies on the grid of 14 significant digits, and the double lies nearer to it than to any neighbour on
/// that grid, so rounding the double to 14 digits gives it back. Which decimal that is, a division tells: both its
/// operands are exact, so its result is the nearest double to their quotient.
char* put_short_decimal(char* out, double value) {
    const auto whole = static_cast<std::int64_t>(value);
    if (static_cast<double>(whole) == value) return put_digits(out, static_cast<std::uint64_t>(whole));
    char* end = put_with_decimals<4, 10000>(out, value);
    if (end == nullptr) end = put_with_decimals<6, 1000000>(out, value);
    if (end == nullptr) end = put_with_decimals<10, 10000000000>(out, value);
    return end;
}

} // namespace

char* write_number(char* out, double value) {
    // Below this the general format turns to exponents; above, few decimals are left in 14 digits.
    constexpr double smallest = 1e-4, largest = 1e10;
    const double magnitude = std::fabs(value);
    if (magnitude >= smallest && magnitude < largest) {
        const bool negative = value < 0;
        if (negative) *out = '-';
        if (char* const end = put_short_decimal(out + negative, magnitude)) return end;
    } else if (const char* const name = name_of(value)) {
        return put(out, name);
    }
    return std::to_chars(out, out + number_text_size, value, std::chars_format::general, 14).ptr;
}

char* write_number(char* out, float value) {
    if (const char* const name = name_of(value)) return put(out, name);
    return std::to_chars(out, out + number_text_size, value, std::chars_format::general, 7).ptr;
}

char* write_number(char* out, int value) {
    return std::to_chars(out, out + number_text_size, value).ptr;
}

char* write_number(char* out, unsigned int value) {
    return std::to_chars(out, out + number_text_size, value).ptr;
}

bool has_default_format(const std::ostream& os) {
    using ios = std::ios_base;
    constexpr auto format_flags = ios::basefield | ios::floatfield | ios::adjustfield | ios::showbase | ios::showpoint |
                                  ios::showpos | ios::uppercase;
    return (os.flags() & format_flags) == ios::dec && os.precision() == 6 && os.width() == 0 &&
           os.getloc() == std::locale::classic();
}

} // namespace hqf
