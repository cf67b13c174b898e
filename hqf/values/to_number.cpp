#include "hqf/values/to_number.h"

#include <charconv>
#include <limits>

#include "hqf/values/eight_digits.h"
#include "hqf/values/lexical.h"
#include "hqf/values/lexical_spans.h"
#include "hqf/values/scan.h"
#include "hqf/values/short_decimal.h"

namespace hqf {

namespace {

using lmx::is_digit;

constexpr int largest_exact_power = 22;
constexpr std::uint64_t exact_integers = std::uint64_t{1} << 53;
constexpr std::uint64_t integer_powers[] = {1, 10, 100, 1000, 10000, 100000, 1000000, 10000000, 100000000};
constexpr int safe_digits = 19; // any 19 digits fit 64 bits

/// Beyond every exponent that matters, and far from the limits of the arithmetic with it.
constexpr std::int64_t exponent_limit = 100000000000000000;

constexpr std::int64_t add_digit(std::int64_t exponent, char digit) {
    return exponent < exponent_limit ? exponent * 10 + (digit - '0') : exponent;
}

/// Whether a number that lies outside the range is too large rather than too small, from the place of its first digit
/// that isn't zero. `exponent_mark` is 'e' for decimal digits and 'p' for hexadecimal ones, in lower case.
bool is_huge(const char* begin, const char* end, char exponent_mark) {
    const std::int64_t weight = exponent_mark == 'p' ? 4 : 1;
    std::int64_t places = 0; // of the first significant digit above the point, negative below it
    bool significant = false;
    bool behind_point = false;
    const char* p = begin;
    for (; p != end && (*p | 0x20) != exponent_mark; ++p) {
        if (*p == '.') {
            behind_point = true;
            continue;
        }
        significant = significant || *p != '0';
        if (significant && !behind_point) ++places;
        if (!significant && behind_point) --places;
    }
    std::int64_t exponent = 0;
    bool negative = false;
    if (p != end) {
        ++p;
        negative = p != end && *p == '-';
        lmx::scan_sign(p, end);
        for (; p != end && is_digit(*p); ++p)
            exponent = add_digit(exponent, *p);
    }
    return places * weight + (negative ? -exponent : exponent) > 0;
}

/// The number at `begin`, which has no sign, and its end; null where none begins.
const char* from_chars(const char* begin, const char* end, std::chars_format format, double& value) {
    const std::from_chars_result result = std::from_chars(begin, end, value, format);
    if (result.ec == std::errc::invalid_argument) return nullptr;
    if (result.ec == std::errc::result_out_of_range) {
        const char exponent_mark = format == std::chars_format::hex ? 'p' : 'e';
        value = is_huge(begin, result.ptr, exponent_mark) ? std::numeric_limits<double>::infinity() : 0.0;
    }
    return result.ptr;
}

bool is_hex_digit(char c) {
    return is_digit(c) || ((c | 0x20) >= 'a' && (c | 0x20) <= 'f');
}

/// The prefix that announces a hexadecimal number is one only before a digit: "0xg" is the number 0.
bool has_hex_prefix(const char* p, const char* end) {
    if (end - p < 3 || p[0] != '0' || (p[1] | 0x20) != 'x') return false;
    return is_hex_digit(p[2]) || (p[2] == '.' && end - p > 3 && is_hex_digit(p[3]));
}

/// `atof` of the "C" locale.
double general_to_double(const char* p, const char* end) {
    while (p != end && lmx::is_space(*p))
        ++p;
    const bool negative = p != end && *p == '-';
    lmx::scan_sign(p, end);
    double value = 0;
    if (p == end || *p == '-') return 0;
    const bool hex = has_hex_prefix(p, end);
    if (from_chars(hex ? p + 2 : p, end, hex ? std::chars_format::hex : std::chars_format::general, value) == nullptr)
        return 0;
    return negative ? -value : value;
}

struct saturated {
    std::uint64_t magnitude = 0;
    bool negative = false;
    bool overflow = false; // of 64 bits
};

/// The common part of `strtol` and `strtoul`.
saturated scan_integer(std::string_view text) {
    saturated number;
    const char* p = text.data();
    const char* const end = p + text.size();
    while (p != end && lmx::is_space(*p))
        ++p;
    number.negative = p != end && *p == '-';
    lmx::scan_sign(p, end);
    for (; p != end && is_digit(*p); ++p) {
        const auto digit = static_cast<std::uint64_t>(*p - '0');
        number.overflow = number.overflow || number.magnitude > (UINT64_MAX - digit) / 10;
        number.magnitude = number.magnitude * 10 + digit;
    }
    return number;
}

/// Moves over one of the three names; null where none stands.
const char* scan_named(const char* begin, const char* end, double& value) {
    const char* p = begin;
    if (lmx::scan_literal(p, end, "INF"))
        value = 1.0 / lmx::float_zero();
    else if (lmx::scan_literal(p, end, "-INF"))
        value = -1.0 / lmx::float_zero();
    else if (lmx::scan_literal(p, end, "NaN"))
        value = 0.0 / lmx::float_zero();
    else
        return nullptr;
    return p;
}

} // namespace

const char* scan_double(const char* begin, const char* end, double& value) {
    const char* p = begin;
    const bool negative = p != end && *p == '-';
    lmx::scan_sign(p, end);

    const char* const digits_begin = p;
    std::uint64_t mantissa = 0;
    for (; p != end && is_digit(*p); ++p)
        mantissa = mantissa * 10 + static_cast<std::uint64_t>(*p - '0');
    std::int64_t digits = p - digits_begin;
    std::int64_t exponent = 0;
    if (p != end && *p == '.') {
        const char* const fraction_begin = ++p;
        for (; p != end && is_digit(*p); ++p)
            mantissa = mantissa * 10 + static_cast<std::uint64_t>(*p - '0');
        exponent = fraction_begin - p;
        digits -= exponent;
    }
    if (digits == 0) return scan_named(begin, end, value);

    if (p != end && (*p == 'e' || *p == 'E')) {
        const char* q = p + 1;
        const bool negative_exponent = q != end && *q == '-';
        lmx::scan_sign(q, end);
        if (q != end && is_digit(*q)) {
            std::int64_t given = 0;
            for (; q != end && is_digit(*q); ++q)
                given = add_digit(given, *q);
            exponent += negative_exponent ? -given : given;
            p = q;
        }
    }

    double magnitude = 0;
    if (digits <= safe_digits && mantissa <= exact_integers && exponent >= -largest_exact_power &&
        exponent <= largest_exact_power) {
        const auto whole = static_cast<double>(mantissa);
        magnitude = exponent < 0 ? whole / exact_powers[-exponent] : whole * exact_powers[exponent];
    } else {
        from_chars(digits_begin, p, std::chars_format::general, magnitude);
    }
    value = negative ? -magnitude : magnitude;
    return p;
}

const char* scan_short_decimal(const char* begin, double& value) {
    if constexpr (!has_low_byte_first) return nullptr;
    const bool negative = *begin == '-';
    const char* const whole = begin + (negative ? 1 : 0);
    std::uint64_t eight = load_eight(whole);
    const unsigned int whole_digits = leading_digits(eight);
    if (whole_digits == 0 || whole_digits == 8) return nullptr;
    std::uint64_t mantissa = digits_value(eight, whole_digits);
    const char* end = whole + whole_digits;
    unsigned int fraction_digits = 0;
    if (*end == '.') {
        eight = load_eight(++end);
        fraction_digits = leading_digits(eight);
        if (fraction_digits == 0) return nullptr;
        mantissa = mantissa * integer_powers[fraction_digits] + digits_value(eight, fraction_digits);
        if (fraction_digits == 8) {
            eight = load_eight(end + 8);
            const unsigned int more = leading_digits(eight);
            if (whole_digits + 8 + more > 15) return nullptr;
            if (more != 0) mantissa = mantissa * integer_powers[more] + digits_value(eight, more);
            fraction_digits += more;
        }
        end += fraction_digits;
    }
    const double magnitude = static_cast<double>(mantissa) / exact_powers[fraction_digits];
    value = negative ? -magnitude : magnitude;
    return end;
}

bool read_short_integer(const char* begin, const char* end, std::int64_t& value) {
    constexpr std::ptrdiff_t most_digits = 18;
    const char* p = begin;
    const bool negative = p != end && *p == '-';
    lmx::scan_sign(p, end);
    if (p == end || end - p > most_digits) return false;
    std::int64_t magnitude = 0;
    for (; p != end; ++p) {
        if (!is_digit(*p)) return false;
        magnitude = magnitude * 10 + (*p - '0');
    }
    value = negative ? -magnitude : magnitude;
    return true;
}

bool read_bool(const char* begin, const char* end, bool& value) {
    if (!is_bool(begin, end)) return false;
    value = *begin == 't' || *begin == '1';
    return true;
}

double to_double(std::string_view text) {
    const char* const begin = text.data();
    const char* const end = begin + text.size();
    double value = 0;
    if (scan_named(begin, end, value) == end && begin != end) return value;
    return general_to_double(begin, end);
}

int to_int(std::string_view text) {
    constexpr auto largest = static_cast<std::uint64_t>(INT64_MAX);
    const saturated number = scan_integer(text);
    if (number.negative) {
        const bool fits = !number.overflow && number.magnitude <= largest + 1;
        return static_cast<int>(fits ? 0 - number.magnitude : largest + 1);
    }
    return static_cast<int>(number.overflow || number.magnitude > largest ? largest : number.magnitude);
}

unsigned int to_unsigned(std::string_view text) {
    const saturated number = scan_integer(text);
    if (number.overflow) return UINT32_MAX;
    return static_cast<unsigned int>(number.negative ? 0 - number.magnitude : number.magnitude);
}

bool to_bool(std::string_view text) {
    return text == "true" || text == "1";
}

} // namespace hqf
