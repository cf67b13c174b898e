#include "hqf/values/text.h"
#include "hqf/xml_in/c_get_as_utf8.h"
#include "hqf/xml_in/name_chars.h"

// From bytes to characters: finding the encoding, and one decoding step in each.
//
// People expect a byte order mark, or else UTF-8. Documents in UTF-16 without a mark are common too; they show by the
// zero beside their first character, which can only be white space or '<'.

namespace lmx {

int c_get_as_utf8::decode_next() {
    if (sequence_cursor_ != nullptr) return deliver_sequence();
    if (state_ >= utf16_be) return decode_utf16();
    const int c = next_byte();
    if (c == -1) return -1;
    switch (state_) {
    case undecided: return detect(c);
    case single_byte: return c < 127 ? c : encode(c);
    default: return c < 128 ? c : read_sequence(c) ? start_sequence() : -1;
    }
}

int c_get_as_utf8::deliver_sequence() {
    if (*sequence_cursor_ == 0) {
        sequence_cursor_ = nullptr;
        return -1;
    }
    const int c = static_cast<unsigned char>(*sequence_cursor_++);
    if (*sequence_cursor_ == 0) sequence_cursor_ = nullptr;
    return c;
}

int c_get_as_utf8::start_sequence() {
    sequence_cursor_ = sequence_[0] != 0 && sequence_[1] != 0 ? sequence_ + 1 : nullptr;
    return static_cast<unsigned char>(sequence_[0]);
}

// U+0085 and U+2028 are line ends of XML 1.1. They are folded here, in every encoding, before anyone counts lines.
int c_get_as_utf8::encode(int code_point) {
    unicode_char_to_utf8(code_point == 0x85 || code_point == 0x2028 ? '\n' : code_point, sequence_);
    return start_sequence();
}

namespace {

int sequence_length(int lead) {
    if (lead < 0xC0) return 1;
    if (lead < 0xE0) return 2;
    if (lead < 0xF0) return 3;
    if (lead < 0xF8) return 4;
    return lead < 0xFC ? 5 : 6;
}

bool is_line_end(const char* sequence) {
    const std::string_view text(sequence);
    return text == "\xC2\x85" || text == "\xE2\x80\xA8";
}

} // namespace

// Reads the rest of the sequence into the sequence buffer; false when it is none.
bool c_get_as_utf8::read_sequence(int lead) {
    const int length = sequence_length(lead);
    int c = lead;
    sequence_[0] = static_cast<char>(lead);
    for (int i = 1; i < length; ++i)
        sequence_[i] = static_cast<char>(c = next_byte());
    sequence_[length] = 0;
    if (c == -1) return false;
    if (is_line_end(sequence_)) {
        sequence_[0] = '\n';
        sequence_[1] = 0;
    }
    return is_valid_utf8_char_sequence(sequence_);
}

int c_get_as_utf8::refuse_encoding() {
    error(error_fatal, err_xml_character_encoding_not_supported, "Unrecognised character encoding");
    return -1;
}

// Combines a byte that has been read with the next one, in the byte order of the state; -1 at the end of input.
int c_get_as_utf8::read_unit(int first) {
    if (first == -1) return -1;
    const int second = next_byte();
    if (second == -1) return -1;
    const bool is_big_endian = state_ == utf16_be || state_ == ucs2_be;
    return is_big_endian ? first * 256 + second : second * 256 + first;
}

int c_get_as_utf8::decode_utf16() {
    const int unit = read_unit(next_byte());
    if (unit == -1) return -1;
    const bool knows_surrogates = state_ == utf16_be || state_ == utf16_le;
    if (!knows_surrogates || unit < 0xD800 || unit > 0xDBFF) return encode(unit);
    const int low = read_unit(next_byte());
    if (low == -1) return -1;
    if (low < 0xDC00 || low > 0xDFFF) return refuse_encoding();
    return encode(((unit & 0x3FF) + 64) * 1024 + (low & 0x3FF));
}

int c_get_as_utf8::detect(int first) {
    switch (first) {
    case 0xFF: return next_byte() == 0xFE ? detect_behind_mark(utf16_le) : refuse_encoding();
    case 0xFE: return next_byte() == 0xFF ? detect_behind_mark(utf16_be) : refuse_encoding();
    case 0xEF:
        if (next_byte() != 0xBB || next_byte() != 0xBF) return refuse_encoding();
        state_ = utf8;
        return next_byte();
    default: return detect_without_mark(first);
    }
}

// Behind a byte order mark of UTF-16, where the first character must be an ASCII one.
int c_get_as_utf8::detect_behind_mark(encoding_state state) {
    state_ = state;
    const int unit = read_unit(next_byte());
    if (unit >= 1 && unit <= 127) return unit;
    state_ = undecided;
    return refuse_encoding();
}

int c_get_as_utf8::detect_without_mark(int first) {
    const auto can_start_document = [](int c) { return hqf::is_white_space(c) || c == '<'; };
    if (first == 0) {
        const int second = next_byte();
        if (!can_start_document(second)) return refuse_encoding();
        state_ = utf16_be;
        return second;
    }
    if (!can_start_document(first)) return refuse_encoding();
    const int second = next_byte();
    if (second == 0) {
        state_ = utf16_le;
        return first;
    }
    state_ = utf8;
    if (second == -1) return first;
    // The second byte has been read, so its character waits behind the first one; where there is none, the end does, as
    // a sequence without bytes.
    if (second < 128) {
        sequence_[0] = static_cast<char>(second);
        sequence_[1] = 0;
    } else if (!read_sequence(second)) {
        sequence_[0] = 0;
    }
    sequence_cursor_ = sequence_;
    return first;
}

} // namespace lmx
