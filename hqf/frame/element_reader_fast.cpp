/// The fast road: whole steps over the window. What a step has not read to its end it has not read at all.

#include "hqf/frame/element_reader.h"
#include "hqf/frame/objects.h"
#include "hqf/frame/read_value.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/reader_access.h"

namespace hqf::frame {

namespace {

/// The window with the '<' of a tag at its position, or null.
window* next_tag(lmx::c_xml_reader& reader) {
    window* const in = reader_access::begin_element(reader);
    if (in == nullptr) return nullptr;
    in->skip_space();
    return in->room(longest_name_room) && *in->p == '<' ? in : nullptr;
}

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
    window* const in = next_tag(reader_);
    if (in == nullptr || in->p[1] != '/') return false;
    const std::string_view name = name_->get_str();
    if (!in->room(name.size() + 3) || std::memcmp(in->p + 2, name.data(), name.size()) != 0 ||
        in->p[2 + name.size()] != '>')
        return false;
    in->p += name.size() + 3;
    reader_.restore_event(lmx::EXE_ELEMENT_END);
    return true;
}

/// Goes into an element whose start tag has been read, or is done with it if that was all.
bool element_reader::enter(const parsed_start& start, const class_rows& rows, const element_name& name, void* object) {
    remember(start, rows, name);
    store_start(start, rows, object);
    if (start.complete) return true;
    error_ = element_reader(rows, object, reader_).entered(qualified_name(name));
    return error_ == lmx::err_no_error;
}

// Children

void element_reader::fast_children(row_cursor& at) {
    for (;;) {
        window* const in = next_tag(reader_);
        if (in == nullptr) return;
        if (in->p[1] == '/') {
            // An element with no content at all is accepted here if its class is tolerant; else the general road
            // reports.
            if (!begun_)
                is_over_ = rows_.tolerant && fast_end_tag();
            else if (is_rest_optional(at))
                at.row = rows_.row_count;
            return;
        }
        int member = -1;
        row_cursor found = at;
        const row* const r = find_row(*in, found, member);
        if (r == nullptr) return;
        const char* const mark = in->mark();
        if (!fast_child(*in, *r, member)) {
            if (error_ == lmx::err_no_error) in->back(mark);
            return;
        }
        begun_ = true;
        successors_ = rows_.events_from(found.row);
        at = found;
        at.seen = true;
        if (!r->is_list()) at.next_row();
    }
}

/// Whether the rows from the cursor on are satisfied with what has been read.
bool element_reader::is_rest_optional(row_cursor at) const {
    for (; at.row < rows_.row_count; at.next_row()) {
        const row& r = rows_.rows[at.row];
        if (r.has(mandatory_row) && !at.seen) return false;
    }
    return true;
}

/// The row that the start tag here belongs to, with the cursor moved to it; null where the general road must decide.
const row* element_reader::find_row(const window& in, row_cursor& at, int& member) const {
    for (; at.row < rows_.row_count; at.next_row()) {
        const row& r = rows_.rows[at.row];
        if (r.is_group()) {
            member = find_member(in, *r.type);
            if (member >= 0) return &r;
        } else if (r.name != nullptr && starts(in, *r.name)) {
            return &r;
        }
        if (r.has(mandatory_row) && !at.seen) return nullptr;
    }
    return nullptr;
}

bool element_reader::fast_child(window& in, const row& r, int member) {
    switch (r.what) {
    case kind::child:
    case kind::child_pointer:
    case kind::child_list: return fast_object(in, r);
    case kind::group:
    case kind::group_pointer:
    case kind::group_list: return fast_member(in, r, member);
    case kind::text_list:
    case kind::moment_list: return fast_text_item(in, r);
    default: return fast_simple(in, r);
    }
}

bool element_reader::fast_simple(window& in, const row& r) {
    parsed_value value;
    in.p += r.name->length;
    if (in.p[-1] != '>' || !parse_value(in, r.what, r.rules, '<', value) || !close_tag(in, *r.name) ||
        !store_value(value, r.what, r.rules, &member_at<char>(object_, r.value)))
        return false;
    member_at<bool>(object_, r.flag) = true;
    remember_value(*r.name, whitespace_of(r.what, r.rules));
    return true;
}

bool element_reader::fast_text_item(window& in, const row& r) {
    parsed_value value;
    in.p += r.name->length;
    if (in.p[-1] != '>' || !parse_value(in, r.what, r.rules, '<', value) || !close_tag(in, *r.name)) return false;
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
    remember_value(*r.name, whitespace_of(r.what, r.rules));
    return true;
}

bool element_reader::fast_object(window& in, const row& r) {
    void* object = nullptr;
    if (r.what == kind::child)
        object = &member_at<char>(object_, r.value);
    else if (r.what == kind::child_pointer)
        object = member_at<void*>(object_, r.value);
    parsed_start start;
    if (!parse_start(in, *r.type, *r.name, object, start) || (!start.complete && is_too_deep())) return false;
    if (r.what == kind::child_list) {
        auto& items = member_at<list_base>(object_, r.value);
        items.make_room();
        object = r.type->create();
        items.append(object);
        return enter(start, *r.type, *r.name, object);
    }
    if (object == nullptr) {
        auto& held = member_at<pointer_member>(object_, r.value);
        if (start.nil) {
            remember(start, *r.type, *r.name);
            return held.nil = held.present = true;
        }
        if (held.nil) return false;
        object = held.object = r.type->create();
    }
    if (!enter(start, *r.type, *r.name, object)) return false;
    member_at<bool>(object_, r.flag) = true;
    return true;
}

bool element_reader::fast_member(window& in, const row& r, int member) {
    if (member == 0 && r.type->calls->head_factory != nullptr) return fast_head(in, r);
    const group_member& chosen = r.type->members[member];
    parsed_start start;
    if (!parse_start(in, *chosen.type, *chosen.name, nullptr, start) || (!start.complete && is_too_deep()))
        return false;
    void* const group = group_to_fill(r);
    void* const made = chosen.type->create();
    hold_member(*r.type, group, member, made);
    if (!enter(start, *chosen.type, *chosen.name, made)) return false;
    if (r.what != kind::group_list) member_at<bool>(object_, r.flag) = true;
    return true;
}

/// The head of a group: xsi:type tells the class.
bool element_reader::fast_head(window& in, const row& r) {
    const class_rows& group_rows = *r.type;
    const element_name& name = *group_rows.members[0].name;
    std::string_view type_name;
    in.p += name.length - 1;
    if (!parse_type_attribute(in, type_name) || is_too_deep()) return false;
    int member = group_rows.member_count - 1;
    while (member > 0 && type_name != group_rows.members[member].type->name)
        --member;
    if (member == 0) return false;
    const class_rows& rows = *group_rows.members[member].type;
    void* const group = group_to_fill(r);
    void* const made = rows.create();
    hold_member(group_rows, group, 0, made);
    fast_trace& trace = reader_access::trace(reader_);
    trace = {"xsi:type", fast_trace::name_kind::xsi, true, lmx::preserve};
    error_ = element_reader(rows, made, reader_).entered(qualified_name(name));
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
    window* const in = next_tag(reader_);
    if (in == nullptr) return false;
    const char* const mark = in->mark();
    int index = 0;
    while (index < rows_.row_count && !starts(*in, *rows_.rows[index].name))
        ++index;
    if (index == rows_.row_count) return false;
    const row& option = rows_.rows[index];
    auto& slot = member_at<choice_slot>(object_, rows_.slot);
    bool done = false;
    if (option.what == kind::child) {
        const void* const object = slot.chosen == index ? slot.object : nullptr;
        parsed_start start;
        if (parse_start(*in, *option.type, *option.name, object, start) && !(!start.complete && is_too_deep())) {
            choose_option(rows_, object_, index);
            done = enter(start, *option.type, *option.name, slot.object);
        }
    } else {
        parsed_value value;
        in->p += option.name->length;
        if (in->p[-1] == '>' && parse_value(*in, option.what, option.rules, '<', value) &&
            close_tag(*in, *option.name)) {
            choose_option(rows_, object_, index);
            done = store_value(value, option.what, option.rules, option.what == kind::text ? slot.object : &slot.real);
            remember_value(*option.name, whitespace_of(option.what, option.rules));
        }
    }
    if (!done) {
        if (error_ == lmx::err_no_error) in->back(mark);
        return false;
    }
    begun_ = true;
    successors_ = rows_.element_events;
    return true;
}

} // namespace hqf::frame
