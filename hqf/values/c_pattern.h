#pragma once

#include <string>

#include "hqf/platform/api.h"

struct _xmlRegexp; // libxml2's compiled expression

/// Pattern facets of XML Schema (Part 2, 4.3.4), over the regular expressions of libxml2.

namespace lmx {

/// A compiled pattern. Compiling happens once, when the object is built; matching only reads, so that threads may share
/// an object for it.
class HQF_API c_regex {
public:
    /// \param pattern in the language of XML Schema patterns, UTF-8. An invalid one gives an object that matches
    /// nothing, and no error.
    explicit c_regex(const std::string& pattern);
    c_regex(const c_regex&) = delete;
    c_regex& operator=(const c_regex&) = delete;
    virtual ~c_regex();

    /// Whether the pattern matches the whole UTF-8 text. Whatever the engine can't decide counts as a match.
    bool is_match(const std::string& text) const;

private:
    _xmlRegexp* compiled_; // owned, null for an invalid pattern
};

/// The pattern facet of a type.
class HQF_API c_pattern {
public:
    explicit c_pattern(const char* pattern)
        : regex_(std::string(pattern)) {}

    bool is_match(const std::string& text) const { return regex_.is_match(text); }
    /// The same on a wide text, through a UTF-8 copy of it.
    bool is_match(const std::wstring& text) const;

private:
    c_regex regex_;
};

/// Stands in for the pattern of a type that has none: matches every text.
class c_pattern_null {
public:
    bool is_match(const std::string&) const { return true; }
    bool is_match(const std::wstring&) const { return true; }
};

} // namespace lmx
