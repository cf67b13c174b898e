#pragma once

#include "hqf/xml_in/c_dtd_util.h"

namespace lmx {

/// Reads a document type declaration with its internal subset, XML 1.0, 2.8.
///
/// Only entity definitions have an effect. An external subset is passed over, external entities are refused with a
/// warning and stay undefined, and declarations of elements, attributes and notations are read over: no attribute gets
/// a default from here.
class HQF_API c_internal_dtd : public c_dtd_util {
public:
    explicit c_internal_dtd(c_get_for_xml& getter)
        : c_dtd_util(getter) {}

    /// Without effect: there is no state to reset.
    void reset() {}
    /// Reads the declaration behind `<!DOCTYPE`. False at the end of input, or after a report.
    bool read_doctype_decl();

private:
    bool read_declaration();
    bool read_pi(const std::string& keyword);
    bool read_entity_decl();
    bool read_definition(std::string* value, bool* is_defined);
    bool skip_to_declaration_end();
    bool read_end();
};

} // namespace lmx
