/// Writing with this library: a loaded document to a new string, to wide text, to a new file and over an old one.

#include "bench/subject.h"

#include <filesystem>
#include <functional>

namespace hqf_bench {

namespace {

/// `write` gives the code of one write of the document that it is given; `prepare` goes before each, untimed.
template<class write_operation>
void measure(benchmark::State& state, const subject& document, write_operation write,
             const std::function<void()>& prepare = {}) {
    const std::string& text = document.text();
    hqf_v2::Hqf loaded;
    if (!load(state, loaded, text)) return;
    for (int round = 0; round < warm_up_rounds; ++round)
        static_cast<void>(write(loaded));
    for (auto _ : state) {
        if (prepare) {
            state.PauseTiming();
            prepare();
            state.ResumeTiming();
        }
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

void to_new_file(benchmark::State& state, subject document) {
    const scratch_file file("hqf-bench-write");
    const std::wstring path = file.path().wstring();
    measure(
        state, document, [&](hqf_v2::Hqf& loaded) { return loaded.writeFile(path); },
        [&] { std::filesystem::remove(file.path()); });
}

/// What the file held is thrown away first, and many file systems hurry to save a file that replaces another.
void over_old_file(benchmark::State& state, subject document) {
    const scratch_file file("hqf-bench-write");
    const std::wstring path = file.path().wstring();
    measure(state, document, [&](hqf_v2::Hqf& loaded) { return loaded.writeFile(path); });
}

/// What a new wide string of the document's length costs by itself: the system clears its memory, then it is filled.
void wide_memory(benchmark::State& state, subject document) {
    const std::size_t size = document.text().size();
    for (int round = 0; round < warm_up_rounds; ++round)
        benchmark::DoNotOptimize(std::wstring(size, L' ').data());
    for (auto _ : state)
        benchmark::DoNotOptimize(std::wstring(size, L' ').data());
    report(state, size, checks::nothing);
}

} // namespace

void add_hqf_write(const subject& document) {
    const auto add = [&](const char* peer, void (*run)(benchmark::State&, subject)) {
        benchmark::RegisterBenchmark(document.benchmark_name("write", peer).c_str(), run, document)
            ->Unit(benchmark::kMillisecond);
    };
    add("hqf", to_string);
    add("hqf_string", to_wide_string);
    add("hqf_file", to_new_file);
    add("hqf_old_file", over_old_file);
    add("wide_memory", wide_memory);
}

} // namespace hqf_bench
