#pragma once

#include <cstdio>
#include <cstdlib>
#include <string>

namespace fuzz {

/// Ends the program, which libFuzzer takes for a finding, unless `holds`. `what` says what should have been so.
inline void require(bool holds, const std::string& what) {
    if (holds) return;
    std::fprintf(stderr, "not so: %s\n", what.c_str());
    std::abort();
}

} // namespace fuzz
