#pragma once

#include "hqf/xml_in/c_read_memory.h"
#include "hqf/xml_in/c_xml_reader.h"

namespace hqf {

// The source must exist before the reader that is built on it, so it is a base in front of that one.
struct owned_memory {
    owned_memory(const char* data, unsigned int size)
        : memory(data, size) {}
    lmx::c_read_memory memory;
};

} // namespace hqf

namespace lmx {

/// A reader over bytes in memory, which are not copied and must outlive it. For 4 GiB and more, build a `c_xml_reader`
/// on a `c_read_string`.
class HQF_API c_xml_reader_memory : private hqf::owned_memory, public c_xml_reader {
public:
    c_xml_reader_memory(const char* data, unsigned int size)
        : owned_memory(data, size)
        , c_xml_reader(memory) {}
    ~c_xml_reader_memory() override;

    bool is_open() const { return memory.is_open(); }
};

} // namespace lmx
