#pragma once

#include <cstddef>
#include <string>

/// Text as it stands in a document, without a stream: the same bytes as `lmx::c_as_xml` of a string gives.

namespace hqf {

/// Room that the escaped form of one narrow character or one wide element fits in.
constexpr std::size_t escaped_size = 6;

void append_xml_escaped(std::string& out, const wchar_t* data, std::size_t size);
void append_xml_escaped(std::string& out, const char* data, std::size_t size);

/// Writes the escaped form of the text from `next` on while at least `escaped_size` bytes are free before `limit`,
/// moves `next` over what is done, and gives the end of what was written. At the end of the text, and at an unpaired
/// high surrogate, which ends a wide text, `next` is `end`.
char* write_xml_escaped(char* out, const char* limit, const wchar_t*& next, const wchar_t* end);
char* write_xml_escaped(char* out, const char* limit, const char*& next, const char* end);

} // namespace hqf
