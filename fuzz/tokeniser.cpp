// Any bytes under the tokeniser, which a caller may drive as he likes: the last bytes of the input choose what happens
// to each element. Both kinds of source give the same, and what was captured of foreign XML captures as itself.

#include <cstdint>
#include <string>
#include <string_view>

#include "fuzz/require.h"
#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml.h"
#include "tests/support/callers_source.h"
#include "tests/support/two_roads.h"

namespace {

constexpr std::size_t choices_size = 8;

struct recorder : lmx::c_error {
    void report_error(lmx::elmx_error_type, lmx::elmx_error code, const char*, int line, const char* text) override {
        log += '{' + std::to_string(code) + ' ' + std::to_string(line) + ' ' + text + '}';
    }
    std::string log;
};

class walk {
public:
    walk(lmx::c_read& source, std::string_view choices, bool has_nul)
        : xml_(source, errors_, true)
        , choices_(choices)
        , has_nul_(has_nul) {}

    /// Everything that the tokeniser told.
    std::string run() {
        for (std::size_t step = 0;; ++step) {
            scope_.clear();
            const lmx::elxp_xml_event event = xml_.get_element_name(&scope_, &name_);
            note("event", event);
            errors_.log += name_;
            if (event == lmx::EXE_EOF || lmx::c_xml::is_error_event(event) || errors_.is_fatal_errored())
                return errors_.log;
            if (event == lmx::EXE_NAME)
                element(static_cast<unsigned char>(choices_.empty() ? 0 : choices_[step % choices_.size()]));
        }
    }

private:
    void element(unsigned int choice) {
        const auto mode = static_cast<lmx::elmx_whitespace>(choice / 8 % 3);
        bool empty = false;
        value_.clear();
        switch (choice % 8) {
        case 0: attributes(mode); break;
        case 1: note("skipped", xml_.skip_rest_of_element(name_)); break;
        case 2: note("skipped empty", xml_.skip_rest_of_empty_element(name_)); break;
        case 3: capture(mode); break;
        case 4:
            if (xml_.skip_start_tag(&empty) && !empty)
                note("nested", xml_.get_nested_element_value(&value_, &name_, mode, false));
            break;
        case 5:
            if (xml_.skip_start_tag(&empty) && !empty) {
                note("value", xml_.get_element_value(&value_, mode, choice >= 128));
                note("end", xml_.is_element_end_tag(name_));
            }
            break;
        case 6:
            note("named", xml_.get_named_attribute(&scope_, 1, "a", &value_));
            note("type", xml_.get_xsi_type(&scope_, &namespace_, &value_));
            attributes(mode);
            break;
        default: note("start tag", xml_.move_to_start_tag_end(&empty)); break;
        }
        errors_.log += value_;
    }

    void attributes(lmx::elmx_whitespace mode) {
        while (xml_.get_attribute_name(&name_, false) == lmx::EXE_NAME) {
            note("attribute", xml_.get_attribute_value(&value_, mode));
            errors_.log += name_ + '=' + value_;
        }
    }

    void capture(lmx::elmx_whitespace mode) {
        const bool captured = xml_.get_any_element(name_, &value_, mode, false);
        note("captured", captured);
        // A NUL, which XML doesn't know, splits an attribute's value; what follows is taken for another attribute.
        if (!captured || has_nul_) return;
        lmx::c_read_string source(value_);
        recorder errors;
        lmx::c_xml xml(source, errors, true);
        std::string name, again;
        (void)xml.get_element_name(nullptr, &name);
        fuzz::require(xml.get_any_element(name, &again, mode, false) && again == value_,
                      "captured XML captures as itself\n" + value_ + "\n--\n" + again);
    }

    void note(const char* what, int result) {
        errors_.log += std::string("\n") + what + ' ' + std::to_string(result) + " line " +
                       std::to_string(xml_.get_line_num()) + ' ';
    }

    recorder errors_;
    lmx::c_xml xml_;
    lmx::c_xml_local scope_;
    std::string_view choices_;
    bool has_nul_;
    std::string name_;
    std::string value_;
    int namespace_ = 0;
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::string text(reinterpret_cast<const char*>(data), size);
    const std::size_t split = size < choices_size ? 0 : size - choices_size;
    const std::string choices = text.substr(split);
    text.resize(split);
    lmx::c_read_string memory(text);
    support::callers_source bytes(text);
    const bool has_nul = text.find('\0') != std::string::npos;
    const std::string fast = walk(memory, choices, has_nul).run();
    const std::string general = walk(bytes, choices, has_nul).run();
    fuzz::require(fast == general, "both sources give the same\n" + fast + "\n--\n" + general);
    return 0;
}
