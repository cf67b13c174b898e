// A source as an application would write one: one byte a call, and the library reads nothing of it ahead.
#pragma once

#include <string>
#include <utility>

#include "hqf/xml_in/c_read.h"

namespace support {

class callers_source : public lmx::c_read {
public:
    explicit callers_source(std::string bytes = {})
        : bytes_(std::move(bytes)) {}
    int read() override { return next_ < bytes_.size() ? static_cast<unsigned char>(bytes_[next_++]) : -1; }
    void rewind() override { next_ = 0; }

private:
    std::string bytes_;
    std::size_t next_ = 0;
};

} // namespace support
