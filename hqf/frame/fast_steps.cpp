#include "hqf/frame/fast_steps.h"

#include <bit>
#include <iterator>
#include <string_view>

#include "hqf/frame/checks.h"
#include "hqf/frame/read_value.h"
#include "hqf/values/datetime_text.h"
#include "hqf/values/lexical_spans.h"
#include "hqf/values/to_number.h"
#include "hqf/values/transcode.h"

namespace hqf::frame {

namespace {

const char* take_text(window& in, const char* at, char stop, parsed_value& value) {
    const char* const end = in.find(at, stop);
    value.begin = at;
    value.size = static_cast<std::size_t>(end - at);
    return end;
}

/// The entities that a text of our own writer refers to (XML 1.0, 4.6).
constexpr struct {
    std::string_view reference;
    char character;
} predefined[] = {{"&amp;", '&'}, {"&apos;", '\''}, {"&quot;", '"'}, {"&lt;", '<'}, {"&gt;", '>'}};

/// The character that a reference at `text` stands for, and the reference's length; 0 for any other.
char predefined_character(const char* text, std::size_t& length) {
    for (const auto& entity : predefined) {
        length = entity.reference.size();
        if (std::memcmp(text, entity.reference.data(), length) == 0) return entity.character;
    }
    return 0;
}

/// Text with references to predefined entities up to `stop`.
const char* take_text_with_references(window& in, const char* at, char stop, parsed_value& value) {
    const char* end = at;
    for (const char* run = at; (end = in.find(run, stop)) == nullptr;) {
        // Text before the reference, then the reference itself.
        const char* const reference = in.find(run, '&');
        std::size_t length = 0;
        if (reference == nullptr || !in.room(reference, longest_name_room) ||
            predefined_character(reference, length) == 0 ||
            std::memchr(run, stop, static_cast<std::size_t>(reference - run)) != nullptr)
            return nullptr;
        run = reference + length;
    }
    value.begin = at;
    value.size = static_cast<std::size_t>(end - at);
    value.has_references = true;
    return end;
}

/// Assigns a text of up to 64 characters, behind which 16 bytes can be read; false, with nothing done, if not all of
/// them are ASCII. Most texts are names of a few words.
bool assign_short(std::wstring& out, const char* text, std::size_t size) {
#if defined(__SSE2__)
    static_assert(sizeof(wchar_t) == 4);
    wchar_t wide[64];
    if (size > std::size(wide)) return false;
    const __m128i zero = _mm_setzero_si128();
    for (std::size_t done = 0; done < size; done += 16) {
        const __m128i bytes = _mm_loadu_si128(reinterpret_cast<const __m128i*>(text + done));
        const auto above = static_cast<unsigned int>(_mm_movemask_epi8(bytes));
        if (above != 0 && done + static_cast<unsigned int>(std::countr_zero(above)) < size) return false;
        auto* const to = reinterpret_cast<__m128i*>(wide + done);
        const __m128i low = _mm_unpacklo_epi8(bytes, zero), high = _mm_unpackhi_epi8(bytes, zero);
        _mm_storeu_si128(to, _mm_unpacklo_epi16(low, zero));
        _mm_storeu_si128(to + 1, _mm_unpackhi_epi16(low, zero));
        _mm_storeu_si128(to + 2, _mm_unpacklo_epi16(high, zero));
        _mm_storeu_si128(to + 3, _mm_unpackhi_epi16(high, zero));
    }
    out.assign(wide, size);
    return true;
#else
    static_cast<void>(out);
    static_cast<void>(text);
    static_cast<void>(size);
    return false;
#endif
}

void assign_text(std::wstring& out, const parsed_value& value) {
    if (!value.has_references && assign_short(out, value.begin, value.size)) return;
    out.clear();
    const char* at = value.begin;
    while (value.has_references) {
        const auto* reference =
            static_cast<const char*>(std::memchr(at, '&', static_cast<std::size_t>(value.end() - at)));
        if (reference == nullptr) break;
        append_wide(out, at, static_cast<std::size_t>(reference - at));
        std::size_t length = 0;
        out += static_cast<wchar_t>(predefined_character(reference, length));
        at = reference + length;
    }
    append_wide(out, at, static_cast<std::size_t>(value.end() - at));
}

const char* parse_whole(window& in, const char* at, const facets* rules, char stop, parsed_value& value) {
    const char* const end = take_text(in, at, stop, value);
    if (end == nullptr || !read_short_integer(at, end, value.whole)) return nullptr;
    // Every integer type has bounds within 32 bits, so a double compares them exactly.
    const auto number = static_cast<double>(value.whole);
    return rules != nullptr && check_range(number, *rules, true) == lmx::err_no_error ? end : nullptr;
}

/// Text that collapsing would change is left to the general road.
bool is_collapsed(const parsed_value& value) {
    char before = ' ';
    for (const char* p = value.begin; p != value.end(); ++p) {
        if ((*p >= 9 && *p <= 13) || (*p == ' ' && before == ' ')) return false;
        before = *p;
    }
    return value.size == 0 || before != ' ';
}

bool fulfils(parsed_value& value, const facets& rules) {
    if (rules.texts != nullptr) {
        value.literal = rules.texts->number_of(value.begin, value.size);
        return value.literal != 0;
    }
    if (rules.whitespace == lmx::collapse && !is_collapsed(value)) return false;
    if (rules.minimum_length >= 0 &&
        !has_min_length(value.begin, value.end(), static_cast<unsigned int>(rules.minimum_length)))
        return false;
    return rules.maximum_length < 0 ||
           has_max_length(value.begin, value.end(), static_cast<unsigned int>(rules.maximum_length));
}

const char* parse_text(window& in, const char* at, const facets* rules, char stop, parsed_value& value) {
    value.literal = 0;
    value.has_references = false;
    const char* const end = take_text(in, at, stop, value);
    if (rules == nullptr) return end != nullptr ? end : take_text_with_references(in, at, stop, value);
    return end != nullptr && fulfils(value, *rules) ? end : nullptr;
}

/// Bytes up to the end of a name in a start tag, '>' or a blank; not beyond those that can be loaded.
std::size_t name_length(const char* at) {
    std::size_t length = 0;
#if defined(__SSE2__)
    for (; length < 64; length += 16) {
        const __m128i bytes = _mm_loadu_si128(reinterpret_cast<const __m128i*>(at + length));
        const __m128i ends =
            _mm_or_si128(_mm_cmpeq_epi8(bytes, _mm_set1_epi8('>')), _mm_cmpeq_epi8(bytes, _mm_set1_epi8(' ')));
        if (const auto mask = static_cast<unsigned int>(_mm_movemask_epi8(ends)); mask != 0)
            return length + static_cast<std::size_t>(std::countr_zero(mask));
    }
#else
    while (length < 64 && at[length] != '>' && at[length] != ' ')
        ++length;
#endif
    return length;
}

bool is_set(const row& r, const void* object) {
    return object != nullptr && member_at<bool>(object, r.flag);
}

bool read_moment(const parsed_value& value, lmx::c_datetime& moment) {
    lmx::c_datetime read;
    if (scan_zoned_datetime(value.begin, value.end(), read) != value.end()) return false;
    moment = read;
    return true;
}

/// Attributes are stored together, so each must be known to be good before the first is.
bool is_storable(const parsed_value& value, const row& r) {
    lmx::c_datetime moment;
    return r.what != kind::moment || read_moment(value, moment);
}

const char* parse_attributes(window& in, const char* at, const class_rows& rows, const void* object,
                             parsed_start& start) {
    const row* next = rows.attributes;
    const row* const end = rows.attributes + rows.attribute_count;
    while (in.room(at, longest_name_room) && *at == ' ') {
        while (next != end && !same_text(at, next->attribute->open, next->attribute->length))
            ++next;
        if (next == end || start.count == parsed_start::most_attributes || is_set(*next, object)) return nullptr;
        parsed_value& value = start.values[start.count];
        at = parse_value(in, at + next->attribute->length, next->what, next->rules, '"', value);
        if (at == nullptr || !is_storable(value, *next)) return nullptr;
        ++at;
        start.attributes[start.count++] = next++;
    }
    return at;
}

/// Whether every mandatory attribute is there, now or from before.
bool has_mandatory_attributes(const class_rows& rows, const void* object, const parsed_start& start) {
    unsigned int at = 0;
    for (const row* r = rows.attributes; r != rows.attributes + rows.attribute_count; ++r) {
        const bool found = at != start.count && start.attributes[at] == r;
        if (found)
            ++at;
        else if (r->has(mandatory_row) && !is_set(*r, object))
            return false;
    }
    return true;
}

/// In the words of our own writer alone.
const char* parse_nil(window& in, const char* at) {
    static constexpr char text[33] = " xsi:nil=\"true\"/>";
    constexpr std::size_t size = 17;
    return in.room(at, size) && same_text(at, text, size) ? at + size : nullptr;
}

} // namespace

const char* scan_real(window& in, const char* at, char stop, double& value) {
    // The longest text of a number in its short form, and some more.
    constexpr std::size_t number_room = 48;
    if (!in.room(at, number_room)) return nullptr;
    const char* end = scan_short_decimal(at, value);
    if (end != nullptr && *end == stop) return end;
    end = scan_double(at, in.edge(), value);
    return end != nullptr && end != in.edge() && *end == stop ? end : nullptr;
}

const char* parse_moment(window& in, const char* at, char stop, lmx::c_datetime& moment) {
    constexpr std::size_t moment_room = 48;
    if (!in.room(at, moment_room)) return nullptr;
    const char* const end = scan_zoned_datetime(at, in.edge(), moment);
    return end != nullptr && end != in.edge() && *end == stop ? end : nullptr;
}

const char* parse_value(window& in, const char* at, kind what, const facets* rules, char stop, parsed_value& value) {
    // Most values of a large document are numbers.
    if (what == kind::real) return parse_real(in, at, rules, stop, value.real);
    const char* end = nullptr;
    switch (what) {
    case kind::integer:
    case kind::natural:
    case kind::octet: return parse_whole(in, at, rules, stop, value);
    case kind::text:
    case kind::enumerated:
    case kind::text_list: return parse_text(in, at, rules, stop, value);
    case kind::moment: return take_text(in, at, stop, value);
    case kind::boolean:
        end = take_text(in, at, stop, value);
        return end != nullptr && read_bool(at, end, value.truth) ? end : nullptr;
    case kind::binary:
        end = take_text(in, at, stop, value);
        return end != nullptr && is_collapsed(value) && lmx::c_binary::is_valid_base64(std::string(at, end)) ? end
                                                                                                             : nullptr;
    default: return nullptr;
    }
}

bool store_value(const parsed_value& value, kind what, const facets* rules, void* member) {
    if (what == kind::real) {
        *static_cast<double*>(member) = value.real;
        return true;
    }
    switch (what) {
    case kind::enumerated: static_cast<enumerated*>(member)->set_number(value.literal); break;
    case kind::integer: *static_cast<int*>(member) = static_cast<int>(value.whole); break;
    case kind::natural: *static_cast<unsigned int*>(member) = static_cast<unsigned int>(value.whole); break;
    case kind::octet: *static_cast<unsigned char*>(member) = static_cast<unsigned char>(value.whole); break;
    case kind::boolean: *static_cast<bool*>(member) = value.truth; break;
    case kind::moment: return read_moment(value, *static_cast<lmx::c_datetime*>(member));
    case kind::binary: static_cast<lmx::c_binary*>(member)->from_base64(std::string(value.begin, value.size)); break;
    default:
        if (value.literal != 0)
            *static_cast<std::wstring*>(member) = rules->texts->wide[value.literal - 1];
        else
            assign_text(*static_cast<std::wstring*>(member), value);
        break;
    }
    return true;
}

const char* parse_full_start(window& in, const char* at, const class_rows& rows, const element_name& name,
                             const void* object, parsed_start& start) {
    at += name.length - 1;
    if (rows.nil != 0) {
        if (const char* const end = parse_nil(in, at)) {
            start.nil = start.complete = true;
            return has_mandatory_attributes(rows, object, start) ? end : nullptr;
        }
        // An object that is nil from before would not read its content.
        if (object != nullptr && rows.is_nil(object)) return nullptr;
    }
    if (*at == ' ' || rows.needed_attributes != 0) {
        at = parse_attributes(in, at, rows, object, start);
        if (at == nullptr || (rows.needed_attributes != 0 && !has_mandatory_attributes(rows, object, start)))
            return nullptr;
        if (!in.room(at, 1)) return nullptr;
    }
    if (*at != '>') return nullptr;
    ++at;
    if (rows.shape != form::simple_content) return at;
    start.complete = true;
    const row& body = *rows.rows;
    return parse_content(in, at, body.what, body.rules, name, start.body);
}

namespace {

/// Reads a value into a member that nobody has seen yet.
const char* read_value(window& in, const char* at, const row& r, char stop, void* object) {
    if (r.what == kind::real) return parse_real(in, at, r.rules, stop, member_at<double>(object, r.value));
    parsed_value value;
    at = parse_value(in, at, r.what, r.rules, stop, value);
    return at != nullptr && store_value(value, r.what, r.rules, &member_at<char>(object, r.value)) ? at : nullptr;
}

} // namespace

const char* read_start(window& in, const char* at, const class_rows& rows, const element_name& name, void* object,
                       new_start& start) {
    at += name.length - 1;
    const row* next = rows.attributes;
    const row* const end = next + rows.attribute_count;
    std::uint32_t missing = rows.needed_attributes;
    while (*at == ' ') {
        while (next != end && !same_text(at, next->attribute->open, next->attribute->length))
            ++next;
        if (next == end) return nullptr;
        at = read_value(in, at + next->attribute->length, *next, '"', object);
        if (at == nullptr || !in.room(++at, longest_name_room)) return nullptr;
        member_at<bool>(object, next->flag) = true;
        missing &= ~(std::uint32_t{1} << (next - rows.attributes));
        start.last_attribute = next++;
    }
    if (*at != '>' || missing != 0) return nullptr;
    ++at;
    if (rows.shape != form::simple_content) return at;
    start.complete = true;
    const row& body = *rows.rows;
    at = read_value(in, at, body, '<', object);
    if (at == nullptr || (at = close_tag(in, at, name)) == nullptr) return nullptr;
    member_at<bool>(object, body.flag) = true;
    return at;
}

void store_start(const parsed_start& start, const class_rows& rows, void* object) {
    for (unsigned int i = 0; i < start.count; ++i) {
        const row& r = *start.attributes[i];
        store_value(start.values[i], r.what, r.rules, &member_at<char>(object, r.value));
        member_at<bool>(object, r.flag) = true;
    }
    if (start.nil) {
        member_at<bool>(object, rows.nil) = true;
    } else if (rows.shape == form::simple_content) {
        const row& body = *rows.rows;
        store_value(start.body, body.what, body.rules, &member_at<char>(object, body.value));
        member_at<bool>(object, body.flag) = true;
    }
}

const char* parse_type_attribute(window& in, const char* at, std::string_view& name) {
    static constexpr char text[17] = " xsi:type=\"Hqf:";
    constexpr std::size_t size = 15;
    if (!in.room(at, longest_name_room) || !same_text(at, text, size)) return nullptr;
    const char* const begin = at + size;
    const char* const end = in.find(begin, '"');
    if (end == nullptr || !in.room(end, 2) || end[1] != '>') return nullptr;
    name = {begin, static_cast<std::size_t>(end - begin)};
    return end + 2;
}

int find_member(const char* at, const class_rows& group) {
    constexpr std::size_t prefix = 5; // "<Hqf:"
    const std::size_t length = name_length(at + prefix);
    const std::uint8_t index = group.index->find(at + prefix, length);
    return index < group.member_count && starts(at, *group.members[index].name) ? index : -1;
}

} // namespace hqf::frame
