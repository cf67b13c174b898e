#include "hqf/xml_out/text_stream.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <new>
#include <utility>

#include "hqf/platform/pages.h"

namespace hqf {

namespace {

/// Blocks grow from one that a small document fills to one that a large document notes no more.
constexpr std::size_t first_block = 64 * 1024, largest_block = 4 * 1024 * 1024;
/// What the put position of a stream buffer can be moved by in one step.
constexpr std::size_t most_at_once = 1024 * 1024 * 1024;

} // namespace

text_buffer::~text_buffer() {
    for (const block& each : blocks_)
        std::free(each.begin);
}

void text_buffer::begin_block(std::size_t size) {
    note_use();
    const std::size_t usual = std::min(first_block << std::min<std::size_t>(blocks_.size(), 8), largest_block);
    const std::size_t capacity = std::max(usual, size);
    blocks_.reserve(blocks_.size() + 1);
    void* const place = allocate_for_filling(capacity);
    if (place == nullptr) throw std::bad_alloc();
    char* const begin = static_cast<char*>(place);
    blocks_.push_back({begin, 0});
    setp(begin, begin + capacity);
}

void text_buffer::move_to(std::string& text) {
    note_use();
    std::size_t size = 0;
    for (const block& each : blocks_)
        size += each.used;
    std::string roomy;
    if (text.capacity() < size) {
        roomy.reserve(size);
        expect_filling(roomy.data(), size);
        text.swap(roomy);
    }
    text.clear();
    for (const block& each : std::exchange(blocks_, {})) {
        text.append(each.begin, each.used);
        std::free(each.begin);
    }
    setp(nullptr, nullptr);
}

text_buffer::int_type text_buffer::overflow(int_type c) {
    if (traits_type::eq_int_type(c, traits_type::eof())) return traits_type::not_eof(c);
    *room(1) = traits_type::to_char_type(c);
    pbump(1);
    return c;
}

std::streamsize text_buffer::xsputn(const char* data, std::streamsize size) {
    for (std::size_t left = static_cast<std::size_t>(size); left != 0;) {
        const std::size_t step = std::min(left, most_at_once);
        char* const at = room(step);
        std::memcpy(at, data, step);
        advance(at + step);
        data += step;
        left -= step;
    }
    return size;
}

} // namespace hqf
