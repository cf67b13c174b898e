#pragma once

#include <cstddef>
#include <string>

#include "hqf/platform/api.h"

namespace lmx {

/// Takes a list value apart at its whitespace, one item after the other. Keeps its own copy of the text; one thread at
/// a time.
class HQF_API c_xml_list_tokeniser {
public:
    explicit c_xml_list_tokeniser(const std::string& text)
        : text_(text) {}

    /// Starts over with another text.
    void set(const std::string& text);

    /// Stores the next item in `*item`. At the end of the text it gives false and leaves `*item` alone.
    bool get(std::string* item);

private:
    std::string text_;
    std::size_t position_ = 0;
};

} // namespace lmx
