#include "hqf/xml_in/c_entity_name_reader.h"
#include "hqf/xml_in/c_xml.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/name_chars.h"

#include <string_view>

// References to entities, XML 1.0, 4.1. In text an entity's value joins the input, markup and all; in attribute values
// it is expanded in place, where a '%' in it starts a reference too.

namespace lmx {
namespace {

struct predefined_entity {
    std::string_view name;
    char character;
};

// Tried before the document's own definitions, so that nobody can give them another meaning.
constexpr predefined_entity predefined_entities[] = {
    {"lt", '<'}, {"gt", '>'}, {"amp", '&'}, {"apos", '\''}, {"quot", '"'},
};

} // namespace

void c_xml::add_general_entity(const std::string& name, const std::string& value) {
    getter_.add_general_entity(name.c_str(), value.c_str());
}

void c_xml::add_parameter_entity(const std::string& name, const std::string& value) {
    getter_.add_parameter_entity(name.c_str(), value.c_str());
}

bool c_xml::insert_entity(c_entity_name_reader& reader, std::string* out) {
    int c = reader.get();
    if (c == '#') return getter_.insert_character_entity(reader, out);
    entity_name_.clear();
    // The first character is part of the name whatever it is.
    if (c != -1) {
        do {
            entity_name_ += static_cast<char>(c);
            c = reader.get();
        } while (hqf::is_name_char(c));
    }
    const bool is_closed = c == ';';
    if (!is_closed) reader.unget(c);
    if (insert_predefined(out)) return true;

    const char* value = nullptr;
    if (getter_.get_general_entity(entity_name_.c_str(), &value)) {
        if (!reader.is_stream) return expand_entity_value(value, out);
        // A refusal has been reported as fatal, and the reads that follow show it.
        getter_.set_input_entity_value(value);
        return true;
    }
    *out += '&';
    *out += entity_name_;
    if (is_closed) *out += ';';
    return false;
}

bool c_xml::insert_predefined(std::string* out) {
    for (const predefined_entity& entity : predefined_entities) {
        if (entity_name_ != entity.name) continue;
        getter_.add_char_verbatim(out, entity.character);
        return true;
    }
    return false;
}

bool c_xml::expand_entity_value(const char* value, std::string* out) {
    if (entities_in_place_.holds(value)) {
        getter_.error(error_fatal, err_badly_formed_dtd, std::string("Recursive entity definition for: ") + value);
        return false;
    }
    if (entities_in_place_.size() >= hqf::limits::entity_depth || !getter_.pay_for_expansion(value)) return false;
    entities_in_place_.push(value);
    bool is_sound = true;
    for (const char* at = value; is_sound && *at != 0;) {
        const char c = *at++;
        if (c != '&' && c != '%') {
            getter_.add_char_wsp(out, static_cast<unsigned char>(c), false);
            continue;
        }
        c_entity_name_reader_for_entity reader(at, at);
        is_sound = insert_entity(reader, out);
    }
    entities_in_place_.pop();
    return is_sound;
}

} // namespace lmx
