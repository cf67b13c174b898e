// Text in, one string out: the drivers of these tests, and the sources that every case runs over.
#pragma once

#include "hqf/errors/c_error.h"
#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>
#include <functional>
#include <string>
#include <vector>

#include <unistd.h>

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
struct recorder : lmx::c_error {
    void report_error(lmx::elmx_error_type type, lmx::elmx_error code, const char*, int line,
                      const char* text) override {
        reports += " {" + std::to_string(type) + " " + std::to_string(code) + " " + text + "}";
        last_line = line;
    }
    std::string reports;
    int last_line = 0;
};

/// A file in the temporary folder, deleted at the end.
struct temporary_file {
    explicit temporary_file(const std::string& bytes) { std::ofstream(path, std::ios::binary) << bytes; }
    temporary_file(const temporary_file&) = delete;
    temporary_file& operator=(const temporary_file&) = delete;
    ~temporary_file() { std::remove(path.c_str()); }
    inline static int count = 0;
    const std::string path = testing::TempDir() + "xml_in_" + std::to_string(getpid()) + "_" + std::to_string(++count);
};

/// A stream of characters or a tokeniser, with what it needs.
template<class T>
struct reading {
    callers_source own;
    recorder errors;
    T in;
    lmx::c_xml_local scope;
    std::string name, value;

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
    std::string bytes, expected, why;
};

/// A row that is explained by its bytes where nothing else is said.
inline row is(const std::string& bytes, const std::string& expected, const std::string& why = {}) {
    return {bytes, expected, why.empty() ? testing::PrintToString(bytes) : why};
}

/// The same for many texts that give the same.
inline std::vector<row> rows(const std::string& expected, const std::vector<std::string>& texts) {
    std::vector<row> out;
    for (const std::string& text : texts)
        out.push_back(is(text, expected));
    return out;
}

/// What the driver must give for the bytes of each row.
struct given {
    driver run;

    /// As memory, string, file and caller's source.
    void from_every_source(const std::vector<row>& rows) const {
        for (const auto& [bytes, expected, why] : rows) {
            const temporary_file on_disk(bytes);
            lmx::c_read_memory memory(bytes.data(), static_cast<unsigned int>(bytes.size()));
            lmx::c_read_string string(bytes);
            callers_source callers(bytes);
            lmx::c_read_file file(on_disk.path.c_str());
            for (lmx::c_read* source : std::initializer_list<lmx::c_read*>{&memory, &string, &callers, &file})
                EXPECT_EQ(run(*source), expected) << why << " (" << typeid(*source).name() << ")";
        }
    }

    /// The same, and from an open file with the edge of a block at every byte of what starts with '<', for a driver
    /// that blanks in front don't disturb.
    void everywhere(const std::vector<row>& rows) const {
        from_every_source(rows);
        for (const auto& [bytes, expected, why] : rows)
            for (std::size_t edge = 1; bytes[0] == '<' && edge <= bytes.size() && edge < 512; ++edge) {
                std::string padded = std::string(512 - edge, ' ') + bytes;
                lmx::c_read_file open_file(fmemopen(padded.data(), padded.size(), "rb"));
                ASSERT_EQ(run(open_file), expected) << why << " (edge of a file block at byte " << edge << ")";
            }
    }
};

/// The next tag or text: <name attribute='value'>, </name>, [text]; "." at the end of input and "!" where something
/// fails, and then false.
inline bool put_tag(lmx::c_xml& xml, lmx::c_xml_local* scope, std::string* out) {
    std::string name, value;
    switch (xml.get_element_name(scope, &name)) {
    case lmx::EXE_NAME: break;
    case lmx::EXE_CHARS: *out += "[" + name + "]"; return true;
    case lmx::EXE_ELEMENT_END: *out += "</" + name + ">"; return true;
    case lmx::EXE_EOF: *out += "."; return false;
    default: *out += "!"; return false;
    }
    *out += "<" + name;
    for (;;)
        switch (xml.get_attribute_name(&name, false)) {
        case lmx::EXE_NAME:
            *out += " " + name + (xml.get_attribute_value(&value, lmx::preserve) ? "='" + value + "'" : "=!");
            break;
        case lmx::EXE_START_TAG_END: *out += ">"; return true;
        case lmx::EXE_ELEMENT_END: *out += "/>"; return true;
        default: *out += "!"; return false;
        }
}

/// All tags, then "@line" and the reports; the same again after a rewind where there were none.
inline std::string tokens(lmx::c_read& source) {
    reading<lmx::c_xml> r(source, true);
    const auto all = [&] {
        std::string out;
        while (put_tag(r.in, &r.scope, &out))
            ;
        return out + "@" + std::to_string(r.in.get_line_num()) + r.errors.reports;
    };
    const std::string first = all();
    r.in.rewind();
    r.scope.clear();
    EXPECT_TRUE(!r.errors.reports.empty() || all() == first) << "rewound";
    return first;
}

/// The value of the first element: (text), then what comes behind as in `tokens`; "!" when it fails, and the reports.
inline driver value_in(lmx::elmx_whitespace mode) {
    return [mode](lmx::c_read& source) {
        reading<lmx::c_xml> r(source, true);
        r.in.get_element_name(&r.scope, &r.name);
        r.in.move_to_start_tag_end(nullptr);
        if (!r.in.get_element_value(&r.value, mode, true)) return "!" + r.errors.reports;
        std::string out = "(" + r.value + ")";
        while (put_tag(r.in, &r.scope, &out))
            ;
        return out.substr(0, out.find_last_not_of('.') + 1) + r.errors.reports;
    };
}

/// The value of the first attribute of the first element in the same way.
inline driver attribute_value_in(lmx::elmx_whitespace mode) {
    return [mode](lmx::c_read& source) {
        reading<lmx::c_xml> r(source, true);
        r.in.get_element_name(&r.scope, &r.name);
        r.in.get_attribute_name(&r.name, false);
        return (r.in.get_attribute_value(&r.value, mode) ? "(" + r.value + ")" : "!") + r.errors.reports;
    };
}

} // namespace xml_in_test
