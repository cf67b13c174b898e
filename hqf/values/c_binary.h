#pragma once

#include <iosfwd>
#include <string>
#include <vector>

#include "hqf/platform/api.h"

namespace lmx {

/// A sequence of bytes with the text forms of xs:hexBinary and xs:base64Binary (XML Schema Part 2, 3.2.15 and 3.2.16).
///
/// A plain value: one object, one thread. The decoders report nothing; they are for texts that the validator of their
/// form has accepted.
class HQF_API c_binary {
public:
    c_binary() = default;
    c_binary(const c_binary&) = default;
    /// Copies `size` bytes.
    c_binary(const unsigned char* data, unsigned int size) { set(data, size); }
    c_binary& operator=(const c_binary&) = default;

    /// Replaces the contents by a copy of `size` bytes, which must not lie in this object.
    void set(const unsigned char* data, unsigned int size);
    void swap(c_binary& other) noexcept { bytes_.swap(other.bytes_); }

    unsigned int size() const { return static_cast<unsigned int>(bytes_.size()); }

    /// Adds one byte at the end.
    void append(unsigned char byte) { bytes_.push_back(byte); }
    c_binary& operator+=(unsigned char byte) {
        append(byte);
        return *this;
    }

    /// Precondition: `index < size()`.
    unsigned char& operator[](unsigned int index) { return bytes_[index]; }
    unsigned char operator[](unsigned int index) const { return bytes_[index]; }
    /// The byte at `index`. Throws `std::out_of_range` at or above `size()`.
    unsigned char& at(unsigned int index);
    unsigned char at(unsigned int index) const;

    /// Copies the first bytes, as many as both sides have, and gives `buffer` back.
    unsigned char* get(unsigned char* buffer, unsigned int size) const;

    /// Whether these are exactly the bytes held.
    bool equal(const unsigned char* data, unsigned int size) const;
    friend bool operator==(const c_binary& a, const c_binary& b) { return a.bytes_ == b.bytes_; }
    friend bool operator!=(const c_binary& a, const c_binary& b) { return !(a == b); }

    /// Whether the text is an even number of hexadecimal digits of either case; the empty text is.
    static bool is_valid_hex(const std::string& text);

    /// Whether the text is Base64: letters, digits, "+" and "/" with whitespace anywhere between them, padded to a
    /// multiple of four by at most two "="; the empty text is.
    static bool is_valid_base64(const std::string& text);

    /// Replaces the contents by the bytes of a hexadecimal text. An odd digit at the end is passed over.
    void from_hex(const std::string& text);

    /// Replaces the contents by the bytes of a Base64 text. Whatever isn't in the alphabet is passed over.
    void from_base64(const std::string& text);

    /// Writes two upper-case hexadecimal digits a byte. The stream's fill is "0" afterwards.
    void out_hex(std::ostream& os) const;

    /// Writes Base64 on one line, however long it becomes (the alphabet and padding of RFC 2045).
    void out_base64(std::ostream& os) const;

private:
    std::vector<unsigned char> bytes_;
};

/// Selects a text form for the insertion of a value, `os << c_as_hex(value)`. Holds a reference: for use within one
/// expression.
template<class T>
class c_as_hex {
public:
    explicit c_as_hex(const T& value)
        : value_(value) {}
    const T& get() const { return value_; }

private:
    const T& value_;
};

/// As `c_as_hex`, for Base64.
template<class T>
class c_as_base64 {
public:
    explicit c_as_base64(const T& value)
        : value_(value) {}
    const T& get() const { return value_; }

private:
    const T& value_;
};

HQF_API std::ostream& operator<<(std::ostream& os, const c_as_hex<c_binary>& value);
HQF_API std::ostream& operator<<(std::ostream& os, const c_as_base64<c_binary>& value);

/// The name under which the model's own types refer to binary content.
using tc_binary = c_binary;

} // namespace lmx
