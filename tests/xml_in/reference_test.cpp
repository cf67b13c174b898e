#include "support.h"

#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

TEST(character_reference, names_a_character) {
    const struct {
        const char* reference;
        std::string text;
        const char* why;
    } rows[] = {
        {"&#65;", "A", "decimal"},
        {"&#x41;", "A", "hexadecimal"},
        {"&#65 ", "A ", "no semicolon"},
        {"&#x4aZ", "JZ", "ended by what is no digit, digits in either case"},
        {"&#x4Ag", "Jg", "but no further than f"},
        {"&#0;", "\0"s, "NUL is let through"},
        {"&#127;&#128;", "\x7F\xC2\x80", "around the end of ASCII"},
        {"&#xD800;", "\xED\xA0\x80", "a surrogate"},
        {"&#x100000;", "\xF4\x80\x80\x80", "the largest"},
        {"&#00000000000000000065;", "A", "leading zeros"},
        {"&#x100001;", "!", "above it"},
        {"&#99999999999999999999999;", "!", "far above it"},
        {"&#X41;", "!", "a capital X"},
        {"&#xg;", "!", "no digit"},
        {"&#x;", "!", "none at all"},
        {"&#;", "!", "none in decimal"},
        {"&#a;", "!", "a letter"},
        {"&lt;&gt;&amp;&apos;&quot;", "<>&'\"", "the predefined names"},
        {"&lt &ltx;", "!", "a predefined name without semicolon is one, a longer name is not"},
        {"&lt .", "< .", "so that this passes"},
        {"&;", "!", "no name"},
        {"&", "!", "nothing at all"},
    };
    for (const auto& row : rows) {
        const std::string expected = row.text == "!" ? "!" : "(" + row.text + ")";
        expect_everywhere("<a b=\""s + row.reference + "\"/>", attribute_value_in(lmx::preserve), expected, row.why);
        expect_everywhere("<a>"s + row.reference + "</a>", value_in(lmx::preserve),
                          row.text == "!" ? "!" : expected + "</a>", row.why);
    }
}

TEST(entity, definitions_of_the_internal_subset) {
    const struct {
        std::string subset;
        std::string content;
        std::string tokens;
        const char* why;
    } rows[] = {
        {"<!ENTITY e \"v\">", "<a b='x&e;y'>x&e;y</a>", "<a b='xvy'>[xvy]</a>.", "in text and in an attribute"},
        {"<!ENTITY e 'v'>", "<a>&e </a>", "<a>[v ]</a>.", "the semicolon may be missing"},
        {"<!ENTITY e '<b/>'>", "<a>&e;</a>", "<a><b/></a>.", "markup in a value is markup"},
        {"<!ENTITY e '<b>'><!ENTITY f 'x</b'>", "<a>&e;&f;></a>", "<a><b>[x]</b></a>.", "even half a tag"},
        {"<!ENTITY e ''>", "<a>&e;x&e;</a>", "<a>[x]</a>.", "no text"},
        {"<!ENTITY e '1'><!ENTITY e '2'>", "<a>&e;</a>", "<a>[2]</a>.", "the later one counts"},
        {"<!ENTITY e 'x\"y'>", "<a>&e;</a>", "<a>[x\"y]</a>.", "the other quote"},
        {"<!ENTITY e 'a&#38;#66;'>", "<a>&e;</a>", "<a>[aB]</a>.", "a character reference is expanded at once"},
        {"<!ENTITY f 'v'><!ENTITY e '&f;'><!ENTITY f 'w'>", "<a>&e;</a>", "<a>[w]</a>.", "a general one when used"},
        {"<!ENTITY e '5%'>", "<a>&e;</a>", "<a>[5]</a>. {1 41 Entity '%' not found}", "a percent sign is a reference"},
        {"<!ENTITY e '5&#37;'>", "<a b='&e;'>&e;</a>", "<a b=!>[5%]</a>.", "written as a number only in an attribute"},
        {"<!ENTITY lt 'x'>", "<a>&lt;</a>", "<a>[<]</a>.", "the predefined stay"},
        {"<!ENTITY % p 'v'><!ENTITY e '%p;w'>", "<a>&e;</a>", "<a>[vw]</a>.", "a parameter entity in a value"},
        {"<!ENTITY % p 'a\"b'><!ENTITY e \"%p;\">", "<a>&e;</a>", "<a>[a\"b]</a>.", "whose quote ends nothing"},
        {"<!ENTITY % p \"<!ENTITY e 'x'>\"> %p;", "<a>&e;</a>", "<a>[x]</a>.", "or as a declaration"},
        {"<!ENTITY % p 'e'><!ENTITY %p; 'x'>", "<a>&e;</a>", "<a>!", "% before a name makes a parameter entity"},
        {"%p;<!ENTITY e 'v'>", "<a>&e;</a>", "<a>[v]</a>. {1 41 Entity '%p' not found}", "an unknown one"},
        {"<!ENTITY e SYSTEM 'u'><!ENTITY f 'v'>", "<a>&f;</a>",
         "<a>[v]</a>. {2 17 External Entity definitions not supported}", "an external one is a warning"},
        {"<!ENTITY e SYSTEM 'u'>", "<a>&e;", "<a>! {2 17 External Entity definitions not supported}",
         "and stays undefined"},
        {"<!ENTITY e FOO 'u'><!ENTITY f 'v'>", "<a>&f;</a>",
         "<a>[v]</a>. {1 33 Unexpected value in Entity definition: FOO}", "another word an error"},
        {"<!ELEMENT a ANY><!ATTLIST a b CDATA '>'><!NOTATION n PUBLIC 'p'>", "<a/>", "<a/>.", "other declarations"},
        {"<!-- > ' --><?p ]>?><?q?><!ENTITY e 'v'>", "<a>&e;</a>", "<a>[v]</a>.", "comments and instructions"},
    };
    for (const auto& row : rows) {
        std::string expected = row.tokens;
        expected.insert(std::min(expected.find(" {"), expected.size()), "@1");
        expect_everywhere("<!DOCTYPE a [ " + row.subset + " ]>" + row.content, tokens, expected, row.why);
    }
}

TEST(document_type, faults) {
    const struct {
        const char* text;
        const char* tokens;
        const char* why;
    } rows[] = {
        {"<!DOCTYPE a [x]>", "!@1 {0 9 DTD not Well Formed (got x)}", "no declaration"},
        {"<!DOCTYPE a [", "!@1 {0 9 DTD not Well Formed (got )}", "the end of input"},
        {"<!DOCTYPE a []x>", "!@1 {0 9 DTD not Well Formed (expected '>', got x)}", "no > behind ]"},
        {"<!DOCTYPE a [<!ELEMENT", "!@1", "the end in a declaration"},
        {"<!DOCTYPE a [<!--", "!@1", "the end in a comment"},
        {"<!DOCTYPE a [<!ENTITY e 'x", "!@1 {0 9 DTD not Well Formed (got )}",
         "the end in a value shows on the next read"},
        {"<!DOCTYPE a [<!ENTITY e '&#X;'>]>", "!@1", "a bad character reference in a value"},
        {"<!DOCTYPE a [<!ENTITY", "!@1", "the end before a name"},
        {"<!DOCTYPE a [<!ENTITY % p '&#37;p;'> %p; ]>", "!@1 {0 9 Recursive entity definition for: %p;}",
         "a parameter entity in itself"},
    };
    for (const auto& row : rows)
        expect_everywhere(row.text, tokens, row.tokens, row.why);
}

TEST(entity, application_can_define_some_before_the_document) {
    const std::string text = "<a b='&g;'>&g;&h;</a>";
    lmx::c_read_string source(text);
    recorder errors;
    lmx::c_xml xml(source, errors, true);
    xml.add_general_entity("g", "v&h;");
    xml.add_general_entity("h", "w");
    std::string value;
    xml.get_element_name(nullptr, &value);
    xml.get_attribute_name(&value, false);
    EXPECT_TRUE(xml.get_attribute_value(&value, lmx::preserve));
    EXPECT_EQ(value, "vw");
    xml.move_to_start_tag_end(nullptr);
    EXPECT_TRUE(xml.get_element_value(&value, lmx::preserve, true));
    EXPECT_EQ(value, "vww");
}

TEST(entity, references_can_be_left_alone) {
    const std::string text = "<a>&lt;x</a>";
    lmx::c_read_string source(text);
    recorder errors;
    lmx::c_xml xml(source, errors, true);
    std::string value;
    xml.get_element_name(nullptr, &value);
    xml.move_to_start_tag_end(nullptr);
    EXPECT_TRUE(xml.get_element_value(&value, lmx::preserve, false));
    EXPECT_EQ(value, "&lt;x");
}

TEST(entity, namespace_uri_is_expanded_before_it_is_numbered) {
    const std::string text = "<a xmlns:p='a&amp;b' xmlns:q='a&#38;b' xmlns='' xmlns:r='' xmlns:xml='z'/>";
    lmx::c_read_string source(text);
    recorder errors;
    lmx::c_xml xml(source, errors, true);
    lmx::c_xml_local scope;
    std::string name;
    EXPECT_EQ(xml.get_element_name(&scope, &name), lmx::EXE_NAME);
    EXPECT_STREQ(xml.find_namespace_from_id(1000), "a&b");
    EXPECT_EQ(scope.find_namespace_id("p"), 1000);
    EXPECT_EQ(scope.find_namespace_id("q"), 1000);
    EXPECT_EQ(scope.find_namespace_id(""), 1) << "the default namespace is switched off";
    EXPECT_EQ(scope.find_namespace_id("r"), 1001) << "a prefix with an empty URI has a number";
    EXPECT_EQ(scope.find_namespace_id("xml"), 2) << "whatever is declared";
    EXPECT_EQ(scope.find_namespace_id("s"), 0);
}

} // namespace
