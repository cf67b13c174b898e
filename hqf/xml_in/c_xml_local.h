#pragma once

#include "hqf/xml_in/c_repository.h"

#include <string>

#include "hqf/platform/api.h"

namespace lmx {

/// One scope of namespace declarations: which prefix stands for which number, here and in the scopes around.
///
/// An inner scope refers to the outer one, which must outlive it. A scope without declarations costs no allocation.
class HQF_API c_xml_local {
public:
    /// A scope with nothing around it.
    c_xml_local() = default;
    /// A scope inside `outer`. This is no copy: declarations are looked up outside, not taken over.
    c_xml_local(const c_xml_local& outer)
        : c_xml_local(&outer) {}
    c_xml_local& operator=(const c_xml_local&) = delete;

    /// Declares a prefix in this scope, or changes its number. The empty prefix is the default namespace.
    void add_namespace(const char* prefix, int id) {
        prefixes_.add(prefix, id);
        active_ = this;
        tell_change();
    }
    /// Drops the declarations of this scope.
    void clear() {
        if (prefixes_.empty()) return;
        prefixes_.clear();
        tell_change();
    }
    /// The number of a prefix by the nearest declaration, or 0. `xml` is 2 everywhere.
    int find_namespace_id(const std::string& prefix) const;
    /// The innermost prefix that has this number, or null; "xml" for 2.
    const char* find_namespace_prefix(int id) const;
    /// The outermost prefix that has this number, or null; "xml" for 2.
    const char* find_first_namespace_prefix(int id) const;

protected:
    explicit c_xml_local(const c_xml_local* outer)
        : parent_(outer)
        , active_(outer->active_)
        , is_changed_(outer->is_changed_) {}

    bool has_declarations() const { return !prefixes_.empty(); }
    void set_change_flag(bool* flag) { is_changed_ = flag; }
    void tell_change() const {
        if (is_changed_ != nullptr) *is_changed_ = true;
    }

private:
    const c_xml_local* parent_ = nullptr;
    // The nearest scope, from this one outwards, that has ever had a declaration: the search starts there.
    const c_xml_local* active_ = nullptr;
    // Raised whenever prefixes may have changed their meaning; belongs to the reader, null where nobody asks.
    bool* is_changed_ = nullptr;
    c_repository<int> prefixes_;
};

} // namespace lmx
