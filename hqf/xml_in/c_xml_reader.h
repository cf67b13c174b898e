#pragma once

#include "hqf/errors/c_error.h"
#include "hqf/xml_in/c_cracked_name.h"
#include "hqf/xml_in/c_string_stack.h"
#include "hqf/xml_in/c_xml.h"
#include "hqf/xml_in/c_xml_reader_scope.h"
#include "hqf/xml_in/s_event_map.h"
#include "hqf/xml_in/s_known_elements.h"

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace hqf {

/// What the fast path has read last, since the general path did: the engine writes it, and hands it over when the
/// general path goes on. The pointers mean something to the engine alone.
struct fast_trace {
    enum class name_kind : unsigned char { none, element, attribute, nil, type };

    name_kind kind = name_kind::none;
    /// The name, for an element or an attribute.
    const void* name = nullptr;
    /// Where the last value went, null where none was read.
    const void* value = nullptr;
};

// The reader's error object must exist before the tokeniser that reports to it, so it is a base in front of that one.
struct reader_error_record {
    lmx::c_error errors;
};

} // namespace hqf

namespace lmx {

struct s_ns_map;

/// Which kind of name an event table is asked for.
enum elxp_attr_elem : int { elxp_attribute = 0, elxp_element = 1 };

/// Reads one document for the model's classes: resolves namespaces, looks names up in event tables, and keeps the state
/// of errors.
///
/// In this order: construct (which reads nothing), optionally `add_namespace_mapping`, `set_ns_map`, open a
/// `c_xml_reader_local`, `get_element_event` for the root, then whatever the classes ask for.
///
/// There are two records of errors. What the input layers report goes to an error object inside (`get_error`,
/// `get_error_info`); what the model's classes find goes through `handle_error` (`get_error_message`). Derive and
/// override `user_handle_error` to see the latter and to let a load go on.
///
/// One thread at a time. Owns neither the source nor the tables that it is given.
class HQF_API c_xml_reader : private hqf::reader_error_record, public c_xml {
public:
    /// What `get_namespace` gives for a prefix that nothing declares: one blank.
    static const std::string k_namespace_not_found;

    explicit c_xml_reader(c_read& input);

    virtual ~c_xml_reader();
    /// Decides about an error that a class has found: a non-zero result ends the load with it, 0 lets it go on.
    ///
    /// By default asks `user_handle_error(code)`. Source file and line are those of the library.
    virtual elmx_error user_handle_error(elmx_error code, const std::string& item, const char* source_file,
                                         int source_line);
    /// Gives the code unchanged by default.
    virtual elmx_error user_handle_error(elmx_error code);
    /// Gives "line:12-'Hqf:Color'-Mandatory element missing" for the last handled error, with the line that has been
    /// reached by now; "No Error" when there is none. Gives `*out`.
    virtual std::string& get_error_message(std::string* out) const;

    /// Records an error of a class, asks `user_handle_error`, records and gives its answer.
    elmx_error handle_error(elmx_error code, const std::string& item, const char* source_file, int source_line);
    /// The last code that the input layers reported, 0 when there is none.
    elmx_error get_error() const { return errors.get_last_error(); }
    /// The input layers' last report. False when there is none.
    bool get_error_info(elmx_error_type* type, elmx_error* code, int* line) const {
        return errors.get_error_info(type, code, line);
    }
    /// The item of the error handled last.
    const std::string& get_error_item_name() const { return error_item_name_; }
    /// The line of what will be read next, from 1.
    int get_line_no() const { return get_line_num(); }

    /// Declares a prefix for the whole document. Takes effect at the next `set_ns_map`.
    void add_namespace_mapping(const std::string& prefix, const std::string& uri);
    void add_default_namespace_mapping(const std::string& uri);
    /// Gives the table's URIs their numbers and declares the mappings added before. Prefixes in the table don't count:
    /// a document may choose its own.
    ///
    /// \param table ends with a null URI
    void set_ns_map(const s_ns_map* table);
    /// The URI of the name's prefix: empty for no namespace, `k_namespace_not_found` for none declared. Gives `*out`.
    std::string& get_namespace(const std::string& qname, std::string* out) const;
    c_xml_reader_local* get_reader_local() const { return current_scope_; }
    void set_reader_local(c_xml_reader_local* scope);
    using c_xml::is_xsi_attribute;
    bool is_xsi_attribute(const std::string& name) const { return c_xml::is_xsi_attribute(current_scope_, name); }
    /// Whether the name's prefix is declared (the default namespace, for a name without) and its parts are ASCII names.
    bool is_valid_qname(const std::string& name) const;

    /// Reads the next tag or text in the current scope, whose declarations it drops first.
    ///
    /// Sets the current event, and for a name the cracked name; with a table it looks the name up.
    /// \param error set to 34 at the end of input, to `get_error` after an error event (it may be 0), else unchanged
    void get_element_event(const s_event_map* map, elmx_error* error, std::string* name);
    /// The same, but passes over elements that neither the table nor `set_known_elements` knows. Error 5 when one
    /// can't be skipped.
    void get_known_element_event(const s_event_map* map, elmx_error* error, std::string* name);
    /// Reads the next attribute's name likewise. \returns false at the end of the start tag: event 4 or 6, error 0
    bool get_attribute_event(const s_event_map* map, elmx_error* error, std::string* name);
    /// Looks the cracked name up and sets the current event. An unprefixed attribute has namespace 1.
    void tokenise(const s_event_map* map, elxp_attr_elem kind);
    int get_current_event() const { return current_event_; }
    void restore_event(int event) { current_event_ = event; }
    /// Whether a name is in hand that could be looked up.
    bool is_current_event_tokenisable() const {
        return current_event_ == EXE_NAME || current_event_ == EXE_OTHER || current_event_ >= EXE_FIRST_TOKEN;
    }

    /// The parts of the name read last: `c_cracked_name`.
    const std::string& get_full_name() const { return cracked_name_.get_full_name(); }
    using c_xml::get_local_name;
    const std::string& get_local_name() const { return cracked_name_.get_local_name(); }
    using c_xml::get_ns_id;
    int get_ns_id() const { return cracked_name_.get_ns_id(); }
    bool get_has_ns_prefix() const { return cracked_name_.get_has_ns_prefix(); }
    int get_element_ns_id() const { return cracked_name_.get_element_ns_id(); }

    c_string_stack& get_element_name_stack() { return element_names_; }
    /// The elements that `get_known_element_event` lets through besides its table; may be null.
    void set_known_elements(const s_known_elements* elements) { known_elements_ = elements; }
    const s_known_elements* get_known_elements() const { return known_elements_; }

    /// Reads an element of text alone from inside its start tag through its end tag.
    ///
    /// \returns false with `*error` 11 (start tag), 29 (value) or 10 (end tag)
    bool get_simple_type_value(const std::string& name, elmx_whitespace mode, std::string* value, elmx_error* error,
                               bool* empty);
    /// The same for an element of any content, which comes as raw text.
    bool get_element_ur_value(const std::string& name, std::string* value, elmx_error* error, bool* empty);
    /// As on `c_xml`; after success the current event is 6.
    bool get_nested_element_value(std::string* value, std::string* end_name, elmx_whitespace mode, bool unused);
    /// As on `c_xml`, in the current scope.
    using c_xml::get_named_attribute;
    bool get_named_attribute(int ns_id, const std::string& name, std::string* value) {
        return c_xml::get_named_attribute(current_scope_, ns_id, name, value);
    }
    using c_xml::get_xsi_type;
    bool get_xsi_type(int* ns_id, std::string* name) { return c_xml::get_xsi_type(current_scope_, ns_id, name); }

private:
    friend class c_xml_reader_local;
    friend struct hqf::reader_access;

    bool is_known_element() const;

    c_xml_reader_local* current_scope_ = &root_scope_;
    c_xml_reader_local root_scope_;
    elmx_error last_handled_error_ = err_no_error;
    std::string error_item_name_;
    c_string_stack element_names_;
    c_cracked_name cracked_name_;
    int current_event_ = EXE_EOF;
    std::vector<std::pair<std::string, std::string>> namespace_mappings_;
    const s_known_elements* known_elements_ = nullptr;

public:
    /// Work space of the model's classes: the current element's name, a value, and an attribute's name.
    std::string item_name;
    std::string value_buffer;
    std::string attribute_name;

private:
    // For the fast path: whether the usual prefixes mean the usual namespaces where reading stands, and whether that
    // must be asked anew.
    bool are_prefixes_changed_ = true;
    bool are_prefixes_plain_ = false;
    // Elements of the model that are open, which the engine counts, and what it has read without the general path.
    unsigned int model_depth_ = 0;
    hqf::fast_trace trace_;
    // Steps that the engine left to the general path, for a test: the speed of a load hangs on their being few.
    unsigned int general_steps_ = 0;
};

inline c_xml_reader_local::c_xml_reader_local(c_xml_reader* reader)
    : c_xml_local(reader->current_scope_)
    , previous_(reader->current_scope_)
    , reader_(reader) {
    reader->current_scope_ = this;
}

inline c_xml_reader_local::~c_xml_reader_local() {
    if (previous_ == nullptr) return;
    if (has_declarations()) tell_change();
    reader_->current_scope_ = previous_;
}

} // namespace lmx
