#pragma once

#include "hqf/xml_in/byte_run.h"
#include "hqf/xml_in/c_read.h"

namespace hqf {
class window;
}

namespace lmx {

/// Reads bytes that lie in memory and belong to somebody else, who must keep them unchanged as long as they are read.
///
/// A copy shares the bytes and starts at the same position. `c_read_string` takes blocks of 4 GiB and more.
class HQF_API c_read_memory : public c_read {
public:
    c_read_memory(const char* data, unsigned int size)
        : c_read_memory(hqf::byte_run{data, data + size}) {}

    int read() override { return run_.empty() ? -1 : run_.take(); }
    void rewind() override;

protected:
    explicit c_read_memory(hqf::byte_run bytes)
        : start_(bytes.cursor)
        , run_(bytes) {}

private:
    friend class c_get_as_utf8;
    friend class hqf::window;

    const char* start_;
    hqf::byte_run run_;
};

} // namespace lmx
