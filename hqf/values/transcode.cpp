#include "hqf/values/transcode.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "hqf/platform/pages.h"

namespace hqf {

namespace {

constexpr bool is_continuation(unsigned char byte) {
    return (byte & 0xC0) == 0x80;
}

/// Length of the ASCII run that the text starts with.
std::size_t ascii_run(const char* data, std::size_t size) {
    constexpr std::uint64_t high_bits = 0x8080808080808080;
    std::size_t run = 0;
    for (std::uint64_t word = 0; run + sizeof word <= size; run += sizeof word) {
        std::memcpy(&word, data + run, sizeof word);
        if ((word & high_bits) != 0) break;
    }
    while (run < size && static_cast<unsigned char>(data[run]) < 0x80)
        ++run;
    return run;
}

/// More elements than these bytes can give: each comes from a sequence of its own, but for the pair that four bytes
/// give.
std::size_t wide_bound(const char* data, std::size_t size) {
    std::size_t bound = 0;
    for (std::size_t i = 0; i < size; ++i) {
        const auto byte = static_cast<unsigned char>(data[i]);
        bound += static_cast<std::size_t>(!is_continuation(byte)) + static_cast<std::size_t>(byte >= 0xF0);
    }
    return bound;
}

/// Decodes the character at `in` and moves both; false where none can be decoded. A high surrogate is one only with its
/// other half behind it.
bool decode_one(const char*& in, const char* end, wchar_t*& out) {
    char32_t value = 0;
    const std::size_t length = decode_sequence(in, end, value);
    if (length == 0) return false;
    in += length;
    if (is_high_surrogate(value)) {
        char32_t low = 0;
        const std::size_t low_length = in < end ? decode_sequence(in, end, low) : 0;
        if (low_length == 0 || !is_low_surrogate(low)) return false;
        in += low_length;
        *out++ = static_cast<wchar_t>(value);
        value = low;
    } else if (value > 0xFFFF) {
        value -= 0x10000;
        *out++ = static_cast<wchar_t>(0xD800 + ((value >> 10) & 0x3FF));
        value = 0xDC00 + (value & 0x3FF);
    }
    *out++ = static_cast<wchar_t>(value);
    return true;
}

bool is_ascii(const wchar_t* data, const wchar_t* end) {
    std::uint32_t all = 0;
    for (; data != end; ++data)
        all |= static_cast<std::uint32_t>(*data);
    return all < 0x80;
}

/// Encodes up to `stop`, and what is needed behind it for the last character.
char* encode(const wchar_t*& in, const wchar_t* stop, const wchar_t* end, char* out) {
    while (in < stop) {
        char32_t c = to_character(*in++);
        if (is_high_surrogate(c)) {
            if (in < end && is_low_surrogate(static_cast<char32_t>(*in)))
                c = join_surrogates(c, static_cast<char32_t>(*in));
            if (in < end) ++in;
        }
        out = encode_utf8(c, out);
    }
    return out;
}

/// Long texts go by way of a piece that stays in the cache: growing by resize() would have them written twice.
constexpr std::ptrdiff_t piece_size = 1024;

void append_ascii(std::wstring& out, const char* data, std::size_t size) {
    wchar_t piece[piece_size];
    for (std::size_t count = 0; size != 0; data += count, size -= count) {
        count = std::min<std::size_t>(size, piece_size);
        for (std::size_t i = 0; i < count; ++i)
            piece[i] = static_cast<wchar_t>(data[i]);
        out.append(piece, count);
    }
}

/// Room in one step for a long text that is about to come.
template<class text_type>
void make_room(text_type& text, std::size_t size) {
    if (text.capacity() - text.size() >= size) return;
    text.reserve(text.size() + size);
    expect_filling(text.data() + text.size(), size * sizeof(text[0]));
}

} // namespace

std::size_t decode_sequence(const char* in, const char* end, char32_t& value) {
    const auto lead = static_cast<unsigned char>(*in);
    std::size_t length = 1;
    if (lead < 0x80)
        value = lead;
    else if ((lead & 0xE0) == 0xC0)
        length = 2, value = lead & 0x1F;
    else if ((lead & 0xF0) == 0xE0)
        length = 3, value = lead & 0x0F;
    else if ((lead & 0xF8) == 0xF0)
        length = 4, value = lead & 0x07;
    else
        return 0;
    if (static_cast<std::size_t>(end - in) < length) return 0;
    for (std::size_t i = 1; i < length; ++i) {
        const auto byte = static_cast<unsigned char>(in[i]);
        if (!is_continuation(byte)) return 0;
        value = (value << 6) | (byte & 0x3F);
    }
    return length;
}

void append_wide(std::wstring& out, const char* data, std::size_t size) {
    const char* const end = data + size;
    std::size_t run = ascii_run(data, size);
    if (size > std::size_t{piece_size}) make_room(out, run + wide_bound(data + run, size - run));
    for (;;) {
        append_ascii(out, data, run);
        data += run;
        if (data == end) return;
        wchar_t piece[piece_size];
        wchar_t* to = piece;
        bool good = true;
        while (good && data != end && static_cast<unsigned char>(*data) >= 0x80 && to - piece < piece_size - 1)
            good = decode_one(data, end, to);
        out.append(piece, static_cast<std::size_t>(to - piece));
        if (!good) return;
        run = ascii_run(data, static_cast<std::size_t>(end - data));
    }
}

void append_utf8(std::string& out, const wchar_t* data, std::size_t size) {
    constexpr std::ptrdiff_t longest = 4; // of a character's bytes
    const wchar_t* const end = data + size;
    if (size > std::size_t{piece_size}) make_room(out, size);
    while (data != end) {
        char piece[longest * piece_size];
        char* to = piece;
        const wchar_t* const stop = data + std::min(end - data, piece_size);
        if (is_ascii(data, stop))
            for (; data != stop; ++data)
                *to++ = static_cast<char>(*data);
        else
            to = encode(data, stop, end, piece);
        out.append(piece, static_cast<std::size_t>(to - piece));
    }
}

char* encode_utf8(char32_t c, char* out) {
    const auto put = [&out](char32_t byte) { *out++ = static_cast<char>(static_cast<unsigned char>(byte)); };
    if (c < 0x80) {
        put(c);
    } else if (c < 0x800) {
        put(0xC0 | (c >> 6));
        put(0x80 | (c & 0x3F));
    } else if (c < 0x10000) {
        put(0xE0 | (c >> 12));
        put(0x80 | ((c >> 6) & 0x3F));
        put(0x80 | (c & 0x3F));
    } else {
        put(0xF0 | (c >> 18));
        put(0x80 | ((c >> 12) & 0x3F));
        put(0x80 | ((c >> 6) & 0x3F));
        put(0x80 | (c & 0x3F));
    }
    return out;
}

} // namespace hqf
