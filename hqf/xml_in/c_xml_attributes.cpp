#include "hqf/xml_in/c_entity_name_reader.h"
#include "hqf/xml_in/c_xml.h"
#include "hqf/xml_in/name_chars.h"

// The attributes of a start tag: taken in raw when its name is read, handed out one by one afterwards.

namespace lmx {
namespace {

constexpr int id_of_no_namespace = 1;
constexpr int id_of_xsi = 5;
constexpr std::string_view xmlns = "xmlns";

std::string_view local_part(std::string_view name) {
    return name.substr(name.find(':') + 1);
}

} // namespace

bool c_xml::read_attributes(c_xml_local* local) {
    attributes_.clear();
    declarations_.clear();
    int c = getter_.get_non_ws();
    for (; hqf::is_name_start(c); c = getter_.get_non_ws()) {
        std::size_t matched = 0;
        for (; matched < xmlns.size() && c == xmlns[matched]; c = getter_.get())
            ++matched;
        const bool is_declaration = local != nullptr && matched == xmlns.size() && (c == ':' || !hqf::is_name_char(c));

        hqf::attribute_store& store = is_declaration ? declarations_ : attributes_;
        const std::size_t name_offset = store.size();
        store.append(xmlns.substr(0, matched));
        for (; hqf::is_name_char(c); c = getter_.get())
            store.append(c);
        getter_.unget(c);
        store.append(0);
        std::size_t value_offset = 0;
        if (!read_attribute_value(store, &value_offset)) return false;
        if (is_declaration && !declare_namespace(local, store.text_at(name_offset), store.text_at(value_offset)))
            return false;
    }
    getter_.unget(c);
    attributes_.append(0);
    return c != -1;
}

bool c_xml::read_attribute_value(hqf::attribute_store& store, std::size_t* value_offset) {
    const auto shown = [](int c) { return c == -1 ? std::string() : std::string(1, static_cast<char>(c)); };
    int c = getter_.get_non_ws();
    if (c == -1) {
        getter_.error(error_fatal, err_unexpected_end_of_message, "Unexpected end of file");
        return false;
    }
    if (c != '=') {
        getter_.error(error_fatal, err_not_well_formed,
                      "Schema is not Well Formed (expected '=', got '" + shown(c) + "')");
        return false;
    }
    const int quote = c = getter_.get_non_ws();
    if (quote == '"' || quote == '\'') {
        store.append(quote);
        if (value_offset != nullptr) *value_offset = store.size();
        for (c = getter_.get(); c != quote && c != -1; c = getter_.get())
            store.append(c);
        store.append(0);
        if (c == quote) return true;
    }
    getter_.error(error_fatal, err_not_well_formed,
                  "Schema is not Well Formed (expected '\"' or ''', got " + shown(c) + ")");
    return false;
}

// `name` is "xmlns" or "xmlns:prefix" as stored, `value` the raw URI.
bool c_xml::declare_namespace(c_xml_local* local, const char* name, const char* value) {
    const char* prefix = name + xmlns.size();
    if (*prefix == ':') ++prefix;
    if (*prefix == 0 && *value == 0) {
        local->add_namespace("", id_of_no_namespace);
        return true;
    }
    std::string expanded;
    if (std::strchr(value, '&') != nullptr) {
        if (!expand_uri(value, &expanded)) return false;
        value = expanded.c_str();
    }
    local->add_namespace(prefix, namespaces_.add_namespace(value));
    return true;
}

bool c_xml::expand_uri(const char* value, std::string* uri) {
    getter_.reset_ws_mode();
    while (*value != 0) {
        if (*value != '&') {
            *uri += *value++;
            continue;
        }
        c_entity_name_reader_for_c_str reader(++value);
        if (!insert_entity(reader, uri)) return false;
        value += reader.index();
    }
    return true;
}

elxp_xml_event c_xml::get_attribute_name(std::string* name, bool is_declaration) {
    name->clear();
    if (attributes_.has_attribute()) {
        *name = attributes_.take_text();
        return EXE_NAME;
    }
    const int c = getter_.get_non_ws();
    if (c == '>') return EXE_START_TAG_END;
    if (c == (is_declaration ? '?' : '/') && getter_.get_non_ws() == '>') return EXE_ELEMENT_END;
    return report_not_well_formed("XML not well-formed");
}

bool c_xml::get_attribute_value(std::string* value, elmx_whitespace mode) {
    value->clear();
    getter_.set_ws_mode(mode);
    attributes_.take_quote();
    bool is_sound = true;
    for (int c = attributes_.get(); is_sound && c != -1; c = attributes_.get()) {
        if (c != '&') {
            getter_.add_char_wsp(value, c, false);
            continue;
        }
        c_entity_name_reader_for_attribute_data reader(attributes_);
        is_sound = insert_entity(reader, value);
    }
    // Behind the value also after a failure: a handler may let the load go on with the next attribute.
    attributes_.skip_text();
    return is_sound;
}

bool c_xml::skip_attribute_value() {
    attributes_.skip_text();
    return true;
}

bool c_xml::get_named_attribute(const c_xml_local* local, int ns_id, const std::string& local_name,
                                std::string* value) {
    bool is_read = false;
    while (attributes_.has_attribute()) {
        *value = attributes_.take_text();
        if (get_ns_id(local, *value) == ns_id && local_part(*value) == local_name) {
            is_read = get_attribute_value(value, preserve);
            break;
        }
        attributes_.skip_text();
    }
    attributes_.rewind();
    return is_read;
}

bool c_xml::get_xsi_type(const c_xml_local* local, int* ns_id, std::string* local_name) {
    std::string value;
    if (!get_named_attribute(local, id_of_xsi, "type", &value)) return false;
    *ns_id = get_ns_id(local, value);
    if (*ns_id == 0 && value.find(':') == std::string::npos) *ns_id = id_of_no_namespace;
    get_local_name(value, local_name);
    return true;
}

std::string* c_xml::get_namespace_prefix(const std::string& name, std::string* out) {
    const std::size_t colon = name.find(':');
    out->assign(name, 0, colon == std::string::npos ? 0 : colon);
    return out;
}

std::string* c_xml::get_local_name(const std::string& name, std::string* out) {
    const std::size_t colon = name.find(':');
    out->assign(name, colon == std::string::npos ? 0 : colon + 1);
    return out;
}

int c_xml::get_ns_id(const c_xml_local* local, const std::string& name) const {
    if (local == nullptr) return 0;
    std::string prefix;
    return local->find_namespace_id(*get_namespace_prefix(name, &prefix));
}

bool c_xml::is_xsi_attribute(const c_xml_local* local, const std::string& name) const {
    return get_ns_id(local, name) == id_of_xsi;
}

} // namespace lmx
