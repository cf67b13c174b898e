#pragma once

/// Scans over runs of bytes, sixteen at a time where the machine can.

#include <bit>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

namespace hqf {

/// Where the first byte stands that is no plain text: not well-formed UTF-8 (Unicode Standard, table 3-7), U+0085,
/// U+2028, or a control character other than 9 to 13.
///
/// \returns `stop`, or up to three bytes behind it when a character crosses it. Precondition: four bytes can be read
/// behind `stop`.
const char* find_not_plain(const char* from, const char* stop);

/// Where the first `wanted`, '&' or CR stands, or `stop`. Precondition: sixteen bytes can be read behind `stop`.
inline const char* find_text_end(const char* from, const char* stop, char wanted) {
    const char* at = from;
#if defined(__SSE2__)
    for (; at < stop; at += 16) {
        const __m128i bytes = _mm_loadu_si128(reinterpret_cast<const __m128i*>(at));
        const __m128i special =
            _mm_or_si128(_mm_cmpeq_epi8(bytes, _mm_set1_epi8('&')), _mm_cmpeq_epi8(bytes, _mm_set1_epi8('\r')));
        const auto found = static_cast<unsigned>(
            _mm_movemask_epi8(_mm_or_si128(_mm_cmpeq_epi8(bytes, _mm_set1_epi8(wanted)), special)));
        if (found != 0) {
            at += std::countr_zero(found);
            break;
        }
    }
    return at < stop ? at : stop;
#else
    while (at < stop && *at != wanted && *at != '&' && *at != '\r')
        ++at;
    return at;
#endif
}

/// Where the first byte above a blank stands, or `stop`. Precondition: sixteen bytes can be read behind `stop`.
inline const char* skip_space(const char* from, const char* stop) {
    const char* at = from;
#if defined(__SSE2__)
    for (; at < stop; at += 16) {
        const __m128i bytes = _mm_loadu_si128(reinterpret_cast<const __m128i*>(at));
        // Bytes above ASCII are negative as signed numbers: no space either.
        const auto above =
            static_cast<unsigned>(_mm_movemask_epi8(_mm_or_si128(_mm_cmpgt_epi8(bytes, _mm_set1_epi8(' ')), bytes)));
        if (above != 0) {
            at += std::countr_zero(above);
            break;
        }
    }
    return at < stop ? at : stop;
#else
    while (at < stop && static_cast<unsigned char>(*at) <= ' ')
        ++at;
    return at;
#endif
}

/// The same for up to 15 bytes of white space, of sixteen that can be read; null if there is more.
inline const char* skip_short_space(const char* at) {
#if defined(__SSE2__)
    const __m128i bytes = _mm_loadu_si128(reinterpret_cast<const __m128i*>(at));
    const auto above =
        static_cast<unsigned>(_mm_movemask_epi8(_mm_or_si128(_mm_cmpgt_epi8(bytes, _mm_set1_epi8(' ')), bytes)));
    return above != 0 ? at + static_cast<unsigned>(std::countr_zero(above)) : nullptr;
#else
    static_cast<void>(at);
    return nullptr;
#endif
}

/// How many lines end in a run: LF, CR, and CR LF once. `before` is the byte in front of it.
long long count_line_ends(const char* from, const char* stop, unsigned char before);

} // namespace hqf
