#include "hqf/xml_in/c_cracked_name.h"

#include "hqf/xml_in/c_xml_local.h"

namespace lmx {

void c_cracked_name::set(const c_xml_local* scope, const std::string& name) {
    full_name_ = name;
    const std::size_t colon = name.find(':');
    has_prefix_ = colon != std::string::npos;
    prefix_.assign(name, 0, has_prefix_ ? colon : 0);
    local_name_.assign(name, has_prefix_ ? colon + 1 : 0);
    ns_id_ = scope->find_namespace_id(prefix_);
}

} // namespace lmx
