#pragma once

#include <iosfwd>
#include <string>

#include "hqf/platform/api.h"
#include "hqf/values/c_big_int.h"

namespace lmx {

/// A decimal number of any size, xs:decimal (XML Schema Part 2, 3.2.3), kept as digits: "1.50" and "1.5" are different
/// objects that compare equal. A negative zero is possible.
///
/// A plain value: one object, one thread. Nothing here reports an error.
class HQF_API c_decimal {
public:
    /// Zero.
    c_decimal() = default;
    c_decimal(const c_decimal&) = default;
    /// Takes an optional sign, digits, and if a "." follows, the digits behind it; anything after them is ignored. A
    /// null pointer is zero.
    c_decimal(const char* text);
    c_decimal(const std::string& text);
    /// `value` divided by ten to the power `scale`: (12345, 2) is 123.45 and (5, -2) is 500. A plain `int` alone fits
    /// both this and the next constructor: write `5L` or `5.0`.
    c_decimal(long value, int scale = 0);
    /// As `set`.
    c_decimal(double value, unsigned int digits = 15);

    c_decimal& operator=(const c_decimal&) = default;
    c_decimal& operator=(const char* text);
    c_decimal& operator=(const std::string& text);
    /// As `set` with 15 digits.
    c_decimal& operator=(double value);

    /// Takes the text of `value` in fixed notation with `digits` decimals, at most 15, as the C library writes it: in a
    /// locale whose decimal point isn't ".", only the integral part is taken.
    void set(double value, unsigned int digits = 15);
    void swap(c_decimal& other) noexcept;

    /// Whether the text is an optional sign and digits with an optional point among or around them.
    static bool is_valid(const std::string& text);

    /// The integral part with the value's sign, as a 32-bit number, wrapped where it doesn't fit.
    ///
    /// \param overflow may be null; otherwise gets whether the magnitude exceeds 2147483647
    long get_integral(bool* overflow) const;
    /// Sets integral part and sign; the digits behind the point stay.
    void set_integral(long value);

    /// The first `digits` digits behind the point as a 32-bit number, filled up with zeros: 500 for 3 digits of 1.5.
    ///
    /// \param overflow may be null; otherwise gets whether that exceeds 4294967295
    unsigned long get_fractional(int digits, bool* overflow) const;
    /// Sets the digits behind the point to those of `value`: with zeros in front up to `width` digits, or only its
    /// first `width` ones.
    void set_fractional(unsigned long value, unsigned int width);

    /// The value times ten to the power `scale`, truncated, as a 32-bit number, wrapped where it doesn't fit.
    ///
    /// \param overflow may be null; otherwise gets whether the magnitude exceeds 2147483647
    long get_scaled(int scale, bool* overflow) const;
    /// Replaces the whole value by `value` divided by ten to the power `scale`. A scale makes that many digits.
    void set_scaled(long value, int scale = 0);

    /// The value as a `double`, accumulated digit by digit.
    double get_as_float() const;
    /// The text that insertion gives.
    std::string get_as_string() const;

    /// Trailing zeros make no difference. Zero is greater than negative zero, and not equal to it.
    friend HQF_API bool operator==(const c_decimal& a, const c_decimal& b);
    friend HQF_API bool operator!=(const c_decimal& a, const c_decimal& b);
    friend HQF_API bool operator<(const c_decimal& a, const c_decimal& b);
    friend HQF_API bool operator<=(const c_decimal& a, const c_decimal& b);
    friend HQF_API bool operator>(const c_decimal& a, const c_decimal& b);
    friend HQF_API bool operator>=(const c_decimal& a, const c_decimal& b);

    /// Writes sign, integral part and the digits behind the point. A zero integral part is left out where there are
    /// such digits: ".5".
    friend HQF_API std::ostream& operator<<(std::ostream& os, const c_decimal& value);

private:
    void assign(const char* begin, const char* end);

    bool is_negative_ = false;
    c_big_int integral_; // never negative
    std::string fraction_;
};

} // namespace lmx
