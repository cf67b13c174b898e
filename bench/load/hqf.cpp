/// Loading with this library: every rule of the schema checked, objects built and, within the time measured, destroyed.

#include <fstream>

#include "bench/subject.h"
#include "hqf/values/text.h"

namespace hqf_bench {

namespace {

template<class load_operation>
void measure(benchmark::State& state, std::size_t document_bytes, load_operation load_into) {
    for (auto _ : state) {
        hqf_v2::Hqf document;
        const lmx::elmx_error error = load_into(document);
        if (error != lmx::err_no_error) {
            state.SkipWithError(("load: code " + std::to_string(error)).c_str());
            break;
        }
        benchmark::DoNotOptimize(document.size_Palette());
    }
    report(state, document_bytes, checks::hqf_load);
}

void from_buffer(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    measure(state, text.size(),
            [&](hqf_v2::Hqf& into) { return into.unmarshal(text.data(), static_cast<unsigned int>(text.size())); });
}

void from_file(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    const scratch_file file("hqf-bench-load");
    std::ofstream(file.path(), std::ios::binary) << text;
    const std::wstring path = file.path().wstring();
    measure(state, text.size(), [&](hqf_v2::Hqf& into) { return into.loadFile(path); });
}

void from_string(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    std::wstring wide_text;
    lmx::convert(&wide_text, text);
    measure(state, text.size(), [&](hqf_v2::Hqf& into) { return into.loadString(wide_text); });
}

} // namespace

void add_hqf_load(const subject& document) {
    const auto add = [&](const char* peer, void (*run)(benchmark::State&, subject)) {
        benchmark::RegisterBenchmark(document.benchmark_name("load", peer).c_str(), run, document)
            ->Unit(benchmark::kMillisecond);
    };
    add("hqf", from_buffer);
    add("hqf_file", from_file);
    add("hqf_string", from_string);
}

} // namespace hqf_bench
