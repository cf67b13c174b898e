// The writer by itself, and what it lets an application change: layout, error handling, the state of the stream.

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <iomanip>
#include <locale>
#include <sstream>

#include "hqf/hqf.h"

namespace {

using lmx::c_xml_writer;

const lmx::s_ns_map one_namespace[] = {{1000, "p", "urn:p"}, {0, nullptr, nullptr}};
const lmx::s_ns_map default_namespace[] = {{1000, "", "urn:d"}, {0, nullptr, nullptr}};
constexpr char xsi[] = " xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\"";

TEST(writer, declaration) {
    const struct {
        int flags;
        const char* expected;
    } rows[] = {
        {0, ""},
        {1, "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\r\n"},
        {2, "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\r\n"},
        {3, "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\r\n"},
        {4, ""},
    };
    for (const auto& row : rows) {
        std::ostringstream stream;
        const c_xml_writer writer(stream, row.flags, "\t", "\r\n");
        EXPECT_EQ(stream.str(), row.expected) << "flags " << row.flags;
    }
}

TEST(writer, namespace_attributes) {
    const struct {
        const char* what;
        std::function<void(c_xml_writer&)> act;
        std::string expected;
    } rows[] = {
        {"the table, then xsi",
         [](auto& w) { w.conditionally_select_ns_map(one_namespace), w.conditionally_write_ns_attrs(true); },
         std::string(" xmlns:p=\"urn:p\"") + xsi},
        {"once only",
         [](auto& w) {
             w.conditionally_select_ns_map(one_namespace);
             w.conditionally_select_ns_map(default_namespace);
             w.conditionally_write_ns_attrs(false);
             w.conditionally_write_ns_attrs(true);
         },
         " xmlns:p=\"urn:p\""},
        {"and again when asked",
         [](auto& w) {
             w.conditionally_select_ns_map(default_namespace);
             w.conditionally_write_ns_attrs(false);
             w.reenable_namespace_map_output();
             w.conditionally_write_ns_attrs(false);
         },
         " xmlns=\"urn:d\" xmlns=\"urn:d\""},
        {"added ones behind the table's, in their order",
         [](auto& w) {
             w.add_namespace("b", "urn:b");
             w.add_default_namespace("urn:a");
             w.conditionally_select_ns_map(one_namespace);
             w.conditionally_write_ns_attrs(false);
         },
         " xmlns:p=\"urn:p\" xmlns:b=\"urn:b\" xmlns=\"urn:a\""},
        {"locations bring xsi along",
         [](auto& w) {
             w.add_schema_location("urn:p", "p.xsd");
             w.add_schema_location("urn:q", "q.xsd");
             w.conditionally_select_ns_map(one_namespace);
             w.conditionally_write_ns_attrs(false);
         },
         std::string(" xmlns:p=\"urn:p\"") + xsi + " xsi:schemaLocation=\"urn:p p.xsd urn:q q.xsd\""},
        {"a first location without a namespace stands alone",
         [](auto& w) {
             w.add_no_namespace_schema_location("n.xsd");
             w.add_schema_location("urn:q", "q.xsd");
             w.conditionally_select_ns_map(one_namespace);
             w.conditionally_write_ns_attrs(false);
         },
         std::string(" xmlns:p=\"urn:p\"") + xsi + " xsi:noNamespaceSchemaLocation=\"n.xsd\""},
    };
    for (const auto& row : rows) {
        std::ostringstream stream;
        c_xml_writer writer(stream, "\t", "\n");
        row.act(writer);
        EXPECT_EQ(stream.str(), row.expected) << row.what;
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

/// A document with each kind of value: text, numbers, dates, truths, bytes, foreign XML.
hqf_v2::Hqf document() {
    hqf_v2::Hqf document;
    auto& header = document.get_Preamble().get_Header();
    header.set_Creator(L"a<b>\"c\"&'d'");
    header.set_CreatorVersion(L"\xD834\xDD1E\xE9");
    header.set_Purpose(L"line\nand\ttab");
    header.append_ChangeHistory("2024-01-01T00:00:05.5+01:00");
    header.append_Revision();
    header.back_Revision().append_any("<r xmlns='urn:r'>&lt;</r>");
    document.append_Color();
    auto& colour = document.get_Color(0);
    colour.set_ColorName(L"n");
    colour.append_ChangeHistory("-0044-03-15T12:00:00Z");
    colour.append_ColorSpace();
    auto& rgb = colour.back_ColorSpace().get_ColorSpaceRGB();
    rgb.append_ChangeHistory("2024-01-01T00:00:00Z");
    auto& conditions = rgb.get_ColorSpaceSpecificationSpectrumTristimulus();
    conditions.get_DeviceFilter().setnil_DeviceFilter();
    conditions.get_DevicePolarization().set_DevicePolarization(true);
    conditions.get_Device().get_DeviceSettings().get_Averaging().set_AveragingValue(2);
    conditions.get_Device().get_DeviceSettings().get_Averaging().set_Averaging(false);
    conditions.get_Device().get_DeviceSettings().set_Aperture(4000000);
    for (const auto set :
         {&hqf_v2::DeviceType::set_Manufacturer, &hqf_v2::DeviceType::set_Model, &hqf_v2::DeviceType::set_SerialNumber})
        (conditions.get_Device().*set)(L"");
    conditions.append_ChangeHistory("2024-01-01T00:00:00Z");
    conditions.get_Spectrum().set_SpectrumType(L"Spectrum_Custom");
    conditions.get_IlluminationOptions().set_ColorTemperature(2147483647);
    conditions.set_FieldOfView(L"FieldOfView_2_Degree");
    conditions.get_GeometryChoice().set_Angle(-1.0 / 3);
    rgb.set_Red(1e-7);
    rgb.set_Green(-0.0);
    rgb.set_Blue(0.1);
    rgb.set_ColorDepth(L"ColorDepth_8");
    auto& profile = conditions.get_Profile();
    profile.set_Direction(L"Profile_Input");
    const unsigned char bytes[] = {1, 2, 3, 255};
    profile.get_ProfileChoice().get_ProfileFile().set_ProfileFile(lmx::c_binary(bytes, 4));
    return document;
}

std::string written(c_xml_writer& writer, std::ostringstream& stream) {
    hqf_v2::Hqf made = document();
    EXPECT_EQ(made.marshal(writer, "Hqf:Hqf"), 0);
    return stream.str();
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
    std::ostringstream plain_stream;
    c_xml_writer plain(plain_stream, "\t", "\n");
    const std::string expected = written(plain, plain_stream);
    std::ostringstream stream;
    counting_writer counting(stream, "\t", "\n");
    EXPECT_EQ(written(counting, stream), expected);
    EXPECT_TRUE(counting.in_order) << "the stream lagged behind a virtual call";
    // The two line feeds and the tab more stand in texts.
    EXPECT_EQ(counting.ends, std::count(expected.begin(), expected.end(), '\n') - 1);
    EXPECT_EQ(counting.nests, std::count(expected.begin(), expected.end(), '\t') - 1);
}

TEST(writer, layout_strings) {
    std::ostringstream tabs_stream;
    std::ostringstream none_stream;
    std::ostringstream wide_stream;
    c_xml_writer tabs(tabs_stream, "\t", "\n");
    c_xml_writer none(none_stream, "", "");
    c_xml_writer wide(wide_stream, "12345678901234567890", "\r\n");
    std::string expected = written(tabs, tabs_stream);
    EXPECT_EQ(written(none, none_stream).find("<Hqf:Hqf xmlns"), 0u);
    std::string one_line;
    std::string spread;
    // A line feed and a tab of the document's own stay.
    for (std::size_t i = 0; i < expected.size(); ++i) {
        const bool own = expected.compare(i, 4, "\nand") == 0 || expected.compare(i, 4, "\ttab") == 0;
        if (own || (expected[i] != '\n' && expected[i] != '\t')) one_line += expected[i];
        spread += own                   ? std::string(1, expected[i])
                  : expected[i] == '\n' ? "\r\n"
                  : expected[i] == '\t' ? "12345678901234567890"
                                        : std::string(1, expected[i]);
    }
    EXPECT_EQ(none_stream.str(), one_line);
    EXPECT_EQ(written(wide, wide_stream), spread);
}

struct grouping : std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
};

/// The stream decides how numbers look, as soon as the caller has changed it.
TEST(writer, state_of_the_stream) {
    const struct {
        const char* what;
        std::function<void(std::ostream&)> change;
        const char* angle;
        const char* aperture;
    } rows[] = {
        {"a new stream", [](std::ostream&) {}, "-0.33333333333333", "4000000"},
        {"another precision plays no part for doubles", [](std::ostream& s) { s << std::setprecision(3); },
         "-0.33333333333333", "4000000"},
        {"fixed notation", [](std::ostream& s) { s << std::fixed; }, "-0.33333333333333", "4000000"},
        {"scientific notation", [](std::ostream& s) { s << std::scientific; }, "-3.33333333333333e-01", "4000000"},
        {"signs", [](std::ostream& s) { s << std::showpos; }, "-0.33333333333333", "4000000"},
        {"a locale given after the writer was made",
         [](std::ostream& s) { s.imbue(std::locale(std::locale::classic(), new grouping)); }, "-0,33333333333333",
         "4.000.000"},
    };
    for (const auto& row : rows) {
        std::ostringstream stream;
        c_xml_writer writer(stream, "\t", "\n");
        row.change(stream);
        const std::string text = written(writer, stream);
        EXPECT_NE(text.find("<Hqf:Angle>" + std::string(row.angle) + "<"), std::string::npos) << row.what;
        EXPECT_NE(text.find("<Hqf:Aperture>" + std::string(row.aperture) + "<"), std::string::npos) << row.what;
        EXPECT_EQ(stream.fill(), '0') << "a date leaves the fill behind";
    }
    std::ostringstream stream;
    stream.imbue(std::locale(std::locale::classic(), new grouping));
    c_xml_writer writer(stream, "\t", "\n");
    EXPECT_NE(written(writer, stream).find("<Hqf:Aperture>4000000<"), std::string::npos)
        << "the writer gives the stream the classic locale";
}

TEST(writer, text_of_values) {
    std::ostringstream stream;
    c_xml_writer writer(stream, "\t", "\n");
    const std::string text = written(writer, stream);
    for (const char* expected : {
             "<Hqf:Creator>a&lt;b>&quot;c&quot;&amp;&apos;d&apos;</Hqf:Creator>",
             "<Hqf:CreatorVersion>\xF0\x9D\x84\x9E\xC3\xA9</Hqf:CreatorVersion>",
             "<Hqf:Purpose>line\nand\ttab</Hqf:Purpose>",
             "<Hqf:ChangeHistory>2024-01-01T00:00:05.5+01:00</Hqf:ChangeHistory>",
             "\t\t\t\t<r xmlns='urn:r'>&lt;</r>\n",
             "<Hqf:ChangeHistory>-0044-03-15T12:00:00Z</Hqf:ChangeHistory>",
             "<Hqf:DeviceFilter xsi:nil=\"true\"/>",
             "<Hqf:Averaging AveragingValue=\"2\">false</Hqf:Averaging>",
             "<Hqf:Manufacturer></Hqf:Manufacturer>",
             "<Hqf:Red>1e-07</Hqf:Red>",
             "<Hqf:Green>-0.0</Hqf:Green>",
             "<Hqf:Blue>0.1</Hqf:Blue>",
             "<Hqf:ProfileFile>AQID/w==</Hqf:ProfileFile>",
         })
        EXPECT_NE(text.find(expected), std::string::npos) << expected;
}

/// Whatever is special in a text is seen at every place, although plain text is written in wide steps.
TEST(writer, escapes_at_every_place) {
    const struct {
        std::wstring text;
        std::string expected;
        bool ends = false;
    } rows[] = {
        {L"\"", "&quot;"},
        {L"'", "&apos;"},
        {L"&", "&amp;"},
        {L"<", "&lt;"},
        {L">", ">"},
        {L"\n", "\n"},
        {L"\xE9", "\xC3\xA9"},
        {L"\x2028", "\xE2\x80\xA8"},
        {L"\xFFFD", "\xEF\xBF\xBD"},
        {L"\xD834\xDD1E", "\xF0\x9D\x84\x9E"},
        {std::wstring(1, static_cast<wchar_t>(0x1D11E)), "\xF0\x9D\x84\x9E"},
        {L"\xDC00", "\xED\xB0\x80"},
        {std::wstring(1, L'\0'), std::string(1, '\0')},
        {L"\xD834", "", true},
    };
    for (const auto& row : rows)
        for (std::size_t before = 0; before < 20; ++before)
            for (const std::size_t behind : {std::size_t{0}, std::size_t{1}, std::size_t{17}}) {
                hqf_v2::Person person;
                person.set_Name(std::wstring(before, L'a') + row.text + std::wstring(behind, L'z'));
                std::ostringstream stream;
                c_xml_writer writer(stream, "", "");
                ASSERT_EQ(person.marshal(writer, "p"), 0);
                const std::string text =
                    std::string(before, 'a') + row.expected + std::string(row.ends ? 0 : behind, 'z');
                EXPECT_EQ(stream.str(), "<p><Hqf:Name>" + text + "</Hqf:Name></p>")
                    << row.expected << " behind " << before;
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
