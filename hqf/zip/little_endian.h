#pragma once

// Numbers as ZIP headers hold them, lowest byte first, in fields without alignment. Internal.

#include <cstddef>
#include <cstdint>
#include <string>

namespace hqf {

template<class Number>
Number read_little_endian(const char* from) {
    Number value = 0;
    for (std::size_t i = sizeof(Number); i-- > 0;)
        value = static_cast<Number>(value << 8 | static_cast<unsigned char>(from[i]));
    return value;
}

/// Takes one field after the other.
class field_reader {
public:
    explicit field_reader(const char* from)
        : at_(from) {}

    template<class Number>
    void operator()(Number& value) {
        value = read_little_endian<Number>(at_);
        at_ += sizeof(Number);
    }

private:
    const char* at_;
};

/// Appends one field after the other.
class field_writer {
public:
    template<class Number>
    field_writer& operator()(Number value) {
        for (std::size_t i = 0; i < sizeof(Number); ++i)
            bytes_ += static_cast<char>(static_cast<unsigned char>(value >> (8 * i)));
        return *this;
    }
    field_writer& bytes(const char* from, std::size_t size) {
        if (size != 0) bytes_.append(from, size);
        return *this;
    }
    const std::string& get() const { return bytes_; }

private:
    std::string bytes_;
};

} // namespace hqf
