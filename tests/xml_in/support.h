#pragma once

#include "hqf/errors/c_error.h"
#include "hqf/xml_in/c_read.h"
#include "hqf/xml_in/c_xml.h"

#include <cstdio>
#include <functional>
#include <string>
#include <vector>

/// Text in, one string out: the drivers of these tests, and the sources that every case runs over.

namespace xml_in_test {

/// A source as an application would write one.
class callers_source : public lmx::c_read {
public:
    explicit callers_source(std::string bytes = {})
        : bytes_(std::move(bytes)) {}
    int read() override { return next_ < bytes_.size() ? static_cast<unsigned char>(bytes_[next_++]) : -1; }
    void rewind() override { next_ = 0; }

private:
    std::string bytes_;
    std::size_t next_ = 0;
};

/// Writes down each report as " {grade code text}".
class recorder : public lmx::c_error {
public:
    void report_error(lmx::elmx_error_type type, lmx::elmx_error code, const char*, int line,
                      const char* text) override;
    std::string reports;
    int last_line = 0;
};

/// A file in the temporary folder, deleted at the end.
class temporary_file {
public:
    explicit temporary_file(const std::string& bytes);
    temporary_file(const temporary_file&) = delete;
    temporary_file& operator=(const temporary_file&) = delete;
    ~temporary_file() { std::remove(path.c_str()); }
    const std::string path;
};

/// A stream of characters or a tokeniser, with what it needs.
template<class T>
struct reading {
    callers_source own;
    recorder errors;
    T in;
    lmx::c_xml_local scope;
    std::string name;
    std::string value;

    template<class... A>
    explicit reading(lmx::c_read& source, A... more)
        : in(source, errors, more...) {}
    template<class... A>
    explicit reading(const std::string& text, A... more)
        : own(text)
        , in(own, errors, more...) {}
};

using driver = std::function<std::string(lmx::c_read&)>;

struct row {
    std::string bytes;
    std::string expected;
    std::string why;
};

/// A row that is explained by its bytes where nothing else is said.
row is(const std::string& bytes, const std::string& expected, const std::string& why = {});

/// The same for many texts that give the same.
std::vector<row> rows(const std::string& expected, const std::vector<std::string>& texts);

/// What the driver must give for the bytes of each row.
struct given {
    driver run;
    /// As memory, string, file and caller's source.
    void from_every_source(const std::vector<row>& rows) const;
    /// The same, and from an open file with the edge of a block at every byte of what starts with '<', for a driver
    /// that blanks in front don't disturb.
    void everywhere(const std::vector<row>& rows) const;
};

/// Every byte that a getter gives, control characters as <decimal>, then "@line".
std::string rest_of(lmx::c_get_as_utf8& getter);

/// All tags: <name attribute='value'>, </name>, [text], and "." at the end of input; "!" and the end where something
/// fails. Then "@line" and the reports.
std::string tokens(lmx::c_read& source);

/// The value of the first element: (text), then what comes next as in `tokens`; "!" when it fails, and the reports.
driver value_in(lmx::elmx_whitespace mode);

/// The value of the first attribute of the first element in the same way.
driver attribute_value_in(lmx::elmx_whitespace mode);

} // namespace xml_in_test
