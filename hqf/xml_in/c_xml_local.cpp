#include "hqf/xml_in/c_xml_local.h"

#include "hqf/xml_in/scope_index.h"

namespace lmx {
namespace {

constexpr int id_of_xml = 2;
constexpr unsigned int longest_walk = 16;

} // namespace

void c_xml_local::add_namespace(const char* prefix, int id) {
    if (active_ != this) become_active();
    prefixes_.add(prefix, id);
    if (index_ != nullptr) index_->declare(this, prefix, id);
    tell_change();
}

void c_xml_local::become_active() {
    const c_xml_local* const outer = parent_ == nullptr ? nullptr : parent_->active_;
    scopes_to_walk_ = outer == nullptr ? 1 : outer->scopes_to_walk_ + 1;
    if (index_ == nullptr && scopes_to_walk_ > longest_walk) index_ = std::make_shared<hqf::scope_index>(this);
    active_ = this;
}

void c_xml_local::drop_declarations() {
    prefixes_.clear();
    if (index_ != nullptr) index_->forget(this);
    tell_change();
}

void c_xml_local::enter_index() {
    index_->open(this, parent_);
}

void c_xml_local::leave_index() {
    index_->close(this, parent_);
}

int c_xml_local::find_namespace_id(const std::string& prefix) const {
    if (prefix == "xml") return id_of_xml;
    int id = 0;
    const c_xml_local* scope = active_;
    if (index_ != nullptr && index_->serves(this)) {
        if (const int* const found = index_->find(prefix)) return *found;
        const c_xml_local* const outer = index_->first()->parent_;
        scope = outer == nullptr ? nullptr : outer->active_;
    }
    while (scope != nullptr) {
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
