#pragma once

namespace lmx {

/// One row of a table of elements that an application wants to see. A row with a null name ends the table.
struct s_known_elements {
    /// Namespace number.
    int ns_id;
    /// Local name.
    const char* name;
    /// Length of the name in bytes.
    int name_length;
};

} // namespace lmx
