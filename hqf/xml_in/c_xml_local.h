#pragma once

#include "hqf/xml_in/c_repository.h"

#include <memory>
#include <string>

#include "hqf/platform/api.h"

namespace hqf {
class scope_index;
}

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
    ~c_xml_local() {
        if (index_ != nullptr) leave_index();
    }

    /// Declares a prefix in this scope, or changes its number. The empty prefix is the default namespace.
    void add_namespace(const char* prefix, int id);
    /// Drops the declarations of this scope.
    void clear() {
        if (!prefixes_.empty()) drop_declarations();
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
        , is_changed_(outer->is_changed_)
        , index_(outer->index_) {
        if (index_ != nullptr) enter_index();
    }

    bool has_declarations() const { return !prefixes_.empty(); }
    void set_change_flag(bool* flag) { is_changed_ = flag; }
    void tell_change() const {
        if (is_changed_ != nullptr) *is_changed_ = true;
    }

private:
    void become_active();
    void drop_declarations();
    void enter_index();
    void leave_index();

    const c_xml_local* parent_ = nullptr;
    // The nearest scope, from this one outwards, that has ever had a declaration: the search starts there.
    const c_xml_local* active_ = nullptr;
    // How many scopes a search from here walks through, once this one is active.
    unsigned int scopes_to_walk_ = 0;
    // Raised whenever prefixes may have changed their meaning; belongs to the reader, null where nobody asks.
    bool* is_changed_ = nullptr;
    c_repository<int> prefixes_;
    // Beside the walk, where that would be long.
    std::shared_ptr<hqf::scope_index> index_;
};

} // namespace lmx
