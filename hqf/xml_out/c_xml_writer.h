#pragma once

#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "hqf/errors/c_error.h"
#include "hqf/errors/elmx_error.h"
#include "hqf/platform/api.h"
#include "hqf/values/s_ns_map.h"

/// The object that carries the state of a write: the stream, the nesting level, the layout strings, the namespace
/// declarations of the outermost element and the errors. It builds no tree and writes no tag itself: model classes
/// write their text to the stream that it hands out.

namespace hqf {
struct writer_access;
}

namespace lmx {

/// Output of one document, always UTF-8.
///
/// Derive from it to change the layout (`endl`, `nest`) or the handling of errors (`user_handle_error`). One thread at
/// a time. The stream and both layout strings are not owned and must outlive the writer.
///
/// A failed stream does not stop a write: ask the stream afterwards.
class HQF_API c_xml_writer {
public:
    /// Flags of the second constructor; either one brings the XML declaration.
    static constexpr int include_xml_decl = 1;   ///< the XML declaration, version 1.0 and UTF-8
    static constexpr int include_standalone = 2; ///< the declaration with `standalone="yes"`

    /// Gives the stream the classic locale, so that numbers never carry grouping or a decimal comma. Writes nothing.
    ///
    /// \param tab one level of indentation
    /// \param nl the line end
    c_xml_writer(std::ostream& stream, const char* tab, const char* nl);
    /// The same, then writes the XML declaration and a line end if `flags & 3` isn't 0.
    c_xml_writer(std::ostream& stream, int flags, const char* tab, const char* nl);
    c_xml_writer(const c_xml_writer&) = delete;
    c_xml_writer& operator=(const c_xml_writer&) = delete;

    /// Writes nothing and doesn't flush the stream.
    virtual ~c_xml_writer();
    /// Called for each error with the item concerned and the place in the source that found it. Returns the code to end
    /// the write with, or 0 to go on. By default the one-argument form decides.
    virtual elmx_error user_handle_error(elmx_error code, const std::string& item, const char* file, int line);
    /// Returns the code unchanged.
    virtual elmx_error user_handle_error(elmx_error code);
    /// Gives the last error as `'item'-message`, or "No Error". Gives `*out`.
    virtual std::string& get_error_message(std::string* out) const;
    /// The line end, for the caller to send to the stream. Writes nothing.
    virtual const char* endl();
    /// Writes one level of indentation to the stream.
    virtual void nest();

    /// Hands out the stream, indented to the current level first if asked.
    std::ostream& operator()(bool indented);
    void indent() { ++nest_level_; }
    /// At level 0 it does nothing.
    void undent() {
        if (nest_level_ > 0) --nest_level_;
    }

    /// Keeps the first table that it is given; a later call changes nothing. An all-zero row ends the table.
    void conditionally_select_ns_map(const s_ns_map* map);
    /// Writes the namespace declarations, the first time only: the selected table, the added namespaces, `xsi` if
    /// `with_xsi` or a schema location asks for it, the schema locations. Without a selected table there are no rows of
    /// one.
    void conditionally_write_ns_attrs(bool with_xsi);
    /// Makes the next conditionally_write_ns_attrs() write again.
    void reenable_namespace_map_output() { ns_attrs_written_ = false; }

    /// Declares a namespace on the outermost element. An empty prefix is the default namespace.
    void add_namespace(const std::string& prefix, const std::string& uri);
    void add_default_namespace(const std::string& uri) { add_namespace(std::string(), uri); }
    /// Appends to `xsi:schemaLocation`. If the first pair's namespace is empty, its location alone becomes
    /// `xsi:noNamespaceSchemaLocation`.
    void add_schema_location(const std::string& ns, const std::string& location);
    void add_no_namespace_schema_location(const std::string& location) { add_schema_location(std::string(), location); }
    /// The prefix of a namespace in the selected table or among the added ones: empty for a default namespace, null for
    /// a URI that nobody declared.
    const char* get_namespace_prefix(const std::string& uri) const;

    /// Identity of the class that the next element's declared type expects; compared by pointer. An object of another
    /// class writes `xsi:type` and clears it.
    void set_expected_class_identity(const char* id) { expected_class_identity_ = id; }
    const char* get_expected_class_identity() const { return expected_class_identity_; }
    void clear_expected_class_identity() { expected_class_identity_ = nullptr; }

    /// Records an error, asks user_handle_error(), and returns what that returned.
    elmx_error handle_error(elmx_error code, const std::string& item, const char* file, int line);
    /// The item of the last error.
    const std::string& get_error_item_name() const { return error_item_name_; }
    /// Grade, code and line of the writer's error object.
    ///
    /// \returns false when that has recorded nothing; then nothing is stored. The writer itself never reports into it.
    bool get_error_info(elmx_error_type* type, elmx_error* code, int* line) const;

private:
    friend struct hqf::writer_access;

    std::ostream& stream_;
    int nest_level_ = 0;
    const char* tab_;
    const char* newline_;
    bool ns_attrs_written_ = false;
    c_error errors_;
    elmx_error last_error_ = err_no_error;
    std::string error_item_name_;
    const s_ns_map* ns_map_ = nullptr;
    std::vector<std::pair<std::string, std::string>> added_namespaces_;
    std::vector<std::pair<std::string, std::string>> schema_locations_;
    const char* expected_class_identity_ = nullptr;
};

} // namespace lmx
