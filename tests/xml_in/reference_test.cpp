#include "support.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

TEST(reference, names_a_character) {
    const given in_attribute{attribute_value_in(lmx::preserve)};
    const given in_text{value_in(lmx::preserve)};
    const std::pair<std::string, std::string> good[] = {{"&#65;&#x41;", "AA"},
                                                        {"&#65 ", "A "},
                                                        {"&#x4aZ&#x4Ag", "JZJg"},
                                                        {"&#0;", "\0"s},
                                                        {"&#127;&#128;", "\x7F\xC2\x80"},
                                                        {"&#xD800;", "\xED\xA0\x80"},
                                                        {"&#x100000;", "\xF4\x80\x80\x80"},
                                                        {"&#000000000065;", "A"},
                                                        {"&lt;&gt;&amp;", "<>&"},
                                                        {"&apos;&quot;", "'\""},
                                                        {"&lt .", "< ."}};
    for (const auto& [reference, text] : good) {
        in_attribute.everywhere({{"<a b=\"" + reference + "\"/>", "(" + text + ")", reference}});
        in_text.everywhere({{"<a>" + reference + "</a>", "(" + text + ")</a>", reference}});
    }
    for (const std::string reference : {"&#x100001;", "&#99999999999999999999999;", "&#X41;", "&#xg;", "&#x;", "&#;",
                                        "&#a;", "&nope;", "&ltx;", "&;", "&"}) {
        in_attribute.everywhere(rows("!", {"<a b=\"" + reference + "\"/>"}));
        in_text.everywhere(rows("!", {"<a>" + reference + "</a>"}));
    }
}

TEST(entity, definitions_of_the_internal_subset) {
    const struct {
        std::string subset, content, tokens;
        const char* why;
    } rows[] = {
        {"<!ENTITY e \"v\">", "<a b='x&e;y'>x&e;y</a>", "<a b='xvy'>[xvy]</a>.", "in text and in an attribute"},
        {"<!ENTITY e 'v'>", "<a>&e </a>", "<a>[v ]</a>.", "the semicolon may be missing"},
        {"<!ENTITY e '<b/>'>", "<a>&e;</a>", "<a><b/></a>.", "markup in a value is markup"},
        {"<!ENTITY e '<b>'><!ENTITY f 'x</b'>", "<a>&e;&f;></a>", "<a><b>[x]</b></a>.", "even half a tag"},
        {"<!ENTITY e ''><!ENTITY f '1'><!ENTITY f '2'><!ENTITY g 'x\"y'><!ENTITY lt 'z'>", "<a>&e;&f;&g;&e;&lt;",
         "<a>[2x\"y<].", "no text, the later one, the other quote, the predefined"},
        {"<!ENTITY f 'v'><!ENTITY e '&f;a&#38;#66;'><!ENTITY f 'w'>", "<a>&e;</a>", "<a>[waB]</a>.",
         "character references are expanded at once"},
        {"<!ENTITY e '5%'>", "<a>&e;</a>", "<a>[5]</a>. {1 41 Entity '%' not found}", "a percent sign is a reference"},
        {"<!ENTITY e '5&#37;'>", "<a b='&e;'>&e;</a>", "<a b=!>[5%]</a>.", "written as a number only in an attribute"},
        {"<!ENTITY % p 'a\"b'><!ENTITY e \"%p;w\">", "<a>&e;</a>", "<a>[a\"bw]</a>.",
         "a parameter entity, whose quote ends nothing"},
        {"<!ENTITY % p \"<!ENTITY e 'x'>\"> %p;", "<a>&e;</a>", "<a>[x]</a>.", "or as a declaration"},
        {"<!ENTITY % p 'e'><!ENTITY %p; 'x'>", "<a>&e;</a>", "<a>!", "% before a name makes a parameter entity"},
        {"%p;<!ENTITY e 'v'>", "<a>&e;</a>", "<a>[v]</a>. {1 41 Entity '%p' not found}", "an unknown one"},
        {"<!ENTITY e SYSTEM 'u'><!ENTITY f 'v'>", "<a>&f;<b/>&e;",
         "<a>[v]<b/>! {2 17 External Entity definitions not supported}", "an external one: a warning, not defined"},
        {"<!ENTITY e FOO 'u'><!ENTITY f 'v'>", "<a>&f;</a>",
         "<a>[v]</a>. {1 33 Unexpected value in Entity definition: FOO}", "another word an error"},
        {"<!ELEMENT a ANY><!ATTLIST a b CDATA '>'><!NOTATION n PUBLIC 'p'>", "<a/>", "<a/>.", "other declarations"},
        {"<!-- > ' --><?p ]>?><?q?><!ENTITY e 'v'>", "<a>&e;</a>", "<a>[v]</a>.", "comments and instructions"},
    };
    for (const auto& row : rows) {
        std::string expected = row.tokens;
        expected.insert(std::min(expected.find(" {"), expected.size()), "@1");
        given{tokens}.everywhere({{"<!DOCTYPE a [ " + row.subset + " ]>" + row.content, expected, row.why}});
    }
}

TEST(document_type, is_read_once_and_first) {
    given{tokens}.everywhere(
        {{"<!DOCTYPE a><!DOCTYPE a>", "!@1 {1 9 Document Type Declaration already read}", "twice"},
         {"<a><!DOCTYPE a>", "<a>!@1 {1 9 Document Type Declaration not at start of document}", "late"},
         {"<!DOCTYPE a [x]>", "!@1 {0 9 DTD not Well Formed (got x)}", "no declaration"},
         {"<!DOCTYPE a [", "!@1 {0 9 DTD not Well Formed (got )}", "the end of input"},
         {"<!DOCTYPE a []x>", "!@1 {0 9 DTD not Well Formed (expected '>', got x)}", "no > behind ]"},
         {"<!DOCTYPE a [<!ENTITY e 'x", "!@1 {0 9 DTD not Well Formed (got )}", "the end in a value shows later"},
         {"<!DOCTYPE a [<!ENTITY % p '&#37;p;'> %p; ]>", "!@1 {0 9 Recursive entity definition for: %p;}",
          "a parameter entity in itself"}});
    given{tokens}.everywhere(rows("<a/>.@1", {"<!DOCTYPE a><a/>", "<!DOCTYPE a SYSTEM \"x\"><a/>"}));
    given{tokens}.everywhere(rows("!@1", {"<!DOCTYPE a", "<!DOCTYPE a [<!ELEMENT", "<!DOCTYPE a [<!--",
                                          "<!DOCTYPE a [<!ENTITY", "<!DOCTYPE a [<!ENTITY e '&#X;'>]>"}));
}

TEST(entity, application_can_define_some_before_the_document) {
    reading<lmx::c_xml> r("<a b='&g;'>&g;&h;</a>"s, true);
    r.in.add_general_entity("g", "v&h;");
    r.in.add_general_entity("h", "w");
    r.in.get_element_name(nullptr, &r.name);
    r.in.get_attribute_name(&r.name, false);
    EXPECT_TRUE(r.in.get_attribute_value(&r.value, lmx::preserve));
    EXPECT_EQ(r.value, "vw");
    r.in.move_to_start_tag_end(nullptr);
    EXPECT_TRUE(r.in.get_element_value(&r.value, lmx::preserve, true));
    EXPECT_EQ(r.value, "vww");
    reading<lmx::c_xml> raw("<a>&lt;x</a>"s, true);
    raw.in.get_element_name(nullptr, &raw.name);
    raw.in.move_to_start_tag_end(nullptr);
    EXPECT_TRUE(raw.in.get_element_value(&raw.value, lmx::preserve, false));
    EXPECT_EQ(raw.value, "&lt;x") << "references can be left alone";
}

TEST(entity, namespace_uri_is_expanded_before_it_is_numbered) {
    reading<lmx::c_xml> r("<a xmlns:p='a&amp;b' xmlns:q='a&#38;b' xmlns='' xmlns:r='' xmlns:xml='z'/>"s, true);
    EXPECT_EQ(r.in.get_element_name(&r.scope, &r.name), lmx::EXE_NAME);
    EXPECT_STREQ(r.in.find_namespace_from_id(1000), "a&b");
    EXPECT_EQ(r.scope.find_namespace_id("p"), 1000);
    EXPECT_EQ(r.scope.find_namespace_id("q"), 1000) << "one URI, one number";
    EXPECT_EQ(r.scope.find_namespace_id(""), 1) << "the default namespace is switched off";
    EXPECT_EQ(r.scope.find_namespace_id("r"), 1001) << "a prefix with an empty URI has a number";
    EXPECT_EQ(r.scope.find_namespace_id("xml"), 2) << "whatever is declared";
    EXPECT_EQ(r.scope.find_namespace_id("s"), 0);
}

} // namespace
