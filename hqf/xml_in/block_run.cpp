#include "hqf/xml_in/block_run.h"

#include <cstring>

namespace hqf {

bool block_run::fill(char* memory, std::size_t size) {
    const std::size_t count = supply_(source_, memory, size, is_at_end);
    delivered += count;
    start = memory;
    run = {memory, memory + count};
    return count != 0;
}

void block_run::read_ahead(std::size_t wanted, std::size_t block_size) {
    const auto unread = static_cast<std::size_t>(run.end - run.cursor);
    if (unread >= wanted || is_at_end) return;
    if (memory_size_ < block_size) {
        auto larger = std::make_unique_for_overwrite<char[]>(block_size);
        if (unread != 0) std::memcpy(larger.get(), run.cursor, unread);
        memory_ = std::move(larger);
        memory_size_ = block_size;
    } else if (unread != 0) {
        std::memmove(memory_.get(), run.cursor, unread);
    }
    fill(memory_.get() + unread, memory_size_ - unread);
    start = run.cursor = memory_.get();
}

void block_run::rewind() {
    run = {};
    delivered = 0;
    is_at_end = false;
}

} // namespace hqf
