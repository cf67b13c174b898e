#include <pugixml.hpp>

#include "bench/memory/peers.h"

namespace hqf_bench {

bool load_pugixml(const std::string& text, const std::function<void()>& while_loaded) {
    pugi::xml_document tree;
    if (!tree.load_buffer(text.data(), text.size(), pugi::parse_default, pugi::encoding_utf8)) return false;
    while_loaded();
    return true;
}

} // namespace hqf_bench
