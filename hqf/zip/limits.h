#pragma once

/// Every limit of the archive layer, with its reason.

#include <cstdint>

namespace hqf::zip_limits {

/// The end record has 22 bytes, and its comment at most 65,535 (APPNOTE 4.4.12): it lies no further from the end.
constexpr std::uint32_t end_record_depth = 22 + 65535;

/// The end record counts entries in 16 bits.
constexpr std::uint32_t most_entries = 65535;

/// The headers hold the length of a name, an extra field and a comment in 16 bits.
constexpr std::uint32_t longest_field = 65535;

/// Positions are 32-bit and signed. A file of 2 GiB or more is refused with EOVERFLOW when it is opened, and a write
/// that would grow a file beyond with EFBIG; no position ever wraps.
constexpr std::uint32_t last_position = 0x7FFFFFFF;

/// A size of all ones is the mark of a ZIP64 entry (APPNOTE 4.3.9.2), so an entry ends one byte below.
constexpr std::uint32_t largest_size = 0xFFFFFFFE;

/// Bytes that a byte of deflate can stand for: the longest match, 258 bytes, costs no less than 2 bits (RFC 1951, 3.2).
constexpr std::uint64_t deflate_expansion = 1032;

/// The same for bzip2, which has no honest bound of its own: a block of 24 bytes can stand for 46 million equal ones.
/// Documents stay far below: 78 to 1 for real ones, 5,400 to 1 for one colour repeated without end.
constexpr std::uint64_t bzip2_expansion = 10000;

/// Bytes gathered before the archive is written to.
constexpr std::uint32_t write_buffer = 65536;

/// Bytes read at a time while the file is searched backwards for a signature.
constexpr std::uint32_t search_buffer = 32768;

/// Packed bytes that a compressor reads or writes at a time.
constexpr std::uint32_t compressor_buffer = 131072;

/// Bytes of a file read at a time while it becomes an entry.
constexpr std::uint32_t copy_buffer = 65536;

} // namespace hqf::zip_limits
