#include "hqf/values/c_pattern.h"

#include <libxml/globals.h>
#include <libxml/xmlerror.h>
#include <libxml/xmlregexp.h>

#include "hqf/values/text.h"

namespace lmx {

namespace {

const xmlChar* as_xml_text(const std::string& text) {
    return reinterpret_cast<const xmlChar*>(text.c_str());
}

/// Keeps libxml2 from printing on the standard error stream while it lives; this thread's handler is put back.
class silence {
public:
    silence()
        : handler_(xmlStructuredError)
        , context_(xmlStructuredErrorContext) {
        xmlSetStructuredErrorFunc(nullptr, [](void*, auto*) {});
    }
    silence(const silence&) = delete;
    silence& operator=(const silence&) = delete;
    ~silence() { xmlSetStructuredErrorFunc(context_, handler_); }

private:
    xmlStructuredErrorFunc handler_;
    void* context_;
};

} // namespace

c_regex::c_regex(const std::string& pattern)
    : compiled_(nullptr) {
    const silence no_output;
    compiled_ = xmlRegexpCompile(as_xml_text(pattern));
}

c_regex::~c_regex() {
    xmlRegFreeRegexp(compiled_);
}

bool c_regex::is_match(const std::string& text) const {
    const silence no_output;
    return compiled_ != nullptr && xmlRegexpExec(compiled_, as_xml_text(text)) != 0;
}

bool c_pattern::is_match(const std::wstring& text) const {
    std::string narrow;
    return is_match(convert(&narrow, text));
}

} // namespace lmx
