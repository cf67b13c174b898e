#include "hqf/frame/write.h"

#include <cstring>

#include "hqf/frame/objects.h"
#include "hqf/frame/presence.h"
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

/// One write. Its steps take the place where the text goes and give the one behind, or null after an error: then every
/// enclosing element leaves out its end tag, and what was gathered is on the stream already.
class element_writer {
public:
    explicit element_writer(lmx::c_xml_writer& writer)
        : out_(writer) {}

    lmx::elmx_error element(const class_rows& rows, void* object, const tag& name) {
        return ended(element(out_.begin(), rows, object, name));
    }
    void attributes(const class_rows& rows, const void* object) { out_.flush(attributes(out_.begin(), rows, object)); }
    lmx::elmx_error content(const class_rows& rows, void* object) { return ended(content(out_.begin(), rows, object)); }
    lmx::elmx_error group(const class_rows& rows, void* object) { return ended(group(out_.begin(), rows, object)); }

private:
    lmx::c_xml_writer& writer() { return out_.writer(); }
    lmx::elmx_error ended(const char* at) {
        if (at != nullptr) out_.flush(at);
        return error_;
    }
    char* failed(const char* at, lmx::elmx_error error) {
        out_.flush(at);
        error_ = error;
        return nullptr;
    }

    char* element(char* at, const class_rows& rows, void* object, const tag& name);
    char* attributes(char* at, const class_rows& rows, const void* object);
    char* body(char* at, const class_rows& rows, const void* object);
    char* content(char* at, const class_rows& rows, void* object);
    char* group(char* at, const class_rows& rows, void* object);
    char* start(char* at, const class_rows& rows, const tag& name);
    char* nil_end(char* at);
    char* type_attribute(char* at, const class_rows& rows);
    char* choice(char* at, const class_rows& rows, void* object);
    char* child(char* at, const row& r, void* object);
    char* bad_selector(const char* at, const class_rows& rows);
    char* list(char* at, const row& r, const list_base& items);
    char* any_items(char* at, const list_base& items);
    /// Writes a single simple value as it is stored; behind it an end tag has room. Most values are numbers.
    char* stored_value(char* at, const row& r, const void* object) {
        return r.what == kind::real ? out_.value(at, member_at<double>(object, r.value)) : other_value(at, r, object);
    }
    char* other_value(char* at, const row& r, const void* object);
    char* literal(char* at, const enumerated& value, const literals& texts);

    template<class value_type>
    char* simple(char* at, const element_name& name, const value_type& value) {
        return end_tag(out_.value(start_tag(at, tag(name)), value), tag(name));
    }
    char* start_tag(char* at, const tag& name) {
        return out_.padded(out_.indent(out_.room(at)), name.open, name.length);
    }
    char* end_tag(char* at, const tag& name) {
        std::memcpy(at, "</", 2);
        return out_.line_end(out_.padded(at + 2, name.open + 1, name.length - 1));
    }

    output out_;
    lmx::elmx_error error_ = lmx::err_no_error;
};

char* element_writer::start(char* at, const class_rows& rows, const tag& name) {
    at = out_.padded(out_.indent(out_.room(at)), name.open, name.length - 1);
    if (rows.writes_namespaces) {
        writer().conditionally_select_ns_map(namespace_map);
        if (!writer_access::ns_attrs_written(writer())) {
            out_.flush(at);
            writer().conditionally_write_ns_attrs(true);
            at = out_.begin();
        }
    }
    return at;
}

/// Ends the start tag of a nil element, and with it the element.
char* element_writer::nil_end(char* at) {
    static constexpr char nil[32] = " xsi:nil=\"true\"/>";
    return out_.line_end(out_.padded(at, nil, 17));
}

char* element_writer::type_attribute(char* at, const class_rows& rows) {
    const char* expected = writer().get_expected_class_identity();
    if (expected == nullptr || expected == *rows.id) return at;
    static constexpr char begin[] = " xsi:type=\"Hqf:";
    at = out_.text(at, begin, sizeof begin - 1);
    at = out_.text(at, rows.name, std::strlen(rows.name));
    at = out_.room(at);
    *at = '"';
    writer().clear_expected_class_identity();
    return at + 1;
}

char* element_writer::element(char* at, const class_rows& rows, void* object, const tag& name) {
    if (!has_mandatory_members(rows, object)) return failed(at, lmx::err_min_max_occurs_error_on_marshaling);
    at = start(at, rows, name);
    if (rows.is_nil(object)) {
        if (rows.attributes_when_nil) at = attributes(at, rows, object);
        return nil_end(out_.room(at));
    }
    if (rows.id != nullptr) at = type_attribute(at, rows);
    if (rows.attribute_count != 0) at = attributes(at, rows, object);
    at = out_.room(at);
    *at++ = '>';
    if (rows.shape == form::simple_content) return end_tag(body(at, rows, object), name);
    at = out_.line_end(at);
    writer().indent();
    at = content(at, rows, object);
    if (at == nullptr) return nullptr;
    writer().undent();
    return end_tag(out_.indent(out_.room(at)), name);
}

char* element_writer::attributes(char* at, const class_rows& rows, const void* object) {
    for (const row* r = rows.attributes; r != rows.attributes + rows.attribute_count; ++r) {
        if (!r->has(mandatory_row) && !r->has(always_written) && !member_at<bool>(object, r->flag)) continue;
        at = out_.padded(out_.room(at), r->attribute->open, r->attribute->length);
        at = stored_value(at, *r, object);
        *at++ = '"';
    }
    return at;
}

char* element_writer::other_value(char* at, const row& r, const void* object) {
    switch (r.what) {
    case kind::text: return out_.value(at, member_at<std::wstring>(object, r.value));
    case kind::enumerated: return literal(at, member_at<enumerated>(object, r.value), *r.rules->texts);
    case kind::integer: return out_.value(at, member_at<int>(object, r.value));
    case kind::natural: return out_.value(at, member_at<unsigned int>(object, r.value));
    case kind::octet: return out_.value(at, static_cast<unsigned int>(member_at<unsigned char>(object, r.value)));
    case kind::boolean: return out_.value(at, member_at<bool>(object, r.value));
    case kind::moment: return out_.value(at, member_at<lmx::c_datetime>(object, r.value));
    case kind::binary: return out_.value(at, member_at<lmx::c_binary>(object, r.value));
    default: return at;
    }
}

/// No literal has a character that would be escaped.
char* element_writer::literal(char* at, const enumerated& value, const literals& texts) {
    const int number = value.number();
    if (number == 0) return out_.value(at, value.text(texts));
    return out_.room(out_.text(at, texts.narrow[number - 1], texts.lengths[number - 1]));
}

/// The value of simple content; behind it an end tag has room.
char* element_writer::body(char* at, const class_rows& rows, const void* object) {
    const row& r = *rows.rows;
    // An optional one that is unset leaves the element empty.
    if (!r.has(mandatory_row) && !member_at<bool>(object, r.flag)) return at;
    return stored_value(out_.room(at), r, object);
}

char* element_writer::content(char* at, const class_rows& rows, void* object) {
    switch (rows.shape) {
    case form::choice: return choice(at, rows, object);
    case form::group: return group(at, rows, object);
    case form::simple_content: return body(at, rows, object);
    default: break;
    }
    for (const row* r = rows.rows; r != rows.rows + rows.row_count && at != nullptr; ++r) {
        if (r->is_list()) {
            const auto& items = member_at<list_base>(object, r->value);
            if (items.size() != 0) at = list(at, *r, items);
        } else if (r->has(mandatory_row) || r->has(always_written) || member_at<bool>(object, r->flag))
            at = child(at, *r, object);
    }
    return at;
}

char* element_writer::child(char* at, const row& r, void* object) {
    switch (r.what) {
    case kind::child: return element(at, *r.type, &member_at<char>(object, r.value), tag(*r.name));
    case kind::group: return group(at, *r.type, &member_at<char>(object, r.value));
    case kind::child_pointer:
    case kind::group_pointer: {
        const auto& held = member_at<pointer_member>(object, r.value);
        if (held.object != nullptr)
            return r.what == kind::group_pointer ? group(at, *r.type, held.object)
                                                 : element(at, *r.type, held.object, tag(*r.name));
        if (!held.nil)
            return failed(at, r.what == kind::group_pointer ? lmx::err_type_not_set
                                                            : lmx::err_min_max_occurs_error_on_marshaling);
        return nil_end(start(at, *r.type, tag(*r.name)));
    }
    default: return end_tag(stored_value(start_tag(at, tag(*r.name)), r, object), tag(*r.name));
    }
}

char* element_writer::list(char* at, const row& r, const list_base& items) {
    if (r.what == kind::any_list) return any_items(at, items);
    for (unsigned int i = 0; i < items.size() && at != nullptr; ++i) {
        void* const item = items.item(i);
        switch (r.what) {
        case kind::child_list: at = element(at, *r.type, item, tag(*r.name)); break;
        case kind::group_list: at = group(at, *r.type, item); break;
        case kind::text_list: at = simple(at, *r.name, *static_cast<const std::wstring*>(item)); break;
        default: at = simple(at, *r.name, *static_cast<const lmx::c_datetime*>(item)); break;
        }
    }
    return at;
}

char* element_writer::any_items(char* at, const list_base& items) {
    for (unsigned int i = 0; i < items.size(); ++i) {
        const std::string& raw = static_cast<const lmx::c_any_info*>(items.item(i))->get_value();
        at = out_.text(out_.indent(out_.room(at)), raw.data(), raw.size());
        at = out_.line_end(out_.room(at));
    }
    return at;
}

char* element_writer::choice(char* at, const class_rows& rows, void* object) {
    const auto& slot = member_at<choice_slot>(object, rows.slot);
    if (slot.chosen < 0 || slot.chosen >= rows.none()) return bad_selector(at, rows);
    const row& option = rows.rows[slot.chosen];
    switch (option.what) {
    case kind::child: return element(at, *option.type, slot.object, tag(*option.name));
    case kind::text: return simple(at, *option.name, *static_cast<const std::wstring*>(slot.object));
    case kind::real: return simple(at, *option.name, slot.real);
    case kind::integer: return simple(at, *option.name, slot.integer);
    default: return simple(at, *option.name, slot.natural);
    }
}

char* element_writer::group(char* at, const class_rows& rows, void* object) {
    const auto& slot = member_at<object_slot>(object, rows.slot);
    if (slot.chosen == rows.none()) return failed(at, lmx::err_min_max_occurs_error_on_marshaling);
    if (slot.chosen < 0 || slot.chosen >= rows.member_count) return bad_selector(at, rows);
    if (slot.object == nullptr) return failed(at, lmx::err_type_not_set);
    const group_member& member = rows.members[slot.chosen];
    const bool is_head = rows.calls->head_factory != nullptr && slot.chosen == 0;
    if (!is_head) return element(at, *member.type, slot.object, tag(*member.name));
    // The head's object may be of any class of the hierarchy, the application's own included: it writes itself.
    writer().set_expected_class_identity(*rows.calls->head_id);
    out_.flush(at);
    error_ = rows.calls->marshal(slot.object, writer(), member.name->qualified().c_str());
    return error_ == lmx::err_no_error ? out_.begin() : nullptr;
}

char* element_writer::bad_selector(const char* at, const class_rows& rows) {
    out_.flush(at);
    error_ = writer().handle_error(lmx::err_inappropriate_choice_option_selected, rows.item, "Hqf", __LINE__);
    return error_ == lmx::err_no_error ? out_.begin() : nullptr;
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
