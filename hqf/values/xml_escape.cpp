#include "hqf/values/xml_escape.h"

#include <cstring>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

#include "hqf/values/transcode.h"

namespace hqf {

namespace {

struct entity {
    unsigned char size = 0; // 0 for a character that stands for itself
    char text[escaped_size] = {};
};

struct entity_table {
    entity of[128];

    constexpr entity_table()
        : of{} {
        set('"', "&quot;");
        set('\'', "&apos;");
        set('&', "&amp;");
        set('<', "&lt;");
    }

    constexpr void set(unsigned char c, const char* text) {
        while (text[of[c].size] != '\0') {
            of[c].text[of[c].size] = text[of[c].size];
            ++of[c].size;
        }
    }
};

constexpr entity_table entities;

/// The entity for an ASCII character; null for one that stands for itself, and for anything above ASCII.
const entity* entity_for(char32_t c) {
    return c < 128 && entities.of[c].size != 0 ? &entities.of[c] : nullptr;
}

/// Copies the whole fixed-size text, as one store; only `size` bytes of it count.
char* put(char* out, const entity& e) {
    std::memcpy(out, e.text, escaped_size);
    return out + e.size;
}

bool has_room(const char* out, const char* limit) {
    return static_cast<std::size_t>(limit - out) >= escaped_size;
}

template<class character>
void append(std::string& out, const character* data, std::size_t size) {
    char buffer[512];
    for (const character *next = data, *end = data + size; next != end;)
        out.append(buffer, write_xml_escaped(buffer, buffer + sizeof buffer, next, end));
}

#if defined(__SSE2__)

/// Eight elements as bytes, and whether each is ASCII that stands for itself.
struct eight_elements {
    __m128i bytes;
    bool are_plain;

    explicit eight_elements(const wchar_t* at) {
        static_assert(sizeof(wchar_t) == 4);
        const auto load = [](const wchar_t* from) { return _mm_loadu_si128(reinterpret_cast<const __m128i*>(from)); };
        const auto is = [this](char c) { return _mm_cmpeq_epi8(bytes, _mm_set1_epi8(c)); };
        // Packing keeps ASCII, and makes of everything else 0 or a byte above 127.
        const __m128i words = _mm_packs_epi32(load(at), load(at + 4));
        bytes = _mm_packus_epi16(words, words);
        const __m128i special =
            _mm_or_si128(_mm_or_si128(is('"'), is('\'')), _mm_or_si128(_mm_or_si128(is('&'), is('<')), is(0)));
        are_plain = _mm_movemask_epi8(_mm_or_si128(special, bytes)) == 0;
    }
    void put(char* out) const { _mm_storel_epi64(reinterpret_cast<__m128i*>(out), bytes); }
};

/// Copies eight elements at a time as long as all of them are ASCII that stands for itself.
char* copy_plain_runs(char* out, const char* limit, const wchar_t*& next, const wchar_t* end) {
    const wchar_t* const begin = next;
    for (; end - next >= 8; next += 8, out += 8) {
        const eight_elements eight(next);
        if (!eight.are_plain || limit - out < 8) return out;
        eight.put(out);
    }
    // The rest once more with elements before it, which are done.
    const auto rest = end - next;
    if (rest == 0 || next == begin || limit - out < rest) return out;
    const eight_elements last(end - 8);
    if (!last.are_plain) return out;
    last.put(out + rest - 8);
    next = end;
    return out + rest;
}

#else

char* copy_plain_runs(char* out, const char*, const wchar_t*&, const wchar_t*) {
    return out;
}

#endif

} // namespace

char* write_xml_escaped(char* out, const char* limit, const wchar_t*& next, const wchar_t* end) {
    out = copy_plain_runs(out, limit, next, end);
    while (next != end && has_room(out, limit)) {
        char32_t c = to_character(*next++);
        if (c < 0x80) {
            if (const entity* const e = entity_for(c))
                out = put(out, *e);
            else
                *out++ = static_cast<char>(c);
            continue;
        }
        if (is_high_surrogate(c)) {
            if (next == end || !is_low_surrogate(static_cast<char32_t>(*next))) {
                next = end;
                break;
            }
            c = join_surrogates(c, static_cast<char32_t>(*next++));
        }
        out = encode_utf8(c, out);
    }
    return out;
}

char* write_xml_escaped(char* out, const char* limit, const char*& next, const char* end) {
    while (next != end && has_room(out, limit)) {
        const char c = *next++;
        if (const entity* const e = entity_for(static_cast<unsigned char>(c)))
            out = put(out, *e);
        else
            *out++ = c;
    }
    return out;
}

void append_xml_escaped(std::string& out, const wchar_t* data, std::size_t size) {
    append(out, data, size);
}

void append_xml_escaped(std::string& out, const char* data, std::size_t size) {
    append(out, data, size);
}

} // namespace hqf
