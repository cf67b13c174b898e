#pragma once

#include <iosfwd>
#include <string>
#include <string_view>

#include "hqf/platform/api.h"

namespace lmx {

/// An integer of any size, kept as its decimal text.
///
/// The text is canonical: an optional "-", then digits without leading zeros; zero is "0". Comparing works on the
/// texts, so a bound can be tested against a document's value before that is narrowed to a machine number.
///
/// A plain value: one object, one thread. Nothing here reports an error.
class HQF_API c_big_int {
public:
    /// Zero.
    c_big_int()
        : text_("0") {}
    c_big_int(const c_big_int&) = default;
    /// Takes an optional sign and the digits behind it; anything after them is ignored. A text without digits, and a
    /// null pointer, is zero. The literal 0 fits a pointer as well as a `long`: write `0L`.
    c_big_int(const char* text);
    c_big_int(const std::string& text);
    c_big_int(long value);

    c_big_int& operator=(const c_big_int&) = default;
    c_big_int& operator=(const char* text);
    c_big_int& operator=(const std::string& text);
    c_big_int& operator=(long value);

    void swap(c_big_int& other) noexcept { text_.swap(other.text_); }

    /// The canonical text.
    std::string get_as_string() const { return text_; }

    /// The value as a 32-bit number, wrapped where it doesn't fit.
    ///
    /// \param overflow may be null; otherwise gets whether the magnitude exceeds 2147483647, also for negative values
    long get(bool* overflow) const;

    /// The value as a `double`, accumulated digit by digit; infinite beyond its range.
    double get_as_float() const;

    /// Comparing two values is comparing with the other's text.
    ///
    /// The text needn't be canonical: a sign and leading zeros are passed over. What is left is compared as it is, by
    /// length and then digit by digit, so 12 is below "12abc". A null pointer counts as "0". The empty text is neither
    /// equal to nor greater than any value, so that `<` holds on it.
    friend bool operator==(const c_big_int& a, const c_big_int& b) { return a.text_ == b.text_; }
    friend bool operator!=(const c_big_int& a, const c_big_int& b) { return !(a == b); }
    friend bool operator<(const c_big_int& a, const c_big_int& b) { return !(a == b) && !(a > b); }
    friend bool operator<=(const c_big_int& a, const c_big_int& b) { return !(a > b); }
    friend bool operator>(const c_big_int& a, const c_big_int& b) { return a.is_greater(b.text_); }
    friend bool operator>=(const c_big_int& a, const c_big_int& b) { return a == b || a > b; }

    friend bool operator==(const c_big_int& v, const char* t) { return v.equals(view(t)); }
    friend bool operator!=(const c_big_int& v, const char* t) { return !(v == t); }
    friend bool operator<(const c_big_int& v, const char* t) { return !(v == t) && !(v > t); }
    friend bool operator<=(const c_big_int& v, const char* t) { return !(v > t); }
    friend bool operator>(const c_big_int& v, const char* t) { return v.is_greater(view(t)); }
    friend bool operator>=(const c_big_int& v, const char* t) { return v == t || v > t; }

    friend bool operator==(const c_big_int& v, const std::string& t) { return v.equals(t); }
    friend bool operator!=(const c_big_int& v, const std::string& t) { return !(v == t); }
    friend bool operator<(const c_big_int& v, const std::string& t) { return !(v == t) && !(v > t); }
    friend bool operator<=(const c_big_int& v, const std::string& t) { return !(v > t); }
    friend bool operator>(const c_big_int& v, const std::string& t) { return v.is_greater(t); }
    friend bool operator>=(const c_big_int& v, const std::string& t) { return v == t || v > t; }

    friend bool operator==(const char* t, const c_big_int& v) { return v == t; }
    friend bool operator!=(const char* t, const c_big_int& v) { return !(v == t); }
    friend bool operator<(const char* t, const c_big_int& v) { return v > t; }
    friend bool operator<=(const char* t, const c_big_int& v) { return v == t || v > t; }
    friend bool operator>(const char* t, const c_big_int& v) { return !(v == t) && !(v > t); }
    friend bool operator>=(const char* t, const c_big_int& v) { return !(v > t); }

    friend bool operator==(const std::string& t, const c_big_int& v) { return v == t; }
    friend bool operator!=(const std::string& t, const c_big_int& v) { return !(v == t); }
    friend bool operator<(const std::string& t, const c_big_int& v) { return v > t; }
    friend bool operator<=(const std::string& t, const c_big_int& v) { return v == t || v > t; }
    friend bool operator>(const std::string& t, const c_big_int& v) { return !(v == t) && !(v > t); }
    friend bool operator>=(const std::string& t, const c_big_int& v) { return !(v > t); }

    /// Writes the canonical text.
    friend HQF_API std::ostream& operator<<(std::ostream& os, const c_big_int& value);

private:
    static std::string_view view(const char* text) {
        return text == nullptr ? std::string_view("0") : std::string_view(text);
    }
    bool equals(std::string_view text) const;
    bool is_greater(std::string_view text) const;
    void assign(std::string_view text);

    std::string text_;
};

} // namespace lmx
