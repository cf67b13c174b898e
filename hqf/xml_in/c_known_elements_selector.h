#pragma once

#include "hqf/xml_in/c_xml_reader.h"

namespace lmx {

/// Gives a reader another table of known elements for a scope.
class c_known_elements_selector {
public:
    c_known_elements_selector(c_xml_reader& reader, const s_known_elements* elements)
        : reader_(reader)
        , previous_(reader.get_known_elements()) {
        reader.set_known_elements(elements);
    }
    c_known_elements_selector(const c_known_elements_selector&) = delete;
    c_known_elements_selector& operator=(const c_known_elements_selector&) = delete;
    ~c_known_elements_selector() { reader_.set_known_elements(previous_); }

private:
    c_xml_reader& reader_;
    const s_known_elements* previous_;
};

} // namespace lmx
