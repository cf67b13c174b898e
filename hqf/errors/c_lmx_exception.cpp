#include "hqf/errors/c_lmx_exception.h"

namespace lmx {

c_lmx_exception::~c_lmx_exception() = default;

const char* c_lmx_exception::what() const {
    return get_error_description(error_);
}

c_lmx_reader_exception::~c_lmx_reader_exception() = default;

} // namespace lmx
