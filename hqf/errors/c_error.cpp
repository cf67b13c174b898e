#include "hqf/errors/c_error.h"

namespace lmx {

void c_error::report_error(elmx_error_type, elmx_error, const char*, int, const char*) {}

c_error::~c_error() = default;

void c_error::error(elmx_error_type type, elmx_error code, const char* source, int line, const char* text) {
    if (is_fatal_errored()) return;
    last_type_ = type;
    last_error_ = code;
    last_line_ = line;
    switch (type) {
    case error_fatal:
        ++fatal_count_;
        ++error_count_;
        break;
    case error_error: ++error_count_; break;
    case error_notice: ++notice_count_; [[fallthrough]];
    case error_warning: ++lesser_count_; break;
    case error_none: break;
    }
    report_error(type, code, source, line, text);
}

bool c_error::get_error_info(elmx_error_type* type, elmx_error* code, int* line) const {
    if (last_error_ == err_no_error) return false;
    *type = last_type_;
    *code = last_error_;
    *line = last_line_;
    return true;
}

c_get_as_utf8* c_error::register_getter(const c_getter_error_binder& binder) {
    c_get_as_utf8* const before = getter_;
    getter_ = binder.get_new_getter();
    return before;
}

void c_error::unregister_getter(const c_getter_error_binder& binder) {
    getter_ = binder.get_old_getter();
}

c_getter_error_binder::~c_getter_error_binder() {
    if (is_bound_) errors_.unregister_getter(*this);
}

void c_getter_error_binder::bind(c_get_as_utf8* getter) {
    if (is_bound_) return;
    is_bound_ = true;
    new_getter_ = getter;
    old_getter_ = errors_.register_getter(*this);
}

} // namespace lmx
