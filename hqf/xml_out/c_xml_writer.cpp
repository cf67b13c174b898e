#include "hqf/xml_out/c_xml_writer.h"

#include <cstring>
#include <locale>

namespace lmx {

namespace {

/// Fixed by XML Schema Part 1, 2.6.
constexpr char instance_namespace[] = "http://www.w3.org/2001/XMLSchema-instance";

void write_declaration(std::ostream& stream, const char* prefix, const char* uri) {
    stream << " xmlns";
    if (*prefix != '\0') stream << ':' << prefix;
    stream << "=\"" << uri << '"';
}

} // namespace

c_xml_writer::c_xml_writer(std::ostream& stream, const char* tab, const char* nl)
    : stream_(stream)
    , tab_(tab)
    , newline_(nl) {
    stream_.imbue(std::locale::classic());
}

c_xml_writer::c_xml_writer(std::ostream& stream, int flags, const char* tab, const char* nl)
    : c_xml_writer(stream, tab, nl) {
    if ((flags & (include_xml_decl | include_standalone)) == 0) return;
    stream_ << "<?xml version=\"1.0\" encoding=\"UTF-8\"";
    if ((flags & include_standalone) != 0) stream_ << " standalone=\"yes\"";
    stream_ << "?>" << newline_;
}

c_xml_writer::~c_xml_writer() = default;

elmx_error c_xml_writer::user_handle_error(elmx_error code, const std::string&, const char*, int) {
    return user_handle_error(code);
}

elmx_error c_xml_writer::user_handle_error(elmx_error code) {
    return code;
}

std::string& c_xml_writer::get_error_message(std::string* out) const {
    *out = last_error_ == err_no_error ? get_error_description(err_no_error)
                                       : '\'' + error_item_name_ + "'-" + get_error_description(last_error_);
    return *out;
}

const char* c_xml_writer::endl() {
    return newline_;
}

void c_xml_writer::nest() {
    stream_ << tab_;
}

std::ostream& c_xml_writer::operator()(bool indented) {
    if (indented)
        for (int level = 0; level < nest_level_; ++level)
            nest();
    return stream_;
}

void c_xml_writer::conditionally_select_ns_map(const s_ns_map* map) {
    if (ns_map_ == nullptr) ns_map_ = map;
}

void c_xml_writer::conditionally_write_ns_attrs(bool with_xsi) {
    if (ns_attrs_written_) return;
    for (const s_ns_map* row = ns_map_; row != nullptr && row->uri != nullptr; ++row)
        write_declaration(stream_, row->prefix, row->uri);
    for (const auto& [prefix, uri] : added_namespaces_)
        write_declaration(stream_, prefix.c_str(), uri.c_str());
    if (with_xsi || !schema_locations_.empty()) write_declaration(stream_, "xsi", instance_namespace);
    if (!schema_locations_.empty() && schema_locations_.front().first.empty()) {
        stream_ << " xsi:noNamespaceSchemaLocation=\"" << schema_locations_.front().second << '"';
    } else if (!schema_locations_.empty()) {
        const char* before = " xsi:schemaLocation=\"";
        for (const auto& [ns, location] : schema_locations_) {
            stream_ << before << ns << ' ' << location;
            before = " ";
        }
        stream_ << '"';
    }
    ns_attrs_written_ = true;
}

void c_xml_writer::add_namespace(const std::string& prefix, const std::string& uri) {
    added_namespaces_.emplace_back(prefix, uri);
}

void c_xml_writer::add_schema_location(const std::string& ns, const std::string& location) {
    schema_locations_.emplace_back(ns, location);
}

const char* c_xml_writer::get_namespace_prefix(const std::string& uri) const {
    for (const s_ns_map* row = ns_map_; row != nullptr && row->uri != nullptr; ++row)
        if (uri == row->uri) return row->prefix;
    for (const auto& [prefix, added] : added_namespaces_)
        if (uri == added) return prefix.c_str();
    return nullptr;
}

elmx_error c_xml_writer::handle_error(elmx_error code, const std::string& item, const char* file, int line) {
    last_error_ = code;
    error_item_name_ = item;
    last_error_ = user_handle_error(code, item, file, line);
    return last_error_;
}

bool c_xml_writer::get_error_info(elmx_error_type* type, elmx_error* code, int* line) const {
    return errors_.get_error_info(type, code, line);
}

} // namespace lmx
