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

const std::wstring& enumerated::text(const literals& texts) const {
    static const std::wstring nothing;
    if (number_ != 0) return texts.wide[number_ - 1];
    return free_text_ == nullptr ? nothing : *free_text_;
}

void enumerated::set_text(const std::wstring& text, const literals& texts) {
    const int number = texts.number_of(text);
    std::unique_ptr<std::wstring> free_text;
    if (number == 0 && !text.empty()) free_text = std::make_unique<std::wstring>(text);
    number_ = number;
    free_text_ = std::move(free_text);
}

} // namespace hqf::frame
