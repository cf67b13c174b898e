/// Peers of the memory table: each loads a text and tells what is in use while the result exists.
#pragma once

#include <functional>
#include <string>

namespace hqf_bench {

/// Loads, calls `while_loaded`, destroys. False if the peer refuses the text.
using memory_peer = bool (*)(const std::string& text, const std::function<void()>& while_loaded);

bool load_hqf(const std::string& text, const std::function<void()>& while_loaded);
/// Reads the file that `pack_for_load_archive` has made of the same text.
bool load_hqf_archive(const std::string& text, const std::function<void()>& while_loaded);
void pack_for_load_archive(const std::string& text);
bool load_pugixml(const std::string& text, const std::function<void()>& while_loaded);

} // namespace hqf_bench
