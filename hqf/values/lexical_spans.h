#pragma once

/// The checks and counts of lexical.h on spans of a document, without a string.

namespace hqf {

/// As `lmx::length`.
unsigned int count_characters(const char* begin, const char* end);
/// As `lmx::is_min_length_ok`.
bool has_min_length(const char* begin, const char* end, unsigned int n);
/// As `lmx::is_max_length_ok`.
bool has_max_length(const char* begin, const char* end, unsigned int n);

/// As `lmx::is_valid_bool`.
bool is_bool(const char* begin, const char* end);
/// As `lmx::is_valid_integer`.
bool is_integer(const char* begin, const char* end);
/// As `lmx::is_valid_float`.
bool is_float(const char* begin, const char* end);

} // namespace hqf
