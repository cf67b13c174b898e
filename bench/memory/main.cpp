/// Peak heap of a load, in bytes per byte of input. The input itself lies with the caller and isn't counted;
/// that of an archive is unpacked by the load, and is.
///
/// usage: hqf_bench_memory [--sizes=1,50]
///
/// Tab-separated lines: kind, million bytes, peer, bytes of input, peak, in use while loaded, the same as the
/// allocator's own statistics have it (a check of the counting), left behind after destruction.

#include <malloc.h>

#include <exception>
#include <iostream>

#include "bench/documents/documents.h"
#include "bench/memory/heap_count.h"
#include "bench/memory/peers.h"
#include "bench/sizes.h"

namespace hqf_bench {

namespace {

const struct {
    const char* name;
    memory_peer load;
    void (*prepare)(const std::string& text);
} peers[] = {
    {"hqf", load_hqf, nullptr},
    {"hqf_archive", load_hqf_archive, pack_for_load_archive},
#ifdef HQF_BENCH_PUGIXML
    {"pugixml", load_pugixml, nullptr},
#endif
};

std::size_t allocator_bytes() {
    const struct mallinfo2 statistics = mallinfo2();
    return statistics.uordblks + statistics.hblkhd;
}

void print_line(kind which, unsigned int megabytes, const char* name, memory_peer load,
                void (*prepare)(const std::string& text)) {
    const std::string& text = document_text(which, megabytes);
    if (prepare != nullptr) {
        prepare(document_text(which, 1));
        prepare(text);
    }
    // The first load pays for what a peer makes once in the life of a program.
    load(document_text(which, 1), [] {});
    malloc_trim(0);

    const std::size_t before = heap_bytes();
    const std::size_t allocator_before = allocator_bytes();
    std::size_t loaded = 0;
    std::size_t allocator_loaded = 0;
    restart_heap_peak();
    const bool taken = load(text, [&] {
        loaded = heap_bytes() - before;
        allocator_loaded = allocator_bytes() - allocator_before;
    });
    if (!taken) throw std::runtime_error(std::string(name) + " refuses a document");
    // Read before anything is printed: the stream has a buffer on the heap.
    const std::size_t peak = heap_peak_bytes() - before;
    const std::size_t left = heap_bytes() - before;
    std::cout << name_of(which) << '\t' << megabytes << '\t' << name << '\t' << text.size() << '\t' << peak << '\t'
              << loaded << '\t' << allocator_loaded << '\t' << left << '\n';
}

} // namespace

} // namespace hqf_bench

int main(int argc, char** argv) {
    using namespace hqf_bench;
    try {
        for (const unsigned int megabytes : take_sizes(argc, argv, {1, 50}))
            for (const kind which : all_kinds)
                for (const auto& peer : peers)
                    print_line(which, megabytes, peer.name, peer.load, peer.prepare);
        return 0;
    } catch (const std::exception& error) {
        std::cerr << error.what() << '\n';
        return 1;
    }
}
