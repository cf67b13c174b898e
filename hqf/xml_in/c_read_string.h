#pragma once

#include "hqf/xml_in/c_read_memory.h"

#include <string>

namespace lmx {

/// Reads the bytes of a string. Nothing is copied: the string must stay alive and unchanged as long as it is read.
class HQF_API c_read_string : public c_read_memory {
public:
    explicit c_read_string(const std::string& text)
        : c_read_memory(hqf::byte_run{text.data(), text.data() + text.size()}) {}
};

} // namespace lmx
