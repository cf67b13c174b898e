#pragma once

#include <string>

#include "hqf/platform/api.h"

namespace lmx {

/// A qualified name: a text of the application's string type, and a narrow one beside it.
template<class T>
struct ct_qname {
    T text;
    std::string narrow;
};

/// Makes a name of whichever type `result` is. Plain strings get `first`; the pairs get `third` as their text and
/// `second` as their narrow member. Text becomes wide where the result is.
HQF_API void make_qname(std::string* result, const std::string& first, const std::string& second,
                        const std::string& third);
HQF_API void make_qname(std::wstring* result, const std::string& first, const std::string& second,
                        const std::string& third);
HQF_API void make_qname(ct_qname<std::string>* result, const std::string& first, const std::string& second,
                        const std::string& third);
HQF_API void make_qname(ct_qname<std::wstring>* result, const std::string& first, const std::string& second,
                        const std::string& third);

} // namespace lmx
