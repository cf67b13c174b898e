/// All rows in one process: loading, writing and handling of the same documents by this library and its peers.
///
/// usage: hqf_bench [--sizes=1,50] [--dump=FOLDER] [flags of Google Benchmark]
///
/// `--sizes` are in million bytes. `--dump` writes the documents to a folder and measures nothing.

#include <unistd.h>

#include <cstring>
#include <exception>
#include <fstream>
#include <iostream>

#include "bench/sizes.h"
#include "bench/subject.h"

namespace hqf_bench {

scratch_file::scratch_file(const std::string& stem)
    : path_(std::filesystem::temp_directory_path() / (stem + '-' + std::to_string(getpid()) + ".hqf")) {}

scratch_file::~scratch_file() {
    std::error_code ignored;
    std::filesystem::remove(path_, ignored);
}

namespace {

void add_rows(const subject& document) {
    add_hqf_load(document);
#ifdef HQF_BENCH_EXPAT
    add_expat_load(document);
#endif
#ifdef HQF_BENCH_PUGIXML
    add_pugixml_load(document);
#endif
    add_hqf_write(document);
#ifdef HQF_BENCH_PUGIXML
    add_pugixml_write(document);
#endif
    add_hqf_objects(document);
    if (document.which == kind::palettes || document.which == kind::spectra) {
        add_hqf_archive(document);
        add_zlib_archive(document);
    }
}

void dump(const subject& document, const std::filesystem::path& folder) {
    std::filesystem::create_directories(folder);
    const std::string name = std::string(name_of(document.which)) + '-' + std::to_string(document.megabytes) + ".hqf";
    std::ofstream(folder / name, std::ios::binary) << document.text();
}

int run(int argc, char** argv) {
    const std::vector<unsigned int> sizes = take_sizes(argc, argv, {1, 50});
    const std::string folder = take_value(argc, argv, "--dump=");
    for (const unsigned int megabytes : sizes) {
        for (const kind which : all_kinds) {
            if (folder.empty()) {
                add_rows({which, megabytes});
            } else {
                dump({which, megabytes}, folder);
            }
        }
    }
    if (!folder.empty()) return 0;
    add_flat_calls();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}

} // namespace

} // namespace hqf_bench

int main(int argc, char** argv) {
    try {
        return hqf_bench::run(argc, argv);
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
        return 1;
    }
}
