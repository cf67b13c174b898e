#include "hqf/xml_in/c_xml.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/name_chars.h"

// Elements taken as raw text. Nothing in them is interpreted but the nesting of tags, so that a foreign element comes
// out as it went in; only comments, instructions and white space between tags are lost.

namespace lmx {

bool c_xml::get_any_element(const std::string& name, std::string* out, elmx_whitespace mode, bool) {
    out->clear();
    getter_.set_ws_mode(mode);
    return capture_element(name, out, 0);
}

bool c_xml::get_nested_element_value(std::string* value, std::string* end_name, elmx_whitespace mode, bool) {
    value->clear();
    end_name->clear();
    getter_.set_ws_mode(mode);
    attributes_.clear();
    declarations_.clear();
    for (std::string token;;) {
        switch (read_raw_token(&token)) {
        case raw_token::text: *value += token; break;
        case raw_token::start_tag:
            if (!capture_element(token, value, 0)) return false;
            break;
        case raw_token::end_tag: *end_name = token; return true;
        case raw_token::error: return false;
        }
    }
}

bool c_xml::capture_element(const std::string& name, std::string* out, unsigned depth) {
    if (depth >= hqf::limits::capture_depth) return false;
    *out += '<';
    *out += name;
    append_stored_attributes(declarations_, out);
    append_stored_attributes(attributes_, out);
    return capture_rest_of_start_tag(out) || capture_content(name, out, depth);
}

void c_xml::append_stored_attributes(hqf::attribute_store& store, std::string* out) {
    for (store.rewind(); store.has_attribute();) {
        *out += ' ';
        *out += store.take_text();
        const char quote = static_cast<char>(store.take_quote());
        *out += '=';
        *out += quote;
        *out += store.take_text();
        *out += quote;
    }
    store.clear();
}

// True when the element is empty.
bool c_xml::capture_rest_of_start_tag(std::string* out) {
    int quote = 0;
    for (int c = getter_.get();; c = getter_.get()) {
        if (c == -1 || (quote == 0 && c == '>')) {
            *out += '>';
            return false;
        }
        if (quote == 0 && c == '/') break;
        *out += static_cast<char>(c);
        if (quote != 0)
            quote = c == quote ? 0 : quote;
        else if (c == '"' || c == '\'')
            quote = c;
    }
    for (int c = getter_.get(); c != '>' && c != -1;)
        c = getter_.get();
    *out += "/>";
    return true;
}

bool c_xml::capture_content(const std::string& name, std::string* out, unsigned depth) {
    for (std::string token;;) {
        switch (read_raw_token(&token)) {
        case raw_token::text: *out += token; break;
        case raw_token::start_tag:
            if (!capture_element(token, out, depth + 1)) return false;
            break;
        case raw_token::end_tag:
            if (token != name) return false;
            *out += "</";
            *out += name;
            *out += '>';
            return true;
        case raw_token::error: return false;
        }
    }
}

c_xml::raw_token c_xml::read_raw_token(std::string* out) {
    out->clear();
    getter_.reset_ws_mode();
    int c = getter_.get();
    if (c == -1) return raw_token::error;
    bool is_text = false;
    for (; c != '<' && c != -1; c = getter_.get()) {
        is_text = is_text || !hqf::is_white_space(c);
        getter_.add_char_wsp(out, c, false);
    }
    if (is_text || c == -1) {
        getter_.unget(c);
        return raw_token::text;
    }
    out->clear();
    getter_.reset_ws_mode();
    return read_raw_markup(out);
}

// Behind a '<'.
c_xml::raw_token c_xml::read_raw_markup(std::string* out) {
    int c = getter_.get();
    switch (c) {
    case '!': return read_raw_declaration(out);
    case '?': getter_.skip_PI(); return raw_token::text;
    case '/':
        c = read_raw_name(getter_.get(), out);
        if (hqf::is_white_space(c)) c = getter_.get_non_ws();
        return c == '>' ? raw_token::end_tag : raw_token::error;
    default:
        if (c == -1 || hqf::is_white_space(c)) return raw_token::error;
        getter_.unget(read_raw_name(c, out));
        return raw_token::start_tag;
    }
}

// Behind a '<!'.
c_xml::raw_token c_xml::read_raw_declaration(std::string* out) {
    const int c = getter_.get();
    if (c == '-') {
        if (getter_.get() == '-') getter_.skip_comment();
    } else if (c == '[') {
        *out = "<![CDATA[";
        if (!getter_.read_cdata(out)) return raw_token::error;
        *out += "]]>";
    }
    return raw_token::text;
}

// Reads a name, of any characters, that begins with `first`; gives the character behind it.
int c_xml::read_raw_name(int first, std::string* out) {
    int c = first;
    for (; c != -1 && c != '>' && c != '/' && !hqf::is_white_space(c); c = getter_.get())
        *out += static_cast<char>(c);
    return c;
}

} // namespace lmx
