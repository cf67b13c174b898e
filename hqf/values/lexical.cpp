#include "hqf/values/lexical.h"

#include <cctype>
#include <cstddef>
#include <string_view>
#include <utility>

#include "hqf/values/lexical_spans.h"
#include "hqf/values/scan.h"

namespace hqf {

namespace {

/// Whether a surrogate pair written as two three-byte sequences begins here.
bool is_split_pair(const char* at, const char* end) {
    return static_cast<unsigned char>(at[0]) == 0xED && end - at > 1 &&
           (static_cast<unsigned char>(at[1]) & 0xE0) == 0xA0;
}

/// Bytes of the character that begins here; 0 when none does.
std::size_t character_size(const char* at, const char* end) {
    const auto lead = static_cast<unsigned char>(*at);
    if (lead < 0x80) return 1;
    if ((lead & 0xE0) == 0xC0) return 2;
    if ((lead & 0xF8) == 0xF0) return 4;
    if ((lead & 0xF0) == 0xE0) return is_split_pair(at, end) ? 6 : 3;
    return 0;
}

} // namespace

unsigned int count_characters(const char* begin, const char* end) {
    unsigned int count = 0;
    while (begin != end) {
        ++count;
        const std::size_t size = character_size(begin, end);
        if (size == 0 || size >= static_cast<std::size_t>(end - begin)) break;
        begin += size;
    }
    return count;
}

bool has_min_length(const char* begin, const char* end, unsigned int n) {
    const auto bytes = static_cast<std::size_t>(end - begin);
    return bytes / 4 >= n || count_characters(begin, end) >= n;
}

bool has_max_length(const char* begin, const char* end, unsigned int n) {
    const auto bytes = static_cast<std::size_t>(end - begin);
    if (bytes <= n) return true;
    if (bytes > std::size_t{4} * n) return false;
    return count_characters(begin, end) <= n;
}

bool is_bool(const char* begin, const char* end) {
    const std::string_view text(begin, static_cast<std::size_t>(end - begin));
    return text == "true" || text == "1" || text == "false" || text == "0";
}

bool is_integer(const char* begin, const char* end) {
    lmx::scan_sign(begin, end);
    return lmx::scan_digits(begin, end) != 0 && begin == end;
}

bool is_float(const char* begin, const char* end) {
    const std::string_view text(begin, static_cast<std::size_t>(end - begin));
    if (text == "INF" || text == "-INF" || text == "NaN") return true;
    lmx::scan_sign(begin, end);
    if (lmx::scan_number(begin, end) == 0) return false;
    if (lmx::scan_literal(begin, end, 'e') || lmx::scan_literal(begin, end, 'E')) {
        lmx::scan_sign(begin, end);
        if (lmx::scan_digits(begin, end) == 0) return false;
    }
    return begin == end;
}

} // namespace hqf

namespace lmx {

unsigned int length(const std::string& text) {
    return hqf::count_characters(text.data(), text.data() + text.size());
}

bool is_min_length_ok(const std::string& text, unsigned int n) {
    return hqf::has_min_length(text.data(), text.data() + text.size(), n);
}

bool is_max_length_ok(const std::string& text, unsigned int n) {
    return hqf::has_max_length(text.data(), text.data() + text.size(), n);
}

int total_digits(const std::string& text) {
    int count = 0;
    for (const char c : text)
        count += is_digit(c) ? 1 : 0;
    return count;
}

int fraction_digits(const std::string& text) {
    const std::size_t point = text.find('.');
    return point == std::string::npos ? 0 : total_digits(text.substr(point + 1));
}

bool is_valid_bool(const std::string& text) {
    return hqf::is_bool(text.data(), text.data() + text.size());
}

bool is_valid_integer(const std::string& text) {
    return hqf::is_integer(text.data(), text.data() + text.size());
}

bool is_valid_float(const std::string& text) {
    return hqf::is_float(text.data(), text.data() + text.size());
}

double float_zero() {
    return 0.0;
}

void bswap(void* a, void* b, unsigned int n) {
    auto* const left = static_cast<unsigned char*>(a);
    auto* const right = static_cast<unsigned char*>(b);
    for (unsigned int i = 0; i < n; ++i)
        std::swap(left[i], right[i]);
}

int stringncompare(const std::string& s, const char* t, unsigned int position, unsigned int n) {
    return s.compare(position, n, t);
}

namespace {

// The C library's tests are tables over unsigned char; any other index is beyond them.
bool test_character(int (*test)(int), int c) {
    return c >= 1 && c <= 255 && test(c) != 0;
}

} // namespace

bool xisalnum(int c) {
    return test_character(std::isalnum, c);
}
bool xisalpha(int c) {
    return test_character(std::isalpha, c);
}
bool xisdigit(int c) {
    return test_character(std::isdigit, c);
}
bool xisprint(int c) {
    return test_character(std::isprint, c);
}
bool xisspace(int c) {
    return test_character(std::isspace, c);
}
bool xisxdigit(int c) {
    return test_character(std::isxdigit, c);
}

} // namespace lmx
