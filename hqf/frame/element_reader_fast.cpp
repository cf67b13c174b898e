/// The fast road: whole steps over the window. What a step has not read to its end it has not read at all.

#include "hqf/frame/element_reader.h"
#include "hqf/frame/objects.h"
#include "hqf/frame/read_value.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/reader_access.h"

namespace hqf::frame {

namespace {

/// The window, and the place of the '<' of the next tag in it, which is null where no step can be taken.
struct tag_place {
    window* in = nullptr;
    const char* at = nullptr;

    explicit tag_place(lmx::c_xml_reader& reader)
        : in(reader_access::begin_element(reader)) {
        if (in == nullptr) return;
        const char* const tag = in->skip_space(in->p);
        if (in->room(tag, longest_name_room) && *tag == '<') at = tag;
    }
};

std::string_view qualified_name(const element_name& name) {
    return {name.open + 1, name.length - 2u};
}

} // namespace

// What the general road would remember

void element_reader::remember_value(const element_name& name, lmx::elmx_whitespace mode) {
    fast_trace& trace = reader_access::trace(reader_);
    trace.kind = fast_trace::name_kind::element;
    trace.name = qualified_name(name);
    trace.has_mode = true;
    trace.mode = mode;
}

void element_reader::remember(const parsed_start& start, const class_rows& rows, const element_name& name) {
    fast_trace& trace = reader_access::trace(reader_);
    trace.kind = fast_trace::name_kind::element;
    trace.name = qualified_name(name);
    if (start.nil) {
        trace.kind = fast_trace::name_kind::xsi;
        trace.name = "xsi:nil";
        trace.has_mode = true;
        trace.mode = lmx::collapse;
    } else if (start.count != 0) {
        const row& last = *start.attributes[start.count - 1];
        trace.kind = fast_trace::name_kind::attribute;
        trace.name = {last.attribute->open + 1, last.attribute->length - 3u};
        trace.has_mode = true;
        trace.mode = whitespace_of(last.what, last.rules);
    }
    if (start.complete && !start.nil) {
        trace.has_mode = true;
        trace.mode = whitespace_of(rows.rows->what, rows.rows->rules);
    }
}

// Tags

bool element_reader::fast_end_tag() {
    const auto [in, at] = tag_place(reader_);
    return at != nullptr && at[1] == '/' && fast_end_tag(*in, at);
}

/// With "</" at the place.
bool element_reader::fast_end_tag(window& in, const char* at) {
    if (fast_name_ != nullptr) {
        at = close_tag(in, at, *fast_name_);
        if (at == nullptr) return false;
        in.p = at;
    } else {
        const std::string_view name = name_->get_str();
        if (!in.room(at, name.size() + 3) || std::memcmp(at + 2, name.data(), name.size()) != 0 ||
            at[2 + name.size()] != '>')
            return false;
        in.p = at + name.size() + 3;
    }
    reader_.restore_event(lmx::EXE_ELEMENT_END);
    return true;
}

/// Goes into an element whose start tag has been read, or is done with it if that was all.
bool element_reader::enter(const parsed_start& start, const class_rows& rows, const element_name& name, void* object) {
    remember(start, rows, name);
    store_start(start, rows, object);
    if (start.complete) return true;
    error_ = element_reader(rows, object, reader_).entered(name);
    return error_ == lmx::err_no_error;
}

// Children

void element_reader::fast_children(row_cursor& at) {
    for (;;) {
        const auto [in, tag] = tag_place(reader_);
        if (tag == nullptr) return;
        if (tag[1] == '/') {
            // An element with no content at all is accepted here if its class is tolerant; else the general road
            // reports.
            if (begun_ ? is_end_due(at) : rows_.tolerant) is_over_ = fast_end_tag(*in, tag);
            return;
        }
        int member = -1;
        row_cursor found = at;
        const row* const r = find_row(tag, found, member);
        if (r == nullptr || !fast_child(*in, tag, *r, member)) return;
        begun_ = true;
        last_row_ = static_cast<int>(found.row);
        at = found;
        at.seen = true;
        if (!r->is_list()) at.next_row();
    }
}

/// Whether the rows from the cursor on are satisfied with what has been read, and nothing is looked at once more.
bool element_reader::is_end_due(row_cursor at) const {
    for (; at.row < rows_.row_count; at.next_row()) {
        const row& r = rows_.rows[at.row];
        if (r.has(mandatory_row) && !at.seen) return false;
    }
    return !rows_.minimums_at_end || is_occurs_ok(rows_, object_);
}

/// The row that the start tag here belongs to, with the cursor moved to it; null where the general road must decide.
const row* element_reader::find_row(const char* tag, row_cursor& at, int& member) const {
    for (; at.row < rows_.row_count; at.next_row()) {
        const row& r = rows_.rows[at.row];
        if (r.is_group()) {
            member = find_member(tag, *r.type);
            if (member >= 0) return &r;
        } else if (r.name != nullptr && starts(tag, *r.name)) {
            return &r;
        }
        if (r.has(mandatory_row) && !at.seen) return nullptr;
    }
    return nullptr;
}

bool element_reader::fast_child(window& in, const char* at, const row& r, int member) {
    switch (r.what) {
    case kind::child:
    case kind::child_pointer:
    case kind::child_list: return fast_object(in, at, r);
    case kind::group:
    case kind::group_pointer:
    case kind::group_list: return fast_member(in, at, r, member);
    case kind::text_list:
    case kind::moment_list: return fast_text_item(in, at, r);
    default: return fast_simple(in, at, r);
    }
}

bool element_reader::fast_simple(window& in, const char* at, const row& r) {
    parsed_value value;
    at += r.name->length;
    if (at[-1] != '>') return false;
    at = parse_content(in, at, r.what, r.rules, *r.name, value);
    if (at == nullptr || !store_value(value, r.what, r.rules, &member_at<char>(object_, r.value))) return false;
    in.p = at;
    member_at<bool>(object_, r.flag) = true;
    remember_value(*r.name, whitespace_of(r.what, r.rules));
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
    if (r.what == kind::text_list) {
        auto* const item = make_object<std::wstring>();
        items.append(item);
        store_value(value, r.what, r.rules, item);
    } else {
        lmx::c_datetime moment;
        if (!store_value(value, r.what, r.rules, &moment)) return false;
        items.append(make_object<lmx::c_datetime>(moment));
    }
    in.p = at;
    remember_value(*r.name, whitespace_of(r.what, r.rules));
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
    if (r.what == kind::child_list) {
        auto& items = member_at<list_base>(object_, r.value);
        items.make_room();
        object = r.type->create();
        items.append(object);
        in.p = at;
        return enter(start, *r.type, *r.name, object);
    }
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
    fast_trace& trace = reader_access::trace(reader_);
    trace = {"xsi:type", fast_trace::name_kind::xsi, true, lmx::preserve};
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
    const auto [in, tag] = tag_place(reader_);
    if (tag == nullptr) return false;
    int index = 0;
    while (index < rows_.row_count && !starts(tag, *rows_.rows[index].name))
        ++index;
    if (index == rows_.row_count) return false;
    const row& option = rows_.rows[index];
    auto& slot = member_at<choice_slot>(object_, rows_.slot);
    if (option.what == kind::child) {
        const void* const object = slot.chosen == index ? slot.object : nullptr;
        parsed_start start;
        const char* const at = parse_start(*in, tag, *option.type, *option.name, object, start);
        if (at == nullptr || (!start.complete && is_too_deep())) return false;
        choose_option(rows_, object_, index);
        in->p = at;
        if (!enter(start, *option.type, *option.name, slot.object)) return false;
    } else {
        parsed_value value;
        const char* at = tag + option.name->length;
        if (at[-1] != '>') return false;
        at = parse_content(*in, at, option.what, option.rules, *option.name, value);
        if (at == nullptr) return false;
        choose_option(rows_, object_, index);
        in->p = at;
        store_value(value, option.what, option.rules, option.what == kind::text ? slot.object : &slot.real);
        remember_value(*option.name, whitespace_of(option.what, option.rules));
    }
    begun_ = true;
    last_row_ = 0;
    return true;
}

} // namespace hqf::frame
