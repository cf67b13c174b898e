/// Looks over the window: a value, a tag, the start of an element. Each takes a place where something stands in the
/// spelling of our own writer and gives the place behind it, or null: then nothing has been stored, the window's
/// position hasn't moved, and the general road reads the same bytes.
#pragma once

#include <bit>
#include <cstdint>
#include <cstring>
#include <string_view>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

#include "hqf/frame/checks.h"
#include "hqf/frame/rows.h"
#include "hqf/values/short_decimal.h"
#include "hqf/xml_in/window.h"

namespace hqf::frame {

/// A value between its check and its store. Left without initial values: starts of elements have room for many, and
/// most use none.
struct parsed_value {
    /// The text in the window, for the kinds that are stored from it.
    const char* begin;
    std::size_t size;
    /// References to the predefined entities are among the text.
    bool has_references;
    union {
        double real;
        std::int64_t whole;
        bool truth;
        /// Number of a literal, 0 for free text.
        int literal;
    };

    const char* end() const { return begin + size; }
};

/// A bit for each of 16 bytes that are the same.
inline unsigned int same_bytes(const char* text, const char* constant) {
#if defined(__SSE2__)
    const __m128i left = _mm_loadu_si128(reinterpret_cast<const __m128i*>(text));
    const __m128i right = _mm_loadu_si128(reinterpret_cast<const __m128i*>(constant));
    return static_cast<unsigned int>(_mm_movemask_epi8(_mm_cmpeq_epi8(left, right)));
#else
    unsigned int bits = 0;
    for (int i = 0; i < 16; ++i)
        bits |= (text[i] == constant[i] ? 1u : 0u) << i;
    return bits;
#endif
}

/// Whether `size` bytes are the same. `constant` is padded to a multiple of 16, and behind `text` 16 bytes can be read.
inline bool same_text(const char* text, const char* constant, std::size_t size) {
    for (; size > 16; size -= 16, text += 16, constant += 16)
        if (same_bytes(text, constant) != 0xFFFF) return false;
    return (~same_bytes(text, constant) & ((1u << size) - 1)) == 0;
}

/// Longest name with what stands around it; a step asks for this many proven bytes first.
inline constexpr std::size_t longest_name_room = 96;

/// Whether the start tag "<Hqf:Name" stands here, followed by its end or by attributes.
inline bool starts(const char* at, const element_name& name) {
    if ((same_bytes(at, name.open) & name.first_bytes) != name.first_bytes) return false;
    const std::size_t size = name.length - 1u;
    if (size > 16 && !same_text(at + 16, name.open + 16, size - 16)) return false;
    return at[size] == '>' || at[size] == ' ';
}

/// Behind "</Hqf:Name>".
inline const char* close_tag(window& in, const char* at, const element_name& name) {
    const bool is_here = in.room(at, longest_name_room) && at[0] == '<' && at[1] == '/' &&
                         same_text(at + 2, name.open + 1, name.length - 1u);
    return is_here ? at + name.length + 1 : nullptr;
}

/// A value up to `stop` that passes every check of its rules; a date and time is checked when it is stored. Gives the
/// place of `stop`.
const char* parse_value(window& in, const char* at, kind what, const facets* rules, char stop, parsed_value& value);

/// Any number up to `stop`, unchecked.
const char* scan_real(window& in, const char* at, char stop, double& value);

/// The same as parse_value() for a real number: most values of a large document are.
inline const char* parse_real(window& in, const char* at, const facets* rules, char stop, double& value) {
    constexpr std::size_t few_digits_room = 16;
    const char* end = in.room(at, few_digits_room) ? scan_few_digits(at, value) : nullptr;
    if (end == nullptr || *end != stop) end = scan_real(in, at, stop, value);
    return end != nullptr && (rules == nullptr || check_range(value, *rules, true) == lmx::err_no_error) ? end
                                                                                                         : nullptr;
}

/// A date and time with its zone up to `stop`.
const char* parse_moment(window& in, const char* at, char stop, lmx::c_datetime& moment);

/// A value and the end tag behind it.
inline const char* parse_content(window& in, const char* at, kind what, const facets* rules, const element_name& name,
                                 parsed_value& value) {
    at = parse_value(in, at, what, rules, '<', value);
    return at == nullptr ? nullptr : close_tag(in, at, name);
}

/// Stores a parsed value in a member of that kind; false, with nothing stored, for a date and time that is not in its
/// common form.
bool store_value(const parsed_value& value, kind what, const facets* rules, void* member);

/// The start of an element, from "<Hqf:Name" to the end of the tag, and for simple content the value and the end tag.
struct parsed_start {
    static constexpr unsigned int most_attributes = 8;

    unsigned int count = 0;
    bool nil = false;
    /// The element is read to its end.
    bool complete = false;
    /// Nothing but the name.
    bool is_plain() const { return count == 0 && !nil && !complete; }

    const row* attributes[most_attributes];
    parsed_value values[most_attributes];
    parsed_value body;
};

/// Any start that can be parsed at all; see parse_start().
const char* parse_full_start(window& in, const char* at, const class_rows& rows, const element_name& name,
                             const void* object, parsed_start& start);

/// \param object the object that the element will be read into, null for one that is yet to be made
inline const char* parse_start(window& in, const char* at, const class_rows& rows, const element_name& name,
                               const void* object, parsed_start& start) {
    const bool is_name_alone = at[name.length - 1] == '>' && rows.needed_attributes == 0 &&
                               rows.shape != form::simple_content && (object == nullptr || !rows.is_nil(object));
    return is_name_alone ? at + name.length : parse_full_start(in, at, rows, name, object, start);
}

/// What the start of an element was that went straight into its new object.
struct new_start {
    const row* last_attribute = nullptr;
    /// The element is read to its end.
    bool complete = false;
};

/// Reads the start of an element, as parse_start() does, into an object that nobody holds yet: after a null it is to be
/// thrown away.
const char* read_start(window& in, const char* at, const class_rows& rows, const element_name& name, void* object,
                       new_start& start);

/// Stores attributes, the nil flag and the body in the object.
void store_start(const parsed_start& start, const class_rows& rows, void* object);

/// Behind ` xsi:type="Hqf:Name">`, of which it gives the name.
const char* parse_type_attribute(window& in, const char* at, std::string_view& name);

/// The member of a group whose start tag stands here, -1 for none.
int find_member(const char* at, const class_rows& group);

} // namespace hqf::frame
