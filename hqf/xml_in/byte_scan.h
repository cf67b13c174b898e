#pragma once

/// Scans over runs of bytes, sixteen at a time where the machine can.

namespace hqf {

/// Where the first byte stands that is no plain text: not well-formed UTF-8 (Unicode Standard, table 3-7), U+0085,
/// U+2028, or a control character other than 9 to 13.
///
/// \returns `stop`, or up to three bytes behind it when a character crosses it. Precondition: four bytes can be read
/// behind `stop`.
const char* find_not_plain(const char* from, const char* stop);

/// Where the first `wanted`, '&' or CR stands, or `stop`. Precondition: sixteen bytes can be read behind `stop`.
const char* find_text_end(const char* from, const char* stop, char wanted);

/// Where the first byte above a blank stands, or `stop`. Precondition: sixteen bytes can be read behind `stop`.
const char* skip_space(const char* from, const char* stop);

/// How many lines end in a run: LF, CR, and CR LF once. `before` is the byte in front of it.
long long count_line_ends(const char* from, const char* stop, unsigned char before);

} // namespace hqf
