#include "hqf/xml_in/c_dtd_util.h"

#include "hqf/xml_in/c_entity_name_reader.h"
#include "hqf/xml_in/name_chars.h"

namespace lmx {

bool c_dtd_util::get_entity_value(std::string* out) {
    int c = getter_.get_non_ws();
    if (c == -1) return false;
    for (; c != '>' && c != -1 && !hqf::is_white_space(c); c = get()) {
        if (c != '%')
            *out += static_cast<char>(c);
        else if (!select_parameter_entity())
            return false;
    }
    unget(c);
    return true;
}

bool c_dtd_util::get_quoted_entity_value(std::string* out) {
    const int quote = getter_.get_non_ws();
    if (quote != '"' && quote != '\'') return false;
    out->clear();
    // A quote that comes out of a parameter entity belongs to the value.
    const unsigned int depth = getter_.get_entity_stack_depth();
    for (;;) {
        int c = get();
        if (c == -1) return true;
        if (c == quote && getter_.get_entity_stack_depth() == depth) return true;
        if (c == '%') {
            if (!select_parameter_entity()) return false;
            continue;
        }
        if (c == '&') {
            c = get();
            if (c == '#') {
                c_entity_name_reader_for_c_get reader(getter_, false);
                if (!getter_.insert_character_entity(reader, out)) return false;
                continue;
            }
            *out += '&';
            if (c == -1) return true;
        }
        *out += static_cast<char>(c);
    }
}

bool c_dtd_util::select_parameter_entity() {
    std::string name;
    int c = get();
    for (; hqf::is_name_char(c); c = get())
        name += static_cast<char>(c);
    if (c != ';') unget(c);
    const char* value = nullptr;
    if (getter_.get_parameter_entity(name.c_str(), &value)) return getter_.set_input_entity_value(value);
    getter_.error(error_error, err_entity_not_found, "Entity '%" + name + "' not found");
    return true;
}

} // namespace lmx
