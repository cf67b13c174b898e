/// Streams into memory of our own, for documents that become strings or files: the gathered output lies in their blocks
/// from the start, and nothing is copied while they grow.
#pragma once

#include <cstddef>
#include <cstdio>
#include <functional>
#include <ostream>
#include <streambuf>
#include <string>
#include <vector>

namespace hqf {

class text_buffer final : public std::streambuf {
public:
    /// Takes over what a full block holds, and gives how many bytes at its end it leaves for the next time. After the
    /// last time there is no next.
    using block_taker = std::size_t (*)(void* target, const char* text, std::size_t size, bool is_last);

    text_buffer() = default;
    /// Gathers in one block of that size, which `take` empties whenever it is full.
    text_buffer(block_taker take, void* target, std::size_t size)
        : take_(take)
        , target_(target)
        , block_size_(size) {}
    /// Gathers in memory of the caller's first, and in blocks what doesn't fit there.
    text_buffer(char* memory, std::size_t size) { setp(memory, memory + size); }
    text_buffer(const text_buffer&) = delete;
    text_buffer& operator=(const text_buffer&) = delete;
    ~text_buffer() override;

    /// How many bytes lie in the caller's memory.
    std::size_t size_in_memory() const { return blocks_.empty() ? gathered() : used_in_memory_; }
    /// Appends what the blocks hold, and empties them, each as soon as it is copied.
    ///
    /// \throws std::bad_alloc; `text` is as it was.
    void move_blocks_to(std::string& text);
    /// Hands the last text over to the taker.
    void finish() {
        if (gathered() != 0) take_(target_, pbase(), gathered(), true);
    }

    /// Where the next text may be written, with room for `size` bytes at least up to room_end(); at most 64 KB can be
    /// asked for.
    ///
    /// \throws std::bad_alloc
    char* room(std::size_t size) {
        if (static_cast<std::size_t>(epptr() - pptr()) < size) begin_block();
        return pptr();
    }
    char* room_end() const { return epptr(); }
    /// Takes over what was written there, up to `end`.
    void advance(const char* end) { advance_by(end - pptr()); }

protected:
    int_type overflow(int_type c) override;
    std::streamsize xsputn(const char* data, std::streamsize size) override;

private:
    struct block {
        char* begin;
        std::size_t used;
    };

    std::size_t gathered() const { return static_cast<std::size_t>(pptr() - pbase()); }
    void advance_by(std::ptrdiff_t size);
    void begin_block();
    void empty_block();
    void note_use() { (blocks_.empty() ? used_in_memory_ : blocks_.back().used) = gathered(); }

    const block_taker take_ = nullptr;
    void* const target_ = nullptr;
    const std::size_t block_size_ = 0;
    std::size_t used_in_memory_ = 0;
    /// The last is the one that the put area lies in; its use is noted when someone asks.
    std::vector<block> blocks_;
};

/// \param arguments those of the buffer's constructor
class text_stream final : public std::ostream {
public:
    template<class... arguments>
    explicit text_stream(arguments... values)
        : std::ostream(nullptr)
        , buffer_(values...) {
        rdbuf(&buffer_);
    }
    text_buffer& buffer() { return buffer_; }

private:
    text_buffer buffer_;
};

/// A stream into a file that is made, or truncated, by this; for documents that the library writes by itself. Whole
/// pages are given to the system: a page that comes in two parts costs it nearly twice as much.
class file_stream final : public std::ostream {
public:
    explicit file_stream(const char* name);
    file_stream(const file_stream&) = delete;
    file_stream& operator=(const file_stream&) = delete;
    ~file_stream() override;

    bool is_open() const { return file_ != nullptr; }
    /// Writes what is left and closes the file; false if the system didn't take all of the text.
    bool close();

private:
    static std::size_t take(void* self, const char* text, std::size_t size, bool is_last);

    std::FILE* file_;
    bool took_all_ = true;
    text_buffer buffer_;
};

using stream_call = std::function<bool(std::ostream& stream)>;

/// Gives `out` what `write` puts on a stream, if that returns true; otherwise `out` stays as it was.
///
/// \param expected about how many bytes that will be, 0 if nobody knows. Up to there the text is gathered in the new
/// string itself; only what goes beyond is copied once.
/// \throws std::bad_alloc, and what `write` throws
void gather(std::string& out, std::size_t expected, const stream_call& write);
/// The same as wide text. It ends where the bytes are no UTF-8.
void gather(std::wstring& out, std::size_t expected, const stream_call& write);

} // namespace hqf
