// Folders and files that a test writes, and paths in both forms.
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <system_error>

#include <unistd.h>

#include "hqf/values/text.h"

namespace support {

/// A new folder, removed with all in it at the end.
struct folder : std::filesystem::path {
    folder()
        : path(std::filesystem::temp_directory_path() /
               ("hqf-" + std::to_string(::getpid()) + '-' + std::to_string(++count))) {
        std::filesystem::create_directories(*this);
    }
    folder(const folder&) = delete;
    folder& operator=(const folder&) = delete;
    ~folder() {
        std::error_code ignored;
        std::filesystem::remove_all(*this, ignored);
    }
    /// Of files and folders in it.
    std::size_t size() const {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(*this), {}));
    }
    inline static int count = 0;
};

inline std::wstring wide(const std::string& utf8) {
    std::wstring result;
    return lmx::convert(&result, utf8);
}
inline std::wstring wide(const std::filesystem::path& path) {
    return wide(path.string());
}

inline std::string bytes_of(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

inline void make_file(const std::filesystem::path& path, const std::string& bytes) {
    std::ofstream(path, std::ios::binary) << bytes;
}

} // namespace support
