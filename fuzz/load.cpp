// Any bytes as a document. Whatever came of the load can be copied, written, reset and used again; what was written
// once loads, and comes out the same.

#include <cstdint>

#include "fuzz/require.h"
#include "hqf/hqf.h"

namespace {

using fuzz::require;
using hqf_v2::Hqf;

/// Lets every error pass, so that as much as possible gets into the document.
class lenient_reader : public lmx::c_xml_reader_memory {
public:
    using c_xml_reader_memory::c_xml_reader_memory;
    lmx::elmx_error user_handle_error(lmx::elmx_error) override { return lmx::err_no_error; }
};

/// Whether a written text holds all of its document. The writer makes no character references, so that a carriage
/// return becomes a line end, a NUL ends the text, and a lone low surrogate is no UTF-8; any of them needs a character
/// reference, or an application, to get into a document. Seconds below a thousandth have six decimals, which may all be
/// zero; the next time there are none.
bool is_faithful(const std::string& text) {
    using namespace std::string_literals;
    if (text.find_first_of("\r\0"s) != std::string::npos || text.find(":00.00") != std::string::npos) return false;
    for (std::size_t at = text.find('\xED'); at != std::string::npos; at = text.find('\xED', at + 1))
        if (static_cast<unsigned char>(text[at + 1]) >= 0xA0) return false;
    return true;
}

void write_and_read_back(Hqf& document) {
    std::string first, second;
    const lmx::elmx_error code = document.marshal(&first);
    require(code == 0 || code == lmx::err_min_max_occurs_error_on_marshaling, "what was loaded is complete or not");
    if (code != 0) return;
    if (!is_faithful(first)) return;
    require(hqf::equal(Hqf(document), document), "a copy is equal");
    Hqf again;
    require(again.unmarshal(first) == 0, "what was written loads\n" + first);
    require(again.marshal(&second) == 0, "what was loaded can be written");
    require(first == second, "it comes out the same\n" + first + "\n--\n" + second);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const char* const bytes = reinterpret_cast<const char*>(data);
    const auto count = static_cast<unsigned int>(size);
    Hqf document;
    if (document.unmarshal(bytes, count) == 0) write_and_read_back(document);

    Hqf lenient;
    lenient_reader reader(bytes, count);
    (void)lenient.unmarshal(reader);
    std::string text;
    (void)lenient.marshal(&text);
    lenient = document;
    lenient.reset();
    require(hqf::equal(lenient, Hqf()), "a reset document is a new one");
    return 0;
}
