#include "hqf/values/transcode.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

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
    std::size_t length = decode_sequence(in, end, value);
    if (length == 0) return false;
    const char* const behind = in + length;
    if (is_high_surrogate(value)) {
        char32_t low = 0;
        const std::size_t low_length = behind < end ? decode_sequence(behind, end, low) : 0;
        if (low_length == 0 || !is_low_surrogate(low)) return false;
        length += low_length;
        *out++ = static_cast<wchar_t>(value);
        value = low;
    } else if (value > 0xFFFF) {
        value -= 0x10000;
        *out++ = static_cast<wchar_t>(0xD800 + ((value >> 10) & 0x3FF));
        value = 0xDC00 + (value & 0x3FF);
    }
    *out++ = static_cast<wchar_t>(value);
    in += length;
    return true;
}

/// Copies ASCII, sixteen elements at a time as long as all of them are.
char* copy_ascii_runs(char* out, const char* limit, const wchar_t*& next, const wchar_t* end) {
#if defined(__SSE2__)
    static_assert(sizeof(wchar_t) == 4);
    const wchar_t* at = next;
    for (; end - at >= 16 && limit - out >= 16; at += 16, out += 16) {
        const auto load = [at](int i) { return _mm_loadu_si128(reinterpret_cast<const __m128i*>(at + i)); };
        // Packing keeps ASCII, and makes of everything else 0 or something above 127; 0 is left to the careful way.
        const __m128i bytes = _mm_packus_epi16(_mm_packs_epi32(load(0), load(4)), _mm_packs_epi32(load(8), load(12)));
        if (_mm_movemask_epi8(_mm_or_si128(bytes, _mm_cmpeq_epi8(bytes, _mm_setzero_si128()))) != 0) break;
        _mm_storeu_si128(reinterpret_cast<__m128i*>(out), bytes);
    }
    next = at;
#else
    static_cast<void>(limit);
    static_cast<void>(next);
    static_cast<void>(end);
#endif
    return out;
}

/// Texts go by way of a piece that stays in the cache: a string that grows by resize() is written twice, and one that
/// grows run by run is moved again and again.
constexpr std::ptrdiff_t piece_size = 1024;

/// Copies ASCII, 32 bytes at a time and then eight, as long as all of them are and there is room.
void widen_ascii_runs(const char*& in, const char* end, wchar_t*& out, const wchar_t* limit) {
#if defined(__SSE2__)
    static_assert(sizeof(wchar_t) == 4);
    const __m128i zero = _mm_setzero_si128();
    const auto widen_eight = [zero](const char* from, wchar_t* to) {
        const __m128i bytes = _mm_loadl_epi64(reinterpret_cast<const __m128i*>(from));
        if (_mm_movemask_epi8(bytes) != 0) return false;
        const __m128i words = _mm_unpacklo_epi8(bytes, zero);
        _mm_storeu_si128(reinterpret_cast<__m128i*>(to), _mm_unpacklo_epi16(words, zero));
        _mm_storeu_si128(reinterpret_cast<__m128i*>(to + 4), _mm_unpackhi_epi16(words, zero));
        return true;
    };
    const auto widen_sixteen = [zero](__m128i bytes, wchar_t* to) {
        const auto store = [to](int i, __m128i four) { _mm_storeu_si128(reinterpret_cast<__m128i*>(to + i), four); };
        const __m128i low = _mm_unpacklo_epi8(bytes, zero), high = _mm_unpackhi_epi8(bytes, zero);
        store(0, _mm_unpacklo_epi16(low, zero));
        store(4, _mm_unpackhi_epi16(low, zero));
        store(8, _mm_unpacklo_epi16(high, zero));
        store(12, _mm_unpackhi_epi16(high, zero));
    };
    const char* from = in;
    wchar_t* to = out;
    const char* const last = from + std::min(end - from, limit - to);
    for (; last - from >= 32; from += 32, to += 32) {
        const __m128i first = _mm_loadu_si128(reinterpret_cast<const __m128i*>(from));
        const __m128i second = _mm_loadu_si128(reinterpret_cast<const __m128i*>(from + 16));
        if (_mm_movemask_epi8(_mm_or_si128(first, second)) != 0) break;
        widen_sixteen(first, to);
        widen_sixteen(second, to + 16);
    }
    for (; last - from >= 8; from += 8, to += 8)
        if (!widen_eight(from, to)) break;
    // The last few once more with bytes before them, which are done.
    const std::ptrdiff_t rest = end - from;
    if (rest > 0 && rest < 8 && from != in && limit - to >= rest && widen_eight(end - 8, to - (8 - rest))) {
        from = end;
        to += rest;
    }
    in = from;
    out = to;
#else
    static_cast<void>(in);
    static_cast<void>(end);
    static_cast<void>(out);
    static_cast<void>(limit);
#endif
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

wchar_t* write_wide(wchar_t* out, const wchar_t* limit, const char*& next, const char* end) {
    constexpr std::ptrdiff_t careful_run = 8;
    for (bool good = true; good && next != end && limit - out >= longest_pair;) {
        widen_ascii_runs(next, end, out, limit);
        const char* const stop = next + std::min(careful_run, end - next);
        while (good && next < stop && limit - out >= longest_pair) {
            const auto byte = static_cast<unsigned char>(*next);
            if (byte < 0x80) {
                *out++ = static_cast<wchar_t>(byte);
                ++next;
            } else {
                good = decode_one(next, end, out);
            }
        }
    }
    return out;
}

const char* append_wide(std::wstring& out, const char* data, std::size_t size) {
    const char* const end = data + size;
    if (size > std::size_t{piece_size}) {
        const std::size_t run = ascii_run(data, size);
        make_room(out, run + wide_bound(data + run, size - run));
    }
    while (data != end) {
        wchar_t piece[piece_size];
        const wchar_t* const filled = write_wide(piece, piece + piece_size, data, end);
        out.append(piece, static_cast<std::size_t>(filled - piece));
        if (piece + piece_size - filled >= longest_pair) return data;
    }
    return data;
}

char* write_utf8(char* out, const char* limit, const wchar_t*& next, const wchar_t* end) {
    constexpr std::ptrdiff_t longest_sequence = 4, careful_run = 16;
    while (next != end && limit - out >= longest_sequence) {
        out = copy_ascii_runs(out, limit, next, end);
        const wchar_t* const stop = next + std::min(careful_run, end - next);
        while (next < stop && limit - out >= longest_sequence) {
            char32_t c = to_character(*next++);
            if (is_high_surrogate(c) && next != end) {
                if (is_low_surrogate(static_cast<char32_t>(*next)))
                    c = join_surrogates(c, static_cast<char32_t>(*next));
                ++next;
            }
            out = encode_utf8(c, out);
        }
    }
    return out;
}

void append_utf8(std::string& out, const wchar_t* data, std::size_t size) {
    const wchar_t* const end = data + size;
    if (size > std::size_t{piece_size}) make_room(out, size);
    while (data != end) {
        char piece[4 * piece_size];
        const char* const filled = write_utf8(piece, piece + sizeof piece, data, end);
        out.append(piece, static_cast<std::size_t>(filled - piece));
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
