// Any bytes over the road through the window and over the general road: the same codes, items, lines and objects, with
// a handler that ends the load and with one that goes on.

#include <cstdint>

#include "fuzz/require.h"
#include "hqf/xml_in/c_read_string.h"
#include "tests/support/two_roads.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    for (const bool goes_on : {false, true}) {
        support::outcome fast, general;
        lmx::c_read_string memory(text);
        support::one_byte_source bytes(text);
        support::load(memory, goes_on, fast);
        support::load(bytes, goes_on, general);
        fuzz::require(fast.log == general.log, "both roads report alike\n" + fast.log + "\n--\n" + general.log);
        fuzz::require(hqf::equal(fast.document, general.document), "both roads make the same document");
    }
    return 0;
}
