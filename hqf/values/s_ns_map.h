#pragma once

namespace lmx {

/// One row of a constant namespace table. A table is an array of rows that ends with an all-zero one; whoever is given
/// a table keeps the pointer, so it must outlive them.
struct s_ns_map {
    /// Number by which a reader knows the namespace; 1000 and up for those of documents.
    int id;
    /// Prefix of qualified names. The empty text stands for the default namespace.
    const char* prefix;
    /// Namespace URI. Null in the row that ends a table.
    const char* uri;
};

} // namespace lmx
