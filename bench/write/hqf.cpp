/// Writing with this library: a loaded document to a new string, to wide text and to a file.

#include "bench/subject.h"

namespace hqf_bench {

namespace {

/// `write` gives the code of one write of the document that it is given.
template<class write_operation>
void measure(benchmark::State& state, const subject& document, write_operation write) {
    const std::string& text = document.text();
    hqf_v2::Hqf loaded;
    if (!load(state, loaded, text)) return;
    for (int round = 0; round < warm_up_rounds; ++round)
        static_cast<void>(write(loaded));
    for (auto _ : state) {
        const lmx::elmx_error error = write(loaded);
        if (error != lmx::err_no_error) {
            state.SkipWithError(("write: code " + std::to_string(error)).c_str());
            break;
        }
    }
    report(state, text.size(), checks::hqf_write);
}

void to_string(benchmark::State& state, subject document) {
    measure(state, document, [](hqf_v2::Hqf& loaded) {
        std::string out;
        const lmx::elmx_error error = loaded.marshal(&out);
        benchmark::DoNotOptimize(out.data());
        return error;
    });
}

void to_wide_string(benchmark::State& state, subject document) {
    measure(state, document, [](hqf_v2::Hqf& loaded) {
        const hqf_v2::XMLDocumentResult result = loaded.writeString();
        return result.getElmxError();
    });
}

void to_file(benchmark::State& state, subject document) {
    const scratch_file file("hqf-bench-write");
    const std::wstring path = file.path().wstring();
    measure(state, document, [&](hqf_v2::Hqf& loaded) { return loaded.writeFile(path); });
}

} // namespace

void add_hqf_write(const subject& document) {
    const auto add = [&](const char* peer, void (*run)(benchmark::State&, subject)) {
        benchmark::RegisterBenchmark(document.benchmark_name("write", peer).c_str(), run, document)
            ->Unit(benchmark::kMillisecond);
    };
    add("hqf", to_string);
    add("hqf_string", to_wide_string);
    add("hqf_file", to_file);
}

} // namespace hqf_bench
