#pragma once

#include <ostream>

/// The seconds of dates and durations on a stream.

namespace hqf {

/// Writes seconds through the stream's own number insertion. Values that the general format would turn into an exponent
/// are put in fixed notation, and the flag for that is always clear afterwards.
inline void insert_seconds(std::ostream& os, float secs) {
    if (secs != 0 && secs < 0.001) os.setf(std::ios_base::fixed, std::ios_base::floatfield);
    os << secs;
    os.unsetf(std::ios_base::fixed);
}

} // namespace hqf
