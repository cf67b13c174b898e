/// What else costs time with a loaded document: destroying it, copying it, comparing two loads of it.

#include <chrono>
#include <memory>

#include "bench/subject.h"

namespace hqf_bench {

namespace {

constexpr char nothing_checked[] = "-";

using steady = std::chrono::steady_clock;

double seconds_since(steady::time_point start) {
    return std::chrono::duration<double>(steady::now() - start).count();
}

// Only destruction is timed, yet each object to destroy must be loaded: hence a fixed number of rounds.
void destroy(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    for (auto _ : state) {
        auto loaded = std::make_unique<hqf_v2::Hqf>();
        if (!load(state, *loaded, text)) break;
        const steady::time_point start = steady::now();
        loaded.reset();
        state.SetIterationTime(seconds_since(start));
    }
    report(state, text.size(), nothing_checked);
}

void copy(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    hqf_v2::Hqf loaded;
    if (!load(state, loaded, text)) return;
    for (auto _ : state) {
        const steady::time_point start = steady::now();
        const hqf_v2::Hqf copied(loaded);
        state.SetIterationTime(seconds_since(start));
        benchmark::DoNotOptimize(copied.size_Palette());
    }
    report(state, text.size(), nothing_checked);
}

void equal(benchmark::State& state, subject document) {
    const std::string& text = document.text();
    hqf_v2::Hqf loaded;
    if (!load(state, loaded, text)) return;
    hqf_v2::Hqf again;
    if (!load(state, again, text)) return;
    for (auto _ : state) {
        if (!hqf::equal(loaded, again)) {
            state.SkipWithError("two loads of a document differ");
            break;
        }
    }
    report(state, text.size(), nothing_checked);
}

} // namespace

void add_hqf_objects(const subject& document) {
    const auto add = [&](const char* peer, void (*run)(benchmark::State&, subject)) {
        return benchmark::RegisterBenchmark(document.benchmark_name("objects", peer).c_str(), run, document)
            ->Unit(benchmark::kMillisecond);
    };
    add("destroy", destroy)->UseManualTime()->Iterations(document.megabytes < 10 ? 20 : 3);
    add("copy", copy)->UseManualTime();
    add("equal", equal);
}

} // namespace hqf_bench
