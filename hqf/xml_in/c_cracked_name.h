#pragma once

#include "hqf/platform/api.h"

#include <string>

namespace hqf {
struct reader_access;
}

namespace lmx {

class c_xml_local;

/// A qualified name taken apart, with the number of its namespace.
class HQF_API c_cracked_name {
public:
    /// Splits `name` at its first colon and looks its prefix up; a name without one is looked up as prefix "".
    void set(const c_xml_local* scope, const std::string& name);

    /// The name as the document spells it.
    const std::string& get_full_name() const { return full_name_; }
    bool get_has_ns_prefix() const { return has_prefix_; }
    /// The number of the prefix; 0 when nothing declares it.
    int get_ns_id() const { return ns_id_; }
    /// The part behind the colon, or the whole name.
    const std::string& get_local_name() const { return local_name_; }
    /// The part before the colon, or nothing.
    const std::string& get_ns_prefix() const { return prefix_; }
    /// The number for an element: an unprefixed name without default namespace has 1.
    int get_element_ns_id() const { return ns_id_ == 0 && !has_prefix_ ? 1 : ns_id_; }

private:
    friend struct hqf::reader_access;

    std::string full_name_;
    bool has_prefix_ = false;
    int ns_id_ = 0;
    std::string local_name_;
    std::string prefix_;
};

} // namespace lmx
