#pragma once

#include "hqf/platform/api.h"

/// The codes that every fallible operation returns, and the one sentence that belongs to each.

namespace lmx {

/// Every code with its name and its sentence, in the order in which they are searched. Codes 47 to 999 don't exist;
/// from 1000 on they belong to the application and to the document operations.
///
/// This list is the only place that knows them: the enumeration and the texts are both made from it.
// clang-format off
#define HQF_ELMX_ERRORS(row)                                                                                           \
    row(0, err_no_error, "No Error")                                                                                   \
    row(1, err_unable_to_open_file, "Unable to open file")                                                             \
    row(2, err_violation_of_xs_all_cardinality_constraints, "Violation of xs:all cardinality constraints")             \
    row(3, err_attribute_has_already_been_read, "Attribute has already been read")                                     \
    row(4, err_attributes_found_in_anonymous_compositor, "Attributes found in anonymous compositor")                   \
    row(5, err_xml_badly_formed, "XML badly formed")                                                                   \
    row(6, err_xml_character_encoding_not_supported, "XML character encoding not supported")                           \
    row(7, err_inappropriate_choice_option_selected, "Inappropriate choice option selected")                           \
    row(8, err_badly_formed_comment, "Badly formed comment")                                                           \
    row(9, err_badly_formed_dtd, "Badly formed DTD")                                                                   \
    row(10, err_bad_end_of_element, "Bad end of element")                                                              \
    row(11, err_bad_start_tag_end, "Bad start tag end")                                                                \
    row(12, err_syntax_error_in_end_tag, "Syntax error in end tag")                                                    \
    row(13, err_bad_xml_decl_spec, "Bad XML Decl spec")                                                                \
    row(14, err_unsupported_xml_version, "Unsupported XML version")                                                    \
    row(15, err_mis_match_between_specified_char_encoding_and_read_bytes,                                              \
        "Mis-match between specified char encoding and read bytes")                                                    \
    row(16, err_element_not_found, "Element not found")                                                                \
    row(17, err_reference_to_external_entity, "Reference to external entity")                                          \
    row(18, err_fraction_digits_exceeded, "Fraction digits exceeded")                                                  \
    row(19, err_length_too_long, "Length too long")                                                                    \
    row(20, err_length_too_short, "Length too short")                                                                  \
    row(21, err_mandatory_element_missing, "Mandatory element missing")                                                \
    row(22, err_no_pattern_matched, "No pattern matched")                                                              \
    row(23, err_not_well_formed, "Not well formed")                                                                    \
    row(24, err_recursive_entity_definition, "Recursive entity definition")                                            \
    row(25, err_required_attribute_s_missing, "Required attribute(s) missing")                                         \
    row(26, err_element_instances_exceeds_maxoccurs, "Element instances exceeds maxOccurs")                            \
    row(27, err_total_digits_exceeded, "Total digits exceeded")                                                        \
    row(28, err_unable_to_read_attribute_value, "Unable to read attribute value")                                      \
    row(29, err_unable_to_read_element_value, "Unable to read element value")                                          \
    row(30, err_unknown_element_in_xs_all, "Unknown element in xs:all")                                                \
    row(31, err_unknown_element_in_complexcontent, "Unknown element in complexContent")                                \
    row(32, err_unexpected_empty_element, "Unexpected empty element")                                                  \
    row(33, err_unexpected_entity, "Unexpected entity")                                                                \
    row(34, err_unexpected_end_of_message, "Unexpected end of message")                                                \
    row(35, err_invalid_value_format_for_this_type, "Invalid value format for this type")                              \
    row(36, err_value_greater_than_specified_maximum, "Value greater than specified maximum")                          \
    row(37, err_value_less_than_specified_minimum, "Value less than specified minimum")                                \
    row(38, err_value_does_not_match_enumerations, "Value does not match enumerations")                                \
    row(39, err_unexpected_attribute, "Unexpected attribute")                                                          \
    row(40, err_nilled_element_body_not_empty, "Nilled element body not empty")                                        \
    row(41, err_entity_not_found, "Entity not found")                                                                  \
    row(42, err_undefined_error, "Undefined error")                                                                    \
    row(43, err_value_does_not_match_specified_fixed_constraint, "Value does not match specified fixed constraint")    \
    row(44, err_unknown_xsi_type, "Unknown xsi:type")                                                                  \
    row(45, err_type_not_set, "Type not set")                                                                          \
    row(46, err_min_max_occurs_error_on_marshaling, "min/max occurs error on marshaling")                              \
    row(1000, err_user_defined_error_1, "User defined error 1")                                                        \
    row(1001, err_user_defined_error_2, "User defined error 2")                                                        \
    row(1002, err_user_defined_error_3, "User defined error 3")                                                        \
    row(1003, err_user_defined_error_4, "User defined error 4")                                                        \
    row(1004, err_user_defined_error_5, "User defined error 5")                                                        \
    row(1005, err_user_defined_error_6, "User defined error 6")                                                        \
    row(1006, err_user_defined_error_7, "User defined error 7")                                                        \
    row(1007, err_user_defined_error_8, "User defined error 8")                                                        \
    row(1008, err_user_defined_error_9, "User defined error 9")
// clang-format on

/// The outcome of an operation: 0 is success. An error handler of the application may bring any other number too.
enum elmx_error : int {
#define HQF_ENUMERATOR(code, name, sentence) name = code,
    HQF_ELMX_ERRORS(HQF_ENUMERATOR)
#undef HQF_ENUMERATOR
};

/// How grave a report of the XML input layers is.
enum elmx_error_type : int {
    error_fatal = 0,   ///< reading ends here
    error_error = 1,   ///< the code is recorded, the caller decides
    error_warning = 2, ///< counted apart
    error_notice = 3,  ///< counted with the warnings, and once more by itself
    error_none = 4,    ///< nothing has been recorded
};

/// The sentence that belongs to a code: "No Error" for 0, the empty text for a number that is no code. Never null; the
/// text stays valid for the life of the library.
HQF_API const char* get_error_description(int code);

} // namespace lmx
