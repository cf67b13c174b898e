#include "hqf/xml_in/c_entity_name_reader.h"
#include "hqf/xml_in/c_xml.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/name_chars.h"

// Element values and end tags, and what it takes to pass over an element.

namespace lmx {

bool c_xml::get_element_value(std::string* value, elmx_whitespace mode, bool expand_references) {
    value->clear();
    getter_.set_ws_mode(mode);
    for (bool is_tag = false; !is_tag;) {
        int c = getter_.get();
        for (; c != '<'; c = getter_.get()) {
            if (c == -1) {
                getter_.error(error_error, err_unexpected_end_of_message, "Premature end of file encountered");
                return false;
            }
            if (c != '&' || !expand_references) {
                getter_.add_char_wsp(value, c, false);
                continue;
            }
            c_entity_name_reader_for_c_get reader(getter_, true);
            if (!insert_entity(reader, value)) return false;
        }
        if (!skip_markup_in_value(value, &is_tag)) return false;
    }
    return true;
}

// Behind a '<' in a value: passes over a comment or an instruction, takes a CDATA section, and gives a tag back.
bool c_xml::skip_markup_in_value(std::string* value, bool* is_tag) {
    int c = getter_.get();
    if (c == '?') {
        getter_.skip_PI();
        return true;
    }
    if (c != '!') {
        getter_.unget(c);
        getter_.unget('<');
        *is_tag = true;
        return true;
    }
    c = getter_.get();
    if (c == '[') {
        if (getter_.read_cdata(value)) return true;
    } else if (c == '-' && getter_.get() == '-') {
        getter_.skip_comment();
        return true;
    }
    report_not_well_formed("XML not well-formed");
    return false;
}

bool c_xml::is_element_end_tag(const std::string& name) {
    if (getter_.get_non_ws() != '<' || getter_.get() != '/') return false;
    for (const char expected : name)
        if (getter_.get() != static_cast<unsigned char>(expected)) return false;
    const int c = getter_.get();
    return c == '>' || (hqf::is_white_space(c) && getter_.get_non_ws() == '>');
}

bool c_xml::skip_element_body(const std::string& name) {
    return skip_element_body(name, 0);
}

bool c_xml::skip_element_body(const std::string& name, unsigned depth) {
    if (depth >= hqf::limits::skip_depth) return false;
    // Declarations of skipped elements must not reach the caller's scope.
    c_xml_local scope;
    std::string found;
    for (;;) {
        scope.clear();
        switch (get_element_name(&scope, &found)) {
        case EXE_CHARS: break;
        case EXE_NAME: {
            bool is_empty = false;
            if (!getter_.move_to_start_tag_end(&is_empty)) return false;
            if (!is_empty && !skip_element_body(found, depth + 1)) return false;
            break;
        }
        case EXE_ELEMENT_END:
            if (found == name) return true;
            report_not_well_formed(
                ("Element start tag (" + name + ") and end tag (" + found + ") do not match").c_str());
            return false;
        default: return false;
        }
    }
}

bool c_xml::skip_rest_of_element(const std::string& name) {
    bool is_empty = false;
    if (!getter_.move_to_start_tag_end(&is_empty)) return false;
    return is_empty || skip_element_body(name);
}

bool c_xml::skip_rest_of_empty_element(const std::string& name) {
    bool is_empty = false;
    if (!getter_.move_to_start_tag_end(&is_empty)) return false;
    return is_empty || is_element_end_tag(name);
}

} // namespace lmx
