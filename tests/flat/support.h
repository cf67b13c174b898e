// What the callbacks of the flat layer were told, and the strings that it gives, taken over and freed.
#pragma once

#include <string>
#include <vector>

#include "hqf/flat/hqf_flat.h"

namespace flat_test {

/// A call of a callback: the table, the row in it and the message.
struct told {
    std::string table;
    int row;
    std::string message;
    bool has_parameter_name = false;
    friend bool operator==(const told&, const told&) = default;
};
void PrintTo(const told& call, std::ostream* out);

/// Registers a callback for every row, for as long as it lives, and collects what they are told.
class listener {
public:
    listener();
    ~listener();
    listener(const listener&) = delete;
    listener& operator=(const listener&) = delete;
    /// What came since the last call of this.
    std::vector<told> heard();
};

using calls = std::vector<told>;
inline calls nothing() {
    return {};
}
inline calls null_of(const std::string& message) {
    return {{"argument", 1, message}};
}
inline calls raised(const std::string& message) {
    return {{"exception", 0, message}};
}

/// Makes the next allocation fail. Under Valgrind none does, as it has operators of its own.
extern bool memory_is_out;
bool can_run_out_of_memory();

/// The text of a platform string, which is freed. A null one and one without its NUL say so.
std::wstring taken(wchar_t* text);
std::string taken(char* text);

} // namespace flat_test
