#pragma once

namespace lmx {

/// One row of a table that turns a name into an event number. A row with a null name ends the table; its event is 1.
struct s_event_map {
    /// Namespace number: 1 for none, 5 for `xsi`, 1000 for the format's own.
    int ns_id;
    /// Local name.
    const char* name;
    /// Length of the name in bytes.
    int name_length;
    /// Event number, 12 or above.
    int event;
};

} // namespace lmx
