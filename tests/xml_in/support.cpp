#include "support.h"

#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_read_string.h"

#include <gtest/gtest.h>

#include <fstream>

#include <unistd.h>

namespace xml_in_test {

void recorder::report_error(lmx::elmx_error_type type, lmx::elmx_error code, const char*, int line, const char* text) {
    reports += " {" + std::to_string(type) + " " + std::to_string(code) + " " + text + "}";
    last_line = line;
}

temporary_file::temporary_file(const std::string& bytes)
    : path([] {
        static int count = 0;
        return testing::TempDir() + "xml_in_" + std::to_string(getpid()) + "_" + std::to_string(++count);
    }()) {
    std::ofstream(path, std::ios::binary) << bytes;
}

row is(const std::string& bytes, const std::string& expected, const std::string& why) {
    return {bytes, expected, why.empty() ? testing::PrintToString(bytes) : why};
}

std::vector<row> rows(const std::string& expected, const std::vector<std::string>& texts) {
    std::vector<row> out;
    for (const std::string& text : texts)
        out.push_back(is(text, expected));
    return out;
}

void given::from_every_source(const std::vector<row>& rows) const {
    for (const auto& [bytes, expected, why] : rows) {
        lmx::c_read_memory memory(bytes.data(), static_cast<unsigned int>(bytes.size()));
        EXPECT_EQ(run(memory), expected) << why << " (memory)";
        lmx::c_read_string string(bytes);
        EXPECT_EQ(run(string), expected) << why << " (string)";
        callers_source callers(bytes);
        EXPECT_EQ(run(callers), expected) << why << " (caller's source)";
        const temporary_file on_disk(bytes);
        lmx::c_read_file file(on_disk.path.c_str());
        EXPECT_EQ(run(file), expected) << why << " (file)";
    }
}

void given::everywhere(const std::vector<row>& rows) const {
    from_every_source(rows);
    for (const auto& [bytes, expected, why] : rows)
        for (std::size_t edge = 1; bytes[0] == '<' && edge <= bytes.size() && edge < 512; ++edge) {
            std::string padded = std::string(512 - edge, ' ') + bytes;
            lmx::c_read_file open_file(fmemopen(padded.data(), padded.size(), "rb"));
            ASSERT_EQ(run(open_file), expected) << why << " (edge of a file block at byte " << edge << ")";
        }
}

std::string rest_of(lmx::c_get_as_utf8& getter) {
    std::string out;
    for (int c = getter.get(); c != -1; c = getter.get())
        out += c < ' ' ? "<" + std::to_string(c) + ">" : std::string(1, static_cast<char>(c));
    return out + "@" + std::to_string(getter.get_line_num());
}

namespace {

// False where the transcript ends.
bool put_tag(lmx::c_xml& xml, lmx::c_xml_local* scope, std::string* out) {
    std::string name;
    std::string value;
    switch (xml.get_element_name(scope, &name)) {
    case lmx::EXE_NAME: break;
    case lmx::EXE_CHARS: *out += "[" + name + "]"; return true;
    case lmx::EXE_ELEMENT_END: *out += "</" + name + ">"; return true;
    case lmx::EXE_EOF: *out += "."; return false;
    default: *out += "!"; return false;
    }
    *out += "<" + name;
    for (;;) {
        switch (xml.get_attribute_name(&name, false)) {
        case lmx::EXE_NAME:
            *out += " " + name;
            *out += xml.get_attribute_value(&value, lmx::preserve) ? "='" + value + "'" : "=!";
            break;
        case lmx::EXE_START_TAG_END: *out += ">"; return true;
        case lmx::EXE_ELEMENT_END: *out += "/>"; return true;
        default: *out += "!"; return false;
        }
    }
}

} // namespace

std::string tokens(lmx::c_read& source) {
    reading<lmx::c_xml> r(source, true);
    while (put_tag(r.in, &r.scope, &r.value)) {
    }
    return r.value + "@" + std::to_string(r.in.get_line_num()) + r.errors.reports;
}

driver value_in(lmx::elmx_whitespace mode) {
    return [mode](lmx::c_read& source) {
        reading<lmx::c_xml> r(source, true);
        r.in.get_element_name(&r.scope, &r.name);
        r.in.move_to_start_tag_end(nullptr);
        if (!r.in.get_element_value(&r.value, mode, true)) return "!" + r.errors.reports;
        std::string out = "(" + r.value + ")";
        put_tag(r.in, &r.scope, &out);
        return out + r.errors.reports;
    };
}

driver attribute_value_in(lmx::elmx_whitespace mode) {
    return [mode](lmx::c_read& source) {
        reading<lmx::c_xml> r(source, true);
        r.in.get_element_name(&r.scope, &r.name);
        r.in.get_attribute_name(&r.name, false);
        return (r.in.get_attribute_value(&r.value, mode) ? "(" + r.value + ")" : "!") + r.errors.reports;
    };
}

} // namespace xml_in_test
