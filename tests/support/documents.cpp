#include "tests/support/documents.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>

namespace support {

std::string document(const std::string& name) {
    std::ifstream file(std::string(HQF_TEST_DATA) + '/' + name, std::ios::binary);
    if (!file) throw std::runtime_error("no such test document: " + name);
    std::ostringstream text;
    text << file.rdbuf();
    return std::move(text).str();
}

std::vector<std::pair<std::string, std::string>> documents(const std::string& folder) {
    std::vector<std::pair<std::string, std::string>> result;
    for (const auto& entry : std::filesystem::directory_iterator(std::string(HQF_TEST_DATA) + '/' + folder))
        if (entry.path().extension() == ".hqf") {
            const std::string name = folder + '/' + entry.path().filename().string();
            result.emplace_back(name, document(name));
        }
    std::sort(result.begin(), result.end());
    return result;
}

int repetitions(int rounds) {
    const char* effort = std::getenv("HQF_TEST_EFFORT");
    return effort == nullptr ? rounds : rounds * std::max(1, std::atoi(effort));
}

void keep(const std::string& name, const std::string& text) {
    std::ofstream(name, std::ios::binary) << text;
}

} // namespace support
