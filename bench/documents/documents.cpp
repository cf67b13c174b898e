#include "bench/documents/documents.h"

#include <algorithm>
#include <map>
#include <stdexcept>
#include <utility>

#include "bench/documents/parts.h"

namespace hqf_bench {

namespace {

const struct {
    const char* name;
    const char* purpose;
    std::unique_ptr<author> (*make_author)();
} kinds[] = {
    {"palettes", "Colour palettes", palette_author},
    {"spectra", "Spectral reflectance", spectrum_author},
    {"quality_control", "Quality control", quality_control_author},
    {"mix", "Everything", mix_author},
};

const auto& entry_of(kind which) {
    return kinds[static_cast<unsigned int>(which)];
}

std::string written(hqf_v2::Hqf& document) {
    std::string text;
    ok(document.marshal(&text));
    return text;
}

std::string make_document(kind which, std::size_t wanted_bytes) {
    hqf_v2::Hqf document;
    add_preamble(document, entry_of(which).purpose);
    const std::unique_ptr<author> writer = entry_of(which).make_author();
    const std::size_t empty_bytes = written(document).size();

    // Each round adds half of what seems to be missing: colours differ in size, and a document that became too long
    // can't be shortened without making it anew.
    std::string text;
    std::size_t colours = 0;
    for (std::size_t more = 16; text.size() < wanted_bytes;) {
        for (std::size_t i = 0; i < more; ++i)
            writer->add_to(document);
        colours += more;
        text = written(document);
        const std::size_t bytes_per_colour = (text.size() - empty_bytes) / colours + 1;
        const std::size_t missing = wanted_bytes > text.size() ? wanted_bytes - text.size() : 0;
        more = std::max<std::size_t>(1, missing / bytes_per_colour / 2);
    }

    hqf_v2::Hqf loaded;
    ok(loaded.unmarshal(text));
    if (written(loaded) != text) throw std::runtime_error("a generated document changes when it is loaded and written");
    return text;
}

} // namespace

const char* name_of(kind which) {
    return entry_of(which).name;
}

const std::string& document_text(kind which, unsigned int megabytes) {
    static std::map<std::pair<kind, unsigned int>, std::string> made;
    std::string& text = made[{which, megabytes}];
    if (text.empty()) text = make_document(which, std::size_t{1'000'000} * megabytes);
    return text;
}

} // namespace hqf_bench
