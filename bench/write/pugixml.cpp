/// pugixml's save of the same document's tree to a new string: indented with tabs, as this library writes it, and raw.

#include <pugixml.hpp>

#include "bench/subject.h"

namespace hqf_bench {

namespace {

struct string_writer final : pugi::xml_writer {
    void write(const void* data, std::size_t size) override { text.append(static_cast<const char*>(data), size); }
    std::string text;
};

void save(benchmark::State& state, const subject& document, unsigned int format) {
    const std::string& text = document.text();
    pugi::xml_document tree;
    if (!tree.load_buffer(text.data(), text.size(), pugi::parse_default, pugi::encoding_utf8)) {
        state.SkipWithError("pugixml refuses the document");
        return;
    }
    const auto write = [&] {
        string_writer writer;
        tree.save(writer, "\t", format, pugi::encoding_utf8);
        benchmark::DoNotOptimize(writer.text.data());
    };
    for (int round = 0; round < warm_up_rounds; ++round)
        write();
    for (auto _ : state)
        write();
    report(state, text.size(), checks::nothing);
}

void indented(benchmark::State& state, subject document) {
    save(state, document, pugi::format_default);
}
void raw(benchmark::State& state, subject document) {
    save(state, document, pugi::format_raw);
}

} // namespace

void add_pugixml_write(const subject& document) {
    const auto add = [&](const char* peer, void (*run)(benchmark::State&, subject)) {
        benchmark::RegisterBenchmark(document.benchmark_name("write", peer).c_str(), run, document)
            ->Unit(benchmark::kMillisecond);
    };
    add("pugixml", indented);
    add("pugixml_raw", raw);
}

} // namespace hqf_bench
