/// Large blocks of memory, for text that is written once from front to back: fetched in large pages where the system
/// has them, since fetching page by page costs as much as writing the text.
#pragma once

#include <cstddef>

namespace hqf {

/// A block for std::free(); null when there is no memory.
void* allocate_for_filling(std::size_t size) noexcept;

/// Tells the system that a block, wherever it comes from, is about to be written whole.
void expect_filling(void* block, std::size_t size) noexcept;

} // namespace hqf
