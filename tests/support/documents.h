// The sample documents under tests/data, and how hard a test tries.
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace support {

/// The bytes of a file under tests/data.
std::string document(const std::string& name);
/// All .hqf files of a folder there, by name.
std::vector<std::pair<std::string, std::string>> documents(const std::string& folder);
/// Rounds of a random test: as many as asked, times the environment's HQF_TEST_EFFORT.
int repetitions(int rounds);
/// Writes the input of a failure to the working directory.
void keep(const std::string& name, const std::string& text);

} // namespace support
