/// Lists what is wrong in documents, a line a fault: file, line, element or attribute, and the rule that it breaks.
///
/// usage: list_faults DOCUMENT.hqf...

#include <algorithm>
#include <iostream>

#include "hqf/hqf.h"
#include "hqf/xml_in/c_xml_reader_file.h"

namespace {

/// What concerns one value alone. The load may pass over it; broken structure would only bring faults that aren't.
constexpr lmx::elmx_error value_faults[] = {
    lmx::err_length_too_long,
    lmx::err_length_too_short,
    lmx::err_no_pattern_matched,
    lmx::err_invalid_value_format_for_this_type,
    lmx::err_value_greater_than_specified_maximum,
    lmx::err_value_less_than_specified_minimum,
    lmx::err_value_does_not_match_enumerations,
};

class fault_lister : public lmx::c_xml_reader_file {
public:
    explicit fault_lister(const char* path)
        : c_xml_reader_file(path)
        , path_(path) {}

    bool has_faults = false;

private:
    using lmx::c_xml_reader_file::user_handle_error;

    /// Called for each fault. The code that it gives ends the load, 0 lets it go on.
    lmx::elmx_error user_handle_error(lmx::elmx_error code, const std::string& item, const char*, int) override {
        has_faults = true;
        std::cout << path_ << ':' << get_line_no() << ": " << item << ": " << lmx::get_error_description(code) << " ["
                  << code << "]\n";
        const bool is_value_fault = std::ranges::find(value_faults, code) != std::end(value_faults);
        return is_value_fault ? lmx::err_no_error : code;
    }

    const char* path_;
};

bool is_sound(const char* path) {
    fault_lister reader(path);
    if (!reader.is_open()) {
        std::cout << path << ": can't be opened\n";
        return false;
    }
    hqf_v2::Hqf document;
    const lmx::elmx_error code = document.unmarshal(reader);
    return code == lmx::err_no_error && !reader.has_faults;
}

} // namespace

int main(int argc, char** argv) {
    int unsound = 0;
    for (int i = 1; i < argc; ++i)
        unsound += is_sound(argv[i]) ? 0 : 1;
    std::cout << "Faults in " << unsound << " of " << argc - 1 << " documents\n";
    return unsound == 0 ? 0 : 1;
}
