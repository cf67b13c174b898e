#pragma once

#include "hqf/xml_in/attribute_store.h"
#include "hqf/xml_in/c_enumerated_namespaces.h"
#include "hqf/xml_in/c_get_for_xml.h"
#include "hqf/xml_in/c_internal_dtd.h"
#include "hqf/xml_in/c_xml_local.h"
#include "hqf/xml_in/elmx_whitespace.h"
#include "hqf/xml_in/elxp_xml_event.h"
#include "hqf/xml_in/open_values.h"

#include <string>

namespace hqf {
struct reader_access;
}

namespace lmx {

/// The tokeniser: turns the character stream into tags, attributes and values, one at a time, as its caller asks.
///
/// It keeps no stack of elements, so it doesn't check that tags match (except while skipping or capturing), nor any
/// name against a schema. The attributes of a start tag are taken in whole when its name is read and kept raw; a value
/// is expanded when it is asked for. They are valid until the next start tag.
///
/// All text is UTF-8. Reports go to the error object; where an operation fails without one, the error object keeps its
/// last code. One thread at a time. A document may come from anyone: depth and entity growth are held to `hqf::limits`.
class HQF_API c_xml {
public:
    /// Owns neither the source nor the error object.
    ///
    /// \param ws_applies_to_references whether white space from a character reference is treated as if it stood in the
    /// text; readers pass true
    c_xml(c_read& input, c_error& errors, bool ws_applies_to_references);
    c_xml(const c_xml&) = delete;
    c_xml& operator=(const c_xml&) = delete;

    /// The next start tag (EXE_NAME), end tag (EXE_ELEMENT_END), text (EXE_CHARS) or end of input (EXE_EOF); EXE_ERROR
    /// otherwise. Comments, processing instructions, the XML declaration and the document type are passed over.
    ///
    /// \param local gets the tag's namespace declarations; null to take them for ordinary attributes
    /// \param name the tag's name as the document spells it, or the text without the white space in front
    elxp_xml_event get_element_name(c_xml_local* local, std::string* name);
    /// The name of the next attribute of the current start tag (EXE_NAME), or the tag's end: EXE_START_TAG_END for `>`,
    /// EXE_ELEMENT_END for `/>`. Each name must be followed by reading or skipping the value.
    ///
    /// \param is_declaration the end is `?>` in place of `/>`
    elxp_xml_event get_attribute_name(std::string* name, bool is_declaration);
    /// The value of the attribute named last. False for a reference that fails; the next attribute can still be read.
    bool get_attribute_value(std::string* value, elmx_whitespace mode);
    /// Passes over the value of the attribute named last; always true.
    bool skip_attribute_value();
    /// Finds an attribute of the current start tag by namespace number and local name, wherever it stands; an
    /// unprefixed one has the number of the default namespace. The attribute loop still sees every attribute.
    ///
    /// \returns false when it isn't there or its value fails; `*value` is work space then
    bool get_named_attribute(const c_xml_local* local, int ns_id, const std::string& local_name, std::string* value);
    /// Finds `xsi:type` likewise and splits its value. A value without prefix, where no default namespace holds, gets
    /// number 1.
    bool get_xsi_type(const c_xml_local* local, int* ns_id, std::string* local_name);

    /// Character data up to the next tag, which stays unread. Comments, instructions and CDATA marks in it vanish.
    ///
    /// \returns false for a reference that fails, or after report 34 (end of input) or 23
    bool get_element_value(std::string* value, elmx_whitespace mode, bool expand_references);
    /// Reads an end tag, after white space. False for anything but the end tag of `name`, part of which is consumed.
    bool is_element_end_tag(const std::string& name);
    /// As `c_get_for_xml::move_to_start_tag_end`.
    bool move_to_start_tag_end(bool* empty) { return getter_.move_to_start_tag_end(empty); }
    bool skip_start_tag(bool* empty) { return getter_.move_to_start_tag_end(empty); }
    /// Skips from behind the start tag of `name` through its end tag. Nested tags must match, or report 23 follows.
    bool skip_element_body(const std::string& name);
    /// Skips from inside the start tag of `name` through the element's end.
    bool skip_rest_of_element(const std::string& name);
    /// The same, but only an element without content passes.
    bool skip_rest_of_empty_element(const std::string& name);

    /// Captures the element whose start tag `name` has just been read, as raw text with its references. Namespace
    /// declarations come first; comments, instructions and white space between tags are left out.
    ///
    /// \returns false for tags that don't match, at the end of input, and beyond the depth limit
    bool get_any_element(const std::string& name, std::string* out, elmx_whitespace mode, bool);
    /// Captures everything up to the next end tag outside a captured child, and that tag's name, which the caller
    /// compares. False as above.
    bool get_nested_element_value(std::string* value, std::string* end_name, elmx_whitespace mode, bool);

    /// Back to the start of the document; entities and namespace numbers are forgotten.
    void rewind();

    int get_line_num() const { return getter_.get_line_num(); }
    const char* get_source_id() const { return getter_.get_source_id(); }

    /// The part before the first colon; empty without one. Gives `out`.
    static std::string* get_namespace_prefix(const std::string& name, std::string* out);
    /// The part behind the first colon; the whole name without one. Gives `out`.
    static std::string* get_local_name(const std::string& name, std::string* out);
    /// The number of the name's prefix in a scope; 0 for none. An unprefixed name is looked up as prefix "".
    int get_ns_id(const c_xml_local* local, const std::string& name) const;
    bool is_xsi_attribute(const c_xml_local* local, const std::string& name) const;

    /// Defines an entity before the document is read.
    void add_general_entity(const std::string& name, const std::string& value);
    void add_parameter_entity(const std::string& name, const std::string& value);
    /// The document's table of namespaces: `c_enumerated_namespaces`.
    int add_namespace(const char* uri) { return namespaces_.add_namespace(uri); }
    void add_namespace(const char* uri, int id) { namespaces_.add_namespace(uri, id); }
    int find_enumerated_namespace(const std::string& uri) const { return namespaces_.find_namespace(uri); }
    const char* find_namespace_from_id(int id) const { return namespaces_.find_namespace_from_id(id); }

    /// Whether an event stands for an error.
    static bool is_error_event(int event) { return event == EXE_FATAL || event == EXE_ERROR; }

private:
    friend struct hqf::reader_access;

    enum class raw_token { error, text, start_tag, end_tag };
    enum class markup { event, go_on };

    elxp_xml_event report_not_well_formed(const char* text);
    elxp_xml_event read_start_tag(int first, c_xml_local* local, std::string* name);
    elxp_xml_event read_end_tag(std::string* name);
    markup read_leading_text(int first, std::string* name, elxp_xml_event* event);
    bool read_text(std::string* out);
    markup read_markup_declaration(std::string* name, elxp_xml_event* event);
    markup read_document_type(elxp_xml_event* event);
    bool read_processing_instruction();

    bool read_attributes(c_xml_local* local);
    bool read_attribute_value(hqf::attribute_store& store, std::size_t* value_offset);
    bool declare_namespace(c_xml_local* local, const char* name, const char* value);
    bool expand_uri(const char* value, std::string* uri);

    bool insert_entity(c_entity_name_reader& reader, std::string* out);
    bool insert_predefined(std::string* out);
    bool expand_entity_value(const char* value, std::string* out);

    bool skip_markup_in_value(std::string* value, bool* is_tag);
    bool skip_element_body(const std::string& name, unsigned depth);

    bool capture_element(const std::string& name, std::string* out, unsigned depth);
    bool capture_rest_of_start_tag(std::string* out);
    bool capture_content(const std::string& name, std::string* out, unsigned depth);
    void append_stored_attributes(hqf::attribute_store& store, std::string* out);
    raw_token read_raw_token(std::string* out);
    raw_token read_raw_markup(std::string* out);
    raw_token read_raw_declaration(std::string* out);
    int read_raw_name(int first, std::string* out);

    c_get_for_xml getter_;
    std::string entity_name_;
    c_internal_dtd dtd_;
    c_enumerated_namespaces namespaces_;
    bool is_document_type_read_ = false;
    bool is_past_prolog_ = false;
    hqf::attribute_store attributes_;
    hqf::attribute_store declarations_;
    hqf::open_values entities_in_place_;
};

} // namespace lmx
