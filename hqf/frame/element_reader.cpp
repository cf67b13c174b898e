/// The general road: one event of the reader after the other.

#include "hqf/frame/element_reader.h"

#include "hqf/frame/objects.h"
#include "hqf/frame/read.h"
#include "hqf/frame/read_value.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/reader_access.h"

namespace hqf::frame {

namespace {

constexpr char source_name[] = "Hqf";
constexpr int xsi_namespace_id = 5;

/// Counts the model elements that are open in a reader.
class depth_count {
public:
    explicit depth_count(lmx::c_xml_reader& reader)
        : depth_(reader_access::model_depth(reader)) {
        ++depth_;
    }
    depth_count(const depth_count&) = delete;
    depth_count& operator=(const depth_count&) = delete;
    ~depth_count() { --depth_; }
    bool is_too_deep() const { return depth_ > limits::model_depth; }

private:
    unsigned int& depth_;
};

} // namespace

/// Before an event of the general road: leaves the reader as that road would have left it behind what the fast one has
/// read.
void element_reader::settle() {
    reader_access::note_general_step(reader_);
    fast_trace& trace = reader_access::trace(reader_);
    using name_kind = fast_trace::name_kind;
    switch (trace.kind) {
    case name_kind::none: return;
    case name_kind::element: {
        const auto& name = *static_cast<const element_name*>(trace.name);
        reader_access::set_name(reader_, name.text(), 3, format_namespace_id);
        break;
    }
    case name_kind::attribute:
        reader_access::crack_name(reader_, static_cast<const attribute_name*>(trace.name)->plain());
        break;
    case name_kind::nil: reader_access::set_name(reader_, "xsi:nil", 3, xsi_namespace_id); break;
    case name_kind::type: reader_access::set_name(reader_, "xsi:type", 3, xsi_namespace_id); break;
    }
    if (const auto* const value = static_cast<const row*>(trace.value); value != nullptr)
        reader_access::set_ws_mode(reader_, whitespace_of(value->what, value->rules));
    reader_access::forget_attributes(reader_);
    trace = {};
}

bool element_reader::report(lmx::elmx_error code, const std::string& item, int line) {
    error_ = reader_.handle_error(code, item, source_name, line);
    return error_ == lmx::err_no_error;
}

lmx::elmx_error element_reader::element(std::string_view name) {
    const depth_count depth(reader_);
    if (depth.is_too_deep()) {
        // No handler can make this go on: the stack of the thread is at stake.
        report(lmx::err_xml_badly_formed, std::string(name), __LINE__);
        return error_ != lmx::err_no_error ? error_ : lmx::err_xml_badly_formed;
    }
    const lmx::c_string_stack_node node(reader_.get_element_name_stack(), name);
    name_ = &node;
    if (!start_tag() || !check_attributes()) return error_;
    if (rows_.shape == form::simple_content)
        simple_content();
    else
        content();
    return error_;
}

lmx::elmx_error element_reader::entered(const element_name& name) {
    const depth_count depth(reader_);
    const lmx::c_string_stack_node node(reader_.get_element_name_stack(), name.text(), lmx::c_string_stack::padded);
    name_ = &node;
    fast_name_ = &name;
    row_cursor at;
    if (rows_.shape == form::sequence)
        fast_children(at);
    else if (rows_.shape == form::choice)
        is_over_ = fast_option() && fast_end_tag();
    if (!is_over_ && error_ == lmx::err_no_error) rest_of_content(at);
    return error_;
}

/// What the fast road has left. Only the general road declares namespaces, so only it needs a scope.
void element_reader::rest_of_content(row_cursor at) {
    const lmx::c_xml_reader_local scope(&reader_);
    const bool is_read = rows_.shape == form::sequence ? children(at) : begun_ || body();
    if (is_read && !is_over_) end_tag();
}

// The start tag

bool element_reader::start_tag() {
    lmx::elmx_error error = lmx::err_no_error;
    while (reader_.get_attribute_event(nullptr, &error, &reader_.attribute_name)) {
        if (error != lmx::err_no_error && !report(error, reader_.attribute_name, __LINE__)) return false;
        if (lmx::c_xml::is_error_event(event()) && reader_access::is_at_end(reader_)) {
            // The handler goes on, but nothing is left to go on with.
            error_ = error != lmx::err_no_error ? error : lmx::err_unexpected_end_of_message;
            return false;
        }
        const bool is_own = attribute(reader_.attribute_name);
        if (error_ != lmx::err_no_error) return false;
        if (is_own) continue;
        if (!reader_.is_xsi_attribute(reader_.attribute_name) &&
            !report(lmx::err_unexpected_attribute, reader_.item_name, __LINE__))
            return false;
        reader_.skip_attribute_value();
    }
    return true;
}

bool element_reader::attribute(const std::string& name) {
    reader_.tokenise(rows_.attribute_events, lmx::elxp_attribute);
    if (rows_.nil != 0 && event() == lmx::EXE_XSI_NIL) return nil_attribute(name);
    const row* r = nullptr;
    for (unsigned int i = 0; i < rows_.attribute_count && r == nullptr; ++i)
        if (rows_.attributes[i].attribute->event == event()) r = &rows_.attributes[i];
    if (r == nullptr) return false;
    bool& set = member_at<bool>(object_, r->flag);
    if (set && !report(lmx::err_attribute_has_already_been_read, name, __LINE__)) return true;
    if (!reader_.get_attribute_value(&reader_.value_buffer, whitespace_of(r->what, r->rules))) {
        report(lmx::err_unable_to_read_attribute_value, name, __LINE__);
        return true;
    }
    error_ = convert_value({r->what, r->rules, &member_at<char>(object_, r->value)}, reader_, name);
    if (error_ == lmx::err_no_error) set = true;
    return true;
}

bool element_reader::nil_attribute(const std::string& name) {
    if (!reader_.get_attribute_value(&reader_.value_buffer, lmx::collapse)) {
        report(lmx::err_unable_to_read_attribute_value, name, __LINE__);
        return true;
    }
    member_at<bool>(object_, rows_.nil) = reader_.value_buffer == "true" || reader_.value_buffer == "1";
    return true;
}

bool element_reader::check_attributes() {
    for (unsigned int i = 0; i < rows_.attribute_count; ++i)
        if (rows_.attributes[i].has(mandatory_row) && !member_at<bool>(object_, rows_.attributes[i].flag))
            return report(lmx::err_required_attribute_s_missing, rows_.name, __LINE__);
    return true;
}

// Content

void element_reader::content() {
    const lmx::c_xml_reader_local scope(&reader_);
    if (rows_.is_nil(object_)) return nil_content();
    if (event() == lmx::EXE_ELEMENT_END) {
        if (!rows_.tolerant) report(lmx::err_unexpected_empty_element, name_->get_str(), __LINE__);
        return;
    }
    if (body() && !is_over_) end_tag();
}

void element_reader::nil_content() {
    reader_.item_name = name_->get_str();
    in_hand_ = event() == lmx::EXE_ELEMENT_END;
    end_tag();
}

void element_reader::simple_content() {
    reader_.item_name = name_->get_str();
    if (!rows_.is_nil(object_) && !simple_body(event() != lmx::EXE_ELEMENT_END)) return;
    in_hand_ = event() == lmx::EXE_ELEMENT_END;
    end_tag();
}

/// Awaits the end of the element: any other thing that stands there gives 10.
void element_reader::end_tag() {
    if (!in_hand_) {
        if (fast_end_tag()) return;
        lmx::elmx_error error = lmx::err_no_error;
        settle();
        reader_.get_element_event(successors(), &error, &reader_.item_name);
        // Behind children the report names what was read; in place of a value or of nothing it names the element.
        if (error != lmx::err_no_error &&
            !report(error, last_row_ >= 0 ? reader_.item_name : name_->get_str(), __LINE__))
            return;
    }
    if (event() != lmx::EXE_ELEMENT_END || *name_ != reader_.item_name)
        report(lmx::err_bad_end_of_element, name_->get_str(), __LINE__);
}

bool element_reader::simple_body(bool has_body) {
    const row& r = *rows_.rows;
    reader_.value_buffer.clear();
    if (has_body && !reader_.get_element_value(&reader_.value_buffer, whitespace_of(r.what, r.rules), true))
        return report(lmx::err_unable_to_read_element_value, reader_.item_name, __LINE__);
    error_ = convert_value({r.what, r.rules, &member_at<char>(object_, r.value)}, reader_, reader_.item_name);
    if (error_ == lmx::err_no_error) member_at<bool>(object_, r.flag) = true;
    return error_ == lmx::err_no_error;
}

bool element_reader::body() {
    switch (rows_.shape) {
    case form::wildcard: return wildcard();
    case form::choice: return choice();
    default: break;
    }
    row_cursor at;
    if (!in_hand_) fast_children(at);
    return is_over_ || error_ != lmx::err_no_error ? error_ == lmx::err_no_error : children(at);
}

bool element_reader::body_from_event() {
    in_hand_ = begun_ = true;
    if (rows_.shape != form::wildcard) reader_.tokenise(rows_.element_events, lmx::elxp_element);
    return body() && (in_hand_ || next_event());
}

/// Reads the first event of the content; an empty element ends with it.
bool element_reader::first_event() {
    begun_ = in_hand_ = true;
    lmx::elmx_error error = lmx::err_no_error;
    settle();
    reader_.get_element_event(nullptr, &error, &reader_.item_name);
    if (error != lmx::err_no_error && !report(error, name_->get_str(), __LINE__)) return false;
    if (event() == lmx::EXE_ELEMENT_END) {
        is_over_ = true;
        return rows_.tolerant || report(lmx::err_unexpected_empty_element, name_->get_str(), __LINE__);
    }
    if (rows_.shape != form::wildcard) reader_.tokenise(rows_.element_events, lmx::elxp_element);
    return true;
}

/// The children that may still come: the table for the next general event, null before the first child.
const lmx::s_event_map* element_reader::successors() const {
    if (last_row_ < 0) return nullptr;
    return rows_.shape == form::choice ? rows_.element_events : rows_.events_from(static_cast<unsigned int>(last_row_));
}

bool element_reader::next_event() {
    if (!begun_) return first_event();
    in_hand_ = true;
    lmx::elmx_error error = lmx::err_no_error;
    settle();
    reader_.get_element_event(successors(), &error, &reader_.item_name);
    return error == lmx::err_no_error || report(error, reader_.item_name, __LINE__);
}

// Children

/// From the cursor on, where the fast road doesn't get any further.
bool element_reader::children(row_cursor at) {
    while (at.row < rows_.row_count) {
        if (!in_hand_) {
            if (!next_event()) return false;
            if (is_over_) return true;
        }
        if (!child_of_row(at)) return false;
        if (in_hand_) continue;
        fast_children(at);
        if (is_over_ || error_ != lmx::err_no_error) return error_ == lmx::err_no_error;
    }
    return !rows_.minimums_at_end || minimums_at_end();
}

/// With an event in hand: reads one child of the cursor's row, or moves on to the next row.
bool element_reader::child_of_row(row_cursor& at) {
    const row& r = rows_.rows[at.row];
    const bool is_next =
        r.is_group() ? is_member(*r.type, reader_) : event() == r.name->event && (!at.seen || r.is_list());
    if (is_next) {
        last_row_ = static_cast<int>(at.row);
        at.seen = true;
        if (!r.is_list()) at.next_row();
        return read_child(r);
    }
    const bool seen = at.seen;
    at.next_row();
    if (seen || !r.has(mandatory_row) || r.what == kind::group_list) return true;
    if (!r.is_group()) return report(lmx::err_mandatory_element_missing, r.name->qualified(), __LINE__);
    last_row_ = static_cast<int>(at.row) - 1;
    return read_single_group(r);
}

bool element_reader::read_child(const row& r) {
    in_hand_ = false;
    switch (r.what) {
    case kind::child:
        if (!read_object(*r.type, &member_at<char>(object_, r.value))) return false;
        member_at<bool>(object_, r.flag) = true;
        return true;
    case kind::child_pointer:
        if (!read_object(*r.type, made_object(r))) return false;
        member_at<bool>(object_, r.flag) = true;
        return true;
    case kind::text_list:
    case kind::moment_list:
    case kind::child_list: return list_item(r);
    case kind::group:
    case kind::group_pointer: return read_single_group(r);
    case kind::group_list:
        return read_member(*r.type, group_to_fill(r), reader_, reader_.item_name, &error_, &in_hand_);
    default: break;
    }
    bool stored = false;
    if (!simple_value(r, r.what, &member_at<char>(object_, r.value), stored)) return false;
    if (stored) member_at<bool>(object_, r.flag) = true;
    return true;
}

/// The object of a child held by pointer, made if need be.
void* element_reader::made_object(const row& r) {
    auto& held = member_at<pointer_member>(object_, r.value);
    if (held.object == nullptr) {
        held.object = r.type->create();
        if (held.nil) member_at<bool>(held.object, r.type->nil) = true;
    }
    return held.object;
}

bool element_reader::read_single_group(const row& r) {
    void* const group = group_to_fill(r);
    in_hand_ = false;
    if (!read_member(*r.type, group, reader_, reader_.item_name, &error_, &in_hand_)) return false;
    member_at<bool>(object_, r.flag) = true;
    return true;
}

bool element_reader::read_object(const class_rows& rows, void* object) {
    error_ = element_reader(rows, object, reader_).element(reader_.item_name);
    return error_ == lmx::err_no_error;
}

bool element_reader::list_item(const row& r) {
    auto& items = member_at<list_base>(object_, r.value);
    if (r.what == kind::child_list) {
        items.make_room();
        items.append(r.type->create());
        return read_object(*r.type, items.item(items.size() - 1));
    }
    bool stored = false;
    const auto append = [&]<class value_type>(value_type value, kind what) {
        if (!simple_value(r, what, &value, stored)) return false;
        if (!stored) return true;
        items.make_room();
        items.append(make_object<value_type>(value));
        return true;
    };
    return r.what == kind::text_list ? append(std::wstring(), kind::text) : append(lmx::c_datetime(), kind::moment);
}

/// Reads a simple element into `value`. False when that ends the load; `stored` tells whether there is a value.
bool element_reader::simple_value(const row& r, kind what, void* value, bool& stored) {
    lmx::elmx_error error = lmx::err_no_error;
    bool empty = false;
    if (!reader_.get_simple_type_value(reader_.item_name, whitespace_of(what, r.rules), &reader_.value_buffer, &error,
                                       &empty))
        return report(r.has(value_error_only) ? lmx::err_unable_to_read_element_value : error, reader_.item_name,
                      __LINE__);
    error_ = convert_value({what, r.rules, value}, reader_, reader_.item_name);
    stored = error_ == lmx::err_no_error;
    return stored;
}

bool element_reader::minimums_at_end() {
    for (unsigned int i = 0; i < rows_.row_count; ++i) {
        const row& r = rows_.rows[i];
        if (!r.is_list() || !r.has(mandatory_row) || member_at<list_base>(object_, r.value).size() != 0) continue;
        if (!in_hand_ && !next_event()) return false;
        if (!report(lmx::err_mandatory_element_missing, rows_.item, __LINE__)) return false;
    }
    return true;
}

// Choices and wildcards

bool element_reader::choice() {
    if (!in_hand_) {
        if (fast_option() || error_ != lmx::err_no_error) return error_ == lmx::err_no_error;
        if (!next_event()) return false;
        if (is_over_) return true;
    }
    for (const row* option = rows_.rows; option != rows_.rows + rows_.row_count; ++option)
        if (option->name->event == event()) return read_option(*option);
    return report(lmx::err_unknown_element_in_complexcontent, reader_.item_name, __LINE__);
}

bool element_reader::read_option(const row& option) {
    in_hand_ = false;
    last_row_ = 0;
    choose_new_option(rows_, object_, static_cast<int>(&option - rows_.rows));
    auto& slot = member_at<choice_slot>(object_, rows_.slot);
    if (option.what == kind::child) return read_object(*option.type, slot.object);
    bool stored = false;
    return simple_value(option, option.what, option.what == kind::text ? slot.object : &slot.real, stored);
}

bool element_reader::wildcard() {
    if (!in_hand_ && !next_event()) return false;
    if (is_over_) return true;
    auto& entries = member_at<list<lmx::c_any_info>>(object_, rows_.rows->value);
    const bool found = reader_.is_current_event_tokenisable();
    while (reader_.is_current_event_tokenisable()) {
        const std::string name = reader_.item_name;
        if (!reader_.get_any_element(name, &reader_.value_buffer, lmx::preserve, false)) {
            if (!report(lmx::err_unable_to_read_element_value, name, __LINE__)) return false;
        } else {
            std::string uri;
            std::string local_name;
            reader_.get_namespace(name, &uri);
            lmx::c_xml::get_local_name(name, &local_name);
            entries.add(uri, local_name, reader_.value_buffer);
        }
        if (!next_event()) return false;
    }
    if (!found && !report(lmx::err_mandatory_element_missing, "Hqf:", __LINE__)) return false;
    return entries.size() != 0 || report(lmx::err_mandatory_element_missing, rows_.item, __LINE__);
}

// Groups

void hold_member(const class_rows& group, void* object, int index, void* made) {
    auto& slot = member_at<object_slot>(object, group.slot);
    void* old = slot.object;
    slot.object = made;
    slot.chosen = index;
    if (old != nullptr) group.calls->destroy(old);
}

bool read_member(const class_rows& group, void* object, lmx::c_xml_reader& reader, const std::string& name,
                 lmx::elmx_error* error, bool* in_hand) {
    const auto go_on_after = [&](lmx::elmx_error code, int line) {
        *error = reader.handle_error(code, name, source_name, line);
        return *error == lmx::err_no_error;
    };
    // An element whose name is one of the xsi attributes' is an element all the same.
    const int event = reader.get_current_event();
    const bool has_name = reader.is_current_event_tokenisable() ||
                          (event >= lmx::EXE_XSI_TYPE && event <= lmx::EXE_XSI_NO_NS_SCHEMA_LOCATION);
    if (has_name) reader.tokenise(group.element_events, lmx::elxp_element);
    int index = has_name ? group.member_count - 1 : -1;
    while (index >= 0 && group.members[index].name->event != reader.get_current_event())
        --index;
    if (index < 0) {
        hold_member(group, object, group.none(), nullptr);
        // Where the owner's end tag stands there is no element to pass over.
        if (!has_name) *in_hand = true;
        return (has_name && reader.skip_rest_of_element(name)) || go_on_after(lmx::err_bad_end_of_element, __LINE__);
    }
    if (index == 0 && group.calls->head_factory != nullptr) {
        int namespace_id = 0;
        std::string type_name;
        void* made = reader.get_xsi_type(&namespace_id, &type_name) ? group.calls->head_factory(namespace_id, type_name)
                                                                    : nullptr;
        if (made == nullptr) {
            *error = lmx::err_unknown_xsi_type;
            return false;
        }
        hold_member(group, object, index, made);
        *error = group.calls->unmarshal(made, reader, name);
    } else {
        void* made = group.members[index].type->create();
        hold_member(group, object, index, made);
        *error = element_reader(*group.members[index].type, made, reader).element(name);
    }
    return *error == lmx::err_no_error;
}

} // namespace hqf::frame
