/// Expat's event parse with namespaces: handlers that count and keep nothing.

#include <expat.h>

#include "bench/subject.h"

namespace hqf_bench {

namespace {

struct counts {
    std::size_t started = 0;
    std::size_t ended = 0;
    std::size_t attributes = 0;
    std::size_t text_bytes = 0;
};

void XMLCALL count_start(void* data, const XML_Char*, const XML_Char** attributes) {
    auto& seen = *static_cast<counts*>(data);
    ++seen.started;
    for (; *attributes != nullptr; attributes += 2)
        ++seen.attributes;
}

void XMLCALL count_end(void* data, const XML_Char*) {
    ++static_cast<counts*>(data)->ended;
}

void XMLCALL count_text(void* data, const XML_Char*, int length) {
    static_cast<counts*>(data)->text_bytes += static_cast<std::size_t>(length);
}

void from_buffer(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    for (auto _ : state) {
        counts seen;
        XML_Parser parser = XML_ParserCreateNS(nullptr, '|');
        XML_SetUserData(parser, &seen);
        XML_SetElementHandler(parser, count_start, count_end);
        XML_SetCharacterDataHandler(parser, count_text);
        // Whole and final at once, which spares it a copy of the input.
        const XML_Status status = XML_Parse(parser, text.data(), static_cast<int>(text.size()), XML_TRUE);
        XML_ParserFree(parser);
        if (status != XML_STATUS_OK || seen.started != seen.ended) {
            state.SkipWithError("expat refuses the document");
            break;
        }
        benchmark::DoNotOptimize(seen);
    }
    report(state, text.size(), checks::expat_load);
}

} // namespace

void add_expat_load(const subject& document) {
    benchmark::RegisterBenchmark(document.benchmark_name("load", "expat").c_str(), from_buffer, document)
        ->Unit(benchmark::kMillisecond);
}

} // namespace hqf_bench
