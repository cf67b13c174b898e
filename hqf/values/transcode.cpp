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

wchar_t* decode(const char* in, const char* end, wchar_t* out) {
    char32_t pending = 0;
    while (in < end) {
        char32_t value = 0;
        const std::size_t length = decode_sequence(in, end, value);
        if (length == 0) break;
        in += length;
        if (pending != 0) {
            if (!is_low_surrogate(value)) break;
            *out++ = static_cast<wchar_t>(pending);
            *out++ = static_cast<wchar_t>(value);
            pending = 0;
        } else if (is_high_surrogate(value)) {
            pending = value;
        } else if (value > 0xFFFF) {
            value -= 0x10000;
            *out++ = static_cast<wchar_t>(0xD800 + ((value >> 10) & 0x3FF));
            *out++ = static_cast<wchar_t>(0xDC00 + (value & 0x3FF));
        } else {
            *out++ = static_cast<wchar_t>(value);
        }
    }
    return out;
}

/// As many bytes as these elements give, or a few more.
std::size_t utf8_bound(const wchar_t* data, std::size_t size) {
    std::size_t bound = size;
    for (std::size_t i = 0; i < size; ++i) {
        const auto c = static_cast<char32_t>(data[i]);
        bound += static_cast<std::size_t>(c >= 0x80) + static_cast<std::size_t>(c >= 0x800) +
                 static_cast<std::size_t>(c >= 0x10000);
    }
    return bound;
}

char* encode(const wchar_t* in, const wchar_t* end, char* out) {
    while (in < end) {
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

void widen(const char* data, std::size_t size, wchar_t* to) {
    for (std::size_t i = 0; i < size; ++i)
        to[i] = static_cast<wchar_t>(data[i]);
}

void append_ascii(std::wstring& out, const char* data, std::size_t size) {
    constexpr std::size_t step = 1024;
    const std::size_t before = out.size();
    if (size <= step) {
        out.resize(before + size);
        return widen(data, size, out.data() + before);
    }
    // By way of a piece that stays in the cache: resize() would have all of a long text written twice.
    out.reserve(before + size);
    expect_filling(out.data() + before, size * sizeof(wchar_t));
    wchar_t piece[step];
    for (std::size_t done = 0; done < size; done += step) {
        const std::size_t count = std::min(step, size - done);
        widen(data + done, count, piece);
        out.append(piece, count);
    }
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
    const std::size_t run = ascii_run(data, size);
    append_ascii(out, data, run);
    if (run == size) return;
    const std::size_t before = out.size();
    out.resize(before + wide_bound(data + run, size - run));
    const wchar_t* const end = decode(data + run, data + size, out.data() + before);
    out.resize(static_cast<std::size_t>(end - out.data()));
}

void append_utf8(std::string& out, const wchar_t* data, std::size_t size) {
    const std::size_t bound = utf8_bound(data, size);
    const std::size_t before = out.size();
    out.resize(before + bound);
    char* const to = out.data() + before;
    if (bound == size) {
        for (std::size_t i = 0; i < size; ++i)
            to[i] = static_cast<char>(data[i]);
        return;
    }
    const char* const end = encode(data, data + size, to);
    out.resize(static_cast<std::size_t>(end - out.data()));
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
