/// A stream into memory of our own, for documents that become strings: what it holds grows without being copied where
/// the platform can help it, and the gathered output lies in it from the start.
#pragma once

#include <cstddef>
#include <ostream>
#include <streambuf>
#include <string_view>

namespace hqf {

class text_buffer final : public std::streambuf {
public:
    text_buffer() = default;
    text_buffer(const text_buffer&) = delete;
    text_buffer& operator=(const text_buffer&) = delete;
    ~text_buffer() override;

    std::string_view text() const { return {pbase(), static_cast<std::size_t>(pptr() - pbase())}; }

    /// Where the next text may be written, with room for `size` bytes at least up to room_end().
    ///
    /// \throws std::bad_alloc
    char* room(std::size_t size) {
        if (static_cast<std::size_t>(epptr() - pptr()) < size) grow(size);
        return pptr();
    }
    char* room_end() const { return epptr(); }
    /// Takes over what was written there, up to `end`.
    void advance(const char* end) { move_to(static_cast<std::size_t>(end - pbase())); }

protected:
    int_type overflow(int_type c) override;
    std::streamsize xsputn(const char* data, std::streamsize size) override;

private:
    void grow(std::size_t size);
    /// Sets the put position; pbump() takes an int, which is too small.
    void move_to(std::size_t position);
};

class text_stream final : public std::ostream {
public:
    text_stream()
        : std::ostream(nullptr) {
        rdbuf(&buffer_);
    }
    std::string_view text() const { return buffer_.text(); }

private:
    text_buffer buffer_;
};

} // namespace hqf
