#include "hqf/values/xml_escape.h"

#include <cstring>

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

} // namespace

char* write_xml_escaped(char* out, const char* limit, const wchar_t*& next, const wchar_t* end) {
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
