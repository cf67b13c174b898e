#include "hqf/xml_out/text_stream.h"

#include <algorithm>
#include <climits>
#include <cstdlib>
#include <cstring>
#include <new>

namespace hqf {

text_buffer::~text_buffer() {
    std::free(pbase());
}

void text_buffer::move_to(std::size_t position) {
    setp(pbase(), epptr());
    for (; position > INT_MAX; position -= INT_MAX)
        pbump(INT_MAX);
    pbump(static_cast<int>(position));
}

void text_buffer::grow(std::size_t size) {
    constexpr std::size_t least = 64 * 1024;
    const std::size_t used = text().size();
    const std::size_t capacity = std::max({least, 2 * used, used + size});
    // A large block is moved by its pages, not by its bytes.
    void* const block = std::realloc(pbase(), capacity);
    if (block == nullptr) throw std::bad_alloc();
    char* const start = static_cast<char*>(block);
    setp(start, start + capacity);
    move_to(used);
}

text_buffer::int_type text_buffer::overflow(int_type c) {
    if (traits_type::eq_int_type(c, traits_type::eof())) return traits_type::not_eof(c);
    *room(1) = traits_type::to_char_type(c);
    pbump(1);
    return c;
}

std::streamsize text_buffer::xsputn(const char* data, std::streamsize size) {
    char* const at = room(static_cast<std::size_t>(size));
    std::memcpy(at, data, static_cast<std::size_t>(size));
    advance(at + size);
    return size;
}

} // namespace hqf
