/// What a process pays that loads one document and ends: nothing is warm, neither the heap nor the code.
///
/// usage: hqf_bench_first hqf|expat FILE
///
/// One line: seconds of CPU time for the process's first load of the file's text, from memory. expat finds events and
/// keeps nothing; this library makes and destroys the objects.

#include <ctime>
#include <exception>
#include <fstream>
#include <iostream>
#include <iterator>
#include <stdexcept>
#include <string>

#ifdef HQF_BENCH_EXPAT
#include <expat.h>
#endif

#include "hqf/hqf.h"

namespace {

void load_hqf(const std::string& text) {
    hqf_v2::Hqf document;
    if (document.unmarshal(text) != lmx::err_no_error) throw std::runtime_error("hqf refuses the document");
}

void load_expat(const std::string& text) {
#ifdef HQF_BENCH_EXPAT
    std::size_t seen = 0;
    XML_Parser parser = XML_ParserCreateNS(nullptr, '|');
    XML_SetUserData(parser, &seen);
    XML_SetElementHandler(
        parser, [](void* data, const XML_Char*, const XML_Char**) { ++*static_cast<std::size_t*>(data); },
        [](void* data, const XML_Char*) { ++*static_cast<std::size_t*>(data); });
    XML_SetCharacterDataHandler(parser, [](void* data, const XML_Char*, int length) {
        *static_cast<std::size_t*>(data) += static_cast<std::size_t>(length);
    });
    const XML_Status status = XML_Parse(parser, text.data(), static_cast<int>(text.size()), XML_TRUE);
    XML_ParserFree(parser);
    if (status != XML_STATUS_OK || seen == 0) throw std::runtime_error("expat refuses the document");
#else
    static_cast<void>(text);
    throw std::runtime_error("expat is not built");
#endif
}

} // namespace

int main(int argc, char** argv) {
    try {
        if (argc != 3) throw std::runtime_error("usage: hqf_bench_first hqf|expat FILE");
        std::ifstream file(argv[2], std::ios::binary);
        const std::string text{std::istreambuf_iterator<char>(file), {}};
        const std::clock_t start = std::clock();
        std::string(argv[1]) == "hqf" ? load_hqf(text) : load_expat(text);
        std::cout << static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC << '\n';
        return 0;
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
        return 1;
    }
}
