// Names: code pages, and the parts of a path.

#include "hqf/platform/file_access.h"

#include "hqf/platform/paths.h"

namespace hqf {
namespace {

constexpr char32_t replacement = 0xFFFD;

bool is_utf8(std::uint32_t code_page) {
    return code_page <= 1 || code_page == 65001;
}

bool is_high_surrogate(char32_t c) {
    return c >= 0xD800 && c < 0xDC00;
}
bool is_low_surrogate(char32_t c) {
    return c >= 0xDC00 && c < 0xE000;
}

char32_t character_at(const std::wstring& text, std::size_t at) {
    return at < text.size() ? static_cast<char32_t>(text[at]) : 0;
}

// Takes one character of UTF-8 (RFC 3629: no overlong form, no surrogate, nothing above U+10FFFF). What is none costs
// one byte, so that the text behind it is not lost.
char32_t next_utf8(std::string_view bytes, std::size_t& at) {
    const auto byte = [&](std::size_t i) { return i < bytes.size() ? static_cast<unsigned char>(bytes[i]) : 0U; };
    const char32_t first = byte(at++);
    if (first < 0x80) return first;
    const std::size_t more = first >= 0xF0 ? 3 : first >= 0xE0 ? 2 : 1;
    static constexpr char32_t least[] = {0, 0x80, 0x800, 0x10000};
    if (first < 0xC0 || first > 0xF4) return replacement;
    char32_t c = first & (0x3FU >> more);
    for (std::size_t i = 0; i < more; ++i) {
        if ((byte(at + i) & 0xC0) != 0x80) return replacement;
        c = c << 6 | (byte(at + i) & 0x3F);
    }
    if (c < least[more] || c > 0x10FFFF || (c >= 0xD800 && c < 0xE000)) return replacement;
    at += more;
    return c;
}

} // namespace

std::string to_code_page(const std::wstring& text, std::uint32_t code_page) {
    std::wstring stored = text;
    bool in_pair = false;
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char32_t c = character_at(text, at);
        const bool begins_pair = is_high_surrogate(c) && is_low_surrogate(character_at(text, at + 1));
        const bool is_alone = (is_high_surrogate(c) || is_low_surrogate(c)) && !begins_pair && !in_pair;
        if (is_alone || c > 0x10FFFF) stored[at] = static_cast<wchar_t>(replacement);
        if (c >= 0x80 && !is_utf8(code_page)) stored[at] = L'?';
        in_pair = begins_pair;
    }
    return path_to_utf8(stored);
}

std::wstring from_code_page(std::string_view bytes, std::uint32_t code_page) {
    std::wstring text;
    text.reserve(bytes.size());
    for (std::size_t at = 0; at < bytes.size();) {
        char32_t c = replacement;
        if (is_utf8(code_page)) {
            c = next_utf8(bytes, at);
        } else if (const unsigned char byte = static_cast<unsigned char>(bytes[at++]); byte < 0x80) {
            c = byte;
        }
        if (c >= 0x10000) {
            text += static_cast<wchar_t>(0xD800 + ((c - 0x10000) >> 10));
            c = 0xDC00 + ((c - 0x10000) & 0x3FF);
        }
        text += static_cast<wchar_t>(c);
    }
    return text;
}

path_parts split_path(const std::wstring& path) {
    path_parts parts;
    const auto is_letter = [](wchar_t c) { return (c >= L'A' && c <= L'Z') || (c >= L'a' && c <= L'z'); };
    std::size_t begin = path.size() >= 2 && path[1] == L':' && is_letter(path[0]) ? 2 : 0;
    parts.drive = path.substr(0, begin);
    std::size_t name = path.size();
    while (name > begin && !is_path_separator(path[name - 1]))
        --name;
    parts.directory = path.substr(begin, name - begin);
    std::size_t dot = path.rfind(L'.');
    if (dot == std::wstring::npos || dot < name) dot = path.size();
    parts.title = path.substr(name, dot - name);
    parts.extension = path.substr(dot);
    return parts;
}

} // namespace hqf
