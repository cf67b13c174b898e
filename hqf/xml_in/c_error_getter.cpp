#include "hqf/errors/c_error.h"
#include "hqf/xml_in/c_get_as_utf8.h"

// The one operation of the error object that must know what a getter is.

namespace lmx {

void c_error::error(elmx_error_type type, elmx_error code, const char* text) {
    if (getter_ == nullptr)
        error(type, code, nullptr, -1, text);
    else
        error(type, code, getter_->get_source_id(), getter_->get_line_num(), text);
}

} // namespace lmx
