#include "hqf/values/number_text.h"

#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <locale>
#include <ostream>

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
    return std::to_chars(out, out + 20, value).ptr;
}

/// Writes the decimal fraction `scaled` / 10^`decimals`, without zeros at its end.
char* put_decimal(char* out, std::uint64_t scaled, int decimals) {
    while (decimals > 0 && scaled % 10 == 0) {
        scaled /= 10;
        --decimals;
    }
    char digits[20];
    const auto count = static_cast<int>(put_digits(digits, scaled) - digits);
    const int whole = count > decimals ? count - decimals : 0;
    if (whole == 0) *out++ = '0';
    std::memcpy(out, digits, static_cast<std::size_t>(whole));
    out += whole;
    if (decimals == 0) return out;
    *out++ = '.';
    for (int zeros = decimals - (count - whole); zeros > 0; --zeros)
        *out++ = '0';
    std::memcpy(out, digits + whole, static_cast<std::size_t>(count - whole));
    return out + (count - whole);
}

/// Writes a positive number that is the nearest double to a decimal of at most 14 digits; gives null for any other.
///
/// Such a decimal lies on the grid of 14 significant digits, and the double lies nearer to it than to any neighbour on
/// that grid, so rounding the double to 14 digits gives it back. Which decimal that is, a division tells: both its
/// operands are exact, so its result is the nearest double to their quotient.
char* put_short_decimal(char* out, double value) {
    constexpr double smallest = 1e-4; // the general format turns to exponents below this
    constexpr double most_digits = 1e14;
    constexpr struct {
        int decimals;
        double power;
    } scales[] = {{3, 1e3}, {6, 1e6}, {10, 1e10}};
    if (value < smallest) return nullptr;
    for (const auto& scale : scales) {
        const double scaled = value * scale.power + 0.5;
        if (!(scaled < most_digits)) break;
        const auto whole = static_cast<std::int64_t>(scaled);
        if (static_cast<double>(whole) / scale.power == value)
            return put_decimal(out, static_cast<std::uint64_t>(whole), scale.decimals);
    }
    return nullptr;
}

} // namespace

char* write_number(char* out, double value) {
    if (const char* const name = name_of(value)) return put(out, name);
    const bool negative = value < 0;
    if (negative) *out = '-';
    if (char* const end = put_short_decimal(out + negative, negative ? -value : value)) return end;
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
