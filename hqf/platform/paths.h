#pragma once

#include <cstdio>
#include <string>

/// Files by wide path. The interface takes paths as UTF-16 units; the file system here takes UTF-8 bytes.

namespace hqf {

/// The path as UTF-8, surrogate pairs joined. A lone surrogate is written as three bytes, so that no two paths become
/// the same.
std::string path_to_utf8(const std::wstring& path);

/// `std::fopen` on a wide path: null when the file can't be opened.
std::FILE* open_file(const std::wstring& path, const char* mode);

/// Deletes a file; false when that fails.
bool remove_file(const std::wstring& path);

} // namespace hqf
