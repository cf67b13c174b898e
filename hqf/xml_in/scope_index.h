#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace lmx {
class c_xml_local;
}

namespace hqf {

/// The prefixes that a long chain of scopes declares, so that a document which nests its declarations as deep as it may
/// doesn't make each name walk through all scopes.
///
/// A chain walks its outermost scopes and starts an index with the first one beyond; the scopes inside share it. It
/// stands for all of them as long as they come, change and go as those of a reader do, at the inner end only. What an
/// application does otherwise puts the index out of use: then the scopes are walked, which is always right.
class scope_index {
public:
    /// For a scope without declarations, and those that will be opened inside of it.
    explicit scope_index(const lmx::c_xml_local* first)
        : first_(first)
        , innermost_(first) {}

    /// The outermost scope in the index.
    const lmx::c_xml_local* first() const { return first_; }
    /// Whether the index knows all that can be seen from a scope, up to the first.
    bool serves(const lmx::c_xml_local* scope) const { return is_in_order_ && scope == innermost_; }
    /// The number by the innermost declaration of a prefix, or null.
    const int* find(const std::string& prefix) const {
        const auto found = ids_.find(prefix);
        return found == ids_.end() || found->second.empty() ? nullptr : &found->second.back();
    }

    void open(const lmx::c_xml_local* scope, const lmx::c_xml_local* outer) {
        expect_innermost(outer);
        innermost_ = scope;
    }
    void close(const lmx::c_xml_local* scope, const lmx::c_xml_local* outer) {
        forget(scope);
        innermost_ = outer;
    }
    void declare(const lmx::c_xml_local* scope, const char* prefix, int id) {
        expect_innermost(scope);
        const auto declared = ids_.try_emplace(prefix).first;
        declared->second.push_back(id);
        declarations_.emplace_back(scope, declared);
    }
    /// Drops a scope's declarations.
    void forget(const lmx::c_xml_local* scope) {
        expect_innermost(scope);
        for (; !declarations_.empty() && declarations_.back().first == scope; declarations_.pop_back()) {
            const auto declared = declarations_.back().second;
            declared->second.pop_back();
            if (declared->second.empty()) ids_.erase(declared);
        }
    }

private:
    using id_lists = std::map<std::string, std::vector<int>>;

    void expect_innermost(const lmx::c_xml_local* scope) { is_in_order_ = is_in_order_ && scope == innermost_; }

    const lmx::c_xml_local* const first_;
    const lmx::c_xml_local* innermost_;
    bool is_in_order_ = true;
    /// For each prefix its numbers, outermost first.
    id_lists ids_;
    /// All declarations in their order, to take them back.
    std::vector<std::pair<const lmx::c_xml_local*, id_lists::iterator>> declarations_;
};

} // namespace hqf
