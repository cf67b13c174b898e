/// One element of one class on its way into an object. The class behind hqf/frame/read.h; see there for the two roads.
#pragma once

#include <string>
#include <string_view>

#include "hqf/frame/fast_steps.h"
#include "hqf/frame/rows.h"
#include "hqf/xml_in/c_xml_reader.h"

namespace hqf::frame {

/// The place among the rows of a class that reading has reached.
struct row_cursor {
    unsigned int row = 0;
    /// The row has been read at least once.
    bool seen = false;

    void next_row() {
        ++row;
        seen = false;
    }
};

class element_reader {
public:
    element_reader(const class_rows& rows, void* object, lmx::c_xml_reader& reader)
        : rows_(rows)
        , object_(object)
        , reader_(reader) {}

    /// The first code that the handler didn't turn into 0; after it every operation has ended.
    lmx::elmx_error error() const { return error_; }

    /// Reads the element whose start tag has been read up to its name.
    lmx::elmx_error element(std::string_view name);
    /// Reads the content of an element whose start tag a fast step has read and stored.
    lmx::elmx_error entered(const element_name& name);

    // Pieces of element(), for classes of the application that put them together themselves. Those with a body start
    // from the reader's current event and leave it at the first thing that they don't take.
    bool attribute(const std::string& name);
    bool check_attributes();
    bool body_from_event();
    bool simple_body(bool has_body);

private:
    bool report(lmx::elmx_error code, const std::string& item, int line);

    // The general road.
    void settle();
    bool start_tag();
    bool nil_attribute(const std::string& name);
    void content();
    void nil_content();
    void simple_content();
    void end_tag();
    bool body();
    bool first_event();
    bool next_event();
    int event() const { return reader_.get_current_event(); }
    bool children(row_cursor at);
    void rest_of_content(row_cursor at);
    bool child_of_row(row_cursor& at);
    bool read_child(const row& r);
    bool read_object(const class_rows& rows, void* object);
    void* made_object(const row& r);
    bool read_single_group(const row& r);
    bool list_item(const row& r);
    bool simple_value(const row& r, kind what, void* value, bool& stored);
    bool minimums_at_end();
    bool choice();
    bool read_option(const row& option);
    bool wildcard();

    // Steps over the window.
    bool fast_end_tag();
    bool fast_end_tag(window& in, const char* at);
    const char* named_end_tag(window& in, const char* at) const;
    bool is_end_due(row_cursor at) const;
    const lmx::s_event_map* successors() const;
    void fast_children(row_cursor& at);
    bool fast_child(window& in, const char* at, const row& r, int member);
    bool fast_real(window& in, const char* at, const row& r);
    bool fast_literal(window& in, const char* at, const row& r);
    bool fast_simple(window& in, const char* at, const row& r);
    bool value_read(window& in, const char* at, const row& r);
    bool fast_text_item(window& in, const char* at, const row& r);
    bool fast_moment_item(window& in, const char* at, const row& r);
    bool fast_object(window& in, const char* at, const row& r);
    bool fast_item(window& in, const char* at, const row& r);
    bool fast_member(window& in, const char* at, const row& r, int member);
    bool fast_head(window& in, const char* at, const row& r);
    void* group_to_fill(const row& r);
    bool fast_option();
    bool is_too_deep() const;
    bool enter(const parsed_start& start, const class_rows& rows, const element_name& name, void* object);
    void remember_start(const element_name& name, const row* last_attribute, const row* body);
    void remember(const parsed_start& start, const class_rows& rows, const element_name& name);
    void remember_value(const row& r);

    const class_rows& rows_;
    void* const object_;
    lmx::c_xml_reader& reader_;
    lmx::elmx_error error_ = lmx::err_no_error;
    /// The element's name on the reader's stack; null while only a piece of an element is read.
    const lmx::c_string_stack_node* name_ = nullptr;
    /// The same name, if a fast step read it.
    const element_name* fast_name_ = nullptr;
    /// The reader's current event is about what comes next; otherwise nothing of that has been read.
    bool in_hand_ = false;
    /// Something of the content has been read.
    bool begun_ = false;
    /// The content ended with its first event.
    bool is_over_ = false;
    /// The row of the last child read, -1 before the first.
    int last_row_ = -1;
};

/// Makes a group hold an object as member `index`.
void hold_member(const class_rows& group, void* object, int index, void* made);

/// Reads the member that the current event names into a group, or passes over an element that is none. The event behind
/// it is not read, unless there was no element to read: then `*in_hand` stays true.
bool read_member(const class_rows& group, void* object, lmx::c_xml_reader& reader, const std::string& name,
                 lmx::elmx_error* error, bool* in_hand);

} // namespace hqf::frame
