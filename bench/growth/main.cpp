/// What a load costs in a document of one size: time and peak heap, for growth.py to divide by the colours.
///
/// usage: hqf_bench_growth MILLION_BYTES SECONDS
///
/// One line, tab-separated: bytes of input, colours, median seconds of CPU time for a load and the destruction (of at
/// least three, and as many as fit into SECONDS), peak heap in bytes without the input. One size a process, so that
/// nothing that an earlier size has left behind is measured.

#include <algorithm>
#include <ctime>
#include <exception>
#include <iostream>
#include <string>
#include <vector>

#include "bench/documents/documents.h"
#include "bench/memory/heap_count.h"
#include "bench/memory/peers.h"

namespace {

double cpu_seconds() {
    return static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

void load(const std::string& text) {
    if (!hqf_bench::load_hqf(text, [] {})) throw std::runtime_error("a document is refused");
}

std::size_t count_colours(const std::string& text) {
    std::size_t colours = 0;
    for (std::size_t at = text.find("<Hqf:Color "); at != std::string::npos; at = text.find("<Hqf:Color ", at + 1))
        ++colours;
    return colours;
}

} // namespace

int main(int argc, char** argv) {
    using namespace hqf_bench;
    try {
        if (argc != 3) throw std::runtime_error("usage: hqf_bench_growth MILLION_BYTES SECONDS");
        const std::string& text = document_text(kind::palettes, static_cast<unsigned int>(std::stoul(argv[1])));
        load(document_text(kind::palettes, 1)); // pays for what is made once in the life of a program
        const std::size_t before = heap_bytes();
        restart_heap_peak();
        load(text);
        const std::size_t peak = heap_peak_bytes() - before;
        std::vector<double> times;
        for (const double begin = cpu_seconds(); times.size() < 3 || cpu_seconds() - begin < std::stod(argv[2]);) {
            const double start = cpu_seconds();
            load(text);
            times.push_back(cpu_seconds() - start);
        }
        std::sort(times.begin(), times.end());
        std::cout << text.size() << '\t' << count_colours(text) << '\t' << times[times.size() / 2] << '\t' << peak
                  << '\n';
        return 0;
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
        return 1;
    }
}
