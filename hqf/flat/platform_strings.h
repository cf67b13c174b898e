/// Strings that leave through the exports: in the layout of the platform allocator for strings that managed callers
/// know, which Linux lacks. The functions themselves are exports; hqf_flat.h declares them.
///
/// A string is a pointer to its first unit. Its length in bytes, 32 bits, lies before it and a NUL of the widest unit
/// behind it. Wide units are `wchar_t`.
#pragma once

#include <string>

namespace hqf::flat {

/// A new platform string, which the caller frees with SysFreeString. Throws `std::bad_alloc`.
wchar_t* platform_string(const std::wstring& text);
char* platform_string(const std::string& text);

} // namespace hqf::flat
