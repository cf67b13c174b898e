/// The options that our two programs have of their own.
#pragma once

#include <algorithm>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace hqf_bench {

/// The text behind `prefix` in the first argument that begins with it; the argument is taken out. Empty if none does.
inline std::string take_value(int& argc, char** argv, const std::string& prefix) {
    char** const end = argv + argc;
    char** const found =
        std::find_if(argv + 1, end, [&](const char* a) { return std::string(a).rfind(prefix, 0) == 0; });
    if (found == end) return {};
    const std::string value = *found + prefix.size();
    std::rotate(found, found + 1, end);
    --argc;
    return value;
}

/// `--sizes=1,50`: million bytes, up to 2,000 (a load from memory takes at most 4 GiB). Throws for anything else.
inline std::vector<unsigned int> take_sizes(int& argc, char** argv, std::vector<unsigned int> usual) {
    std::istringstream list(take_value(argc, argv, "--sizes="));
    std::vector<unsigned int> sizes;
    for (std::string item; std::getline(list, item, ',');) {
        const unsigned long size = std::stoul(item);
        if (size == 0 || size > 2000) throw std::runtime_error("--sizes: 1 to 2000 million bytes each");
        sizes.push_back(static_cast<unsigned int>(size));
    }
    return sizes.empty() ? usual : sizes;
}

} // namespace hqf_bench
