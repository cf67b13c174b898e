/// Files of a benchmark on archives, on a memory file system, so that no row waits for a disk.
#pragma once

#include <unistd.h>

#include <filesystem>
#include <stdexcept>
#include <string>

#include "hqf/hqf.h"

namespace hqf_bench {

/// A folder in /dev/shm (or, without one, among the temporary files), gone with this object.
class memory_folder {
public:
    memory_folder() {
        const std::filesystem::path shared = "/dev/shm";
        path_ = (std::filesystem::exists(shared) ? shared : std::filesystem::temp_directory_path()) /
                ("hqf-bench-" + std::to_string(getpid()));
        std::filesystem::create_directories(path_);
    }
    ~memory_folder() {
        std::error_code ignored;
        std::filesystem::remove_all(path_, ignored);
    }
    memory_folder(const memory_folder&) = delete;
    memory_folder& operator=(const memory_folder&) = delete;

    std::filesystem::path operator/(const char* name) const { return path_ / name; }

private:
    std::filesystem::path path_;
};

/// Loads a document from memory and writes it to `path`, of either kind. Throws `std::runtime_error` when it can't.
inline void write_document(const std::string& text, const std::filesystem::path& path) {
    hqf_v2::Hqf document;
    if (document.unmarshal(text) != lmx::err_no_error || document.writeFile(path.wstring()) != lmx::err_no_error)
        throw std::runtime_error("can't write " + path.string());
}

} // namespace hqf_bench
