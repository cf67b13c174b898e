#include "hqf/frame/read.h"

#include "hqf/frame/element_reader.h"

namespace hqf::frame {

namespace {

/// Derived classes may follow the item's name in a string of their own; all else looks at the reader's.
class item_name_of_caller {
public:
    item_name_of_caller(lmx::c_xml_reader& reader, std::string* name)
        : reader_(reader)
        , name_(name == &reader.item_name ? nullptr : name) {
        if (name_ != nullptr) reader_.item_name = *name_;
    }
    item_name_of_caller(const item_name_of_caller&) = delete;
    item_name_of_caller& operator=(const item_name_of_caller&) = delete;
    ~item_name_of_caller() {
        if (name_ != nullptr) name_->swap(reader_.item_name);
    }

private:
    lmx::c_xml_reader& reader_;
    std::string* const name_;
};

} // namespace

lmx::elmx_error read_element(const class_rows& rows, void* object, lmx::c_xml_reader& reader, const std::string& name) {
    return element_reader(rows, object, reader).element(name);
}

bool read_attribute(const class_rows& rows, void* object, lmx::c_xml_reader& reader, const std::string& attribute,
                    lmx::elmx_error* error) {
    element_reader element(rows, object, reader);
    const bool is_own = element.attribute(attribute);
    *error = element.error();
    return is_own;
}

lmx::elmx_error check_attributes(const class_rows& rows, void* object, lmx::c_xml_reader& reader) {
    element_reader element(rows, object, reader);
    element.check_attributes();
    return element.error();
}

bool read_body(const class_rows& rows, void* object, lmx::c_xml_reader& reader, std::string* name,
               lmx::elmx_error* error) {
    const item_name_of_caller own(reader, name);
    element_reader element(rows, object, reader);
    const bool done = element.body_from_event();
    *error = element.error();
    return done;
}

bool read_simple_body(const class_rows& rows, void* object, lmx::c_xml_reader& reader, std::string* name,
                      lmx::elmx_error* error, bool has_body) {
    const item_name_of_caller own(reader, name);
    element_reader element(rows, object, reader);
    const bool done = element.simple_body(has_body);
    *error = element.error();
    return done;
}

bool is_member(const class_rows& rows, lmx::c_xml_reader& reader) {
    if (!reader.is_current_event_tokenisable()) return false;
    const int old_event = reader.get_current_event();
    reader.tokenise(rows.element_events, lmx::elxp_element);
    if (reader.get_current_event() >= lmx::EXE_FIRST_TOKEN) return true;
    reader.restore_event(old_event);
    return false;
}

bool read_group(const class_rows& rows, void* object, lmx::c_xml_reader& reader, std::string* name,
                lmx::elmx_error* error) {
    bool in_hand = false;
    *error = lmx::err_no_error;
    if (!read_member(rows, object, reader, *name, error, &in_hand)) return false;
    if (in_hand) return true;
    lmx::elmx_error code = lmx::err_no_error;
    reader.get_element_event(rows.element_events, &code, name);
    if (code != lmx::err_no_error) *error = reader.handle_error(code, *name, "Hqf", __LINE__);
    return *error == lmx::err_no_error;
}

} // namespace hqf::frame
