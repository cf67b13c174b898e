/// pugixml's tree from a memory buffer, which it copies and leaves alone; destroyed within the time measured.

#include <pugixml.hpp>

#include "bench/subject.h"

namespace hqf_bench {

namespace {

void from_buffer(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    for (auto _ : state) {
        pugi::xml_document tree;
        const pugi::xml_parse_result result =
            tree.load_buffer(text.data(), text.size(), pugi::parse_default, pugi::encoding_utf8);
        if (!result) {
            state.SkipWithError("pugixml refuses the document");
            break;
        }
        benchmark::DoNotOptimize(tree.first_child());
    }
    report(state, text.size(), checks::pugixml_load);
}

} // namespace

void add_pugixml_load(const subject& document) {
    benchmark::RegisterBenchmark(document.benchmark_name("load", "pugixml").c_str(), from_buffer, document)
        ->Unit(benchmark::kMillisecond);
}

} // namespace hqf_bench
