#include "hqf/xml_in/c_xml_reader.h"

#include "hqf/values/s_ns_map.h"

#include <cstring>

// The reader: errors, namespaces and events. Values stand in c_xml_reader_values.cpp.

namespace lmx {
namespace {

constexpr int id_of_no_namespace = 1;
constexpr int id_of_xsi = 5;

// Number, first character, length, whole name: in this order most rows are told apart by the first two tests.
template<class Row>
bool is_row_of(const Row& row, int ns_id, const std::string& name) {
    return row.ns_id == ns_id && row.name[0] == name[0] && static_cast<std::size_t>(row.name_length) == name.size() &&
           std::memcmp(row.name, name.data(), name.size()) == 0;
}

int event_of_xsi_attribute(const std::string& name) {
    if (name == "type") return EXE_XSI_TYPE;
    if (name == "nil") return EXE_XSI_NIL;
    if (name == "noNamespaceSchemaLocation") return EXE_XSI_NO_NS_SCHEMA_LOCATION;
    if (name == "schemaLocation") return EXE_XSI_SCHEMA_LOCATION;
    return EXE_OTHER;
}

} // namespace

const std::string c_xml_reader::k_namespace_not_found(" ");

c_xml_reader::c_xml_reader(c_read& input)
    : c_xml(input, errors, true) {
    root_scope_.set_reader(this);
    root_scope_.set_change_flag(&are_prefixes_changed_);
}

c_xml_reader::~c_xml_reader() = default;

elmx_error c_xml_reader::user_handle_error(elmx_error code, const std::string&, const char*, int) {
    return user_handle_error(code);
}

elmx_error c_xml_reader::user_handle_error(elmx_error code) {
    return code;
}

elmx_error c_xml_reader::handle_error(elmx_error code, const std::string& item, const char* source_file,
                                      int source_line) {
    last_handled_error_ = code;
    error_item_name_ = item;
    last_handled_error_ = user_handle_error(code, item, source_file, source_line);
    return last_handled_error_;
}

std::string& c_xml_reader::get_error_message(std::string* out) const {
    out->clear();
    if (last_handled_error_ != err_no_error) {
        *out += "line:";
        *out += std::to_string(get_line_no());
        *out += "-'";
        *out += error_item_name_;
        *out += "'-";
    }
    return *out += get_error_description(last_handled_error_);
}

void c_xml_reader::add_namespace_mapping(const std::string& prefix, const std::string& uri) {
    namespace_mappings_.emplace_back(prefix, uri);
}

void c_xml_reader::add_default_namespace_mapping(const std::string& uri) {
    namespace_mappings_.emplace_back(std::string(), uri);
}

void c_xml_reader::set_ns_map(const s_ns_map* table) {
    for (const s_ns_map* row = table; row != nullptr && row->uri != nullptr; ++row)
        add_namespace(row->uri, row->id);
    for (const auto& [prefix, uri] : namespace_mappings_)
        root_scope_.add_namespace(prefix.c_str(), add_namespace(uri.c_str()));
}

std::string& c_xml_reader::get_namespace(const std::string& qname, std::string* out) const {
    const int id = c_xml::get_ns_id(current_scope_, qname);
    if (id == id_of_no_namespace) {
        out->clear();
        return *out;
    }
    const char* const uri = id == 0 ? nullptr : find_namespace_from_id(id);
    return *out = uri == nullptr ? k_namespace_not_found : uri;
}

void c_xml_reader::set_reader_local(c_xml_reader_local* scope) {
    current_scope_ = scope;
    are_prefixes_changed_ = true;
    if (scope != nullptr) scope->set_change_flag(&are_prefixes_changed_);
}

bool c_xml_reader::is_valid_qname(const std::string& name) const {
    const auto is_letter = [](char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); };
    const auto is_name = [&](const std::string& part) {
        if (part.empty() || !(is_letter(part[0]) || part[0] == '_' || part[0] == ':')) return false;
        for (std::size_t i = 1; i < part.size(); ++i) {
            const char c = part[i];
            if (!is_letter(c) && !(c >= '0' && c <= '9') && c != '.' && c != '-' && c != '_') return false;
        }
        return true;
    };
    c_cracked_name cracked;
    cracked.set(current_scope_, name);
    if (cracked.get_ns_id() == 0) return false;
    if (cracked.get_has_ns_prefix() && !is_name(cracked.get_ns_prefix())) return false;
    return is_name(cracked.get_local_name());
}

void c_xml_reader::get_element_event(const s_event_map* map, elmx_error* error, std::string* name) {
    current_scope_->clear();
    current_event_ = get_element_name(current_scope_, name);
    if (current_event_ == EXE_NAME) {
        cracked_name_.set(current_scope_, *name);
        if (map != nullptr) tokenise(map, elxp_element);
    } else if (is_error_event(current_event_)) {
        *error = get_error();
    } else if (current_event_ == EXE_EOF) {
        *error = err_unexpected_end_of_message;
    }
}

void c_xml_reader::get_known_element_event(const s_event_map* map, elmx_error* error, std::string* name) {
    for (;;) {
        get_element_event(nullptr, error, name);
        if (current_event_ != EXE_NAME) return;
        if (map != nullptr) {
            tokenise(map, elxp_element);
            if (current_event_ != EXE_OTHER) return;
        }
        if (is_known_element()) return;
        if (!skip_rest_of_element(*name)) {
            *error = err_xml_badly_formed;
            return;
        }
    }
}

bool c_xml_reader::is_known_element() const {
    for (const s_known_elements* row = known_elements_; row != nullptr && row->name != nullptr; ++row)
        if (is_row_of(*row, get_element_ns_id(), get_local_name())) return true;
    return false;
}

bool c_xml_reader::get_attribute_event(const s_event_map* map, elmx_error* error, std::string* name) {
    *error = err_no_error;
    current_event_ = get_attribute_name(name, false);
    if (is_error_event(current_event_)) {
        *error = get_error();
        return true;
    }
    if (current_event_ == EXE_EOF) {
        *error = err_unexpected_end_of_message;
        return true;
    }
    if (current_event_ != EXE_NAME) return false;
    cracked_name_.set(current_scope_, *name);
    if (map != nullptr) tokenise(map, elxp_attribute);
    return true;
}

void c_xml_reader::tokenise(const s_event_map* map, elxp_attr_elem kind) {
    int ns_id = cracked_name_.get_ns_id();
    if (!cracked_name_.get_has_ns_prefix())
        ns_id = kind == elxp_attribute ? id_of_no_namespace : cracked_name_.get_element_ns_id();
    const std::string& name = cracked_name_.get_local_name();
    if (ns_id == id_of_xsi) {
        current_event_ = event_of_xsi_attribute(name);
        return;
    }
    current_event_ = EXE_OTHER;
    for (const s_event_map* row = map; row != nullptr && row->name != nullptr; ++row) {
        if (!is_row_of(*row, ns_id, name)) continue;
        current_event_ = row->event;
        return;
    }
}

} // namespace lmx
