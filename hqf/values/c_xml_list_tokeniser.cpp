#include "hqf/values/c_xml_list_tokeniser.h"

#include "hqf/values/scan.h"

namespace lmx {

void c_xml_list_tokeniser::set(const std::string& text) {
    text_ = text;
    position_ = 0;
}

bool c_xml_list_tokeniser::get(std::string* item) {
    while (position_ < text_.size() && is_space(text_[position_]))
        ++position_;
    if (position_ == text_.size()) return false;
    const std::size_t begin = position_;
    while (position_ < text_.size() && !is_space(text_[position_]))
        ++position_;
    item->assign(text_, begin, position_ - begin);
    return true;
}

} // namespace lmx
