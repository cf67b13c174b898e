#include "hqf/xml_in/c_get_for_xml.h"

#include "hqf/xml_in/name_chars.h"

namespace lmx {

c_get_for_xml::~c_get_for_xml() = default;

void c_get_for_xml::put_pending_blank(std::string* out) {
    if (!is_blank_pending_) return;
    if (!out->empty()) *out += ' ';
    is_blank_pending_ = false;
}

void c_get_for_xml::add_char_wsp(std::string* out, int c, bool from_reference) {
    const bool mode_applies = !from_reference || ws_applies_to_references_;
    switch (ws_mode_) {
    case preserve: break;
    case replace:
        if (mode_applies && hqf::is_white_space(c)) c = ' ';
        break;
    case collapse:
        if (c == ' ' || (mode_applies && hqf::is_white_space(c))) {
            is_blank_pending_ = true;
            return;
        }
        put_pending_blank(out);
        break;
    }
    *out += static_cast<char>(c);
}

void c_get_for_xml::add_char_verbatim(std::string* out, int c) {
    put_pending_blank(out);
    *out += static_cast<char>(c);
}

bool c_get_for_xml::read_specified_string_from_input(const char* s) {
    for (; *s != 0; ++s)
        if (get() != static_cast<unsigned char>(*s)) return false;
    return true;
}

bool c_get_for_xml::get_simple_quoted_value(std::string* out) {
    out->clear();
    const int quote = get_non_ws();
    if (quote != '"' && quote != '\'') return false;
    for (int c = get(); c != quote; c = get()) {
        if (c == -1) return false;
        *out += static_cast<char>(c);
    }
    return true;
}

bool c_get_for_xml::skip_comment() {
    int hyphens = 0;
    for (int c = get(); c != -1; c = get()) {
        if (c == '-') {
            if (hyphens < 3) ++hyphens;
            continue;
        }
        if (c == '>' && hyphens >= 2) {
            if (hyphens > 2) error(error_warning, err_badly_formed_comment, "End of comment not Well-Formed");
            return true;
        }
        hyphens = 0;
    }
    return false;
}

bool c_get_for_xml::skip_PI() {
    int previous = 0;
    for (int c = get(); c != -1; c = get()) {
        if (c == '>' && previous == '?') return true;
        previous = c;
    }
    return false;
}

bool c_get_for_xml::move_to_start_tag_end(bool* empty) {
    const auto tell = [empty](bool is_empty) {
        if (empty != nullptr) *empty = is_empty;
    };
    int quote = 0;
    int c = get();
    for (; quote != 0 || c != '/'; c = get()) {
        if (c == -1) return false;
        if (quote != 0) {
            if (c == quote) quote = 0;
        } else if (c == '"' || c == '\'') {
            quote = c;
        } else if (c == '>') {
            tell(false);
            return true;
        }
    }
    bool is_sound = true;
    for (c = get(); c != '>' && c != -1; c = get()) {
        if (!is_sound || hqf::is_white_space(c)) continue;
        is_sound = false;
        error(error_error, err_syntax_error_in_end_tag,
              std::string("Illegal character(s) after / at end of tag - ") + static_cast<char>(c));
    }
    tell(true);
    return is_sound;
}

bool c_get_for_xml::read_cdata(std::string* out) {
    if (!read_specified_string_from_input("CDATA[")) {
        error(error_error, err_not_well_formed, "XML not Well-Formed");
        return false;
    }
    // Brackets are held back until it shows whether the last two of them end the section.
    std::size_t brackets = 0;
    const auto release = [&](std::size_t count) {
        for (; count != 0; --count)
            add_char_verbatim(out, ']');
    };
    for (int c = get();; c = get()) {
        if (c == ']') {
            ++brackets;
            continue;
        }
        if (c == -1 || (c == '>' && brackets >= 2)) {
            release(brackets > 2 ? brackets - 2 : 0);
            return true;
        }
        release(brackets);
        brackets = 0;
        add_char_verbatim(out, c);
    }
}

void c_get_for_xml::rewind() {
    set_ws_mode(preserve);
    c_get_with_entities::rewind();
}

} // namespace lmx
