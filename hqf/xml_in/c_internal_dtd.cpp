#include "hqf/xml_in/c_internal_dtd.h"

#include "hqf/xml_in/name_chars.h"

namespace lmx {
namespace {

// A character for a message; the end of input is none.
std::string shown(int c) {
    return c == -1 ? std::string() : std::string(1, static_cast<char>(c));
}

} // namespace

bool c_internal_dtd::read_doctype_decl() {
    int c = get();
    while (c != '[' && c != '>' && c != -1)
        c = get();
    if (c != '[') return c == '>';
    for (;;) {
        c = getter().get_non_ws();
        switch (c) {
        case '<':
            if (!read_declaration()) return false;
            break;
        case '%':
            if (!select_parameter_entity()) return false;
            break;
        case ']': return read_end();
        default:
            getter().error(error_fatal, err_badly_formed_dtd, "DTD not Well Formed (got " + shown(c) + ")");
            return false;
        }
    }
}

bool c_internal_dtd::read_end() {
    const int c = getter().get_non_ws();
    if (c == '>') return true;
    getter().error(error_fatal, err_badly_formed_dtd, "DTD not Well Formed (expected '>', got " + shown(c) + ")");
    return false;
}

bool c_internal_dtd::read_declaration() {
    std::string keyword;
    int c = get();
    for (; c != -1 && c != '[' && c != '>' && !hqf::is_white_space(c); c = get()) {
        keyword += static_cast<char>(c);
        if (keyword == "!--") return getter().skip_comment();
    }
    unget(c);
    if (keyword == "!ENTITY") return read_entity_decl();
    if (!keyword.empty() && keyword[0] == '?') return read_pi(keyword);
    return skip_to_declaration_end();
}

// An instruction of nothing but a target, such as <?x?>, has lost its question mark to the keyword.
bool c_internal_dtd::read_pi(const std::string& keyword) {
    if (keyword.size() > 1 && keyword.back() == '?') {
        const int c = get();
        if (c == '>') return true;
        unget(c);
    }
    return getter().skip_PI();
}

bool c_internal_dtd::read_entity_decl() {
    const int c = getter().get_non_ws();
    const bool is_parameter = c == '%';
    if (!is_parameter) unget(c);
    std::string name;
    std::string value;
    bool is_defined = false;
    const bool is_read = get_entity_value(&name) && read_definition(&value, &is_defined);
    if (is_read && is_defined) {
        if (is_parameter)
            getter().add_parameter_entity(name.c_str(), value.c_str());
        else
            getter().add_general_entity(name.c_str(), value.c_str());
    }
    skip_to_declaration_end();
    return is_read;
}

// Reads what stands behind the name. Without a value in quotes nothing is defined: a reference to such an entity then
// fails as one to an unknown name, and no text of another meaning slips into the document.
bool c_internal_dtd::read_definition(std::string* value, bool* is_defined) {
    const int c = getter().get_non_ws();
    unget(c);
    if (c == '"' || c == '\'') return *is_defined = get_quoted_entity_value(value);
    std::string word;
    const bool is_read = get_entity_value(&word);
    if (word == "SYSTEM" || word == "PUBLIC")
        getter().error(error_warning, err_reference_to_external_entity, "External Entity definitions not supported");
    else
        getter().error(error_error, err_unexpected_entity, "Unexpected value in Entity definition: " + word);
    return is_read;
}

bool c_internal_dtd::skip_to_declaration_end() {
    int quote = 0;
    for (int c = get(); c != -1; c = get()) {
        if (quote != 0) {
            if (c == quote) quote = 0;
        } else if (c == '"' || c == '\'') {
            quote = c;
        } else if (c == '>') {
            return true;
        }
    }
    return false;
}

} // namespace lmx
