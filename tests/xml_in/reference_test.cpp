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
