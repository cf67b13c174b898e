#pragma once

#include "hqf/platform/api.h"

#include <string>
#include <utility>

namespace lmx {

/// One element of any name, kept as raw XML text in UTF-8. Namespace and name are what the reader found; an
/// application may leave them empty.
class HQF_API c_any_info {
public:
    c_any_info() = default;
    c_any_info(const std::string& ns, const std::string& name, const std::string& value)
        : namespace_(ns)
        , name_(name)
        , value_(value) {}
    c_any_info(const std::string& name, const std::string& value)
        : name_(name)
        , value_(value) {}
    explicit c_any_info(const std::string& value)
        : value_(value) {}

    /// Namespace URI.
    const std::string& get_namespace() const { return namespace_; }
    const std::string& get_name() const { return name_; }
    /// The whole element, from `<` to `>`.
    const std::string& get_value() const { return value_; }
    void set_namespace(const std::string& ns) { namespace_ = ns; }
    void set_name(const std::string& name) { name_ = name; }
    void set_value(const std::string& value) { value_ = value; }

private:
    std::string namespace_;
    std::string name_;
    std::string value_;
};

} // namespace lmx
