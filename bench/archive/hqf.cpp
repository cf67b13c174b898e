/// Loading and saving archives and, on the same file system, the plain files.

#include <malloc.h>

#include "bench/archive/archive.h"
#include "bench/subject.h"

namespace hqf_bench {

namespace {

bool failed(benchmark::State& state, lmx::elmx_error error) {
    if (error == lmx::err_no_error) return false;
    state.SkipWithError(("code " + std::to_string(error)).c_str());
    return true;
}

void load_file(benchmark::State& state, subject document, const char* name) {
    const memory_folder folder;
    write_document(document.text(), folder / name);
    const std::wstring path = (folder / name).wstring();
    malloc_trim(0); // what other rows have left in the heap, in pieces, costs some rows more than others
    for (auto _ : state) {
        hqf_v2::Hqf loaded;
        if (failed(state, loaded.loadFile(path))) break;
        benchmark::DoNotOptimize(loaded.size_Palette());
    }
    report(state, document.text().size(), checks::hqf_load);
}

void load_memory(benchmark::State& state, subject document, const char* /*name*/) {
    const std::string& text = document.text();
    malloc_trim(0); // what other rows have left in the heap, in pieces, costs some rows more than others
    for (auto _ : state) {
        hqf_v2::Hqf loaded;
        if (!load(state, loaded, text)) break;
        benchmark::DoNotOptimize(loaded.size_Palette());
    }
    report(state, text.size(), checks::hqf_load);
}

void save_file(benchmark::State& state, subject document, const char* name) {
    const memory_folder folder;
    hqf_v2::Hqf loaded;
    if (!load(state, loaded, document.text())) return;
    const std::wstring path = (folder / name).wstring();
    malloc_trim(0); // what other rows have left in the heap, in pieces, costs some rows more than others
    for (auto _ : state)
        if (failed(state, loaded.writeFile(path))) break;
    report(state, document.text().size(), checks::hqf_write);
}

} // namespace

void add_hqf_archive(const subject& document) {
    const struct {
        const char *task, *peer, *file;
        void (*run)(benchmark::State&, subject, const char*);
    } rows[] = {
        {"archive_load", "hqf", "a.hqfz", load_file},       {"archive_load", "plain_file", "a.hqf", load_file},
        {"archive_load", "memory", "", load_memory},        {"archive_save", "hqf", "a.hqfz", save_file},
        {"archive_save", "plain_file", "a.hqf", save_file},
    };
    for (const auto& row : rows)
        benchmark::RegisterBenchmark(document.benchmark_name(row.task, row.peer).c_str(), row.run, document, row.file)
            ->Unit(benchmark::kMillisecond);
}

} // namespace hqf_bench
