#include "hqf/values/c_decimal.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <ostream>
#include <string_view>

#include "hqf/values/checked_digits.h"
#include "hqf/values/scan.h"

namespace lmx {

namespace {

unsigned long magnitude(long value) {
    return value < 0 ? 0 - static_cast<unsigned long>(value) : static_cast<unsigned long>(value);
}

/// Orders two runs of digits behind the point; a missing digit counts as zero. Below, at or above 0.
int compare_fractions(std::string_view a, std::string_view b) {
    for (std::size_t i = 0; i < std::max(a.size(), b.size()); ++i) {
        const int difference = (i < a.size() ? a[i] : '0') - (i < b.size() ? b[i] : '0');
        if (difference != 0) return difference;
    }
    return 0;
}

} // namespace

c_decimal::c_decimal(const char* text) {
    *this = text;
}

c_decimal::c_decimal(const std::string& text) {
    *this = text;
}

c_decimal::c_decimal(long value, int scale) {
    set_scaled(value, scale);
}

c_decimal::c_decimal(double value, unsigned int digits) {
    set(value, digits);
}

c_decimal& c_decimal::operator=(const char* text) {
    if (text == nullptr) text = "";
    assign(text, text + std::strlen(text));
    return *this;
}

c_decimal& c_decimal::operator=(const std::string& text) {
    assign(text.data(), text.data() + text.size());
    return *this;
}

c_decimal& c_decimal::operator=(double value) {
    set(value, 15);
    return *this;
}

void c_decimal::assign(const char* begin, const char* end) {
    const char* cursor = begin;
    is_negative_ = cursor != end && *cursor == '-';
    scan_sign(cursor, end);
    const char* const integral = cursor;
    scan_digits(cursor, end);
    integral_ = std::string(integral, cursor);
    fraction_.clear();
    if (!scan_literal(cursor, end, '.')) return;
    const char* const fraction = cursor;
    scan_digits(cursor, end);
    fraction_.assign(fraction, cursor);
}

void c_decimal::set(double value, unsigned int digits) {
    constexpr unsigned int most_digits = 15;
    char text[400]; // the largest double has 309 digits before its point
    const int size = std::snprintf(text, sizeof text, "%.*f", static_cast<int>(std::min(digits, most_digits)), value);
    assign(text, text + size);
}

void c_decimal::swap(c_decimal& other) noexcept {
    std::swap(is_negative_, other.is_negative_);
    integral_.swap(other.integral_);
    fraction_.swap(other.fraction_);
}

bool c_decimal::is_valid(const std::string& text) {
    const char* cursor = text.data();
    const char* const end = cursor + text.size();
    scan_sign(cursor, end);
    return scan_number(cursor, end) != 0 && cursor == end;
}

long c_decimal::get_integral(bool* overflow) const {
    const auto value = static_cast<std::uint32_t>(integral_.get(overflow));
    return static_cast<std::int32_t>(is_negative_ ? 0 - value : value);
}

void c_decimal::set_integral(long value) {
    is_negative_ = value < 0;
    integral_ = std::to_string(magnitude(value));
}

unsigned long c_decimal::get_fractional(int digits, bool* overflow) const {
    hqf::unsigned_digits number;
    const auto wanted = static_cast<std::size_t>(std::max(digits, 0));
    const std::string_view taken = std::string_view(fraction_).substr(0, wanted);
    for (const char c : taken)
        number.add(c);
    hqf::add_zeros(number, static_cast<std::int64_t>(wanted - taken.size()));
    if (overflow != nullptr) *overflow = number.overflow;
    return number.value;
}

void c_decimal::set_fractional(unsigned long value, unsigned int width) {
    const std::string digits = std::to_string(value);
    if (width < digits.size())
        fraction_.assign(digits, 0, width);
    else
        fraction_.assign(width - digits.size(), '0').append(digits);
}

long c_decimal::get_scaled(int scale, bool* overflow) const {
    hqf::signed_digits number;
    const std::string integral = integral_.get_as_string();
    std::string_view taken = integral;
    if (scale < 0) {
        const auto dropped = static_cast<std::size_t>(-static_cast<std::int64_t>(scale));
        taken.remove_suffix(std::min(dropped, taken.size()));
    }
    for (const char c : taken)
        number.add(c);
    if (scale > 0) {
        const std::string_view digits = std::string_view(fraction_).substr(0, static_cast<std::size_t>(scale));
        for (const char c : digits)
            number.add(c);
        hqf::add_zeros(number, scale - static_cast<std::int64_t>(digits.size()));
    }
    if (overflow != nullptr) *overflow = number.overflow;
    return number.with_sign(is_negative_);
}

void c_decimal::set_scaled(long value, int scale) {
    std::string digits = std::to_string(magnitude(value));
    is_negative_ = value < 0;
    fraction_.clear();
    if (scale > 0) {
        const std::size_t split = digits.size() - std::min(digits.size(), static_cast<std::size_t>(scale));
        const unsigned long part = std::stoul(std::string(1, '0').append(digits, split));
        set_fractional(part, static_cast<unsigned int>(scale));
        digits.erase(split);
    } else {
        digits.append(static_cast<std::size_t>(-static_cast<std::int64_t>(scale)), '0');
    }
    integral_ = digits;
}

double c_decimal::get_as_float() const {
    double value = integral_.get_as_float();
    double factor = 0.1;
    for (const char c : fraction_) {
        value += (c - '0') * factor;
        factor /= 10.0;
    }
    return is_negative_ ? -value : value;
}

std::string c_decimal::get_as_string() const {
    std::string text = is_negative_ ? "-" : "";
    if (fraction_.empty() || integral_ != "0") text += integral_.get_as_string();
    if (!fraction_.empty()) text.append(1, '.').append(fraction_);
    return text;
}

bool operator==(const c_decimal& a, const c_decimal& b) {
    return a.is_negative_ == b.is_negative_ && a.integral_ == b.integral_ &&
           compare_fractions(a.fraction_, b.fraction_) == 0;
}

bool operator!=(const c_decimal& a, const c_decimal& b) {
    return !(a == b);
}

bool operator>(const c_decimal& a, const c_decimal& b) {
    if (a.is_negative_ != b.is_negative_) return b.is_negative_;
    const c_decimal& larger = a.is_negative_ ? b : a;
    const c_decimal& smaller = a.is_negative_ ? a : b;
    if (larger.integral_ != smaller.integral_) return larger.integral_ > smaller.integral_;
    return compare_fractions(larger.fraction_, smaller.fraction_) > 0;
}

bool operator>=(const c_decimal& a, const c_decimal& b) {
    return a == b || a > b;
}

bool operator<(const c_decimal& a, const c_decimal& b) {
    return !(a == b) && !(a > b);
}

bool operator<=(const c_decimal& a, const c_decimal& b) {
    return !(a > b);
}

std::ostream& operator<<(std::ostream& os, const c_decimal& value) {
    return os << value.get_as_string();
}

} // namespace lmx
