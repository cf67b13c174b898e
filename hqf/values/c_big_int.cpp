#include "hqf/values/c_big_int.h"

#include <algorithm>
#include <cstdint>
#include <ostream>
#include <utility>

#include "hqf/values/checked_digits.h"
#include "hqf/values/scan.h"

namespace lmx {

namespace {

bool starts_with_minus(std::string_view text) {
    return !text.empty() && text.front() == '-';
}

/// The text behind a sign and the zeros after it.
std::string_view significant(std::string_view text) {
    if (!text.empty() && (text.front() == '-' || text.front() == '+')) text.remove_prefix(1);
    text.remove_prefix(std::min(text.find_first_not_of('0'), text.size()));
    return text;
}

/// Whether a text is read as zero: no digit but zeros before the first character that is none.
bool reads_as_zero(std::string_view text) {
    const std::string_view rest = significant(text);
    return rest.empty() || !is_digit(rest.front());
}

} // namespace

c_big_int::c_big_int(const char* text) {
    assign(view(text));
}

c_big_int::c_big_int(const std::string& text) {
    assign(text);
}

c_big_int::c_big_int(long value) {
    assign(std::to_string(value));
}

c_big_int& c_big_int::operator=(const char* text) {
    assign(view(text));
    return *this;
}

c_big_int& c_big_int::operator=(const std::string& text) {
    assign(text);
    return *this;
}

c_big_int& c_big_int::operator=(long value) {
    assign(std::to_string(value));
    return *this;
}

void c_big_int::assign(std::string_view text) {
    const std::string_view rest = significant(text);
    const auto digits = static_cast<std::size_t>(std::find_if_not(rest.begin(), rest.end(), is_digit) - rest.begin());
    if (digits == 0) {
        text_.assign(1, '0');
        return;
    }
    // Built apart, because the text may be this object's own.
    std::string canonical(starts_with_minus(text) ? 1 : 0, '-');
    canonical.append(rest, 0, digits);
    text_ = std::move(canonical);
}

long c_big_int::get(bool* overflow) const {
    hqf::signed_digits number;
    for (const char c : text_)
        if (is_digit(c)) number.add(c);
    if (overflow != nullptr) *overflow = number.overflow;
    return number.with_sign(starts_with_minus(text_));
}

double c_big_int::get_as_float() const {
    double value = 0;
    for (const char c : text_)
        if (is_digit(c)) value = value * 10 + (c - '0');
    return starts_with_minus(text_) ? -value : value;
}

bool c_big_int::equals(std::string_view text) const {
    if (text.empty()) return false;
    const bool negative = starts_with_minus(text_);
    if (negative != starts_with_minus(text)) return text.substr(0, 2) == "-0" && text_ == "0" && reads_as_zero(text);
    const std::string_view rest = significant(text);
    if (rest.empty()) return text_ == "0";
    return std::string_view(text_).substr(negative ? 1 : 0) == rest;
}

bool c_big_int::is_greater(std::string_view text) const {
    if (text.empty()) return false;
    const bool negative = starts_with_minus(text_);
    if (negative != starts_with_minus(text)) {
        if (text.substr(0, 2) == "-0" && text_ == "0" && reads_as_zero(text)) return false;
        return !negative;
    }
    const std::string_view rest = significant(text);
    if (rest.empty()) return !negative && text_ != "0";
    const std::string_view digits = std::string_view(text_).substr(negative ? 1 : 0);
    if (digits.size() != rest.size()) return (digits.size() > rest.size()) != negative;
    return negative ? digits < rest : digits > rest;
}

std::ostream& operator<<(std::ostream& os, const c_big_int& value) {
    return os << value.text_;
}

} // namespace lmx
