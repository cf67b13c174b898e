#include "hqf/xml_in/c_read.h"
#include "hqf/xml_in/c_read_memory.h"

namespace lmx {

bool c_read::is_open() const {
    return true;
}

const char* c_read::get_source_id() {
    return nullptr;
}

c_read::~c_read() = default;

void c_read_memory::rewind() {
    run_.cursor = start_;
}

} // namespace lmx
