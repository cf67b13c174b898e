#pragma once

#include <cstddef>
#include <iosfwd>

/// Text of numbers into a caller's buffer, for the road out of a document: byte for byte what insertion through
/// `lmx::c_as_xml`, or of a plain integer, gives on a stream in its default state. Each function gives the end of what
/// it wrote; there is no NUL.

namespace hqf {

/// Room that any of these texts fits in.
constexpr std::size_t number_text_size = 32;

/// "NaN", "-INF", "INF", "-0.0", "0.0", or 14 significant digits in general format.
char* write_number(char* out, double value);
/// The same with 7 significant digits.
char* write_number(char* out, float value);
char* write_number(char* out, int value);
char* write_number(char* out, unsigned int value);

/// Whether numbers come out of this stream as these functions write them: default flags, precision and width, and a
/// locale with the number format of the classic one.
bool has_default_format(const std::ostream& os);

} // namespace hqf
