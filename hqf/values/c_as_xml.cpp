#include "hqf/values/c_as_xml.h"

#include <cmath>
#include <ostream>

#include "hqf/values/xml_escape.h"

namespace lmx {

namespace {

/// Puts a stream's precision back.
class precision_guard {
public:
    precision_guard(std::ostream& os, std::streamsize precision)
        : os_(os)
        , old_(os.precision(precision)) {}
    precision_guard(const precision_guard&) = delete;
    precision_guard& operator=(const precision_guard&) = delete;
    ~precision_guard() { os_.precision(old_); }

private:
    std::ostream& os_;
    std::streamsize old_;
};

template<class number>
std::ostream& insert_number(std::ostream& os, number value, std::streamsize digits) {
    if (std::isnan(value)) return os << "NaN";
    if (value == 0) return os << (std::signbit(value) ? "-0.0" : "0.0");
    if (std::isinf(value)) return os << (value < 0 ? "-INF" : "INF");
    const precision_guard guard(os, digits);
    return os << value;
}

template<class text>
std::ostream& insert_escaped(std::ostream& os, const text& value) {
    char buffer[512];
    for (auto *next = value.data(), *end = value.data() + value.size(); next != end;)
        os.write(buffer, hqf::write_xml_escaped(buffer, buffer + sizeof buffer, next, end) - buffer);
    return os;
}

} // namespace

std::ostream& operator<<(std::ostream& os, const c_as_xml<float>& value) {
    return insert_number(os, value.get(), 7);
}

std::ostream& operator<<(std::ostream& os, const c_as_xml<double>& value) {
    return insert_number(os, value.get(), 14);
}

std::ostream& operator<<(std::ostream& os, const c_as_xml<bool>& value) {
    return os << (value.get() ? "true" : "false");
}

std::ostream& operator<<(std::ostream& os, const c_as_xml<std::string>& value) {
    return insert_escaped(os, value.get());
}

std::ostream& operator<<(std::ostream& os, const c_as_xml<std::wstring>& value) {
    return insert_escaped(os, value.get());
}

std::ostream& operator<<(std::ostream& os, const c_as_escaped<std::string>& value) {
    return insert_escaped(os, value.get());
}

std::ostream& operator<<(std::ostream& os, const c_as_ascii<std::wstring>& value) {
    for (const wchar_t c : value.get())
        os.put(static_cast<char32_t>(c) < 0x80 ? static_cast<char>(c) : '.');
    return os;
}

std::ostream& operator<<(std::ostream& os, const c_as_bool_digit<bool>& value) {
    return os << (value.get() ? '1' : '0');
}

} // namespace lmx
