/// The tables that drive the engine. The generator emits one class_rows for each model class, with a row for each of
/// its attributes and children in schema order; hqf/frame reads, writes, copies, counts and checks by them and by
/// nothing else.
///
/// Rows of a base class stand first in the tables of a derived one: the hierarchies are single, so an offset into the
/// base is one into the derived class too.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "hqf/errors/elmx_error.h"
#include "hqf/frame/storage.h"
#include "hqf/values/c_big_int.h"
#include "hqf/values/c_binary.h"
#include "hqf/values/c_datetime.h"
#include "hqf/values/s_ns_map.h"
#include "hqf/xml_in/c_any_info.h"
#include "hqf/xml_in/c_xml.h"
#include "hqf/xml_in/s_event_map.h"

namespace lmx {
class c_xml_reader;
class c_xml_writer;
} // namespace lmx

namespace hqf::frame {

/// Number of the format's namespace in every reader.
inline constexpr int format_namespace_id = 1000;

/// The format's one namespace row and the end row; emitted with the tables.
extern const lmx::s_ns_map namespace_map[];

/// An element name of the vocabulary as it stands in a document of our own, once for all the places that use it.
struct alignas(16) element_name {
    /// "<Hqf:Name>", padded so that whole 16-byte blocks can be copied and compared from any place in the text.
    char open[64];
    /// Length of `open`, both brackets included.
    std::uint8_t length;
    /// The number that event tables give the name.
    std::int16_t event;
    /// A bit for each of the first 16 bytes of `open` that belong to "<Hqf:Name".
    std::uint32_t first_bytes = length > 16 ? 0xFFFF : (1u << (length - 1)) - 1;

    /// "Hqf:Name", padded too.
    std::string_view text() const { return {open + 1, length - 2u}; }
    std::string qualified() const { return std::string(text()); }
};

/// An attribute's name as it stands in a start tag.
struct alignas(16) attribute_name {
    /// ` Name="`, padded like an element's.
    char open[48];
    /// Length of `open`, blank, equals sign and quote included.
    std::uint8_t length;
    std::int32_t event;

    /// "Name"
    std::string plain() const { return std::string(open + 1, length - 3u); }
};

/// The texts of an enumeration, numbered from 1 in schema order.
struct literals {
    int count;
    const char* const* narrow;
    const std::uint8_t* lengths;
    const std::wstring* wide;

    /// The number of a text, 0 for one that is not in the list.
    int number_of(const std::wstring& text) const;
    int number_of(const char* text, std::size_t length) const;
};

/// What a value must fulfil. One object for each simple type of the schema that has a rule.
struct facets {
    lmx::elmx_whitespace whitespace = lmx::preserve;
    bool has_minimum = false;
    bool minimum_is_exclusive = false;
    bool has_maximum = false;
    bool maximum_is_exclusive = false;
    /// False where only the reader tests the minimum.
    bool setter_checks_minimum = true;
    /// The one pattern of the format: an explicit time zone is mandatory.
    bool zoned = false;
    double minimum = 0;
    double maximum = 0;
    /// In characters on reading, in wide units in setters; -1 for no limit.
    int minimum_length = -1;
    int maximum_length = -1;
    const literals* texts = nullptr;
    /// Bounds of the integer types, tested on the text before it is narrowed.
    const lmx::c_big_int* integer_minimum = nullptr;
    const lmx::c_big_int* integer_maximum = nullptr;
};

/// How a member is stored and what it holds.
enum class kind : std::uint8_t {
    text,
    enumerated, // its facets have the literals
    real,
    integer,
    natural,
    octet,
    boolean,
    moment, // lmx::c_datetime
    binary,
    child, // a class by value, in a row's `type`
    child_pointer,
    group, // an sg_ class
    group_pointer,
    group_list, // here the lists begin and the groups end
    child_list,
    text_list,
    moment_list,
    any_list // lmx::c_any_info
};

enum row_flag : std::uint8_t {
    mandatory_row = 1,
    /// Written whether or not it is set: a member with a default, and what the writer always asks for.
    always_written = 2,
    /// Optional in the tables of the reader, mandatory for the writer: is_occurs_ok() passes it over.
    not_counted = 4,
    /// A value that can't be fetched gives code 29, whatever went wrong.
    value_error_only = 8
};

/// One attribute, one child, one option or the body of a class: 40 bytes.
///
///     what 1 | flags 1 | value 2 | flag 2 | - | name 8 | attribute 8 | rules 8 | type 8
///
/// Offsets are into the object. Lists have no flag; the options of a choice all name its slot.
struct row {
    kind what;
    std::uint8_t flags;
    std::uint16_t value;
    std::uint16_t flag;
    /// Null for attributes and for the body.
    const element_name* name;
    /// Null for children.
    const attribute_name* attribute;
    /// Null where the type has no rule of its own: text is preserved then, all else collapsed.
    const facets* rules;
    /// The class of a child, null for a simple one.
    const class_rows* type;

    constexpr bool has(row_flag asked) const { return (flags & asked) != 0; }
    constexpr bool is_list() const { return what >= kind::group_list; }
    constexpr bool is_group() const { return what >= kind::group && what <= kind::group_list; }
    constexpr bool is_pointer() const { return what == kind::child_pointer || what == kind::group_pointer; }
};
static_assert(sizeof(row) == 40);

/// A bit for each row that is mandatory.
template<std::size_t count>
constexpr std::uint32_t mandatory_among(const row (&rows)[count]) {
    static_assert(count <= 32);
    std::uint32_t bits = 0;
    for (std::size_t i = 0; i < count; ++i)
        if (rows[i].has(mandatory_row)) bits |= std::uint32_t{1} << i;
    return bits;
}

/// A bit for each row that must be there before an object can be written.
template<std::size_t count>
constexpr std::uint32_t needed(const row (&rows)[count]) {
    std::uint32_t bits = mandatory_among(rows);
    for (std::size_t i = 0; i < count; ++i)
        if (rows[i].has(not_counted)) bits &= ~(std::uint32_t{1} << i);
    return bits;
}

/// One member of a substitution group.
struct group_member {
    const element_name* name;
    const class_rows* type;
};

/// Finds a member of a group by its name without comparing it with all: by its length and two of its characters, which
/// tell the members of the group apart.
struct member_index {
    /// Places of the characters, counted from the name's last one.
    std::uint8_t first, second;
    std::uint8_t factor;
    /// The number of the member, or 255, by hash.
    std::uint8_t members[128];

    constexpr std::uint8_t find(const char* name, std::size_t length) const {
        if (length <= first || length <= second) return 255;
        const auto character = [&](std::size_t place) { return static_cast<unsigned char>(name[length - 1 - place]); };
        return members[(length + character(first) + character(second) * factor) % sizeof members];
    }
};

/// What the engine asks of an object in a group through its virtual operations: only they know its class.
struct group_calls {
    void* (*clone)(const void* object);
    void (*destroy)(void* object);
    const char* (*id)(const void* object);
    lmx::elmx_error (*marshal)(void* object, lmx::c_xml_writer& writer, const char* name);
    /// The factory behind the head element, null for groups whose head stands outside.
    void* (*head_factory)(int namespace_id, const std::string& type_name);
    lmx::elmx_error (*unmarshal)(void* object, lmx::c_xml_reader& reader, const std::string& name);
    /// The identity that the head's declared type expects.
    const char* const* head_id;
};

enum class form : std::uint8_t {
    sequence,
    simple_content,
    choice,
    group,
    wildcard // Revision: any children
};

struct class_rows {
    /// "ColorType": the item of code 25.
    const char* name;
    form shape;
    /// An element without any content is accepted, whatever is mandatory.
    bool tolerant = false;
    /// The class can start a document: it selects the namespace map and writes the declarations.
    bool writes_namespaces = false;
    /// The minimums are tested once more when the body has been read.
    bool minimums_at_end = false;
    /// A nilled element still writes its attributes.
    bool attributes_when_nil = false;

    /// What is_occurs_ok() asks for: a bit for each attribute, and for each row.
    std::uint32_t needed_attributes = 0;
    std::uint32_t needed_rows = 0;
    /// What a reader asks for: a bit for each row.
    std::uint32_t mandatory_rows = 0;

    std::uint8_t attribute_count = 0;
    /// Children; the body of a class with simple content; the options of a choice.
    std::uint8_t row_count = 0;
    std::uint8_t member_count = 0;
    const row* attributes = nullptr;
    const row* rows = nullptr;
    /// Of a substitution group.
    const group_member* members = nullptr;
    const member_index* index = nullptr;

    const lmx::s_event_map* attribute_events = nullptr;
    /// All children, in the order of the rows; for a group its members.
    const lmx::s_event_map* element_events = nullptr;
    /// For row i, how many entries of element_events stand before it.
    const std::uint8_t* first_event = nullptr;

    /// Offset of the nil flag, 0 for a class that can't be nil (at offset 0 lies the virtual table).
    std::uint16_t nil = 0;
    /// Offset of the slot of a choice or a group.
    std::uint16_t slot = 0;
    /// The class's own element, such as "Hqf:ColorType": item of the minimums at the end, and of code 7.
    const char* item = nullptr;
    /// The class identity, null outside the hierarchies.
    const char* const* id = nullptr;

    void* (*create)() = nullptr;
    void* (*clone)(const void* object) = nullptr;
    void (*destroy)(void* object) = nullptr;
    const group_calls* calls = nullptr;

    bool is_nil(const void* object) const;
    /// Selector of a choice or a group with nothing chosen.
    int none() const { return shape == form::group ? member_count + 1 : row_count; }
    const lmx::s_event_map* events_from(unsigned int row_index) const {
        return element_events + first_event[row_index];
    }
};

/// The member of type `value_type` at an offset of an object.
template<class value_type>
value_type& member_at(void* object, unsigned int offset) {
    return *reinterpret_cast<value_type*>(static_cast<char*>(object) + offset);
}
template<class value_type>
const value_type& member_at(const void* object, unsigned int offset) {
    return *reinterpret_cast<const value_type*>(static_cast<const char*>(object) + offset);
}

inline bool class_rows::is_nil(const void* object) const {
    return nil != 0 && member_at<bool>(object, nil);
}

template<class object_type>
void* create_object() {
    return make_object<object_type>();
}
template<class object_type>
void* clone_object(const void* object) {
    return make_object<object_type>(*static_cast<const object_type*>(object));
}

} // namespace hqf::frame
