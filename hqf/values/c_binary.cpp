#include "hqf/values/c_binary.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <ostream>
#include <stdexcept>

#include "hqf/values/scan.h"

namespace lmx {

namespace {

constexpr char alphabet[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
constexpr unsigned char no_digit = 64;

struct base64_values {
    unsigned char of[256];

    constexpr base64_values()
        : of{} {
        std::fill(of, of + 256, no_digit);
        for (unsigned char i = 0; i < no_digit; ++i)
            of[static_cast<unsigned char>(alphabet[i])] = i;
    }
};

constexpr base64_values values;

constexpr unsigned char base64_value(char c) {
    return values.of[static_cast<unsigned char>(c)];
}

constexpr bool is_hex_digit(char c) {
    return is_digit(c) || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F');
}

/// The value of a hexadecimal digit. Any other character gets what the rule for "A" to "F" makes of it.
constexpr unsigned int hex_value(char c) {
    if (is_digit(c)) return static_cast<unsigned int>(c - '0');
    if (c >= 'a' && c <= 'f') return static_cast<unsigned int>(c - 'a' + 10);
    return static_cast<unsigned int>(static_cast<unsigned char>(c)) - 55;
}

void check_index(std::size_t index, std::size_t size) {
    if (index >= size) throw std::out_of_range("invalid vector<T> subscript");
}

/// Writes the four characters of up to three bytes; gives the end of them.
char* put_group(char* out, const unsigned char* bytes, std::size_t count) {
    std::uint32_t group = static_cast<std::uint32_t>(bytes[0]) << 16;
    if (count > 1) group |= static_cast<std::uint32_t>(bytes[1]) << 8;
    if (count > 2) group |= bytes[2];
    out[0] = alphabet[group >> 18];
    out[1] = alphabet[(group >> 12) & 63];
    out[2] = count > 1 ? alphabet[(group >> 6) & 63] : '=';
    out[3] = count > 2 ? alphabet[group & 63] : '=';
    return out + 4;
}

/// Puts a stream's flags back.
class flags_guard {
public:
    flags_guard(std::ostream& os, std::ios_base::fmtflags flags)
        : os_(os)
        , old_(os.flags(flags)) {}
    flags_guard(const flags_guard&) = delete;
    flags_guard& operator=(const flags_guard&) = delete;
    ~flags_guard() { os_.flags(old_); }

private:
    std::ostream& os_;
    std::ios_base::fmtflags old_;
};

} // namespace

void c_binary::set(const unsigned char* data, unsigned int size) {
    bytes_.assign(data, data + size);
}

unsigned char& c_binary::at(unsigned int index) {
    check_index(index, bytes_.size());
    return bytes_[index];
}

unsigned char c_binary::at(unsigned int index) const {
    check_index(index, bytes_.size());
    return bytes_[index];
}

unsigned char* c_binary::get(unsigned char* buffer, unsigned int size) const {
    std::copy_n(bytes_.begin(), std::min<std::size_t>(size, bytes_.size()), buffer);
    return buffer;
}

bool c_binary::equal(const unsigned char* data, unsigned int size) const {
    return std::equal(bytes_.begin(), bytes_.end(), data, data + size);
}

bool c_binary::is_valid_hex(const std::string& text) {
    return text.size() % 2 == 0 && std::all_of(text.begin(), text.end(), is_hex_digit);
}

bool c_binary::is_valid_base64(const std::string& text) {
    if (text.empty()) return true;
    std::size_t behind = 0; // the run of digits and whitespace
    std::size_t digits = 0;
    for (; behind < text.size(); ++behind) {
        if (base64_value(text[behind]) != no_digit)
            ++digits;
        else if (!is_space(text[behind]))
            break;
    }
    const std::size_t padding = text.size() - behind;
    if (behind < 2 || padding > 2 || (digits + padding) % 4 != 0) return false;
    for (std::size_t i = behind; i < text.size() && !is_space(text[i]); ++i)
        if (text[i] != '=') return false;
    return true;
}

void c_binary::from_hex(const std::string& text) {
    bytes_.clear();
    bytes_.reserve(text.size() / 2);
    for (std::size_t i = 0; i + 1 < text.size(); i += 2)
        bytes_.push_back(static_cast<unsigned char>(hex_value(text[i]) * 16 + hex_value(text[i + 1])));
}

void c_binary::from_base64(const std::string& text) {
    bytes_.clear();
    bytes_.reserve(text.size() / 4 * 3 + 3);
    std::uint32_t group = 0;
    int count = 0;
    for (const char c : text) {
        const unsigned char value = base64_value(c);
        if (value == no_digit) continue;
        group = group << 6 | value;
        if (++count < 4) continue;
        bytes_.push_back(static_cast<unsigned char>(group >> 16));
        bytes_.push_back(static_cast<unsigned char>(group >> 8));
        bytes_.push_back(static_cast<unsigned char>(group));
        group = 0;
        count = 0;
    }
    if (count == 0) return;
    group <<= (4 - count) * 6;
    bytes_.push_back(static_cast<unsigned char>(group >> 16));
    if (count == 3) bytes_.push_back(static_cast<unsigned char>(group >> 8));
}

void c_binary::out_hex(std::ostream& os) const {
    const flags_guard guard(os, std::ios_base::hex | std::ios_base::uppercase);
    os.fill('0');
    for (const unsigned int byte : bytes_) {
        os.width(2);
        os << byte;
    }
}

void c_binary::out_base64(std::ostream& os) const {
    char buffer[1024];
    char* out = buffer;
    for (std::size_t i = 0; i < bytes_.size(); i += 3) {
        out = put_group(out, bytes_.data() + i, std::min<std::size_t>(3, bytes_.size() - i));
        if (out == buffer + sizeof buffer) {
            os.write(buffer, sizeof buffer);
            out = buffer;
        }
    }
    os.write(buffer, out - buffer);
}

std::ostream& operator<<(std::ostream& os, const c_as_hex<c_binary>& value) {
    value.get().out_hex(os);
    return os;
}

std::ostream& operator<<(std::ostream& os, const c_as_base64<c_binary>& value) {
    value.get().out_base64(os);
    return os;
}

} // namespace lmx
