#pragma once

#include <cstddef>

#include "hqf/values/c_datetime.h"

/// The short roads of `c_datetime` into and out of a document.

namespace hqf {

/// Reads the common form YYYY-MM-DDThh:mm:ss with an optional fraction of seconds and a zone, "Z" or +hh:mm or -hh:mm.
///
/// \returns the end of the form that begins here: it is then valid, matches the pattern `.+T.+(Z|[+\-].+)`, and is
/// stored as assignment would. Null says nothing about the text, and nothing is stored.
const char* scan_zoned_datetime(const char* begin, const char* end, lmx::c_datetime& value);

/// Whether the span has the lexical form of a `c_datetime`, as `c_datetime::is_valid`.
bool is_datetime(const char* begin, const char* end);

/// What is known of a text without the regular expression engine.
enum class zone_pattern { matched, not_matched, ask_engine };

/// Whether the span matches `.+T.+(Z|[+\-].+)`, in one pass whatever the text: on some texts the general engine goes
/// back so often that its time grows with the cube of their length. The engine has the word only where something that
/// is no XML character comes first, and there it stops.
zone_pattern match_zone_pattern(const char* begin, const char* end);

/// Room that any text of a `c_datetime` fits in.
constexpr std::size_t datetime_text_size = 160;

/// Writes what insertion into a stream in its default state gives, and gives the end of it; there is no NUL. A caller
/// that does this in place of an insertion sets the stream's fill to "0" itself.
char* write_datetime(char* out, const lmx::c_datetime& value);

} // namespace hqf
