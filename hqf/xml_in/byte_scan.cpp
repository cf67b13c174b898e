#include "hqf/xml_in/byte_scan.h"

#include <bit>
#include <cstddef>
#include <cstring>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

namespace hqf {
namespace {

using byte = unsigned char;

bool is_plain_ascii(byte c) {
    return c >= 9 && c < 0x80 && (c <= 13 || c >= ' ');
}

#if defined(__SSE2__)

__m128i load(const char* at) {
    return _mm_loadu_si128(reinterpret_cast<const __m128i*>(at));
}

// All bits of each of 16 bytes that is no plain ASCII.
__m128i not_plain(const char* at) {
    const __m128i bytes = load(at);
    // As signed numbers the bytes above ASCII are below the controls, so that one comparison finds both.
    const __m128i low = _mm_cmplt_epi8(bytes, _mm_set1_epi8(' '));
    const __m128i from_tab = _mm_sub_epi8(bytes, _mm_set1_epi8(9));
    const __m128i space = _mm_cmpeq_epi8(_mm_min_epu8(from_tab, _mm_set1_epi8(4)), from_tab);
    return _mm_andnot_si128(space, low);
}

unsigned mask_of(__m128i bytes) {
    return static_cast<unsigned>(_mm_movemask_epi8(bytes));
}

// The line feeds in the whole 64-byte blocks of a run, and whether there is a CR; `from` moves behind the blocks.
long long count_line_feeds_in_blocks(const char*& from, const char* stop, bool& has_returns) {
    __m128i returns = _mm_setzero_si128();
    const auto at_line_feeds = [&returns](const char* at) {
        const __m128i bytes = load(at);
        returns = _mm_or_si128(returns, _mm_cmpeq_epi8(bytes, _mm_set1_epi8('\r')));
        return _mm_cmpeq_epi8(bytes, _mm_set1_epi8('\n'));
    };
    long long count = 0;
    while (stop - from >= 64) {
        // Each byte of the sum counts one column; 255 rows are as many as it can hold, and a block has four.
        __m128i columns = _mm_setzero_si128();
        for (int block = 0; block < 63 && stop - from >= 64; ++block, from += 64) {
            const __m128i first = _mm_add_epi8(at_line_feeds(from), at_line_feeds(from + 16));
            const __m128i second = _mm_add_epi8(at_line_feeds(from + 32), at_line_feeds(from + 48));
            columns = _mm_sub_epi8(columns, _mm_add_epi8(first, second));
        }
        const __m128i sums = _mm_sad_epu8(columns, _mm_setzero_si128());
        count += _mm_cvtsi128_si64(sums) + _mm_cvtsi128_si64(_mm_srli_si128(sums, 8));
    }
    has_returns = mask_of(returns) != 0;
    return count;
}

#endif

const char* skip_plain_ascii(const char* at, const char* stop) {
#if defined(__SSE2__)
    for (; stop - at >= 64; at += 64) {
        const __m128i first = _mm_or_si128(not_plain(at), not_plain(at + 16));
        const __m128i second = _mm_or_si128(not_plain(at + 32), not_plain(at + 48));
        if (mask_of(_mm_or_si128(first, second)) != 0) break;
    }
    for (; stop - at >= 16; at += 16)
        if (const unsigned mask = mask_of(not_plain(at))) return at + std::countr_zero(mask);
#endif
    while (at < stop && is_plain_ascii(static_cast<byte>(*at)))
        ++at;
    return at;
}

// The length of the character that starts with a byte above ASCII; 0 when it is none, or a line end.
std::size_t plain_sequence_length(const char* at) {
    const auto b = [at](std::size_t i) { return static_cast<byte>(at[i]); };
    const auto continues = [&b](std::size_t i) { return (b(i) & 0xC0) == 0x80; };
    const byte lead = b(0);
    if (lead < 0xC2 || lead > 0xF4 || !continues(1)) return 0;
    if (lead < 0xE0) return lead == 0xC2 && b(1) == 0x85 ? 0 : 2;
    if (!continues(2)) return 0;
    if (lead < 0xF0) {
        const bool is_overlong = lead == 0xE0 && b(1) < 0xA0;
        const bool is_surrogate = lead == 0xED && b(1) > 0x9F;
        const bool is_line_separator = lead == 0xE2 && b(1) == 0x80 && b(2) == 0xA8;
        return is_overlong || is_surrogate || is_line_separator ? 0 : 3;
    }
    const bool is_out_of_range = (lead == 0xF0 && b(1) < 0x90) || (lead == 0xF4 && b(1) > 0x8F);
    return is_out_of_range || !continues(3) ? 0 : 4;
}

} // namespace

const char* find_not_plain(const char* from, const char* stop) {
    for (const char* at = from;;) {
        at = skip_plain_ascii(at, stop);
        if (at >= stop || static_cast<byte>(*at) < 0x80) return at;
        while (at < stop && static_cast<byte>(*at) >= 0x80) {
            const std::size_t length = plain_sequence_length(at);
            if (length == 0) return at;
            at += length;
        }
        if (at >= stop) return at;
    }
}

long long count_line_ends(const char* from, const char* stop, unsigned char before) {
    long long count = 0;
    if (from == stop) return count;
    const char* rest = from;
    bool has_returns = false;
#if defined(__SSE2__)
    count = count_line_feeds_in_blocks(rest, stop, has_returns);
#endif
    for (; rest != stop; ++rest) {
        count += *rest == '\n' ? 1 : 0;
        has_returns = has_returns || *rest == '\r';
    }
    if (before == '\r' && *from == '\n') --count;
    // Few documents have a CR at all, so its cost is paid only where there is one.
    if (!has_returns) return count;
    const auto* at = static_cast<const char*>(std::memchr(from, '\r', static_cast<std::size_t>(stop - from)));
    for (; at != nullptr && at != stop; ++at)
        if (*at == '\r' && !(at + 1 != stop && at[1] == '\n')) ++count;
    return count;
}

} // namespace hqf
