// The writer by itself, and what it lets an application change: layout, error handling, the state of the stream.

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <iomanip>
#include <locale>
#include <sstream>

#include "hqf/hqf.h"
#include "tests/support/documents.h"

namespace {

using lmx::c_xml_writer;

const lmx::s_ns_map one_namespace[] = {{1000, "p", "urn:p"}, {0, nullptr, nullptr}};
const lmx::s_ns_map default_namespace[] = {{1000, "", "urn:d"}, {0, nullptr, nullptr}};
constexpr char xsi[] = " xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\"";

TEST(writer, declaration) {
    const std::string version = "<?xml version=\"1.0\" encoding=\"UTF-8\"", alone = " standalone=\"yes\"",
                      end = "?>\r\n";
    const std::string expected[] = {"", version + end, version + alone + end, version + alone + end, ""};
    for (int flags = 0; flags < 5; ++flags) {
        std::ostringstream stream;
        const c_xml_writer writer(stream, flags, "\t", "\r\n");
        EXPECT_EQ(stream.str(), expected[flags]) << "flags " << flags;
    }
}

TEST(writer, namespace_attributes) {
    // What is done before a table is chosen and its attributes are written.
    const std::string table = " xmlns:p=\"urn:p\"";
    const std::tuple<const char*, std::function<void(c_xml_writer&)>, std::string> rows[] = {
        {"the table alone", [](auto&) {}, table},
        {"then xsi, and once only",
         [](auto& w) {
             w.conditionally_select_ns_map(one_namespace);
             w.conditionally_select_ns_map(default_namespace);
             w.conditionally_write_ns_attrs(true);
         },
         table + xsi},
        {"and again when asked",
         [](auto& w) {
             w.conditionally_select_ns_map(default_namespace);
             w.conditionally_write_ns_attrs(false);
             w.reenable_namespace_map_output();
         },
         " xmlns=\"urn:d\" xmlns=\"urn:d\""},
        {"added ones behind the table's, in their order",
         [](auto& w) { w.add_namespace("b", "urn:b"), w.add_default_namespace("urn:a"); },
         table + " xmlns:b=\"urn:b\" xmlns=\"urn:a\""},
        {"locations bring xsi along",
         [](auto& w) { w.add_schema_location("urn:p", "p.xsd"), w.add_schema_location("urn:q", "q.xsd"); },
         table + xsi + " xsi:schemaLocation=\"urn:p p.xsd urn:q q.xsd\""},
        {"a first location without a namespace stands alone",
         [](auto& w) { w.add_no_namespace_schema_location("n.xsd"), w.add_schema_location("urn:q", "q.xsd"); },
         table + xsi + " xsi:noNamespaceSchemaLocation=\"n.xsd\""},
    };
    for (const auto& [what, act, expected] : rows) {
        std::ostringstream stream;
        c_xml_writer writer(stream, "\t", "\n");
        act(writer);
        writer.conditionally_select_ns_map(one_namespace);
        writer.conditionally_write_ns_attrs(false);
        EXPECT_EQ(stream.str(), expected) << what;
    }
}

TEST(writer, prefixes_levels_and_messages) {
    std::ostringstream stream;
    c_xml_writer writer(stream, "--", "\n");
    writer.conditionally_select_ns_map(one_namespace);
    writer.add_default_namespace("urn:d");
    EXPECT_STREQ(writer.get_namespace_prefix("urn:p"), "p");
    EXPECT_STREQ(writer.get_namespace_prefix("urn:d"), "");
    EXPECT_EQ(writer.get_namespace_prefix("urn:x"), nullptr);
    writer.undent();
    writer(true) << "a";
    writer.indent();
    writer.indent();
    writer(true) << "b";
    writer(false) << "c";
    EXPECT_EQ(stream.str(), "a----bc");
    std::string message;
    EXPECT_EQ(writer.get_error_message(&message), "No Error");
    EXPECT_EQ(writer.handle_error(lmx::elmx_error(7), "sg_ColorSpace", "f", 1), 7);
    EXPECT_EQ(writer.get_error_message(&message), "'sg_ColorSpace'-Inappropriate choice option selected");
    writer.handle_error(lmx::elmx_error(999), "x", "f", 1);
    EXPECT_EQ(writer.get_error_message(&message), "'x'-");
}

/// A document of every element, with line feeds and tabs of its own.
std::string written(c_xml_writer& writer, std::ostringstream& stream) {
    hqf_v2::Hqf document;
    EXPECT_EQ(document.unmarshal(support::document("documents/everything.hqf")), 0);
    EXPECT_EQ(document.marshal(writer, "Hqf:Hqf"), 0);
    return stream.str();
}

std::string written(const char* tab, const char* line_end) {
    std::ostringstream stream;
    c_xml_writer writer(stream, tab, line_end);
    return written(writer, stream);
}

/// Calls of a derived writer, and whether the stream was up to date at each.
class counting_writer : public c_xml_writer {
public:
    counting_writer(std::ostringstream& stream, const char* tab, const char* nl)
        : c_xml_writer(stream, tab, nl)
        , stream_(stream) {}
    void nest() override {
        const char last = stream_.str().empty() ? '\n' : stream_.str().back();
        in_order = in_order && (last == '\n' || last == '\t');
        ++nests;
        c_xml_writer::nest();
    }
    const char* endl() override {
        in_order = in_order && stream_.str().back() == '>';
        ++ends;
        return c_xml_writer::endl();
    }
    int nests = 0;
    int ends = 0;
    bool in_order = true;

private:
    std::ostringstream& stream_;
};

TEST(writer, derived_writers_get_their_calls) {
    const std::string expected = written("\t", "\n"), bare = written("", "");
    std::ostringstream stream;
    counting_writer counting(stream, "\t", "\n");
    EXPECT_EQ(written(counting, stream), expected);
    EXPECT_TRUE(counting.in_order) << "the stream lagged behind a virtual call";
    const auto more = [&](char c) { return std::ranges::count(expected, c) - std::ranges::count(bare, c); };
    EXPECT_EQ(counting.ends, more('\n'));
    EXPECT_EQ(counting.nests, more('\t'));
    // The same layout in other strings, while the document's own stay.
    std::string one_line, spread;
    for (std::size_t i = 0; i < expected.size(); ++i) {
        const bool is_own = expected.compare(i, 9, "\nline two") == 0 || expected.compare(i, 10, "\tand a tab") == 0;
        const bool is_layout = !is_own && (expected[i] == '\n' || expected[i] == '\t');
        if (!is_layout) one_line += expected[i];
        spread += !is_layout ? std::string(1, expected[i]) : expected[i] == '\n' ? "\r\n" : "12345678901234567890";
    }
    EXPECT_EQ(bare, one_line);
    EXPECT_EQ(written("12345678901234567890", "\r\n"), spread);
}

struct grouping : std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
};

/// The stream decides how numbers look, as soon as the caller has changed it.
TEST(writer, state_of_the_stream) {
    const std::tuple<const char*, std::function<void(std::ostream&)>, const char*, const char*> rows[] = {
        {"a new stream", [](std::ostream&) {}, "0.25", "2147483647"},
        {"precision plays no part for doubles", [](auto& s) { s << std::setprecision(1); }, "0.25", "2147483647"},
        {"fixed notation, which the first date clears", [](auto& s) { s << std::fixed; }, "0.25", "2147483647"},
        {"scientific notation", [](auto& s) { s << std::scientific; }, "2.50000000000000e-01", "2147483647"},
        {"signs", [](auto& s) { s << std::showpos; }, "+0.25", "2147483647"},
        {"capitals", [](auto& s) { s << std::uppercase << std::scientific; }, "2.50000000000000E-01", "2147483647"},
        {"hexadecimal", [](auto& s) { s << std::hex; }, "0.25", "7fffffff"},
        {"a locale given after the writer was made",
         [](auto& s) { s.imbue(std::locale(std::locale::classic(), new grouping)); }, "0,25", "2.147.483.647"},
    };
    for (const auto& [what, change, contribution, aperture] : rows) {
        std::ostringstream stream;
        stream.imbue(std::locale(std::locale::classic(), new grouping)); // the writer gives it the classic one
        c_xml_writer writer(stream, "\t", "\n");
        change(stream);
        const std::string text = written(writer, stream);
        EXPECT_NE(text.find("<Hqf:Contribution>" + std::string(contribution) + "<"), std::string::npos) << what;
        EXPECT_NE(text.find("<Hqf:Aperture>" + std::string(aperture) + "<"), std::string::npos) << what;
        EXPECT_EQ(stream.fill(), '0') << "a date leaves the fill behind";
    }
}

/// Whatever is special in a text is seen at every place, although plain text is written in wide steps.
TEST(writer, escapes_at_every_place) {
    const std::pair<std::wstring, std::string> rows[] = {{L"\"", "&quot;"},
                                                         {L"'", "&apos;"},
                                                         {L"&", "&amp;"},
                                                         {L"<", "&lt;"},
                                                         {L">", ">"},
                                                         {L"\n", "\n"},
                                                         {L"\xE9", "\xC3\xA9"},
                                                         {L"\x2028", "\xE2\x80\xA8"},
                                                         {L"\xFFFD", "\xEF\xBF\xBD"},
                                                         {L"\xD834\xDD1E", "\xF0\x9D\x84\x9E"},
                                                         {{static_cast<wchar_t>(0x1D11E)}, "\xF0\x9D\x84\x9E"},
                                                         {L"\xDC00", "\xED\xB0\x80"},
                                                         {{L'\0'}, {'\0'}},
                                                         {L"\xD834", ""}}; // half a pair ends the text
    for (const auto& [special, expected] : rows)
        for (std::size_t before = 0; before < 20; ++before)
            for (const std::size_t behind : {0u, 1u, 17u}) {
                hqf_v2::Person person;
                person.set_Name(std::wstring(before, L'a') + special + std::wstring(behind, L'z'));
                std::ostringstream stream;
                c_xml_writer writer(stream, "", "");
                ASSERT_EQ(person.marshal(writer, "p"), 0);
                EXPECT_EQ(stream.str(), "<p><Hqf:Name>" + std::string(before, 'a') + expected +
                                            std::string(expected.empty() ? 0 : behind, 'z') + "</Hqf:Name></p>")
                    << expected << " behind " << before;
            }
}

TEST(writer, incomplete_elements) {
    using namespace hqf_v2;
    std::string out = "as it was";
    ColorSpaceCIELab incomplete;
    EXPECT_EQ(incomplete.marshal(&out), 46);
    EXPECT_EQ(out, "as it was");
    std::ostringstream stream;
    c_xml_writer writer(stream, "\t", "\n");
    sg_Function group;
    EXPECT_EQ(group.marshal(writer, ""), 46) << "nothing chosen";
    group.assign_Function(static_cast<FunctionType*>(nullptr));
    EXPECT_EQ(group.marshal(writer, ""), 45) << "chosen, but no object";
    EXPECT_EQ(stream.str(), "");
    Averaging bare;
    bare.set_AveragingValue(5);
    EXPECT_EQ(bare.marshal(writer, "a"), 0) << "an optional body";
    EXPECT_EQ(stream.str(), "<a AveragingValue=\"5\"></a>\n");
}

/// An object under the head says what it is; a plain one doesn't, and leaves the question open for the next object.
TEST(writer, types_under_the_head) {
    using namespace hqf_v2;
    std::ostringstream stream;
    c_xml_writer writer(stream, "\t", "\n");
    sg_Function group;
    auto* const de = new FunctionDEType;
    de->set_Result(1.5);
    group.assign_Function(de);
    EXPECT_EQ(group.marshal(writer, ""), 0);
    EXPECT_NE(stream.str().find(" xsi:type=\"Hqf:FunctionDEType\">"), std::string::npos);
    EXPECT_EQ(writer.get_expected_class_identity(), nullptr);
    stream.str("");
    group.get_FunctionDE();
    group.get_Function();
    EXPECT_EQ(group.marshal(writer, ""), 0);
    EXPECT_EQ(stream.str(), "<Hqf:Function>\n</Hqf:Function>\n");
    EXPECT_EQ(writer.get_expected_class_identity(), FunctionType::id);
}

} // namespace
