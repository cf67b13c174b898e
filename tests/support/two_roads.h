// One load over either of the two roads into a document, and what of it can be told from outside. The general road is
// taken by a source that the library knows nothing of, such as a callers_source.
#pragma once

#include <string>

#include "hqf/hqf.h"
#include "hqf/xml_in/c_read.h"
#include "hqf/xml_in/c_xml_reader.h"

namespace support {

/// Writes every report down, with what a handler can see of the reader, and goes on if asked to.
class recording_reader : public lmx::c_xml_reader {
public:
    recording_reader(lmx::c_read& source, bool goes_on)
        : c_xml_reader(source)
        , goes_on_(goes_on) {}
    lmx::elmx_error user_handle_error(lmx::elmx_error code, const std::string& item, const char*, int) override {
        log += std::to_string(code) + ' ' + item + " line " + std::to_string(get_line_no()) + " depth " +
               std::to_string(get_element_name_stack().get_stack_size()) + ' ' + item_name + '\n';
        return goes_on_ ? lmx::err_no_error : code;
    }
    std::string log;

private:
    bool goes_on_;
};

struct outcome {
    hqf_v2::Hqf document;
    std::string log;
};

inline void load(lmx::c_read& source, bool goes_on, outcome& out) {
    recording_reader reader(source, goes_on);
    const lmx::elmx_error code = out.document.unmarshal(reader);
    out.log = reader.log + "code " + std::to_string(code) + " line " + std::to_string(reader.get_line_no());
}

} // namespace support
