#include "hqf/platform/paths.h"

#include <cstddef>

namespace hqf {

namespace {

void append_utf8(std::string& out, char32_t c) {
    const auto put = [&out](char32_t byte) { out.push_back(static_cast<char>(static_cast<unsigned char>(byte))); };
    if (c < 0x80) return put(c);
    if (c < 0x800) {
        put(0xC0 | (c >> 6));
    } else if (c < 0x10000) {
        put(0xE0 | (c >> 12));
        put(0x80 | ((c >> 6) & 0x3F));
    } else {
        put(0xF0 | ((c >> 18) & 7));
        put(0x80 | ((c >> 12) & 0x3F));
        put(0x80 | ((c >> 6) & 0x3F));
    }
    put(0x80 | (c & 0x3F));
}

} // namespace

std::string path_to_utf8(const std::wstring& path) {
    std::string out;
    out.reserve(path.size());
    for (std::size_t i = 0; i < path.size(); ++i) {
        auto c = static_cast<char32_t>(path[i]);
        const char32_t next = i + 1 < path.size() ? static_cast<char32_t>(path[i + 1]) : 0;
        if (c >= 0xD800 && c <= 0xDBFF && next >= 0xDC00 && next <= 0xDFFF) {
            c = 0x10000 + ((c & 0x3FF) << 10) + (next & 0x3FF);
            ++i;
        }
        append_utf8(out, c);
    }
    return out;
}

std::FILE* open_file(const std::wstring& path, const char* mode) {
    return std::fopen(path_to_utf8(path).c_str(), mode);
}

bool remove_file(const std::wstring& path) {
    return std::remove(path_to_utf8(path).c_str()) == 0;
}

} // namespace hqf
