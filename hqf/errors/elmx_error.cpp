#include "hqf/errors/elmx_error.h"

namespace lmx {

namespace {

struct error_row {
    elmx_error code;
    const char* sentence;
};

constexpr error_row error_rows[] = {
#define HQF_ROW(code, name, sentence) {name, sentence},
    HQF_ELMX_ERRORS(HQF_ROW)
#undef HQF_ROW
};

} // namespace

const char* get_error_description(int code) {
    for (const error_row& row : error_rows)
        if (row.code == code) return row.sentence;
    return "";
}

} // namespace lmx
