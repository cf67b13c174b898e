#include "hqf/xml_in/c_xml_local.h"

namespace lmx {
namespace {

constexpr int id_of_xml = 2;

} // namespace

int c_xml_local::find_namespace_id(const std::string& prefix) const {
    if (prefix == "xml") return id_of_xml;
    int id = 0;
    for (const c_xml_local* scope = active_; scope != nullptr;) {
        if (scope->prefixes_.find(prefix.c_str(), &id)) return id;
        scope = scope->parent_ == nullptr ? nullptr : scope->parent_->active_;
    }
    return 0;
}

const char* c_xml_local::find_namespace_prefix(int id) const {
    if (id == id_of_xml) return "xml";
    for (const c_xml_local* scope = active_; scope != nullptr;) {
        if (const char* const prefix = scope->prefixes_.find_key(id)) return prefix;
        scope = scope->parent_ == nullptr ? nullptr : scope->parent_->active_;
    }
    return nullptr;
}

const char* c_xml_local::find_first_namespace_prefix(int id) const {
    if (id == id_of_xml) return "xml";
    const char* outermost = nullptr;
    for (const c_xml_local* scope = active_; scope != nullptr;) {
        if (const char* const prefix = scope->prefixes_.find_key(id)) outermost = prefix;
        scope = scope->parent_ == nullptr ? nullptr : scope->parent_->active_;
    }
    return outermost;
}

} // namespace lmx
