#pragma once

#include <string>

#include "hqf/platform/api.h"

/// Lexical checks and counts of XML Schema simple types on UTF-8 text, and a few plain helpers.
///
/// The text is judged as it stands: whitespace is the reader's business, and a blank around a value makes it invalid.
/// All functions are reentrant; unless told otherwise none depends on the locale.

namespace lmx {

/// Characters of a UTF-8 text, as the length facets count them. A surrogate pair written as two three-byte sequences
/// is one character. Counting ends behind the first byte that starts no sequence; continuation bytes aren't checked.
HQF_API unsigned int length(const std::string& text);

/// Whether the text has at least `n` characters. A text of 4n bytes or more always does.
HQF_API bool is_min_length_ok(const std::string& text, unsigned int n);
/// Whether the text has at most `n` characters. A text of more than 4n bytes never does.
HQF_API bool is_max_length_ok(const std::string& text, unsigned int n);

/// ASCII digits anywhere in the text: 5 for "007.50".
HQF_API int total_digits(const std::string& text);
/// ASCII digits behind the first point: 2 for "1.50".
HQF_API int fraction_digits(const std::string& text);

/// Whether the text is "true", "1", "false" or "0".
HQF_API bool is_valid_bool(const std::string& text);
/// Whether the text is an optional sign and one or more digits.
HQF_API bool is_valid_integer(const std::string& text);
/// Whether the text is "INF", "-INF" or "NaN", or an optional sign, digits with an optional point among or around them,
/// and an optional exponent ("e" or "E", an optional sign, digits).
HQF_API bool is_valid_float(const std::string& text);

/// 0.0, from a function of its own, so that a division by it happens at run time.
HQF_API double float_zero();

/// Exchanges the `n` bytes at `a` with those at `b`. The two must not overlap.
HQF_API void bswap(void* a, void* b, unsigned int n);

/// Compares at most `n` characters of `s` from `position` with the whole of `t`: below, at or above 0, as
/// `std::string::compare`. Throws `std::out_of_range` when `position` lies beyond the end of `s`.
HQF_API int stringncompare(const std::string& s, const char* t, unsigned int position, unsigned int n);

/// The C library's tests of a character, in the process's locale. False for `c` below 1 and above 255, where the
/// library's own tests have no answer.
HQF_API bool xisalnum(int c);
HQF_API bool xisalpha(int c);
HQF_API bool xisdigit(int c);
HQF_API bool xisprint(int c);
HQF_API bool xisspace(int c);
HQF_API bool xisxdigit(int c);

} // namespace lmx
