// References: characters, entities of the internal subset and of the application, and where they stand.

#include "support.h"

#include <algorithm>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

TEST(reference, names_a_character) {
    const given in_attribute{attribute_value_in(lmx::preserve)};
    const given in_text{value_in(lmx::preserve)};
    for (const auto& [reference, text, why] :
         {is("&#65 &#x41;", "A A"), is("&#x4aZ&#x4Ag", "JZJg"), is("&#0;", "\0"s), is("&#127;&#128;", "\x7F\xC2\x80"),
          is("&#xD800;", "\xED\xA0\x80"), is("&#x100000;", "\xF4\x80\x80\x80"), is("&#000000000065;", "A"),
          is("&lt;&gt;&amp;&apos;&quot;", "<>&'\""), is("&lt .", "< .")}) {
        in_attribute.everywhere({is("<a b=\"" + reference + "\"/>", "(" + text + ")")});
        in_text.everywhere({is("<a>" + reference + "</a>", "(" + text + ")</a>")});
    }
    for (const std::string reference : {"&#x100001;", "&#99999999999999999999999;", "&#X41;", "&#xg;", "&#x;", "&#;",
                                        "&#a;", "&nope;", "&ltx;", "&;", "&"}) {
        in_attribute.everywhere(rows("!", {"<a b=\"" + reference + "\"/>"}));
        in_text.everywhere(rows("!", {"<a>" + reference + "</a>"}));
    }
}

TEST(entity, definitions_of_the_internal_subset) {
    const std::string rows[][4] = {
        {"<!ENTITY e \"v\">", "<a b='x&e;y'>x&e </a>", "<a b='xvy'>[xv ]</a>.", "the semicolon may be missing"},
        {"<!ENTITY e '<b/><b>'><!ENTITY f 'x</b'>", "<a>&e;&f;></a>", "<a><b/><b>[x]</b></a>.", "even half a tag"},
        {"<!ENTITY e ''><!ENTITY f '1'><!ENTITY f '2'><!ENTITY g 'x\"y'><!ENTITY lt 'z'>", "<a>&e;&f;&g;&e;&lt;",
         "<a>[2x\"y<].", "no text, the later one, the other quote, the predefined"},
        {"<!ENTITY f 'v'><!ENTITY e '&f;a&#38;#66;'><!ENTITY f 'w'>", "<a>&e;", "<a>[waB].", "numbers go first"},
        {"<!ENTITY e '5%'>", "<a>&e;", "<a>[5]. {1 41 Entity '%' not found}", "a percent sign is a reference"},
        {"<!ENTITY e '5&#37;'>", "<a b='&e;'>&e;", "<a b=!>[5%].", "written as a number only in an attribute"},
        {"<!ENTITY % p 'a\"b'><!ENTITY e \"%p;w\">", "<a>&e;", "<a>[a\"bw].", "its quote ends nothing"},
        {"<!ENTITY % p \"<!ENTITY e 'x'>\"> %p;", "<a>&e;", "<a>[x].", "or a declaration"},
        {"<!ENTITY % p 'e'><!ENTITY %p; 'x'>", "<a>&e;", "<a>!", "% before a name makes a parameter entity"},
        {"%p;<!ENTITY e 'v'>", "<a>&e;", "<a>[v]. {1 41 Entity '%p' not found}", "an unknown one"},
        {"<!ENTITY e SYSTEM 'u'><!ENTITY f 'v'>", "<a>&f;<b/>&e;",
         "<a>[v]<b/>! {2 17 External Entity definitions not supported}", "an external one: a warning, not defined"},
        {"<!ENTITY e FOO 'u'><!ENTITY f 'v'>", "<a>&f;", "<a>[v]. {1 33 Unexpected value in Entity definition: FOO}",
         "another word an error"},
        {"<!-- > ' --><?p ]>?><!ELEMENT a ANY><!ATTLIST a b CDATA '>'><!NOTATION n PUBLIC 'p'><!ENTITY e 'v'>",
         "<a>&e;", "<a>[v].", "comments, instructions and other declarations"},
    };
    for (const auto& [subset, content, transcript, why] : rows) {
        std::string expected = transcript;
        expected.insert(std::min(expected.find(" {"), expected.size()), "@1");
        given{tokens}.everywhere({{"<!DOCTYPE a [ " + subset + " ]>" + content, expected, why}});
    }
}

TEST(document_type, is_read_once_and_first) {
    given{tokens}.everywhere(
        {is("<!DOCTYPE a><!DOCTYPE a>", "!@1 {1 9 Document Type Declaration already read}"),
         is("<a><!DOCTYPE a>", "<a>!@1 {1 9 Document Type Declaration not at start of document}"),
         is("<!DOCTYPE a [<!ENTITY % p '&#37;p;'> %p; ]>", "!@1 {0 9 Recursive entity definition for: %p;}")});
    const std::string fault = "!@1 {0 9 DTD not Well Formed (";
    given{tokens}.everywhere({is("<!DOCTYPE a [x]>", fault + "got x)}"), is("<!DOCTYPE a [", fault + "got )}"),
                              is("<!DOCTYPE a []x>", fault + "expected '>', got x)}"),
                              is("<!DOCTYPE a [<!ENTITY e 'x", fault + "got )}")});
    given{tokens}.everywhere(rows("<a/>.@1", {"<!DOCTYPE a><a/>", "<!DOCTYPE a SYSTEM \"x\"><a/>"}));
    given{tokens}.everywhere(rows("!@1", {"<!DOCTYPE a", "<!DOCTYPE a [<!ELEMENT", "<!DOCTYPE a [<!--",
                                          "<!DOCTYPE a [<!ENTITY", "<!DOCTYPE a [<!ENTITY e '&#X;'>]>"}));
}

TEST(entity, application_can_define_some_before_the_document) {
    for (const bool expands : {true, false}) {
        reading<lmx::c_xml> r("<a b='&g;'>&g;&lt;</a>"s, true);
        r.in.add_general_entity("g", "v&h;");
        r.in.add_general_entity("h", "w");
        r.in.get_element_name(nullptr, &r.name);
        r.in.get_attribute_name(&r.name, false);
        r.in.get_attribute_value(&r.value, lmx::preserve);
        EXPECT_EQ(r.value, "vw");
        r.in.move_to_start_tag_end(nullptr);
        r.in.get_element_value(&r.value, lmx::preserve, expands);
        EXPECT_EQ(r.value, expands ? "vw<" : "&g;&lt;");
    }
}

TEST(entity, namespace_uri_is_expanded_before_it_is_numbered) {
    reading<lmx::c_xml> r("<a xmlns:p='a&amp;b' xmlns:q='a&#38;b' xmlns='' xmlns:r='' xmlns:xml='z'/>"s, true);
    EXPECT_EQ(r.in.get_element_name(&r.scope, &r.name), lmx::EXE_NAME);
    EXPECT_STREQ(r.in.find_namespace_from_id(1000), "a&b");
    for (const auto& [prefix, id, why] : {std::tuple{"p", 1000, "the first"},
                                          {"q", 1000, "one URI, one number"},
                                          {"", 1, "the default namespace is switched off"},
                                          {"r", 1001, "a prefix with an empty URI has a number"},
                                          {"xml", 2, "whatever is declared"},
                                          {"s", 0, "unknown"}})
        EXPECT_EQ(r.scope.find_namespace_id(prefix), id) << why;
    r.in.rewind();
    EXPECT_EQ(r.in.find_enumerated_namespace("a&b"), 0) << "a rewind forgets the numbers";
}

} // namespace
