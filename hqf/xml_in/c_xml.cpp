#include "hqf/xml_in/c_xml.h"

#include "hqf/xml_in/c_entity_name_reader.h"
#include "hqf/xml_in/name_chars.h"

// The main loop of the tokeniser, and what stands outside tags: text, declarations, instructions.

namespace lmx {

c_xml::c_xml(c_read& input, c_error& errors, bool ws_applies_to_references)
    : getter_(input, errors, ws_applies_to_references)
    , dtd_(getter_) {}

void c_xml::rewind() {
    namespaces_.clear();
    is_document_type_read_ = false;
    is_past_prolog_ = false;
    getter_.rewind();
}

elxp_xml_event c_xml::report_not_well_formed(const char* text) {
    getter_.error(error_error, err_not_well_formed, text);
    return EXE_ERROR;
}

elxp_xml_event c_xml::get_element_name(c_xml_local* local, std::string* name) {
    elxp_xml_event event = EXE_ERROR;
    for (;;) {
        name->clear();
        int c = getter_.get_non_ws();
        if (c != '<') {
            if (read_leading_text(c, name, &event) == markup::event) return event;
            continue;
        }
        c = getter_.get();
        if (hqf::is_name_start(c)) return read_start_tag(c, local, name);
        switch (c) {
        case '/': return read_end_tag(name);
        case '?':
            if (!read_processing_instruction()) return EXE_ERROR;
            break;
        case '!':
            if (read_markup_declaration(name, &event) == markup::go_on) break;
            is_past_prolog_ = true;
            return event;
        default:
            report_not_well_formed("XML not Well-Formed");
            getter_.move_to_start_tag_end(nullptr);
            return EXE_ERROR;
        }
    }
}

elxp_xml_event c_xml::read_start_tag(int first, c_xml_local* local, std::string* name) {
    int c = first;
    for (; hqf::is_name_char(c); c = getter_.get())
        *name += static_cast<char>(c);
    if (c == -1) return report_not_well_formed("XML not Well-Formed");
    getter_.unget(c);
    if (!read_attributes(local)) return EXE_ERROR;
    is_past_prolog_ = true;
    return EXE_NAME;
}

elxp_xml_event c_xml::read_end_tag(std::string* name) {
    int c = getter_.get();
    for (; hqf::is_name_char(c); c = getter_.get())
        *name += static_cast<char>(c);
    if (name->empty()) return EXE_ERROR;
    if (hqf::is_white_space(c)) c = getter_.get_non_ws();
    if (c != '>') return report_not_well_formed("XML not Well-Formed");
    is_past_prolog_ = true;
    return EXE_ELEMENT_END;
}

// Text that starts with the character in hand. A reference may only have put an entity on the input: then there is no
// event yet.
c_xml::markup c_xml::read_leading_text(int first, std::string* name, elxp_xml_event* event) {
    if (first == -1) {
        is_past_prolog_ = true;
        *event = EXE_EOF;
        return markup::event;
    }
    if (first == '&') {
        c_entity_name_reader_for_c_get reader(getter_, true);
        if (!insert_entity(reader, name)) {
            *event = EXE_ERROR;
            return markup::event;
        }
        if (name->empty()) return markup::go_on;
    } else {
        *name += static_cast<char>(first);
    }
    *event = read_text(name) ? EXE_CHARS : EXE_ERROR;
    is_past_prolog_ = true;
    return markup::event;
}

bool c_xml::read_text(std::string* out) {
    getter_.reset_ws_mode();
    int c = getter_.get();
    for (; c != '<' && c != -1; c = getter_.get()) {
        if (c != '&') {
            getter_.add_char_wsp(out, c, false);
            continue;
        }
        c_entity_name_reader_for_c_get reader(getter_, true);
        if (!insert_entity(reader, out)) return false;
    }
    getter_.unget(c);
    return true;
}

c_xml::markup c_xml::read_markup_declaration(std::string* name, elxp_xml_event* event) {
    *event = EXE_ERROR;
    switch (getter_.get()) {
    case '[':
        name->clear();
        if (getter_.read_cdata(name))
            *event = EXE_CHARS;
        else
            report_not_well_formed("XML not Well-Formed");
        return markup::event;
    case '-':
        if (getter_.get() == '-') return getter_.skip_comment() ? markup::go_on : markup::event;
        break;
    case 'D':
        if (getter_.read_specified_string_from_input("OCTYPE")) return read_document_type(event);
        break;
    default: break;
    }
    getter_.move_to_start_tag_end(nullptr);
    return markup::event;
}

c_xml::markup c_xml::read_document_type(elxp_xml_event* event) {
    *event = EXE_ERROR;
    const char* fault = nullptr;
    if (is_past_prolog_)
        fault = "Document Type Declaration not at start of document";
    else if (is_document_type_read_)
        fault = "Document Type Declaration already read";
    if (fault != nullptr) {
        getter_.error(error_error, err_badly_formed_dtd, fault);
        return markup::event;
    }
    if (!dtd_.read_doctype_decl()) return markup::event;
    is_document_type_read_ = true;
    return markup::go_on;
}

// A target that merely starts with "xml" is taken for the XML declaration. The first character that differs is given
// back, since it may be the '?' that ends the instruction.
bool c_xml::read_processing_instruction() {
    for (const char* expected = "xml"; *expected != 0; ++expected) {
        const int c = getter_.get();
        if (c == *expected) continue;
        getter_.unget(c);
        return getter_.skip_PI();
    }
    if (!is_past_prolog_) return getter_.read_xml_decl();
    getter_.error(error_fatal, err_bad_xml_decl_spec, "XML declaration not at start of document");
    return false;
}

} // namespace lmx
