#include <cstring>

#include "hqf/frame/rows.h"

namespace hqf::frame {

int literals::number_of(const std::wstring& text) const {
    for (int i = 0; i < count; ++i)
        if (wide[i] == text) return i + 1;
    return 0;
}

int literals::number_of(const char* text, std::size_t length) const {
    for (int i = 0; i < count; ++i)
        if (lengths[i] == length && std::memcmp(narrow[i], text, length) == 0) return i + 1;
    return 0;
}

} // namespace hqf::frame
