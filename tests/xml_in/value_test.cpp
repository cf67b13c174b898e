#include "support.h"

#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml.h"

#include <gtest/gtest.h>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

TEST(value, keeps_replaces_or_collapses_white_space) {
    const struct {
        const char* raw;
        const char* kept;
        const char* replaced;
        const char* collapsed;
        const char* why;
    } rows[] = {
        {"  a  b  ", "  a  b  ", "  a  b  ", "a b", "blanks"},
        {"\ta\r\n\vb\f", "\ta\n\vb\f", " a  b ", "a b", "each character from tab to carriage return"},
        {" \t ", " \t ", "   ", "", "nothing else"},
        {"a &lt; b", "a < b", "a < b", "a < b", "a predefined reference keeps the blanks around it"},
        {" &lt;", " <", " <", "<", "but no blank goes in front of everything"},
        {"a&#9;&#32;b&#10;", "a\t b\n", "a  b ", "a b", "white space from references"},
        {"a&#x85;&#x2028;b", "a\n\nb", "a  b", "a b", "line ends from references"},
        {"a &#233; b", "a \xC3\xA9 b", "a \xC3\xA9 b", "a \xC3\xA9 b", "characters above ASCII"},
    };
    for (const auto& row : rows) {
        const std::string element = std::string("<a>") + row.raw + "</a>";
        const std::string attribute = std::string("<a b=\"") + row.raw + "\"/>";
        const std::string values[] = {row.kept, row.replaced, row.collapsed};
        for (const int mode : {0, 1, 2}) {
            const auto whitespace = static_cast<lmx::elmx_whitespace>(mode);
            const std::string why = row.why + std::string(", mode ") + std::to_string(mode);
            expect_everywhere(element, value_in(whitespace), "(" + values[mode] + ")</a>", why);
            expect_everywhere(attribute, attribute_value_in(whitespace), "(" + values[mode] + ")", why);
        }
    }
}

TEST(value, leaves_white_space_from_references_alone_where_told_so) {
    const std::string text = "<a b=' &#10; &#32; x&#x85;'/>";
    const struct {
        lmx::elmx_whitespace mode;
        const char* value;
    } rows[] = {
        {lmx::preserve, " \n   x\n"},
        {lmx::replace, " \n   x\n"},
        {lmx::collapse, "\n x\n"},
    };
    for (const auto& row : rows) {
        lmx::c_read_string source(text);
        recorder errors;
        lmx::c_xml xml(source, errors, false);
        std::string value;
        xml.get_element_name(nullptr, &value);
        xml.get_attribute_name(&value, false);
        xml.get_attribute_value(&value, row.mode);
        EXPECT_EQ(value, row.value) << "mode " << row.mode;
    }
}

TEST(value, goes_on_behind_markup_that_vanishes) {
    const std::string bad = "! {1 23 XML not well-formed}";
    const struct {
        const char* text;
        std::string value;
        const char* why;
    } rows[] = {
        {"<a>x<!--c-->y</a>", "(xy)</a>", "a comment"},
        {"<a>x<?p ?>y<!-- > --></a>", "(xy)</a>", "an instruction"},
        {"<a> x <![CDATA[ & ]]> y</a>", "(x  &  y)</a>", "CDATA keeps its own blanks, and those around it count"},
        {"<a><![CDATA[a]]></a>", "(a)</a>", "CDATA alone"},
        {"<a>x<b c='1'/>", "(x)<b c='1'/>", "stops before a child, which comes back whole"},
        {"<a>x</b>", "(x)</b>", "or before any end tag"},
        {"<a></a>", "()</a>", "nothing"},
        {"<a>x", "! {1 34 Premature end of file encountered}", "the end of input"},
        {"<a>x<!--", "! {1 34 Premature end of file encountered}", "or within a comment"},
        {"<a>x<", "(x)! {1 23 XML not Well-Formed}", "a < at the very end"},
        {"<a>x&nope;", "!", "an unknown reference fails without a report"},
        {"<a>x<!D", bad, "a declaration"},
        {"<a>x<!-y", bad, "half a comment"},
        {"<a>x<![CDATE[", "! {1 23 XML not Well-Formed} {1 23 XML not well-formed}", "half a CDATA section"},
    };
    for (const auto& row : rows)
        expect_everywhere(row.text, value_in(lmx::collapse), row.value, row.why);
}

TEST(value, owes_no_blank_to_what_follows) {
    for (const std::string text : {"<a> x <b xmlns='u&amp;v'/>", "<a> x <b xmlns='u'/>yz"}) {
        lmx::c_read_string source(text);
        recorder errors;
        lmx::c_xml xml(source, errors, true);
        lmx::c_xml_local scope;
        std::string value;
        xml.get_element_name(&scope, &value);
        xml.move_to_start_tag_end(nullptr);
        xml.get_element_value(&value, lmx::collapse, true);
        xml.get_element_name(&scope, &value);
        EXPECT_EQ(xml.find_namespace_from_id(1000), text[17] == '&' ? "u&v"s : "u"s) << "a URI";
        xml.move_to_start_tag_end(nullptr);
        if (xml.get_element_name(&scope, &value) == lmx::EXE_CHARS) {
            EXPECT_EQ(value, "yz") << "text";
        }
    }
}

// What an operation on the tokeniser gives for the first element, as text.
using operation = std::string (*)(lmx::c_xml&, const std::string& name);

driver first_element(operation operate) {
    return [operate](lmx::c_read& source) {
        recorder errors;
        lmx::c_xml xml(source, errors, true);
        lmx::c_xml_local scope;
        std::string name;
        xml.get_element_name(&scope, &name);
        const std::string out = operate(xml, name);
        std::string next;
        const int event = xml.get_element_name(&scope, &next);
        return out + " then " + std::to_string(event) + next + errors.reports;
    };
}

struct element_row {
    const char* text;
    const char* expected;
    const char* why;
};

void expect_elements(operation operate, std::initializer_list<element_row> rows) {
    for (const element_row& row : rows)
        expect_everywhere(row.text, first_element(operate), row.expected, row.why);
}

TEST(element, end_tag_must_be_the_named_one) {
    const operation end = [](lmx::c_xml& xml, const std::string& name) -> std::string {
        xml.move_to_start_tag_end(nullptr);
        return xml.is_element_end_tag(name) ? "yes" : "no";
    };
    expect_elements(end, {
                             {"<a></a><n/>", "yes then 7n", "plain"},
                             {"<a> \n</a\t><n/>", "yes then 7n", "white space before and in it"},
                             {"<a></a b><n/>", "no then 5>", "something else in it"},
                             {"<a></ab><n/>", "no then 5>", "a longer name"},
                             {"<ab></a><n/>", "no then 7n", "a shorter name"},
                             {"<a>x</a>", "no then 6a", "text before it"},
                         });
}

TEST(element, start_tag_end_minds_quotes) {
    const operation move = [](lmx::c_xml& xml, const std::string&) -> std::string {
        bool empty = false;
        const bool is_found = xml.skip_start_tag(&empty);
        return std::string(is_found ? "found" : "not found") + (empty ? ", empty" : "");
    };
    expect_elements(
        move, {
                  {"<a ><n/>", "found then 7n", "a plain tag"},
                  {"<a/><n/>", "found, empty then 7n", "an empty one"},
                  {"<a ,'/>\"'>\"><n/>", "found then 5\">", "what stands in quotes ends nothing"},
                  {"<a / \n><n/>", "found, empty then 7n", "white space behind /"},
                  {"<a /xy><n/>", "not found, empty then 7n {1 12 Illegal character(s) after / at end of tag - x}",
                   "one report for all that stands behind /"},
                  {"<a ,", "not found then 0", "the end before /"},
                  {"<a /", "found, empty then 0", "the end behind / counts as >"},
              });
}

TEST(element, skipping_checks_nested_tags) {
    const operation skip = [](lmx::c_xml& xml, const std::string& name) -> std::string {
        return xml.skip_rest_of_element(name) ? "skipped" : "failed";
    };
    expect_elements(
        skip,
        {
            {"<a/><n/>", "skipped then 7n", "an empty element"},
            {"<a>x<b>&lt;<c/></b><!--</a>--><![CDATA[</a>]]></a ><n/>", "skipped then 7n", "a full one"},
            {"<a><b><c><d></e></c></b></a>", "failed then 6c {1 23 Element start tag (d) and end tag (e) do not match}",
             "the report names the inner pair"},
            {"<a><b>", "failed then 0", "the end of input"},
            {"<a>&nope;</a>", "failed then 6a", "a reference that fails"},
        });
    const operation skip_empty = [](lmx::c_xml& xml, const std::string& name) -> std::string {
        return xml.skip_rest_of_empty_element(name) ? "skipped" : "failed";
    };
    expect_elements(skip_empty, {
                                    {"<a/><n/>", "skipped then 7n", "an empty element"},
                                    {"<a> </a><n/>", "skipped then 7n", "one with nothing in it"},
                                    {"<a><b/></a>", "failed then 5/>", "one with a child"},
                                });
}

TEST(element, is_captured_as_raw_text) {
    const operation capture = [](lmx::c_xml& xml, const std::string& name) -> std::string {
        std::string out = "old";
        return xml.get_any_element(name, &out, lmx::preserve, true) ? out : "failed";
    };
    expect_elements(
        capture,
        {
            {"<p r=\"&amp;\" xmlns:q='u'>text</p><n/>", "<p xmlns:q='u' r=\"&amp;\">text</p> then 7n",
             "declarations first, references as they are"},
            {"<p/><n/>", "<p/> then 7n", "an empty element"},
            {"<p r='1'><b/></p>", "<p r='1'><b/></p> then 0", "attributes belong to one tag"},
            {"<p><b  x = '/>'  /> \n <c/> t \n<d>u&e;</d></p ><n/>",
             "<p><b  x = '/>'  /><c/> t \n<d>u&e;</d></p> then 7n", "white space goes between tags and stays in text"},
            {"<p>a<!--c-->b<?i?>c<!x d</p><n/>", "<p>abc d</p> then 7n", "comments, instructions and other markup go"},
            {"<p>x <![CDATA[ </p> ]]]> </p><n/>", "<p>x <![CDATA[ </p> ]]]></p> then 7n", "CDATA stays"},
            {"<p><b / x></b></p>", "failed then 6p", "an empty child has no end tag"},
            {"<p><b></c></p>", "failed then 6p", "tags must match"},
            {"<p></p q>", "failed then 5>", "nothing else in an end tag"},
            {"<p>< b></p>", "failed then 5b>", "no blank behind <"},
            {"<p>x", "failed then 0", "the end of input"},
            {"<p><1>x</1></p><n/>", "<p><1>x</1></p> then 7n", "names are not judged"},
        });
    const operation collapsed = [](lmx::c_xml& xml, const std::string& name) -> std::string {
        std::string out;
        return xml.get_any_element(name, &out, lmx::collapse, true) ? out : "failed";
    };
    expect_elements(collapsed, {{"<p>  a  b <c/> d </p>", "<p>a b<c/>d</p> then 0", "each text collapsed by itself"}});
}

TEST(element, mixed_content_is_captured_up_to_an_end_tag) {
    const operation nested = [](lmx::c_xml& xml, const std::string&) -> std::string {
        std::string value = "old";
        std::string end = "old";
        xml.move_to_start_tag_end(nullptr);
        return xml.get_nested_element_value(&value, &end, lmx::preserve, true) ? value + "|" + end : "failed";
    };
    expect_elements(nested,
                    {
                        {"<a>x<b>y</b>z</a><n/>", "x<b>y</b>z|a then 7n", "text and children"},
                        {"<a q='1'><b r='2'/></c>", "<b r='2'/>|c then 0", "any end tag; no attribute from before"},
                        {"<a>x", "failed then 0", "the end of input"},
                    });
}

} // namespace
