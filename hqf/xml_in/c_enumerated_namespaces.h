#pragma once

#include "hqf/xml_in/c_repository.h"

#include <string>
#include <unordered_map>

#include "hqf/platform/api.h"

namespace lmx {

/// The numbers that stand for namespace URIs while a document is read, so that names are compared without looking at a
/// URI. 0 is no mapping, 1 no namespace, 2 the namespace of the prefix `xml`, 5 that of XML Schema's instance
/// attributes; others get 1000 and up in the order in which they are met.
class HQF_API c_enumerated_namespaces {
public:
    c_enumerated_namespaces() { clear(); }

    /// The number of a URI, newly given if it is new.
    int add_namespace(const char* uri);
    /// Gives a new URI this number; one that is known keeps its own. New numbers begin above `id` in either case.
    void add_namespace(const char* uri, int id);
    /// The number of a URI, or 0.
    int find_namespace(const std::string& uri) const;
    /// The first URI that got this number, or null. Valid until `clear`.
    const char* find_namespace_from_id(int id) const;
    /// Back to the two fixed URIs, with 1000 as the next number.
    void clear();

private:
    int next_id_ = 0;
    c_repository<int> uris_;
    std::unordered_map<int, std::string> uri_of_id_;
};

} // namespace lmx
