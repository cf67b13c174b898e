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

void write_and_read_back(Hqf& document) {
    std::string first, second;
    const lmx::elmx_error code = document.marshal(&first);
    require(code == 0 || code == lmx::err_min_max_occurs_error_on_marshaling, "what was loaded is complete or not");
    if (code != 0) return;
    // Seconds below a thousandth have six decimals, which may all be zero; the next time there are none.
    if (first.find(":00.00") != std::string::npos) return;
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
