#include "hqf/xml_in/c_get_for_xml.h"

// The XML declaration, XML 1.0, 2.8. Order and quotes are held to; white space between its parts may be missing.

namespace lmx {

bool c_get_for_xml::read_version() {
    std::string version;
    if (get_non_ws() != 'v' || !read_specified_string_from_input("ersion") || get_non_ws() != '=' ||
        !get_simple_quoted_value(&version)) {
        error(error_error, err_bad_xml_decl_spec, "Version not present in XML Decl");
        return false;
    }
    if (version == "1.0" || version == "1.1") return true;
    error(error_error, err_unsupported_xml_version, "XML version " + version + " not understood");
    return false;
}

bool c_get_for_xml::read_encoding(int* next) {
    if (*next != 'e') return true;
    std::string name;
    if (!read_specified_string_from_input("ncoding") || get_non_ws() != '=' || !get_simple_quoted_value(&name) ||
        !set_encoding(name.c_str()))
        return false;
    *next = get_non_ws();
    return true;
}

bool c_get_for_xml::read_standalone(int* next) {
    if (*next != 's') return true;
    std::string answer;
    if (!read_specified_string_from_input("tandalone") || get_non_ws() != '=' || !get_simple_quoted_value(&answer))
        return false;
    if (answer == "no") {
        error(error_error, err_bad_xml_decl_spec, "XML Document is not standalone");
        return false;
    }
    *next = get_non_ws();
    return true;
}

bool c_get_for_xml::read_xml_decl() {
    if (!read_version()) return false;
    int next = get_non_ws();
    return read_encoding(&next) && read_standalone(&next) && next == '?' && get() == '>';
}

} // namespace lmx
