#pragma once

namespace lmx {

/// What becomes of white space (tab to carriage return, and the blank) in a value; the whiteSpace facet of XML Schema
/// Part 2, 4.3.6.
enum elmx_whitespace : int {
    preserve = 0, ///< kept unchanged
    replace = 1,  ///< each character becomes a blank
    collapse = 2, ///< runs become one blank, those at both ends go
};

} // namespace lmx
