#pragma once

#include <cstddef>
#include <cstdint>

/// Every limit on untrusted documents, in one place. No genuine document comes near them; they stand between a hostile
/// one and the stack, the memory and the patience of the program that reads it.

namespace hqf::limits {

/// Deepest nesting of the format's own elements.
///
/// Each level is a few calls on the stack of the reading thread. Parent colour spaces are the only elements that may
/// hold one another without end. Beyond it the load ends with code 5.
inline constexpr unsigned model_depth = 1000;

/// Deepest nesting inside an element that is being skipped.
///
/// Skipping calls itself once a level. Beyond it the skip fails, which its callers turn into code 10 (or 5 for
/// `get_known_element_event`).
inline constexpr unsigned skip_depth = 1000;

/// Deepest nesting inside an element that is captured as raw text.
///
/// Capturing calls itself once a level, and writing such a text back makes other programs nest as deep. Beyond it the
/// capture fails: code 29.
inline constexpr unsigned capture_depth = 1000;

/// Most entities that may be open inside one another in an attribute value.
///
/// There each is a call on the stack, and a deeper reference fails: code 28. In text they lie on the heap, as many as
/// the limits below let in.
inline constexpr std::size_t entity_depth = 1000;

/// Bytes that entities may add to a document before their growth is held against its size.
///
/// Ten entities that each name the one before ten times make gigabytes out of a few hundred bytes. A document that
/// uses entities as abbreviations stays far below this.
inline constexpr std::uint64_t entity_allowance = std::uint64_t{8} << 20;

/// Bytes that entities may add for each byte of the document that has been read, on top of the allowance.
///
/// Memory and time then stay in proportion to what the sender paid for.
inline constexpr std::uint64_t entity_growth = 10;

/// What a reference costs beside the length of its text.
///
/// Looking an entity up takes longer than copying a few bytes, so that references to short or empty entities weigh as
/// much as the work they make.
inline constexpr std::uint64_t entity_reference_cost = 32;

} // namespace hqf::limits
