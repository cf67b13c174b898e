#pragma once

/// A reading position in bytes that lie in memory.

namespace hqf {

/// The unread part of a block of bytes. The built-in sources keep their position in one, so that whoever knows their
/// exact type can read on without a virtual call a byte, and both see the same position.
struct byte_run {
    const char* cursor = nullptr;
    const char* end = nullptr;

    bool empty() const { return cursor == end; }
    /// Precondition: not empty.
    int take() { return static_cast<unsigned char>(*cursor++); }
};

} // namespace hqf
