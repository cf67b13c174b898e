#pragma once

#include "hqf/xml_in/c_xml_local.h"

namespace hqf {
struct reader_access;
}

namespace lmx {

class c_xml_reader;

/// A namespace scope that is the reader's current one as long as it lives. Scopes end in reverse order of their start.
class HQF_API c_xml_reader_local : public c_xml_local {
public:
    /// A scope that belongs to no reader yet.
    c_xml_reader_local() = default;
    /// A scope inside the reader's current one, which it replaces.
    explicit c_xml_reader_local(c_xml_reader* reader);
    c_xml_reader_local(const c_xml_reader_local&) = delete;
    c_xml_reader_local& operator=(const c_xml_reader_local&) = delete;
    /// Makes the scope before this one current again.
    ~c_xml_reader_local();

    void set_reader(c_xml_reader* reader) { reader_ = reader; }

private:
    friend class c_xml_reader;
    friend struct hqf::reader_access;

    c_xml_reader_local* previous_ = nullptr;
    c_xml_reader* reader_ = nullptr;
};

} // namespace lmx
