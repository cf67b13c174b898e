// Text in, one string out: the drivers of these tests, and the sources that every case runs over.
#pragma once

#include "hqf/errors/c_error.h"
#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml.h"
#include "tests/support/callers_source.h"
#include "tests/support/documents.h"
#include "tests/support/files.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <functional>
#include <sstream>
#include <string>
#include <vector>

namespace xml_in_test {

using support::callers_source;

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

/// A file that is deleted at the end.
struct temporary_file : support::folder {
    explicit temporary_file(const std::string& bytes) { support::make_file(path, bytes); }
    const std::string path = *this / "file";
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

/// What a text of cases.txt stands for.
inline std::string unescaped(const std::string& text) {
    static const std::string letters = "nrtvf\\", characters = "\n\r\t\v\f\\";
    std::string out;
    for (std::size_t i = 0; i < text.size(); ++i)
        if (text[i] != '\\')
            out += text[i];
        else if (text[++i] != 'x')
            out += characters.at(letters.find(text[i]));
        else
            out += static_cast<char>(std::stoi(text.substr(i + 1, 2), nullptr, 16)), i += 2;
    return out;
}

/// The rows under a heading of cases.txt.
inline std::vector<row> cases(const std::string& heading) {
    std::istringstream table(support::document("xml_in/cases.txt"));
    std::vector<row> out;
    std::string line, current;
    while (std::getline(table, line)) {
        if (!line.empty() && line[0] == '[') current = line;
        if (current != "[" + heading + "]" || line.find('\t') == std::string::npos || line[0] == '#') continue;
        std::istringstream fields(line);
        std::string text, expected, why;
        std::getline(std::getline(std::getline(fields, text, '\t'), expected, '\t'), why);
        out.push_back(is(unescaped(text), unescaped(expected), why));
    }
    EXPECT_FALSE(out.empty()) << heading;
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
