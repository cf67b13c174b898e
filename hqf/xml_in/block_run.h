#pragma once

#include "hqf/xml_in/byte_run.h"

#include <cstddef>
#include <cstdint>
#include <memory>

/// A reading position in bytes that come block by block.

namespace hqf {

/// The unread part of the current block of a source, and how to bring more. Like byte_run for bytes in memory: the
/// built-in sources that have no whole keep their position in one, so that a window can read them ahead.
struct block_run {
    /// Fills memory from a source and gives how many bytes came; `is_last` becomes true when no more will.
    using supplier = std::size_t (*)(void* source, char* memory, std::size_t size, bool& is_last);

    block_run(supplier supply, void* source)
        : supply_(supply)
        , source_(source) {}

    byte_run run;
    /// Where the block starts.
    const char* start = nullptr;
    /// Bytes that the source has delivered so far.
    std::uint64_t delivered = 0;
    /// False for a source that must not be asked for more than its reader needs.
    bool may_read_ahead = true;
    bool is_at_end = false;

    /// Goes on with the block at `memory`, filled anew; false if nothing came.
    bool fill(char* memory, std::size_t size);
    /// Where fewer than `wanted` unread bytes are at hand, brings them into one block of `block_size` and fills that.
    void read_ahead(std::size_t wanted, std::size_t block_size);
    /// Forgets all bytes; the source starts again.
    void rewind();
    /// How many bytes have been read.
    std::uint64_t consumed() const { return delivered - static_cast<std::size_t>(run.end - run.cursor); }

private:
    const supplier supply_;
    void* const source_;
    std::unique_ptr<char[]> memory_;
    std::size_t memory_size_ = 0;
};

} // namespace hqf
