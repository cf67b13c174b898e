#pragma once

#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_xml_reader.h"

namespace hqf {

// The source must exist before the reader that is built on it, so it is a base in front of that one.
struct owned_file {
    template<class Argument>
    explicit owned_file(Argument argument)
        : file(argument) {}
    lmx::c_read_file file;
};

} // namespace hqf

namespace lmx {

/// A reader with a file of its own. Test `is_open` before reading: construction reads nothing.
class HQF_API c_xml_reader_file : private hqf::owned_file, public c_xml_reader {
public:
    /// \param path in UTF-8
    explicit c_xml_reader_file(const char* path)
        : owned_file(path)
        , c_xml_reader(file) {}
    explicit c_xml_reader_file(const wchar_t* path)
        : owned_file(path)
        , c_xml_reader(file) {}
    /// Takes the handle over and closes it at the end.
    explicit c_xml_reader_file(FILE* open_file)
        : owned_file(open_file)
        , c_xml_reader(file) {}
    ~c_xml_reader_file() override;

    bool is_open() const { return file.is_open(); }
};

} // namespace lmx
