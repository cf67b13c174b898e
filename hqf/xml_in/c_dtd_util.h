#pragma once

#include "hqf/xml_in/c_get_for_xml.h"

namespace lmx {

/// What reading a document type declaration needs of the character stream, and how entity values are read from it.
class HQF_API c_dtd_util {
public:
    explicit c_dtd_util(c_get_for_xml& getter)
        : getter_(getter) {}

    int get() { return getter_.get(); }
    void unget(int c) { getter_.unget(c); }
    c_get_for_xml& getter() { return getter_; }

    /// Appends a word, up to white space or `>`; a parameter entity can supply it. False at the end of input.
    bool get_entity_value(std::string* out);
    /// Reads a value in quotes. Parameter entities and character references in it are expanded now, general entities
    /// when the value is used. The end of input ends the value.
    bool get_quoted_entity_value(std::string* out);
    /// Starts reading the parameter entity whose `%` has been read. An unknown one is reported (code 41) and has no
    /// effect. False when the entity can't be read: `c_get_with_entities::set_input_entity_value`.
    bool select_parameter_entity();

private:
    c_get_for_xml& getter_;
};

} // namespace lmx
