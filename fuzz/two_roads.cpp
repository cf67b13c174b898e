// Any bytes over the road through the window and over the general road: the same codes, items, lines and objects.

#include <cstdint>

#include "fuzz/require.h"
#include "hqf/xml_in/c_read_string.h"
#include "tests/support/callers_source.h"
#include "tests/support/two_roads.h"

namespace {

using fuzz::require;

struct pair_of_documents {
    support::outcome fast, general;

    void load(const std::string& text, bool goes_on) {
        lmx::c_read_string memory(text);
        support::callers_source bytes(text);
        support::load(memory, goes_on, fast);
        support::load(bytes, goes_on, general);
        require(fast.log == general.log, "both roads report alike\n" + fast.log + "\n--\n" + general.log);
        require(hqf::equal(fast.document, general.document), "both roads make the same document");
    }
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    pair_of_documents strict, lenient;
    strict.load(text, false);
    lenient.load(text, true);
    // Once more on top of what is there: what is set already brings errors of its own.
    strict.load(text, true);
    return 0;
}
