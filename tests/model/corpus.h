// The generated corpus as corpus.py writes it at build time: records between 0x1E, fields between 0x1F.
#pragma once

#include <array>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace corpus {

inline constexpr std::string_view anything = "-";
inline constexpr std::string_view the_document = "=";

struct test_case {
    std::string_view family;
    /// Class, member and what was done to it.
    std::string_view what;
    int code;
    /// Of the report; `anything` where there is none or it isn't fixed.
    std::string_view item;
    /// Code of a write after a load that gave 0, or `anything`.
    std::string_view write;
    std::string_view document;
    /// What a write must give: `the_document` byte for byte, other text, or `anything`.
    std::string_view written;
};

/// The bytes of the corpus, which the cases point into.
inline std::string bytes() {
    std::ifstream file(HQF_CORPUS, std::ios::binary);
    if (!file) throw std::runtime_error("no corpus: " HQF_CORPUS);
    std::ostringstream text;
    text << file.rdbuf();
    return std::move(text).str();
}

inline std::vector<test_case> cases(std::string_view text) {
    std::vector<test_case> result;
    const auto upto = [&](char stop) {
        const std::string_view part = text.substr(0, text.find(stop));
        text.remove_prefix(part.size() == text.size() ? part.size() : part.size() + 1);
        return part;
    };
    while (!text.empty()) {
        std::string_view record = upto('\x1e');
        std::array<std::string_view, 7> fields;
        std::swap(text, record);
        for (auto& field : fields)
            field = upto('\x1f');
        std::swap(text, record);
        result.push_back({fields[0], fields[1], std::atoi(std::string(fields[2]).c_str()), fields[3], fields[4],
                          fields[5], fields[6]});
    }
    return result;
}

} // namespace corpus
