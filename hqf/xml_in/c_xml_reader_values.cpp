#include "hqf/xml_in/c_xml_reader.h"

// Whole values through the reader. Where the tokeniser only says no, a code says which part of the element failed.

namespace lmx {
namespace {

bool fail(elmx_error* error, elmx_error code) {
    *error = code;
    return false;
}

} // namespace

bool c_xml_reader::get_simple_type_value(const std::string& name, elmx_whitespace mode, std::string* out,
                                         elmx_error* error, bool* empty) {
    bool unwanted = false;
    if (empty == nullptr) empty = &unwanted;
    out->clear();
    if (!move_to_start_tag_end(empty)) return fail(error, err_bad_start_tag_end);
    if (*empty) return true;
    if (!get_element_value(out, mode, true)) return fail(error, err_unable_to_read_element_value);
    return is_element_end_tag(name) || fail(error, err_bad_end_of_element);
}

bool c_xml_reader::get_element_ur_value(const std::string& name, std::string* out, elmx_error* error, bool* empty) {
    bool unwanted = false;
    if (empty == nullptr) empty = &unwanted;
    out->clear();
    if (!move_to_start_tag_end(empty)) return fail(error, err_bad_start_tag_end);
    if (*empty) return true;
    std::string end_name;
    if (!c_xml::get_nested_element_value(out, &end_name, preserve, true))
        return fail(error, err_unable_to_read_element_value);
    current_event_ = EXE_ELEMENT_END;
    return end_name == name || fail(error, err_bad_end_of_element);
}

bool c_xml_reader::get_nested_element_value(std::string* out, std::string* end_name, elmx_whitespace mode,
                                            bool unused) {
    if (!c_xml::get_nested_element_value(out, end_name, mode, unused)) return false;
    current_event_ = EXE_ELEMENT_END;
    return true;
}

} // namespace lmx
