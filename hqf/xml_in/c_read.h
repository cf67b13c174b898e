#pragma once

#include "hqf/platform/api.h"

/// The bottom of the input stack: where the bytes of a document come from.

namespace lmx {

/// A source of bytes. Derive from it to read a document from anywhere: a socket, an archive, a resource.
///
/// A derived source is asked for one byte at a time and never for more than the reader needs. One thread at a time.
class HQF_API c_read {
public:
    c_read() = default;
    c_read(const c_read&) = default;
    c_read& operator=(const c_read&) = default;

    /// Whether there is something to read from; true unless a derived class says otherwise.
    virtual bool is_open() const;
    /// The next byte as 0 to 255, or -1 at the end.
    virtual int read() = 0;
    /// A name for messages, such as a file name; null when there is none. Stays valid as long as the source.
    virtual const char* get_source_id();
    /// Back to the start: the next `read` gives the first byte again.
    virtual void rewind() = 0;
    virtual ~c_read();
};

} // namespace lmx
