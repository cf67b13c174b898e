#include "hqf/xml_in/c_enumerated_namespaces.h"

#include <limits>

namespace lmx {
namespace {

constexpr int first_id = 1000;

} // namespace

void c_enumerated_namespaces::clear() {
    uris_.clear();
    uri_of_id_.clear();
    next_id_ = first_id;
    // XML Schema Part 1, 2.6, and Namespaces in XML 1.0, 3.
    add_namespace("http://www.w3.org/2001/XMLSchema-instance", 5);
    add_namespace("http://www.w3.org/XML/1998/namespace", 2);
}

int c_enumerated_namespaces::add_namespace(const char* uri) {
    int id = 0;
    if (uris_.find(uri, &id)) return id;
    id = next_id_;
    add_namespace(uri, id);
    return id;
}

void c_enumerated_namespaces::add_namespace(const char* uri, int id) {
    if (!uris_.has_key(uri)) {
        uris_.add(uri, id);
        uri_of_id_.emplace(id, uri);
    }
    if (id >= next_id_ && id != std::numeric_limits<int>::max()) next_id_ = id + 1;
}

int c_enumerated_namespaces::find_namespace(const std::string& uri) const {
    int id = 0;
    return uris_.find(uri.c_str(), &id) ? id : 0;
}

const char* c_enumerated_namespaces::find_namespace_from_id(int id) const {
    const auto found = uri_of_id_.find(id);
    return found == uri_of_id_.end() ? nullptr : found->second.c_str();
}

} // namespace lmx
