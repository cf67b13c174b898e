/// The fast road: whole steps over the window. What a step has not read to its end it has not read at all.

#include "hqf/frame/element_reader.h"

#include <utility>

#include "hqf/frame/objects.h"
#include "hqf/frame/read_value.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/reader_access.h"

namespace hqf::frame {

namespace {

/// What the general road would remember of an attribute that only it looks for.
constexpr row nil_row = {kind::boolean, 0, 0, 0, nullptr, nullptr, nullptr, nullptr};
constexpr row type_row = {kind::text, 0, 0, 0, nullptr, nullptr, nullptr, nullptr};

/// The place of the '<' of the next tag in the window, behind white space; null where no step can be taken.
inline const char* next_tag(window& in) {
    // Most tags have a short indent.
    const char* tag = in.room(in.p, 16 + longest_name_room) ? skip_short_space(in.p) : nullptr;
    if (tag == nullptr) {
        tag = in.skip_space(in.p);
        if (!in.room(tag, longest_name_room)) return nullptr;
    }
    return *tag == '<' ? tag : nullptr;
}

using name_kind = fast_trace::name_kind;

/// An object that nobody holds yet.
class new_object {
public:
    explicit new_object(const class_rows& rows)
        : rows_(rows)
        , object_(rows.create()) {}
    new_object(const new_object&) = delete;
    new_object& operator=(const new_object&) = delete;
    ~new_object() {
        if (object_ != nullptr) rows_.destroy(object_);
    }
    void* get() const { return object_; }
    void* release() { return std::exchange(object_, nullptr); }

private:
    const class_rows& rows_;
    void* object_;
};

} // namespace

// What the general road would remember: settle() hands it over.

void element_reader::remember_value(const row& r) {
    reader_access::trace(reader_) = {name_kind::element, r.name, &r};
}

/// Of a start tag, and of the value behind it if the element is read to its end: both may be null.
inline void element_reader::remember_start(const element_name& name, const row* last_attribute, const row* body) {
    fast_trace& trace = reader_access::trace(reader_);
    if (last_attribute == nullptr) {
        trace.kind = name_kind::element;
        trace.name = &name;
    } else {
        trace = {name_kind::attribute, last_attribute->attribute, last_attribute};
    }
    if (body != nullptr) trace.value = body;
}

void element_reader::remember(const parsed_start& start, const class_rows& rows, const element_name& name) {
    if (start.nil) {
        fast_trace& trace = reader_access::trace(reader_);
        trace.kind = name_kind::nil;
        trace.value = &nil_row;
        return;
    }
    remember_start(name, start.count == 0 ? nullptr : start.attributes[start.count - 1],
                   start.complete ? rows.rows : nullptr);
}

// Tags

bool element_reader::fast_end_tag() {
    window* const in = reader_access::begin_element(reader_);
    const char* const at = in == nullptr ? nullptr : next_tag(*in);
    return at != nullptr && at[1] == '/' && fast_end_tag(*in, at);
}

/// With "</" at the place.
inline bool element_reader::fast_end_tag(window& in, const char* at) {
    at = fast_name_ != nullptr ? close_tag(in, at, *fast_name_) : named_end_tag(in, at);
    if (at == nullptr) return false;
    in.p = at;
    reader_.restore_event(lmx::EXE_ELEMENT_END);
    return true;
}

/// Behind the end tag of an element that the general road began, with the name as that read it.
const char* element_reader::named_end_tag(window& in, const char* at) const {
    const std::string_view name = name_->get_str();
    const bool is_here = in.room(at, name.size() + 3) && std::memcmp(at + 2, name.data(), name.size()) == 0 &&
                         at[2 + name.size()] == '>';
    return is_here ? at + name.size() + 3 : nullptr;
}

/// Goes into an element whose start tag has been read, or is done with it if that was all.
bool element_reader::enter(const parsed_start& start, const class_rows& rows, const element_name& name, void* object) {
    if (start.is_plain()) {
        remember_start(name, nullptr, nullptr);
    } else {
        remember(start, rows, name);
        store_start(start, rows, object);
        if (start.complete) return true;
    }
    error_ = element_reader(rows, object, reader_).entered(name);
    return error_ == lmx::err_no_error;
}

// Children

void element_reader::fast_children(row_cursor& at) {
    window* in = reader_access::begin_element(reader_);
    const row* const end = rows_.rows + rows_.row_count;
    for (const unsigned int steps = reader_access::general_steps(reader_); in != nullptr;) {
        const char* const tag = next_tag(*in);
        if (tag == nullptr) return;
        if (tag[1] == '/') {
            // An element with no content at all is accepted here if its class is tolerant; else the general road
            // reports.
            if (begun_ ? is_end_due(at) : rows_.tolerant) is_over_ = fast_end_tag(*in, tag);
            return;
        }
        // The row that the tag belongs to, from the cursor on.
        int member = -1;
        const row* r = rows_.rows + at.row;
        for (bool seen = at.seen;; ++r, seen = false) {
            if (r == end) return;
            if (r->name != nullptr) {
                if (starts(tag, *r->name)) break;
            } else if (r->is_group()) {
                member = find_member(tag, *r->type);
                if (member >= 0) break;
            }
            if (r->has(mandatory_row) && !seen) return;
        }
        if (!fast_child(*in, tag, *r, member)) return;
        begun_ = true;
        const auto found = static_cast<unsigned int>(r - rows_.rows);
        last_row_ = static_cast<int>(found);
        at.row = r->is_list() ? found : found + 1;
        at.seen = r->is_list();
        // Where the general road has not been, nothing has changed but the place.
        if (steps != reader_access::general_steps(reader_) || !in->is_ready())
            in = reader_access::begin_element(reader_);
    }
}

/// Whether the rows from the cursor on are satisfied with what has been read, and nothing is looked at once more.
bool element_reader::is_end_due(row_cursor at) const {
    const std::uint64_t coming = ~std::uint64_t{0} << (at.row + (at.seen ? 1 : 0));
    return (rows_.mandatory_rows & coming) == 0 && (!rows_.minimums_at_end || is_occurs_ok(rows_, object_));
}

bool element_reader::fast_child(window& in, const char* at, const row& r, int member) {
    switch (r.what) {
    case kind::child_list: return fast_item(in, at, r);
    case kind::child:
    case kind::child_pointer: return fast_object(in, at, r);
    case kind::group:
    case kind::group_pointer:
    case kind::group_list: return fast_member(in, at, r, member);
    case kind::text_list: return fast_text_item(in, at, r);
    case kind::moment_list: return fast_moment_item(in, at, r);
    case kind::real: return fast_real(in, at, r);
    case kind::enumerated: return fast_literal(in, at, r);
    default: return fast_simple(in, at, r);
    }
}

bool element_reader::fast_real(window& in, const char* at, const row& r) {
    double value = 0;
    at += r.name->length;
    if (at[-1] != '>') return false;
    at = parse_real(in, at, r.rules, '<', value);
    if (at == nullptr || (at = close_tag(in, at, *r.name)) == nullptr) return false;
    member_at<double>(object_, r.value) = value;
    return value_read(in, at, r);
}

bool element_reader::fast_literal(window& in, const char* at, const row& r) {
    at += r.name->length;
    if (at[-1] != '>') return false;
    const char* const end = in.find(at, '<');
    if (end == nullptr) return false;
    const int number = r.rules->texts->number_of(at, static_cast<std::size_t>(end - at));
    if (number == 0 || (at = close_tag(in, end, *r.name)) == nullptr) return false;
    member_at<enumerated>(object_, r.value).set_number(number);
    return value_read(in, at, r);
}

bool element_reader::fast_simple(window& in, const char* at, const row& r) {
    parsed_value value;
    at += r.name->length;
    if (at[-1] != '>') return false;
    at = parse_content(in, at, r.what, r.rules, *r.name, value);
    if (at == nullptr || !store_value(value, r.what, r.rules, &member_at<char>(object_, r.value))) return false;
    return value_read(in, at, r);
}

/// Behind a simple child whose value is stored.
bool element_reader::value_read(window& in, const char* at, const row& r) {
    in.p = at;
    member_at<bool>(object_, r.flag) = true;
    remember_value(r);
    return true;
}

bool element_reader::fast_text_item(window& in, const char* at, const row& r) {
    parsed_value value;
    at += r.name->length;
    if (at[-1] != '>') return false;
    at = parse_content(in, at, r.what, r.rules, *r.name, value);
    if (at == nullptr) return false;
    auto& items = member_at<list_base>(object_, r.value);
    items.make_room();
    auto* const item = make_object<std::wstring>();
    items.append(item);
    store_value(value, r.what, r.rules, item);
    in.p = at;
    remember_value(r);
    return true;
}

bool element_reader::fast_moment_item(window& in, const char* at, const row& r) {
    lmx::c_datetime moment;
    at += r.name->length;
    if (at[-1] != '>') return false;
    at = parse_moment(in, at, '<', moment);
    if (at == nullptr || (at = close_tag(in, at, *r.name)) == nullptr) return false;
    auto& items = member_at<list_base>(object_, r.value);
    items.make_room();
    items.append(make_object<lmx::c_datetime>(moment));
    in.p = at;
    remember_value(r);
    return true;
}

bool element_reader::fast_object(window& in, const char* at, const row& r) {
    void* object = nullptr;
    if (r.what == kind::child)
        object = &member_at<char>(object_, r.value);
    else if (r.what == kind::child_pointer)
        object = member_at<void*>(object_, r.value);
    parsed_start start;
    at = parse_start(in, at, *r.type, *r.name, object, start);
    if (at == nullptr || (!start.complete && is_too_deep())) return false;
    if (object == nullptr) {
        auto& held = member_at<pointer_member>(object_, r.value);
        if (start.nil) {
            in.p = at;
            remember(start, *r.type, *r.name);
            return held.nil = held.present = true;
        }
        if (held.nil) return false;
        object = held.object = r.type->create();
    }
    in.p = at;
    if (!enter(start, *r.type, *r.name, object)) return false;
    member_at<bool>(object_, r.flag) = true;
    return true;
}

bool element_reader::fast_item(window& in, const char* at, const row& r) {
    const class_rows& rows = *r.type;
    auto& items = member_at<list_base>(object_, r.value);
    items.make_room();
    new_object item(rows);
    new_start start;
    at = read_start(in, at, rows, *r.name, item.get(), start);
    if (at == nullptr || (!start.complete && is_too_deep())) return false;
    void* const object = item.release();
    items.append(object);
    in.p = at;
    remember_start(*r.name, start.last_attribute, start.complete ? rows.rows : nullptr);
    if (start.complete) return true;
    error_ = element_reader(rows, object, reader_).entered(*r.name);
    return error_ == lmx::err_no_error;
}

bool element_reader::fast_member(window& in, const char* at, const row& r, int member) {
    if (member == 0 && r.type->calls->head_factory != nullptr) return fast_head(in, at, r);
    const group_member& chosen = r.type->members[member];
    parsed_start start;
    at = parse_start(in, at, *chosen.type, *chosen.name, nullptr, start);
    if (at == nullptr || (!start.complete && is_too_deep())) return false;
    void* const group = group_to_fill(r);
    void* const made = chosen.type->create();
    hold_member(*r.type, group, member, made);
    in.p = at;
    if (!enter(start, *chosen.type, *chosen.name, made)) return false;
    if (r.what != kind::group_list) member_at<bool>(object_, r.flag) = true;
    return true;
}

/// The head of a group: xsi:type tells the class.
bool element_reader::fast_head(window& in, const char* at, const row& r) {
    const class_rows& group_rows = *r.type;
    const element_name& name = *group_rows.members[0].name;
    std::string_view type_name;
    at = parse_type_attribute(in, at + name.length - 1, type_name);
    if (at == nullptr || is_too_deep()) return false;
    int member = group_rows.member_count - 1;
    while (member > 0 && type_name != group_rows.members[member].type->name)
        --member;
    if (member == 0) return false;
    const class_rows& rows = *group_rows.members[member].type;
    void* const group = group_to_fill(r);
    void* const made = rows.create();
    hold_member(group_rows, group, 0, made);
    in.p = at;
    reader_access::trace(reader_) = {name_kind::type, nullptr, &type_row};
    error_ = element_reader(rows, made, reader_).entered(name);
    if (error_ != lmx::err_no_error) return false;
    if (r.what != kind::group_list) member_at<bool>(object_, r.flag) = true;
    return true;
}

/// The group of a row, made if need be.
void* element_reader::group_to_fill(const row& r) {
    if (r.what == kind::group) return &member_at<char>(object_, r.value);
    if (r.what == kind::group_pointer) {
        void*& held = member_at<void*>(object_, r.value);
        if (held == nullptr) held = r.type->create();
        return held;
    }
    auto& items = member_at<list_base>(object_, r.value);
    items.make_room();
    void* const group = r.type->create();
    items.append(group);
    return group;
}

/// An element at the limit is left to the general road, which reports it.
bool element_reader::is_too_deep() const {
    return reader_access::model_depth(reader_) >= limits::model_depth;
}

bool element_reader::fast_option() {
    window* const in = reader_access::begin_element(reader_);
    const char* const tag = in == nullptr ? nullptr : next_tag(*in);
    if (tag == nullptr) return false;
    int index = 0;
    while (index < rows_.row_count && !starts(tag, *rows_.rows[index].name))
        ++index;
    if (index == rows_.row_count) return false;
    const row& option = rows_.rows[index];
    auto& slot = member_at<choice_slot>(object_, rows_.slot);
    if (option.what == kind::child) {
        parsed_start start;
        const char* const at = parse_start(*in, tag, *option.type, *option.name, nullptr, start);
        if (at == nullptr || (!start.complete && is_too_deep())) return false;
        choose_new_option(rows_, object_, index);
        in->p = at;
        if (!enter(start, *option.type, *option.name, slot.object)) return false;
    } else {
        parsed_value value;
        const char* at = tag + option.name->length;
        if (at[-1] != '>') return false;
        at = parse_content(*in, at, option.what, option.rules, *option.name, value);
        if (at == nullptr) return false;
        choose_new_option(rows_, object_, index);
        in->p = at;
        store_value(value, option.what, option.rules, option.what == kind::text ? slot.object : &slot.real);
        remember_value(option);
    }
    begun_ = true;
    last_row_ = 0;
    return true;
}

} // namespace hqf::frame
