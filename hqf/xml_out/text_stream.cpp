#include "hqf/xml_out/text_stream.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <exception>
#include <limits>
#include <new>
#include <optional>
#include <utility>

#include "hqf/platform/pages.h"
#include "hqf/values/transcode.h"

namespace hqf {

namespace {

/// Blocks grow from one that a small document fills to one that a large document notes no more.
constexpr std::size_t first_block = 64 * 1024, largest_block = 4 * 1024 * 1024;

/// What is widened stays in the cache beside what it becomes. A file is written block by block, each a call of the
/// system.
constexpr std::size_t block_to_widen = 64 * 1024, block_to_file = 256 * 1024;

/// What the system keeps files in.
constexpr std::size_t page = 4096;

/// Documents change between a load and a write, and between two writes: a little more is needed, at times.
constexpr std::size_t with_reserve(std::size_t expected) {
    return expected + expected / 64 + 4096;
}

/// A text that was expected to be much longer doesn't hold on to the memory.
template<class text_type>
void give_up_excess(text_type& text) {
    if (text.size() < text.capacity() / 2) text.shrink_to_fit();
}

/// Makes `text` a new string of up to `size` elements that `fill` writes; it gets the memory, or none where that much
/// can't be had in one piece, and gives how many it wrote.
template<class text_type, class filler>
void fill_new(text_type& text, std::size_t size, const filler& fill) {
#if defined(__cpp_lib_string_resize_and_overwrite)
    try {
        text.reserve(size);
    } catch (const std::exception&) {
        fill(nullptr, 0);
        return;
    }
    expect_filling(text.data(), size * sizeof text[0]);
    // Nothing may be thrown through the string.
    std::exception_ptr thrown;
    text.resize_and_overwrite(size, [&](auto* memory, std::size_t) noexcept -> std::size_t {
        try {
            return fill(memory, size);
        } catch (...) {
            thrown = std::current_exception();
            return 0;
        }
    });
    if (thrown != nullptr) std::rethrow_exception(thrown);
#else
    // This standard library can't leave a string to be written later, so all goes another way.
    static_cast<void>(size);
    text.resize(fill(nullptr, 0));
#endif
}

/// The bytes of UTF-8 that come block by block, as wide text: in memory first, then in a string.
struct wide_target {
    wchar_t* at = nullptr;
    const wchar_t* limit = nullptr;
    std::wstring rest;
    bool has_ended = false;

    /// A character that the block's end cuts in two is left for the next time.
    static std::size_t take(void* target, const char* bytes, std::size_t size, bool) {
        auto& own = *static_cast<wide_target*>(target);
        if (own.has_ended) return 0;
        const char* const end = bytes + size;
        own.at = write_wide(own.at, own.limit, bytes, end);
        if (own.limit - own.at < longest_pair)
            bytes = append_wide(own.rest, bytes, static_cast<std::size_t>(end - bytes));
        const auto left = static_cast<std::size_t>(end - bytes);
        own.has_ended = left >= longest_character;
        return own.has_ended ? 0 : left;
    }
};

} // namespace

text_buffer::~text_buffer() {
    for (const block& each : blocks_)
        std::free(each.begin);
}

void text_buffer::begin_block() {
    if (take_ != nullptr && !blocks_.empty()) return empty_block();
    note_use();
    const std::size_t grown = std::min(first_block << std::min<std::size_t>(blocks_.size(), 8), largest_block);
    const std::size_t capacity = take_ != nullptr ? block_size_ : grown;
    blocks_.reserve(blocks_.size() + 1);
    void* const place = allocate_for_filling(capacity);
    if (place == nullptr) throw std::bad_alloc();
    char* const begin = static_cast<char*>(place);
    blocks_.push_back({begin, 0});
    setp(begin, begin + capacity);
}

void text_buffer::empty_block() {
    const std::size_t left = take_(target_, pbase(), gathered(), false);
    std::memmove(pbase(), pptr() - left, left);
    setp(pbase(), epptr());
    advance_by(static_cast<std::ptrdiff_t>(left));
}

void text_buffer::advance_by(std::ptrdiff_t size) {
    // The put position of a stream buffer can't be moved by more in one step.
    constexpr int most = std::numeric_limits<int>::max();
    for (; size > most; size -= most)
        pbump(most);
    pbump(static_cast<int>(size));
}

void text_buffer::move_blocks_to(std::string& text) {
    note_use();
    std::size_t size = text.size();
    for (const block& each : blocks_)
        size += each.used;
    if (text.capacity() < size) {
        std::string roomy;
        roomy.reserve(size);
        expect_filling(roomy.data(), size);
        roomy.append(text);
        text.swap(roomy);
    }
    for (const block& each : std::exchange(blocks_, {})) {
        text.append(each.begin, each.used);
        std::free(each.begin);
    }
    setp(nullptr, nullptr);
}

text_buffer::int_type text_buffer::overflow(int_type c) {
    if (traits_type::eq_int_type(c, traits_type::eof())) return traits_type::not_eof(c);
    *room(1) = traits_type::to_char_type(c);
    advance_by(1);
    return c;
}

std::streamsize text_buffer::xsputn(const char* data, std::streamsize size) {
    for (std::streamsize left = size; left != 0;) {
        char* const at = room(1);
        const std::streamsize step = std::min<std::streamsize>(left, epptr() - at);
        std::memcpy(at, data, static_cast<std::size_t>(step));
        advance_by(step);
        data += step;
        left -= step;
    }
    return size;
}

file_stream::file_stream(const char* name)
    : std::ostream(nullptr)
    , file_(std::fopen(name, "w"))
    , buffer_(take, static_cast<void*>(this), block_to_file) {
    rdbuf(&buffer_);
    // Blocks come from the buffer above, so they needn't go through another.
    if (is_open()) std::setvbuf(file_, nullptr, _IONBF, 0);
}

file_stream::~file_stream() {
    if (is_open()) std::fclose(file_);
}

bool file_stream::close() {
    buffer_.finish();
    return std::fclose(std::exchange(file_, nullptr)) == 0 && took_all_ && good();
}

std::size_t file_stream::take(void* self, const char* text, std::size_t size, bool is_last) {
    auto& own = *static_cast<file_stream*>(self);
    const std::size_t left = is_last ? 0 : size % page;
    // What comes after a hole would be no document.
    if (own.took_all_) own.took_all_ = std::fwrite(text, 1, size - left, own.file_) == size - left;
    return left;
}

void gather(std::string& out, std::size_t expected, const stream_call& write) {
    std::string text;
    std::optional<text_stream> stream;
    bool is_wanted = false;
    const auto fill = [&](char* memory, std::size_t size) {
        stream.emplace(memory, size);
        is_wanted = write(*stream);
        return stream->buffer().size_in_memory();
    };
    if (expected == 0)
        fill(nullptr, 0);
    else
        fill_new(text, with_reserve(expected), fill);
    if (!is_wanted) return;
    stream->buffer().move_blocks_to(text);
    give_up_excess(text);
    out.swap(text);
}

void gather(std::wstring& out, std::size_t expected, const stream_call& write) {
    if (expected == 0) {
        std::string utf8;
        bool is_wanted = false;
        gather(utf8, 0, [&](std::ostream& stream) { return is_wanted = write(stream); });
        if (is_wanted) assign_wide(out, utf8.data(), utf8.size());
        return;
    }
    std::wstring text;
    wide_target wide;
    bool is_wanted = false;
    fill_new(text, with_reserve(expected), [&](wchar_t* memory, std::size_t size) {
        wide.at = memory;
        wide.limit = memory + size;
        text_stream stream(wide_target::take, static_cast<void*>(&wide), block_to_widen);
        is_wanted = write(stream);
        if (is_wanted) stream.buffer().finish();
        return static_cast<std::size_t>(wide.at - memory);
    });
    if (!is_wanted) return;
    text += wide.rest;
    give_up_excess(text);
    out.swap(text);
}

} // namespace hqf
