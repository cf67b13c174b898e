// Any text as each kind of value, and any bytes as a number or a date: the short roads give what the long ones give,
// and what was written once reads as itself.

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <sstream>
#include <string>
#include <vector>

#include "fuzz/require.h"
#include "hqf/hqf.h"
#include "hqf/values/c_as_xml.h"
#include "hqf/values/c_big_int.h"
#include "hqf/values/c_decimal.h"
#include "hqf/values/c_duration.h"
#include "hqf/values/c_pattern.h"
#include "hqf/values/c_xml_list_tokeniser.h"
#include "hqf/values/datetime_text.h"
#include "hqf/values/lexical.h"
#include "hqf/values/lexical_spans.h"
#include "hqf/values/number_text.h"
#include "hqf/values/to_number.h"
#include "hqf/values/transcode.h"
#include "hqf/values/xml_escape.h"

namespace {

using fuzz::require;

template<class T>
std::string inserted(const T& value) {
    std::ostringstream os;
    os << value;
    return os.str();
}

bool same_bits(double a, double b) {
    return std::memcmp(&a, &b, sizeof a) == 0 || (a != a && b != b);
}

/// Whether the text of the seconds holds their value: below a thousandth they have six decimals, and from a million on
/// the exponent of the stream's own number insertion.
template<class T>
bool has_plain_seconds(const T& value) {
    if constexpr (requires { value.get_secs(); })
        return value.get_secs() == 0 || (value.get_secs() >= 0.001F && value.get_secs() < 1e6F);
    else
        return true;
}

/// For a type with `is_valid`, a constructor from text, and `get_as_string`.
template<class T>
void valid_text_settles(const std::string& text, const char* type) {
    const T value(text);
    const std::string first = value.get_as_string();
    if (!T::is_valid(text) || !has_plain_seconds(value)) return;
    require(T::is_valid(first), std::string(type) + ": what was written is valid: " + text + " -> " + first);
    const std::string second = T(first).get_as_string();
    require(first == second, std::string(type) + " comes out the same: " + text + " -> " + first + " -> " + second);
}

void number_is_written_as_inserted(double value) {
    char buffer[hqf::number_text_size];
    const std::string text(buffer, hqf::write_number(buffer, value));
    require(text == inserted(lmx::c_as_xml(value)), "double as inserted: " + text);
    require(lmx::is_valid_float(text), "a written double is valid: " + text);
    const std::string again(buffer, hqf::write_number(buffer, hqf::to_double(text)));
    require(text == again, "double comes out the same: " + text + " -> " + again);
    const auto single = static_cast<float>(std::clamp(value, -3e38, 3e38));
    require(std::string(buffer, hqf::write_number(buffer, single)) == inserted(lmx::c_as_xml(single)),
            "float as inserted");
}

void numbers(const std::string& text) {
    const char* const begin = text.data();
    const char* const end = begin + text.size();
    require(hqf::is_float(begin, end) == lmx::is_valid_float(text), "is_float");
    require(hqf::is_integer(begin, end) == lmx::is_valid_integer(text), "is_integer");
    require(hqf::is_bool(begin, end) == lmx::is_valid_bool(text), "is_bool");

    double value = 0;
    const char* const behind = hqf::scan_double(begin, end, value);
    require((behind == end) == lmx::is_valid_float(text), "scan_double takes what is valid");
    if (behind == end) {
        require(same_bits(value, hqf::to_double(text)), "scan_double gives the value of to_double");
        number_is_written_as_inserted(value);
    }
    const std::string padded = text + std::string(32, '<');
    double short_value = 0;
    if (hqf::scan_short_decimal(padded.data(), short_value) == padded.data() + text.size()) {
        require(behind == end, "scan_short_decimal takes what scan_double does");
        require(same_bits(value, short_value), "scan_short_decimal gives the value of scan_double");
    }
    std::int64_t integer = 0;
    if (hqf::read_short_integer(begin, end, integer)) {
        require(lmx::is_valid_integer(text), "read_short_integer takes integers");
        require(static_cast<int>(integer) == hqf::to_int(text), "read_short_integer gives the value of to_int");
        require(static_cast<unsigned int>(integer) == hqf::to_unsigned(text), "and of to_unsigned");
    }
    bool truth = false;
    require(hqf::read_bool(begin, end, truth) == lmx::is_valid_bool(text), "read_bool");
    require(truth == (lmx::is_valid_bool(text) && hqf::to_bool(text)), "read_bool gives the value of to_bool");

    valid_text_settles<lmx::c_decimal>(text, "c_decimal");
    const lmx::c_big_int big(text);
    require(lmx::c_big_int(big.get_as_string()) == big, "c_big_int reads what it wrote");
}

void dates(const std::string& text) {
    const char* const begin = text.data();
    const char* const end = begin + text.size();
    require(hqf::is_datetime(begin, end) == lmx::c_datetime::is_valid(text), "is_datetime");
    static const lmx::c_pattern pattern(".+T.+(Z|[+\\-].+)");
    constexpr std::size_t affordable = 64; // the engine's time grows with the cube of the length
    const hqf::zone_pattern known = hqf::match_zone_pattern(begin, end);
    if (text.size() <= affordable && known != hqf::zone_pattern::ask_engine)
        require(pattern.is_match(text) == (known == hqf::zone_pattern::matched), "match_zone_pattern: " + text);
    lmx::c_datetime fast;
    if (hqf::scan_zoned_datetime(begin, end, fast) == end) {
        require(lmx::c_datetime::is_valid(text), "scan_zoned_datetime takes what is valid");
        require(known == hqf::zone_pattern::matched, "scan_zoned_datetime takes what matches");
        const lmx::c_datetime assigned(text);
        require(fast == assigned && fast.get_is_utc() == assigned.get_is_utc() &&
                    fast.get_total_offset_mins() == assigned.get_total_offset_mins(),
                "scan_zoned_datetime stores what assignment does");
    }
    valid_text_settles<lmx::c_datetime>(text, "c_datetime");
    valid_text_settles<lmx::c_date>(text, "c_date");
    valid_text_settles<lmx::c_time>(text, "c_time");
    valid_text_settles<lmx::c_gyear>(text, "c_gyear");
    valid_text_settles<lmx::c_gyearmonth>(text, "c_gyearmonth");
    valid_text_settles<lmx::c_gmonth>(text, "c_gmonth");
    valid_text_settles<lmx::c_gmonthday>(text, "c_gmonthday");
    valid_text_settles<lmx::c_gday>(text, "c_gday");
    valid_text_settles<lmx::c_duration>(text, "c_duration");
}

void binary(const std::string& text) {
    lmx::c_binary value, again;
    value.from_base64(text);
    const std::string base64 = inserted(lmx::c_as_base64(value));
    require(lmx::c_binary::is_valid_base64(base64), "Base64 that was written is valid");
    again.from_base64(base64);
    require(value == again, "Base64 reads as it was written");
    value.from_hex(text);
    const std::string hex = inserted(lmx::c_as_hex(value));
    require(lmx::c_binary::is_valid_hex(hex), "hexadecimal digits that were written are valid");
    again.from_hex(hex);
    require(value == again, "hexadecimal digits read as they were written");
    if (lmx::c_binary::is_valid_hex(text)) require(text.size() == hex.size(), "no hexadecimal digit is lost");
}

template<class text>
std::string escaped_in_pieces(const text& value) {
    std::string out;
    const auto* next = value.data();
    const auto* const end = next + value.size();
    while (next != end) {
        std::vector<char> piece(hqf::escaped_size + value.size() % 5); // the address sanitizer guards its end
        out.append(piece.data(), hqf::write_xml_escaped(piece.data(), piece.data() + piece.size(), next, end));
    }
    return out;
}

void texts(const std::string& text) {
    std::string escaped;
    hqf::append_xml_escaped(escaped, text.data(), text.size());
    require(escaped == inserted(lmx::c_as_xml(text)), "narrow text as inserted");
    require(escaped == escaped_in_pieces(text), "narrow text in pieces");
    std::wstring wide, again;
    lmx::convert(&wide, text);
    escaped.clear();
    hqf::append_xml_escaped(escaped, wide.data(), wide.size());
    require(escaped == inserted(lmx::c_as_xml(wide)), "wide text as inserted");
    require(escaped == escaped_in_pieces(wide), "wide text in pieces");
    std::string narrow;
    lmx::convert(&narrow, wide);
    lmx::convert(&again, narrow);
    require(wide == again, "text that was converted converts back");

    const char* const begin = text.data();
    const char* const end = begin + text.size();
    require(hqf::count_characters(begin, end) == lmx::length(text), "count_characters");
    for (unsigned int n : {0U, 1U, 3U, 20U}) {
        require(hqf::has_min_length(begin, end, n) == lmx::is_min_length_ok(text, n), "has_min_length");
        require(hqf::has_max_length(begin, end, n) == lmx::is_max_length_ok(text, n), "has_max_length");
    }
    lmx::c_xml_list_tokeniser items(text);
    for (std::string item; items.get(&item);)
        require(!item.empty(), "an item is never empty");
}

/// Wide elements and numbers of any bits, which an application may store where a document can't.
void raw_bits(const std::uint8_t* data, std::size_t size) {
    std::wstring wide(size / sizeof(wchar_t), L'\0');
    if (!wide.empty()) std::memcpy(wide.data(), data, wide.size() * sizeof(wchar_t));
    std::string escaped;
    hqf::append_xml_escaped(escaped, wide.data(), wide.size());
    require(escaped == inserted(lmx::c_as_xml(wide)), "any elements as inserted");
    require(escaped == escaped_in_pieces(wide), "any elements in pieces");

    double number = 0;
    if (size >= sizeof number) {
        std::memcpy(&number, data, sizeof number);
        number_is_written_as_inserted(number);
    }
    std::int32_t fields[8] = {};
    if (size < sizeof fields) return;
    std::memcpy(fields, data, sizeof fields);
    lmx::c_datetime moment;
    moment.set_year(fields[0]);
    moment.set_month(static_cast<unsigned int>(fields[1]));
    moment.set_day(static_cast<unsigned int>(fields[2]));
    moment.set_hours(static_cast<unsigned int>(fields[3]));
    moment.set_mins(static_cast<unsigned int>(fields[4]));
    float seconds = 0;
    std::memcpy(&seconds, &fields[5], sizeof seconds);
    moment.set_secs(seconds);
    moment.set_total_offset_mins(fields[6]);
    moment.set_is_utc(fields[7] % 2 != 0);
    std::vector<char> exact(hqf::datetime_text_size);
    require(std::string(exact.data(), hqf::write_datetime(exact.data(), moment)) == moment.get_as_string(),
            "a date as inserted: " + moment.get_as_string());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    numbers(text);
    dates(text);
    binary(text);
    texts(text);
    raw_bits(data, size);
    return 0;
}
