#include "hqf/values/datetime_text.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>

#include "hqf/values/digit_pairs.h"
#include "hqf/values/eight_digits.h"
#include "hqf/values/scan.h"
#include "hqf/values/transcode.h"

namespace hqf {

namespace {

using lmx::is_digit;

/// The places of the digits in the common form and what stands between them.
constexpr char common_form[] = "0000-00-00T00:00:00";
constexpr std::ptrdiff_t common_size = sizeof common_form - 1;

/// Eight characters of the common form from a place, as differences() wants them.
struct form_part {
    std::uint64_t form = 0;
    std::uint64_t slack = 0;

    explicit constexpr form_part(int place) {
        for (int i = 7; i >= 0; --i) {
            form = form << 8 | static_cast<unsigned char>(common_form[place + i]);
            slack = slack << 8 | (common_form[place + i] == '0' ? 0x76 : 0x7F);
        }
    }
};

bool has_common_form(const char* text) {
    if constexpr (has_low_byte_first) {
        constexpr int last_place = common_size - 8; // the parts overlap
        constexpr form_part first(0), second(8), last(last_place);
        return (differences(load_eight(text), first.form, first.slack) |
                differences(load_eight(text + 8), second.form, second.slack) |
                differences(load_eight(text + last_place), last.form, last.slack)) == 0;
    }
    bool fits = true;
    for (std::ptrdiff_t i = 0; i < common_size; ++i)
        fits &= common_form[i] == '0' ? is_digit(text[i]) : text[i] == common_form[i];
    return fits;
}

std::uint32_t two_digits(const char* at) {
    return static_cast<std::uint32_t>((at[0] - '0') * 10 + (at[1] - '0'));
}

/// Bytes of the XML character that begins here (XML 1.0, production 2); 0 when none does.
std::size_t character_size(const char* at, const char* end) {
    const auto lead = static_cast<unsigned char>(*at);
    if (lead < 0x80) return lead >= 0x20 || lead == '\t' || lead == '\n' || lead == '\r' ? 1 : 0;
    char32_t c = 0;
    const std::size_t size = decode_sequence(at, end, c);
    const bool is_overlong = c < 0x80; // a line end in disguise is for the engine to judge
    return is_overlong || (c >= 0xD800 && c <= 0xDFFF) || c == 0xFFFE || c == 0xFFFF || c > 0x10FFFF ? 0 : size;
}

char* put_padded(char* out, std::uint32_t value, int width) {
    char digits[10];
    const auto count = static_cast<int>(std::to_chars(digits, digits + sizeof digits, value).ptr - digits);
    for (int i = count; i < width; ++i)
        *out++ = '0';
    std::memcpy(out, digits, static_cast<std::size_t>(count));
    return out + count;
}

char* put_two(char* out, std::uint32_t value) {
    return value > 99 ? put_padded(out, value, 2) : put_pair(out, value);
}

char* put_seconds(char* out, char* limit, float secs) {
    constexpr float whole_limit = 100;
    if (secs < whole_limit && !std::signbit(secs) && secs == std::trunc(secs))
        return put_two(out, static_cast<std::uint32_t>(secs));
    if (secs < 10.0f) *out++ = '0';
    const bool is_fixed = secs != 0 && secs < 0.001;
    return std::to_chars(out, limit, secs, is_fixed ? std::chars_format::fixed : std::chars_format::general, 6).ptr;
}

constexpr std::uint32_t magnitude(std::int32_t value) {
    return value < 0 ? 0 - static_cast<std::uint32_t>(value) : static_cast<std::uint32_t>(value);
}

} // namespace

const char* scan_zoned_datetime(const char* begin, const char* end, lmx::c_datetime& value) {
    if (end - begin <= common_size || !has_common_form(begin)) return nullptr;

    const char* cursor = begin + common_size;
    auto secs = static_cast<float>(two_digits(begin + 17));
    if (*cursor == '.') {
        cursor = begin + 17;
        lmx::scan_seconds(cursor, end, secs);
    }
    std::int32_t offset = 0;
    const bool is_utc = cursor != end && *cursor == 'Z';
    if (!is_utc) {
        if (end - cursor < 6 || (*cursor != '+' && *cursor != '-') || !is_digit(cursor[1]) || !is_digit(cursor[2]) ||
            cursor[3] != ':' || !is_digit(cursor[4]) || !is_digit(cursor[5]))
            return nullptr;
        offset = static_cast<std::int32_t>(two_digits(cursor + 1) * 60 + two_digits(cursor + 4));
        if (*cursor == '-') offset = -offset;
    }

    value.year = static_cast<std::int32_t>(two_digits(begin) * 100 + two_digits(begin + 2));
    value.month = two_digits(begin + 5);
    value.day = two_digits(begin + 8);
    value.hours = two_digits(begin + 11);
    value.mins = two_digits(begin + 14);
    value.secs = secs;
    value.total_offset_mins = offset;
    value.is_utc = is_utc;
    return cursor + (is_utc ? 1 : 6);
}

zone_pattern match_zone_pattern(const char* begin, const char* end) {
    for (const char* p = begin; p != end;) {
        if (*p == '\n' || *p == '\r') return zone_pattern::not_matched; // the two characters that "." leaves out
        const std::size_t size = character_size(p, end);
        if (size == 0) return zone_pattern::ask_engine;
        p += size;
    }
    // The first "T" that has something before it leaves the most for the rest of the pattern.
    const char* const first_t = begin == end ? end : std::find(begin + 1, end, 'T');
    if (end - first_t < 3) return zone_pattern::not_matched;
    const auto is_sign = [](char c) { return c == '+' || c == '-'; };
    const bool has_zone = end[-1] == 'Z' || std::any_of(first_t + 2, end - 1, is_sign);
    return has_zone ? zone_pattern::matched : zone_pattern::not_matched;
}

char* write_datetime(char* out, const lmx::c_datetime& value) {
    char* const limit = out + datetime_text_size;
    if (value.year < 0) *out++ = '-';
    const std::uint32_t year = magnitude(value.year);
    out = year > 9999 ? put_padded(out, year, 4) : put_pair(put_pair(out, year / 100), year % 100);
    *out++ = '-';
    out = put_two(out, value.month);
    *out++ = '-';
    out = put_two(out, value.day);
    *out++ = 'T';
    out = put_two(out, value.hours);
    *out++ = ':';
    out = put_two(out, value.mins);
    *out++ = ':';
    out = put_seconds(out, limit, value.secs);
    if (value.is_utc) {
        *out++ = 'Z';
    } else if (value.total_offset_mins != 0) {
        const std::uint32_t minutes = magnitude(value.total_offset_mins);
        *out++ = value.total_offset_mins < 0 ? '-' : '+';
        out = put_two(out, minutes / 60);
        *out++ = ':';
        out = put_two(out, minutes % 60);
    }
    return out;
}

} // namespace hqf
