#pragma once

#include <string>

#include "hqf/platform/api.h"

/// The two string forms of the library and the ways between them.
///
/// Narrow text is a `std::string` of UTF-8 bytes. Wide text is a `std::wstring` of UTF-16 units, one unit an element
/// also where `wchar_t` has 32 bits: a character above U+FFFF is a surrogate pair of two elements. A single 32-bit
/// element above U+FFFF is accepted too and taken for that character; one that is no Unicode character at all becomes
/// U+FFFD.
///
/// Nothing here fails outwardly: invalid input shortens the result as told at each function.

namespace lmx {

/// UTF-8 to UTF-16. Replaces `out` and gives it back.
///
/// The result ends before the first thing that is not UTF-8: a byte that starts no sequence, a missing continuation
/// byte, a sequence that the end cuts off. Overlong forms are accepted. A surrogate pair written as two three-byte
/// sequences becomes the pair; a high surrogate that no low one follows ends the result and is dropped.
HQF_API std::wstring& vtostring(std::wstring& out, const std::string& in);

/// A plain copy, so that generic code can ask for either form. Gives `out` back.
HQF_API std::string& vtostring(std::string& out, const std::string& in);

/// UTF-8 to UTF-16, as `vtostring`. Gives `*out` back.
HQF_API std::wstring& convert(std::wstring* out, const std::string& in);

/// UTF-16 to UTF-8. Replaces `*out` and gives it back.
///
/// A surrogate pair becomes one four-byte sequence. A lone surrogate is written as three bytes; behind a high one the
/// following element is lost.
HQF_API std::string& convert(std::string* out, const std::wstring& in);

/// Decodes the UTF-8 sequence at `in`, as long as its first byte says, into `*out`.
///
/// \returns false with `*out` -1 when no sequence starts with the first byte; false with the bits read so far when a
/// continuation byte is missing. Overlong forms and surrogates pass.
HQF_API bool utf8_to_unicode_char(const char* in, int* out);

/// Encodes `c` in one to four UTF-8 bytes with a NUL behind them and gives `out` back.
///
/// \param c not checked: surrogates are encoded like any other value, and anything below 128 is one byte
/// \param out room for five bytes at least
HQF_API char* unicode_char_to_utf8(int c, char* out);

/// Whether the first two bytes at `in` can begin a character by the table of well-formed UTF-8 sequences (Unicode
/// Standard, table 3-7). The second byte is read only where the first one restricts it; later bytes never are.
HQF_API bool is_valid_utf8_char_sequence(const char* in);

} // namespace lmx
