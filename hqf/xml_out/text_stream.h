/// A stream into memory of our own, for documents that become strings: a chain of blocks, so that nothing is copied
/// while it grows, and the gathered output lies in it from the start.
#pragma once

#include <cstddef>
#include <ostream>
#include <streambuf>
#include <string>
#include <vector>

namespace hqf {

class text_buffer final : public std::streambuf {
public:
    text_buffer() = default;
    text_buffer(const text_buffer&) = delete;
    text_buffer& operator=(const text_buffer&) = delete;
    ~text_buffer() override;

    /// Replaces `text` by what was written, and empties the buffer, each block as soon as it is copied.
    ///
    /// \throws std::bad_alloc; `text` is as it was.
    void move_to(std::string& text);

    /// Where the next text may be written, with room for `size` bytes at least up to room_end().
    ///
    /// \throws std::bad_alloc
    char* room(std::size_t size) {
        if (static_cast<std::size_t>(epptr() - pptr()) < size) begin_block(size);
        return pptr();
    }
    char* room_end() const { return epptr(); }
    /// Takes over what was written there, up to `end`.
    void advance(const char* end) { pbump(static_cast<int>(end - pptr())); }

protected:
    int_type overflow(int_type c) override;
    std::streamsize xsputn(const char* data, std::streamsize size) override;

private:
    struct block {
        char* begin;
        std::size_t used;
    };

    void begin_block(std::size_t size);
    void note_use() {
        if (!blocks_.empty()) blocks_.back().used = static_cast<std::size_t>(pptr() - pbase());
    }

    /// The last is the one that the put area lies in; its use is noted when someone asks.
    std::vector<block> blocks_;
};

class text_stream final : public std::ostream {
public:
    text_stream()
        : std::ostream(nullptr) {
        rdbuf(&buffer_);
    }
    void move_to(std::string& text) { buffer_.move_to(text); }

private:
    text_buffer buffer_;
};

} // namespace hqf
