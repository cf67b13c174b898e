#include "hqf/xml_in/must_understand.h"

#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/reader_access.h"

namespace lmx {

elmx_must_understand bool_must_understand(const std::string& text) {
    if (text == "1" || text == "true") return must_understand_yes;
    if (text == "0" || text == "false") return must_understand_no;
    return must_understand_unclear;
}

bool get_instance_namespace(c_xml_reader& reader, std::string* uri) {
    bool is_found = false;
    {
        c_xml_reader_local scope(&reader);
        std::string name;
        if (reader.get_element_name(&scope, &name) == EXE_NAME) {
            hqf::reader_access::crack_name(reader, name);
            is_found = reader.get_namespace(name, uri) != c_xml_reader::k_namespace_not_found;
        }
    }
    reader.rewind();
    return is_found;
}

namespace {

// The search through one element after another, each of whose names has been read.
class attribute_search {
public:
    attribute_search(c_xml_reader& reader, const std::string& ns, const std::string& attribute,
                     elmx_must_understand (*decide)(const std::string&))
        : reader_(reader)
        , ns_(ns)
        , attribute_(attribute)
        , decide_(decide) {}

    elmx_must_understand search_element(const std::string& name, unsigned depth) {
        if (depth >= hqf::limits::skip_depth) return must_understand_unclear;
        for (;;) {
            std::string attribute;
            switch (reader_.get_attribute_name(&attribute, false)) {
            case EXE_NAME:
                if (const elmx_must_understand answer = ask(attribute)) return answer;
                break;
            case EXE_ELEMENT_END: return must_understand_no;
            case EXE_START_TAG_END: return search_content(name, depth);
            default: return must_understand_unclear;
            }
        }
    }

private:
    elmx_must_understand ask(const std::string& qname) {
        std::string text;
        if (*c_xml::get_local_name(qname, &text) != attribute_ || reader_.get_namespace(qname, &text) != ns_) {
            reader_.skip_attribute_value();
            return must_understand_no;
        }
        return reader_.get_attribute_value(&text, preserve) ? decide_(text) : must_understand_unclear;
    }

    elmx_must_understand search_content(const std::string& name, unsigned depth) {
        for (;;) {
            c_xml_reader_local scope(&reader_);
            std::string found;
            switch (reader_.get_element_name(&scope, &found)) {
            case EXE_NAME:
                if (const elmx_must_understand answer = search_element(found, depth + 1)) return answer;
                break;
            case EXE_CHARS: break;
            case EXE_ELEMENT_END: return found == name ? must_understand_no : must_understand_unclear;
            default: return must_understand_unclear;
            }
        }
    }

    c_xml_reader& reader_;
    const std::string& ns_;
    const std::string& attribute_;
    elmx_must_understand (*decide_)(const std::string&);
};

} // namespace

elmx_must_understand has_must_understand(c_xml_reader& reader, const std::string& ns, const std::string& attribute,
                                         elmx_must_understand (*decide)(const std::string&)) {
    elmx_must_understand answer = must_understand_unclear;
    c_xml_reader_local scope(&reader);
    std::string name;
    if (reader.get_element_name(&scope, &name) != EXE_NAME) return answer;
    answer = attribute_search(reader, ns, attribute, decide).search_element(name, 0);
    reader.rewind();
    return answer;
}

} // namespace lmx
