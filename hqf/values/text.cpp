#include "hqf/values/text.h"

#include "hqf/values/transcode.h"

namespace lmx {

std::wstring& vtostring(std::wstring& out, const std::string& in) {
    hqf::assign_wide(out, in.data(), in.size());
    return out;
}

std::string& vtostring(std::string& out, const std::string& in) {
    return out = in;
}

std::wstring& convert(std::wstring* out, const std::string& in) {
    return vtostring(*out, in);
}

std::string& convert(std::string* out, const std::wstring& in) {
    hqf::assign_utf8(*out, in.data(), in.size());
    return *out;
}

bool utf8_to_unicode_char(const char* in, int* out) {
    const auto lead = static_cast<unsigned char>(*in);
    int continuations = 0;
    if (lead < 0x80) {
        *out = lead;
        return true;
    }
    if ((lead & 0xE0) == 0xC0)
        continuations = 1, *out = lead & 0x1F;
    else if ((lead & 0xF0) == 0xE0)
        continuations = 2, *out = lead & 0x0F;
    else if ((lead & 0xF8) == 0xF0)
        continuations = 3, *out = lead & 0x07;
    else {
        *out = -1;
        return false;
    }
    for (int i = 1; i <= continuations; ++i) {
        const auto byte = static_cast<unsigned char>(in[i]);
        if ((byte & 0xC0) != 0x80) return false;
        *out = (*out << 6) | (byte & 0x3F);
    }
    return true;
}

char* unicode_char_to_utf8(int c, char* out) {
    char* end = out;
    if (c < 0x80)
        *end++ = static_cast<char>(c);
    else
        end = hqf::encode_utf8(static_cast<char32_t>(c), out);
    *end = '\0';
    return out;
}

bool is_valid_utf8_char_sequence(const char* in) {
    const auto first = static_cast<unsigned char>(in[0]);
    const auto second_is = [in](unsigned char low, unsigned char high) {
        const auto second = static_cast<unsigned char>(in[1]);
        return second >= low && second <= high;
    };
    if (first < 0x80) return true;
    if (first < 0xC2 || first > 0xF4) return false;
    switch (first) {
    case 0xE0: return second_is(0xA0, 0xBF);
    case 0xED: return second_is(0x80, 0x9F);
    case 0xF0: return second_is(0x90, 0xBF);
    case 0xF4: return second_is(0x80, 0x8F);
    default: return true;
    }
}

} // namespace lmx
