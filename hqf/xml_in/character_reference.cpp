#include "hqf/values/text.h"
#include "hqf/xml_in/c_entity_name_reader.h"
#include "hqf/xml_in/c_get_for_xml.h"

// Character references, XML 1.0, 4.1, with the semicolon optional.

namespace lmx {
namespace {

constexpr int largest_reference = 0x100000;

// The digit's value, or -1 for what is no digit of the base.
int digit_value(int c, bool is_hexadecimal) {
    if (c >= '0' && c <= '9') return c - '0';
    if (!is_hexadecimal) return -1;
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

// The number, or anything above the limit where it is too large.
int number_of(const std::string& digits, bool is_hexadecimal) {
    int number = 0;
    for (const char digit : digits) {
        number = number * (is_hexadecimal ? 16 : 10) + digit_value(digit, is_hexadecimal);
        if (number > largest_reference) break;
    }
    return number;
}

} // namespace

bool c_get_for_xml::insert_character_entity(c_entity_name_reader& reader, std::string* out) {
    int c = reader.get();
    const bool is_hexadecimal = c == 'x';
    if (is_hexadecimal)
        c = reader.get();
    else if (digit_value(c, false) == -1)
        return false;
    digits_.clear();
    for (; digit_value(c, is_hexadecimal) != -1; c = reader.get())
        digits_ += static_cast<char>(c);
    if (c != ';') reader.unget(c);
    if (digits_.empty()) return false;

    const int number = number_of(digits_, is_hexadecimal);
    if (number > largest_reference) return false;
    // The line ends of XML 1.1 are folded here as they are in the bytes of a document.
    if (number == 0x85 || number == 0x2028) {
        add_char_wsp(out, '\n', true);
    } else if (number > 127) {
        char encoded[8];
        put_pending_blank(out);
        *out += unicode_char_to_utf8(number, encoded);
    } else {
        add_char_wsp(out, number, true);
    }
    return true;
}

} // namespace lmx
