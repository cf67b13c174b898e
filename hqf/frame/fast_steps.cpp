#include "hqf/frame/fast_steps.h"

#include <string_view>

#include "hqf/frame/checks.h"
#include "hqf/frame/read_value.h"
#include "hqf/values/datetime_text.h"
#include "hqf/values/lexical_spans.h"
#include "hqf/values/to_number.h"
#include "hqf/values/transcode.h"

namespace hqf::frame {

namespace {

/// The longest text of a number in its short form, and some more.
constexpr std::size_t number_room = 48;

bool parse_real(window& in, const facets* rules, char stop, parsed_value& value) {
    if (!in.room(number_room)) return false;
    const char* end = scan_short_decimal(in.p, value.real);
    if (end == nullptr || *end != stop) {
        end = scan_double(in.p, in.edge(), value.real);
        if (end == nullptr || end == in.edge() || *end != stop) return false;
    }
    if (rules != nullptr && check_range(value.real, *rules, true) != lmx::err_no_error) return false;
    in.p = end;
    return true;
}

bool take_text(window& in, char stop, parsed_value& value) {
    std::string_view text;
    if (!in.text(stop, text)) return false;
    value.begin = text.data();
    value.size = text.size();
    return true;
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
bool take_text_with_references(window& in, char stop, parsed_value& value) {
    const char* const start = in.p;
    std::string_view run;
    std::size_t length = 0;
    while (!in.text(stop, run)) {
        // Text before the reference, then the reference itself.
        if (!in.text('&', run) || !in.room(longest_name_room) || predefined_character(in.p, length) == 0) return false;
        if (std::memchr(run.data(), stop, run.size()) != nullptr) return false;
        in.p += length;
    }
    value.begin = start;
    value.size = static_cast<std::size_t>(in.p - start);
    value.has_references = true;
    return true;
}

void assign_text(std::wstring& out, const parsed_value& value) {
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

bool parse_whole(window& in, const facets* rules, char stop, parsed_value& value) {
    if (!take_text(in, stop, value) || !read_short_integer(value.begin, value.end(), value.whole)) return false;
    // Every integer type has bounds within 32 bits, so a double compares them exactly.
    return rules != nullptr && check_range(static_cast<double>(value.whole), *rules, true) == lmx::err_no_error;
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

bool parse_text(window& in, const facets* rules, char stop, parsed_value& value) {
    value.literal = 0;
    value.has_references = false;
    const char* const mark = in.mark();
    if (!take_text(in, stop, value)) {
        in.back(mark);
        // Only where no rule looks at the text.
        return rules == nullptr && take_text_with_references(in, stop, value);
    }
    if (rules == nullptr) return true;
    if (rules->texts != nullptr) {
        value.literal = rules->texts->number_of(value.begin, value.size);
        return value.literal != 0;
    }
    if (rules->whitespace == lmx::collapse && !is_collapsed(value)) return false;
    if (rules->minimum_length >= 0 &&
        !has_min_length(value.begin, value.end(), static_cast<unsigned int>(rules->minimum_length)))
        return false;
    return rules->maximum_length < 0 ||
           has_max_length(value.begin, value.end(), static_cast<unsigned int>(rules->maximum_length));
}

bool is_set(const row& r, const void* object) {
    return object != nullptr && member_at<bool>(object, r.flag);
}

/// Attributes are stored together, so each must be known to be good before the first is.
bool is_storable(const parsed_value& value, const row& r) {
    lmx::c_datetime moment;
    return r.what != kind::moment || read_zoned_datetime(value.begin, value.end(), moment);
}

bool parse_attributes(window& in, const class_rows& rows, const void* object, parsed_start& start) {
    const row* next = rows.attributes;
    const row* const end = rows.attributes + rows.attribute_count;
    while (in.room(longest_name_room) && *in.p == ' ') {
        while (next != end && !same_text(in.p, next->attribute->open, next->attribute->length))
            ++next;
        if (next == end || start.count == parsed_start::most_attributes || is_set(*next, object)) return false;
        in.p += next->attribute->length;
        parsed_value& value = start.values[start.count];
        if (!parse_value(in, next->what, next->rules, '"', value) || !is_storable(value, *next)) return false;
        ++in.p;
        start.attributes[start.count++] = next++;
    }
    return true;
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
bool parse_nil(window& in) {
    static constexpr char text[33] = " xsi:nil=\"true\"/>";
    constexpr std::size_t size = 17;
    if (!in.room(size) || !same_text(in.p, text, size)) return false;
    in.p += size;
    return true;
}

} // namespace

bool parse_value(window& in, kind what, const facets* rules, char stop, parsed_value& value) {
    switch (what) {
    case kind::real: return parse_real(in, rules, stop, value);
    case kind::integer:
    case kind::natural:
    case kind::octet: return parse_whole(in, rules, stop, value);
    case kind::text:
    case kind::text_list: return parse_text(in, rules, stop, value);
    case kind::boolean: return take_text(in, stop, value) && read_bool(value.begin, value.end(), value.truth);
    case kind::moment:
    case kind::moment_list: return take_text(in, stop, value);
    case kind::binary:
        return take_text(in, stop, value) && is_collapsed(value) &&
               lmx::c_binary::is_valid_base64(std::string(value.begin, value.size));
    default: return false;
    }
}

bool store_value(const parsed_value& value, kind what, const facets* rules, void* member) {
    switch (what) {
    case kind::real: *static_cast<double*>(member) = value.real; break;
    case kind::integer: *static_cast<int*>(member) = static_cast<int>(value.whole); break;
    case kind::natural: *static_cast<unsigned int*>(member) = static_cast<unsigned int>(value.whole); break;
    case kind::octet: *static_cast<unsigned char*>(member) = static_cast<unsigned char>(value.whole); break;
    case kind::boolean: *static_cast<bool*>(member) = value.truth; break;
    case kind::moment:
    case kind::moment_list:
        return read_zoned_datetime(value.begin, value.end(), *static_cast<lmx::c_datetime*>(member));
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

bool parse_start(window& in, const class_rows& rows, const element_name& name, const void* object,
                 parsed_start& start) {
    in.p += name.length - 1;
    if (rows.nil != 0 && parse_nil(in)) {
        start.nil = start.complete = true;
        return has_mandatory_attributes(rows, object, start);
    }
    // An object that is nil from before would not read its content.
    if (!parse_attributes(in, rows, object, start) || !in.room(1) || *in.p != '>' ||
        (object != nullptr && rows.is_nil(object)) || !has_mandatory_attributes(rows, object, start))
        return false;
    ++in.p;
    if (rows.shape != form::simple_content) return true;
    start.complete = true;
    const row& body = *rows.rows;
    return parse_value(in, body.what, body.rules, '<', start.body) && close_tag(in, name);
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

bool parse_type_attribute(window& in, std::string_view& name) {
    static constexpr char text[17] = " xsi:type=\"Hqf:";
    constexpr std::size_t size = 15;
    if (!in.room(longest_name_room) || !same_text(in.p, text, size)) return false;
    in.p += size;
    if (!in.text('"', name) || !in.room(2) || in.p[1] != '>') return false;
    in.p += 2;
    return true;
}

int find_member(const window& in, const class_rows& group) {
    for (int i = 0; i < group.member_count; ++i)
        if (starts(in, *group.members[i].name)) return i;
    return -1;
}

} // namespace hqf::frame
