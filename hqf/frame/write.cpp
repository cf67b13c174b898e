#include "hqf/frame/write.h"

#include "hqf/frame/objects.h"
#include "hqf/xml_out/output.h"

namespace hqf::frame {

namespace {

/// A qualified name between angle brackets, readable up to the next multiple of 16.
struct tag {
    const char* open;
    std::size_t length;

    explicit tag(const element_name& name)
        : open(name.open)
        , length(name.length) {}
    explicit tag(const std::string& padded, std::size_t size)
        : open(padded.data())
        , length(size) {}
};

/// One write. Codes come back through every enclosing element, which then leaves out its end tag.
class element_writer {
public:
    explicit element_writer(lmx::c_xml_writer& writer)
        : out_(writer) {}

    lmx::elmx_error element(const class_rows& rows, void* object, const tag& name);
    void attributes(const class_rows& rows, const void* object);
    lmx::elmx_error content(const class_rows& rows, void* object);
    lmx::elmx_error group(const class_rows& rows, void* object);

private:
    lmx::c_xml_writer& writer() { return out_.writer(); }

    void start(const class_rows& rows, const tag& name);
    void nil_end();
    void type_attribute(const class_rows& rows);
    void attribute(const row& r, const void* object);
    lmx::elmx_error choice(const class_rows& rows, void* object);
    lmx::elmx_error child(const row& r, void* object);
    lmx::elmx_error group_member(const class_rows& rows, int chosen, void* object);
    lmx::elmx_error bad_selector(const class_rows& rows);
    void list(const row& r, const list_base& items);
    bool stored_value(const row& r, const void* object);
    void literal(const enumerated& value, const literals& texts);
    void option_value(const row& r, const choice_slot& slot);

    template<class value_type>
    void simple(const element_name& name, const value_type& value) {
        const tag around(name);
        out_.indent();
        out_.padded(around.open, around.length);
        out_.value(value);
        end_tag(around);
    }
    void end_tag(const tag& name) {
        out_.character('<');
        out_.character('/');
        out_.padded(name.open + 1, name.length - 1);
        out_.line_end();
    }

    output out_;
};

void element_writer::start(const class_rows& rows, const tag& name) {
    out_.indent();
    out_.padded(name.open, name.length - 1);
    if (rows.writes_namespaces) {
        writer().conditionally_select_ns_map(namespace_map);
        if (!writer_access::ns_attrs_written(writer())) {
            out_.flush();
            writer().conditionally_write_ns_attrs(true);
        }
    }
}

/// Ends the start tag of a nil element, and with it the element.
void element_writer::nil_end() {
    static constexpr char nil[] = " xsi:nil=\"true\"/>";
    out_.text(nil, sizeof(nil) - 1);
    out_.line_end();
}

void element_writer::type_attribute(const class_rows& rows) {
    const char* expected = writer().get_expected_class_identity();
    if (expected == nullptr || expected == *rows.id) return;
    const std::string text = " xsi:type=\"Hqf:" + std::string(rows.name) + '"';
    out_.text(text.data(), text.size());
    writer().clear_expected_class_identity();
}

lmx::elmx_error element_writer::element(const class_rows& rows, void* object, const tag& name) {
    if (!is_occurs_ok(rows, object)) return lmx::err_min_max_occurs_error_on_marshaling;
    start(rows, name);
    if (rows.is_nil(object)) {
        if (rows.attributes_when_nil) attributes(rows, object);
        nil_end();
        return lmx::err_no_error;
    }
    if (rows.id != nullptr) type_attribute(rows);
    attributes(rows, object);
    out_.character('>');
    if (rows.shape == form::simple_content) {
        content(rows, object);
        end_tag(name);
        return lmx::err_no_error;
    }
    out_.line_end();
    writer().indent();
    const lmx::elmx_error error = content(rows, object);
    if (error != lmx::err_no_error) return error;
    writer().undent();
    out_.indent();
    end_tag(name);
    return lmx::err_no_error;
}

void element_writer::attributes(const class_rows& rows, const void* object) {
    for (unsigned int i = 0; i < rows.attribute_count; ++i) {
        const row& r = rows.attributes[i];
        if (r.has(mandatory_row) || r.has(always_written) || member_at<bool>(object, r.flag)) attribute(r, object);
    }
}

void element_writer::attribute(const row& r, const void* object) {
    out_.padded(r.attribute->open, r.attribute->length);
    stored_value(r, object);
    out_.character('"');
}

/// Writes a single simple value as it is stored; false for a row that holds no such value.
bool element_writer::stored_value(const row& r, const void* object) {
    switch (r.what) {
    case kind::text: out_.value(member_at<std::wstring>(object, r.value)); return true;
    case kind::enumerated: literal(member_at<enumerated>(object, r.value), *r.rules->texts); return true;
    case kind::real: out_.value(member_at<double>(object, r.value)); return true;
    case kind::integer: out_.value(member_at<int>(object, r.value)); return true;
    case kind::natural: out_.value(member_at<unsigned int>(object, r.value)); return true;
    case kind::octet: out_.value(static_cast<unsigned int>(member_at<unsigned char>(object, r.value))); return true;
    case kind::boolean: out_.value(member_at<bool>(object, r.value)); return true;
    case kind::moment: out_.value(member_at<lmx::c_datetime>(object, r.value)); return true;
    case kind::binary: out_.value(member_at<lmx::c_binary>(object, r.value)); return true;
    default: return false;
    }
}

/// No literal has a character that would be escaped.
void element_writer::literal(const enumerated& value, const literals& texts) {
    if (const int number = value.number(); number != 0)
        out_.text(texts.narrow[number - 1], texts.lengths[number - 1]);
    else
        out_.value(value.text(texts));
}

lmx::elmx_error element_writer::content(const class_rows& rows, void* object) {
    switch (rows.shape) {
    case form::choice: return choice(rows, object);
    case form::group: return group(rows, object);
    case form::simple_content:
        // An optional body that is unset leaves the element empty.
        if (rows.rows->has(mandatory_row) || member_at<bool>(object, rows.rows->flag)) stored_value(*rows.rows, object);
        return lmx::err_no_error;
    default: break;
    }
    for (unsigned int i = 0; i < rows.row_count; ++i) {
        const lmx::elmx_error error = child(rows.rows[i], object);
        if (error != lmx::err_no_error) return error;
    }
    return lmx::err_no_error;
}

lmx::elmx_error element_writer::child(const row& r, void* object) {
    void* member = &member_at<char>(object, r.value);
    switch (r.what) {
    case kind::text_list:
    case kind::moment_list:
    case kind::any_list: list(r, member_at<list_base>(object, r.value)); return lmx::err_no_error;
    case kind::child_list:
    case kind::group_list: {
        const auto& items = member_at<list_base>(object, r.value);
        for (unsigned int i = 0; i < items.size(); ++i) {
            const lmx::elmx_error error = r.what == kind::group_list ? group(*r.type, items.item(i))
                                                                     : element(*r.type, items.item(i), tag(*r.name));
            if (error != lmx::err_no_error) return error;
        }
        return lmx::err_no_error;
    }
    default: break;
    }
    if (!r.has(mandatory_row) && !r.has(always_written) && !member_at<bool>(object, r.flag)) return lmx::err_no_error;
    switch (r.what) {
    case kind::child: return element(*r.type, member, tag(*r.name));
    case kind::group: return group(*r.type, member);
    case kind::child_pointer:
    case kind::group_pointer: {
        const auto& held = member_at<pointer_member>(object, r.value);
        if (held.object != nullptr)
            return r.what == kind::group_pointer ? group(*r.type, held.object)
                                                 : element(*r.type, held.object, tag(*r.name));
        if (!held.nil) return lmx::err_type_not_set;
        start(*r.type, tag(*r.name));
        nil_end();
        return lmx::err_no_error;
    }
    default: break;
    }
    const tag around(*r.name);
    out_.indent();
    out_.padded(around.open, around.length);
    stored_value(r, object);
    end_tag(around);
    return lmx::err_no_error;
}

void element_writer::list(const row& r, const list_base& items) {
    for (unsigned int i = 0; i < items.size(); ++i) {
        const void* item = items.item(i);
        if (r.what == kind::text_list) {
            simple(*r.name, *static_cast<const std::wstring*>(item));
        } else if (r.what == kind::moment_list) {
            simple(*r.name, *static_cast<const lmx::c_datetime*>(item));
        } else {
            const std::string& raw = static_cast<const lmx::c_any_info*>(item)->get_value();
            out_.indent();
            out_.text(raw.data(), raw.size());
            out_.line_end();
        }
    }
}

lmx::elmx_error element_writer::choice(const class_rows& rows, void* object) {
    const auto& slot = member_at<choice_slot>(object, rows.slot);
    if (slot.chosen < 0 || slot.chosen >= rows.none()) return bad_selector(rows);
    const row& option = rows.rows[slot.chosen];
    switch (option.what) {
    case kind::child: return element(*option.type, slot.object, tag(*option.name));
    case kind::text: simple(*option.name, *static_cast<const std::wstring*>(slot.object)); break;
    case kind::real: simple(*option.name, slot.real); break;
    case kind::integer: simple(*option.name, slot.integer); break;
    default: simple(*option.name, slot.natural); break;
    }
    return lmx::err_no_error;
}

lmx::elmx_error element_writer::group(const class_rows& rows, void* object) {
    const auto& slot = member_at<object_slot>(object, rows.slot);
    if (slot.chosen == rows.none()) return lmx::err_min_max_occurs_error_on_marshaling;
    if (slot.chosen < 0 || slot.chosen >= rows.member_count) return bad_selector(rows);
    if (slot.object == nullptr) return lmx::err_type_not_set;
    return group_member(rows, slot.chosen, slot.object);
}

lmx::elmx_error element_writer::group_member(const class_rows& rows, int chosen, void* object) {
    const frame::group_member& member = rows.members[chosen];
    const bool is_head = rows.calls->head_factory != nullptr && chosen == 0;
    if (!is_head) return element(*member.type, object, tag(*member.name));
    // The head's object may be of any class of the hierarchy, the application's own included: it writes itself.
    writer().set_expected_class_identity(*rows.calls->head_id);
    out_.flush();
    return rows.calls->marshal(object, writer(), member.name->qualified().c_str());
}

lmx::elmx_error element_writer::bad_selector(const class_rows& rows) {
    out_.flush();
    return writer().handle_error(lmx::err_inappropriate_choice_option_selected, rows.item, "Hqf", __LINE__);
}

} // namespace

lmx::elmx_error write_element(const class_rows& rows, void* object, lmx::c_xml_writer& writer, const char* name) {
    std::string open = '<' + std::string(name) + '>';
    const std::size_t size = open.size();
    open.append(16, '\0');
    return element_writer(writer).element(rows, object, tag(open, size));
}

void write_attributes(const class_rows& rows, const void* object, lmx::c_xml_writer& writer) {
    element_writer(writer).attributes(rows, object);
}

lmx::elmx_error write_content(const class_rows& rows, void* object, lmx::c_xml_writer& writer) {
    return element_writer(writer).content(rows, object);
}

lmx::elmx_error write_group(const class_rows& rows, void* object, lmx::c_xml_writer& writer) {
    return element_writer(writer).group(rows, object);
}

} // namespace hqf::frame
