#pragma once

#include <iosfwd>
#include <string>

#include "hqf/platform/api.h"

/// The forms in which values reach a document. Each wrapper holds a reference to one value and selects a stream
/// insertion, `os << lmx::c_as_xml(value)`; use it within one expression.

namespace lmx {

/// The XML form of a `float`, `double`, `bool`, `std::string` or `std::wstring`.
template<class T>
class c_as_xml {
public:
    explicit c_as_xml(const T& value)
        : value_(value) {}
    const T& get() const { return value_; }

private:
    const T& value_;
};

/// The XML form of a `std::string`; the same as `c_as_xml`.
template<class T>
class c_as_escaped {
public:
    explicit c_as_escaped(const T& value)
        : value_(value) {}
    const T& get() const { return value_; }

private:
    const T& value_;
};

/// The ASCII shadow of a `std::wstring`.
template<class T>
class c_as_ascii {
public:
    explicit c_as_ascii(const T& value)
        : value_(value) {}
    const T& get() const { return value_; }

private:
    const T& value_;
};

/// A `bool` as a digit.
template<class T>
class c_as_bool_digit {
public:
    explicit c_as_bool_digit(const T& value)
        : value_(value) {}
    const T& get() const { return value_; }

private:
    const T& value_;
};

/// "NaN", "-INF", "INF", "-0.0" and "0.0" by name. Any other number goes through the stream's own insertion with 7
/// significant digits for `float` and 14 for `double`; flags and locale are the stream's, and its precision is put
/// back.
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_xml<float>& value);
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_xml<double>& value);

/// "true" or "false".
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_xml<bool>& value);

/// UTF-8 text with `"`, `'`, `&` and `<` as entity references; `>` and all else pass through.
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_xml<std::string>& value);

/// The same from UTF-16. An unpaired high surrogate ends the output; a lone low one is written as three bytes. A 32-bit
/// element above U+FFFF is written as that character, and one that is no character at all as U+FFFD.
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_xml<std::wstring>& value);

HQF_API std::ostream& operator<<(std::ostream& os, const c_as_escaped<std::string>& value);

/// Each element below 128 as that byte, each other one as ".". Nothing is escaped.
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_ascii<std::wstring>& value);

/// "1" or "0".
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_bool_digit<bool>& value);

} // namespace lmx
