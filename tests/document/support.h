// A folder of its own for files that a test writes, and paths in both forms.
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include <unistd.h>

#include <gtest/gtest.h>

#include "hqf/hqf.h"

namespace document_test {

/// Emptied at the start, removed at the end.
class folder {
public:
    folder()
        : path_(std::filesystem::path(testing::TempDir()) / ("hqf_" + std::to_string(::getpid()))) {
        std::filesystem::remove_all(path_);
        std::filesystem::create_directories(path_);
    }
    folder(const folder&) = delete;
    folder& operator=(const folder&) = delete;
    ~folder() {
        std::error_code ignored;
        std::filesystem::remove_all(path_, ignored);
    }
    std::filesystem::path operator/(const std::string& name) const { return path_ / name; }
    std::size_t size() const {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(path_), {}));
    }

private:
    std::filesystem::path path_;
};

inline std::wstring wide(const std::string& utf8) {
    std::wstring result;
    lmx::convert(&result, utf8);
    return result;
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

/// Writes without a stamp.
inline std::string written(hqf_v2::Hqf& document) {
    std::string text;
    const int code = document.marshal(&text);
    return code == 0 ? text : "code " + std::to_string(code);
}

/// What a document needs to be written.
inline void fill_header(hqf_v2::Hqf& document) {
    auto& header = document.get_Preamble().get_Header();
    header.set_Creator(L"tests");
    header.set_CreatorVersion(L"1");
    header.set_Purpose(L"");
    header.append_ChangeHistory(lmx::c_datetime("2024-05-01T09:00:00Z"));
}

} // namespace document_test
