/// Heap of a load from an archive. The unpacked text isn't the caller's here, so it counts.

#include "bench/archive/archive.h"
#include "bench/memory/peers.h"

namespace hqf_bench {

namespace {

std::filesystem::path archive_of(const std::string& text) {
    static const memory_folder folder;
    return folder / (std::to_string(text.size()) + ".hqfz").c_str();
}

} // namespace

void pack_for_load_archive(const std::string& text) {
    write_document(text, archive_of(text));
}

bool load_hqf_archive(const std::string& text, const std::function<void()>& while_loaded) {
    hqf_v2::Hqf document;
    if (document.loadFile(archive_of(text).wstring()) != lmx::err_no_error) return false;
    while_loaded();
    return true;
}

} // namespace hqf_bench
