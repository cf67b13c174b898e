#pragma once

#include "hqf/xml_in/c_xml_reader.h"

#include <string>

/// For applications that look at a document before they load it.

namespace lmx {

/// Whether a document asks to be understood.
enum elmx_must_understand : int {
    must_understand_no = 0,      ///< the text says no
    must_understand_unclear = 1, ///< the text says neither, or the document can't be read
    must_understand_yes = 2,     ///< the text says yes
};

/// "1" and "true" are yes, "0" and "false" no. It has the form that `has_must_understand` asks for.
HQF_API elmx_must_understand bool_must_understand(const std::string& text);

/// Gives the namespace URI of the first element and goes back to the start of the document.
///
/// \returns false when there is no element or its prefix is not declared
HQF_API bool get_instance_namespace(c_xml_reader& reader, std::string* uri);

/// Looks through the whole document, in order, for attributes of a namespace and local name, and asks `decide` about
/// each value until it gives something other than 0.
///
/// \returns that answer; 0 when none gave one; 1 when the document can't be read. The reader is back at the start of
/// the document, unless that has no first element.
HQF_API elmx_must_understand has_must_understand(c_xml_reader& reader, const std::string& ns,
                                                 const std::string& attribute,
                                                 elmx_must_understand (*decide)(const std::string&));

} // namespace lmx
