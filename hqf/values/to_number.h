#pragma once

#include <cstdint>
#include <string_view>

/// Numbers from text, for the road into a document. No result depends on the process's locale.
///
/// The `read_` forms check and convert in one scan and serve text that must have its lexical form. The `to_` forms
/// convert whatever they are given as the C library would in the "C" locale; they are for text that failed its check
/// where an error handler wants to go on.

namespace hqf {

/// Moves over the longest float form at `begin` ("INF", "-INF", "NaN"; or a sign, digits with an optional point, an
/// exponent) and stores its value: the nearest double, infinite or zero beyond the range, -0.0 for "-0".
///
/// \returns the end of the form; null, with nothing stored, where none begins
const char* scan_double(const char* begin, const char* end, double& value);

/// The same for the form that most numbers have: up to 15 digits with at most one point, which stands between digits.
/// Null for any other; scan_double() decides then. Precondition: 32 bytes can be read.
const char* scan_short_decimal(const char* begin, double& value);

/// Whether the whole span is an integer form of at most 18 digits, which is when its value is stored. False says no
/// more than that the long road must decide.
bool read_short_integer(const char* begin, const char* end, std::int64_t& value);

/// Whether the whole span is "true", "1", "false" or "0", which is when its value is stored.
bool read_bool(const char* begin, const char* end, bool& value);

/// "NaN", "INF" and "-INF" by name, any other text as `atof`.
double to_double(std::string_view text);
/// As `atoi`: 64-bit saturation, then the low 32 bits.
int to_int(std::string_view text);
/// As `strtoul` with base 10: 64-bit saturation, then the low 32 bits.
unsigned int to_unsigned(std::string_view text);
/// True for "true" and "1".
bool to_bool(std::string_view text);

} // namespace hqf
