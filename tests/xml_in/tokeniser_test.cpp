#include "support.h"

#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml.h"

#include <gtest/gtest.h>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

const std::string not_well_formed = " {1 23 XML not Well-Formed}";
const std::string tag_not_well_formed = " {1 23 XML not well-formed}";

struct row {
    std::string text;
    std::string tokens;
    const char* why;
};

void expect_tokens(std::initializer_list<row> rows) {
    for (const row& r : rows)
        expect_everywhere(r.text, tokens, r.tokens, r.why);
}

TEST(tokeniser, yields_tags_and_text) {
    expect_tokens({
        {"<a>\n <b/> t\tx</a>", "<a><b/>[t\tx]</a>.@2", "white space in front of text is passed over"},
        {"<a><b>x</c>y", "<a><b>[x]</c>[y].@1", "tags need not match here, and the end may come anywhere"},
        {"<a></a \n>", "<a></a>.@2", "white space in an end tag"},
        {"<_:-.9\xC3\xA9/>", "<_:-.9\xC3\xA9/>.@1", "all that a name may hold"},
        {"<a>x&lt;&#65;</a>", "<a>[x<A]</a>.@1", "references in text"},
        {"<a>&amp;x</a>", "<a>[&x]</a>.@1", "and at its start"},
        {"<a>x&nope;", "<a>!@1", "an unknown one fails without a report"},
        {"<a>&nope;", "<a>!@1", "also at the start"},
        {"<a><![CDATA[ <b> ]]></a>", "<a>[ <b> ]</a>.@1", "a CDATA section is text by itself"},
        {"<a><![CDATA[a]]]></a>", "<a>[a]]</a>.@1", "a bracket before its end"},
        {"<a><![CDATA[]>]]]] >]]></a>", "<a>[]>]]]] >]</a>.@1", "brackets that end nothing"},
        {"<a><![CDATA[x]]", "<a>[x].@1", "ended by the end of input"},
        {"<a><![CDATA[x]]]]", "<a>[x]]].@1", "all but the last two brackets are text"},
        {"", ".@1", "nothing at all"},
    });
}

TEST(tokeniser, refuses_what_is_no_tag) {
    expect_tokens({
        {"<a", "!@1" + not_well_formed, "the end within a name"},
        {"<a>< b>", "<a>!@1" + not_well_formed, "a blank behind <"},
        {"<a><1b>", "<a>!@1" + not_well_formed, "a digit behind <"},
        {"<a><1 q='>'/x>", "<a>!@1" + not_well_formed + " {1 12 Illegal character(s) after / at end of tag - x}",
         "and its tag is read over, quotes minded"},
        {"<a></>", "<a>!@1", "an end tag without name is not even reported"},
        {"<a></a b>", "<a>!@1" + not_well_formed, "something else in an end tag"},
        {"<a></a", "<a>!@1" + not_well_formed, "the end within an end tag"},
        {"<a><![CDAT[x]]>", "<a>!@1" + not_well_formed + not_well_formed, "no CDATA"},
        {"<a><!x>", "<a>!@1", "no markup declaration"},
        {"<a><!-x>", "<a>!@1", "no comment"},
        {"<!DOCTYP x>", "!@1", "no document type"},
    });
}

TEST(tokeniser, passes_comments_and_instructions_over) {
    expect_tokens({
        {"<!-- c --><a><!----></a>", "<a></a>.@1", "before and inside the root"},
        {"<!-- a -- b > -> --><a/>", "<a/>.@1", "hyphens in the middle"},
        {"<!-- a --->\n<a/>", "<a/>.@2 {2 8 End of comment not Well-Formed}", "one hyphen too many is a warning"},
        {"<!--->--><a/>", "<a/>.@1", "one hyphen too few goes on"},
        {"<!-- a", "!@1", "not ended"},
        {"<?x?><?y a > b ?\?><a/>", "<a/>.@1", "instructions end at their own ?>"},
        {"<?\?><a/>", "<a/>.@1", "even one without target"},
        {"<?xm?><a/>", "<a/>.@1", "or with half of another's"},
        {"<?x >", "!@1", "not ended"},
    });
}

TEST(tokeniser, reads_the_xml_declaration) {
    const std::string no_version = " {1 13 Version not present in XML Decl}";
    expect_tokens({
        {"<?xml version=\"1.0\"?><a/>", "<a/>.@1", "the usual one"},
        {"<?xml\tversion = '1.1' encoding = 'utf-8' standalone = 'yes' ?><a/>", "<a/>.@1", "with all its parts"},
        {"<?xmlversion='1.0'standalone='maybe'?><a/>", "<a/>.@1", "blanks may be missing"},
        {"<!-- c --><?p?><?xml version='1.0'?><a/>", "<a/>.@1", "comments don't leave the prolog"},
        {"<?xml-stylesheet href='x'?><a/>", "!@1" + no_version, "a target that starts with xml"},
        {"<?xml?>", "!@1" + no_version, "no version"},
        {"<?xml version=1.0?>", "!@1" + no_version, "no quotes"},
        {"<?xml version='2.0'?>", "!@1 {1 14 XML version 2.0 not understood}", "another version"},
        {"<?xml version='1.0' standalone='no'?>", "!@1 {1 13 XML Document is not standalone}", "not standalone"},
        {"<?xml version='1.0' standalone='yes' encoding='UTF-8'?>", "!@1", "the wrong order"},
        {"<?xml version='1.0' encoding?>", "!@1", "an encoding without name"},
        {"<?xml version='1.0' encoding='UTF-16'?><a/>",
         "!@1 {0 15 Mis-match between specfied encoding and byte format}", "the wrong encoding"},
        {"<?xml version='1.0' encoding='ISO-8859-1'?><a>\xE9</a>", "<a>[\xC3\xA9]</a>.@1", "the right one"},
        {"<?xml version='1.0' ? ><a/>", "!@1", "a blank before >"},
        {"<a><?xml version='1.0'?>", "<a>!@1 {0 13 XML declaration not at start of document}", "too late"},
        {"x<?xml version='1.0'?>", ".@1 {0 6 Unrecognised character encoding}", "not at all"},
        {" &amp;<?xml version='1.0'?>", "[&]!@1 {0 13 XML declaration not at start of document}", "behind text"},
    });
}

TEST(tokeniser, reads_attributes) {
    const std::string no_equals = " {0 23 Schema is not Well Formed (expected '=', got '";
    const std::string no_quote = " {0 23 Schema is not Well Formed (expected '\"' or ''', got ";
    expect_tokens({
        {"<a b=\"1\"c='2\"'/>", "<a b='1' c='2\"'/>.@1", "no white space between, either quote"},
        {"<a b = '1' />", "<a b='1'/>.@1", "white space around ="},
        {"<a\nb\n=\n'x\ny'\n>", "<a b='x\ny'>.@6", "line ends everywhere"},
        {"<a b='<>/&#65;&lt;'/>", "<a b='<>/A<'/>.@1", "markup in a value, and references"},
        {"<a b='&nope;x' c='2'/>", "<a b=! c='2'/>.@1", "a reference that fails leaves the next attribute alone"},
        {"<a b='1' b='2'/>", "<a b='1' b='2'/>.@1", "repeated ones are the caller's affair"},
        {"<a xmlnsx='1' xmln='2' xmlns.='3'/>", "<a xmlnsx='1' xmln='2' xmlns.='3'/>.@1", "names like xmlns"},
        {"<a xmlns='u' b='1' xmlns:p='v'/>", "<a b='1'/>.@1", "declarations are kept apart"},
        {"<a b>", "!@1" + no_equals + ">')}", "no ="},
        {"<a b", "!@1 {0 34 Unexpected end of file}", "the end in place of ="},
        {"<a b=c>", "!@1" + no_quote + "c)}", "no quote"},
        {"<a b='1 >", "!@1" + no_quote + ")}", "a quote without end"},
        {"<a b='1'", "!@1", "the end in a tag"},
        {"<a b='1' / >", "<a b='1'/>.@1", "white space before the end"},
        {"<a b='1' /x>", "<a b='1'!@1" + tag_not_well_formed, "no > behind /"},
        {"<a b='1' ?>", "<a b='1'!@1" + tag_not_well_formed, "the end of another kind of tag"},
        {"<a b='x\0y'/>"s, "<a b='x' y=''/>.@1", "a NUL splits a value, and nothing worse"},
    });
}

TEST(tokeniser, reads_the_document_type_once_and_first) {
    expect_tokens({
        {"<!DOCTYPE a><a/>", "<a/>.@1", "no subset"},
        {"<!DOCTYPE a SYSTEM \"x\"><a/>", "<a/>.@1", "an external one"},
        {"<!DOCTYPE a><!DOCTYPE a>", "!@1 {1 9 Document Type Declaration already read}", "twice"},
        {"<a><!DOCTYPE a>", "<a>!@1 {1 9 Document Type Declaration not at start of document}", "late"},
        {"<!DOCTYPE a", "!@1", "not ended"},
    });
}

TEST(tokeniser, finds_attributes_out_of_order) {
    const std::string text = "<a x='1' p:x='2' p:type='q:T' p:z='&nope;' xmlns:p='http://www.w3.org/2001/"
                             "XMLSchema-instance' xmlns:q='u'/>";
    lmx::c_read_string source(text);
    recorder errors;
    lmx::c_xml xml(source, errors, true);
    lmx::c_xml_local scope;
    std::string name;
    std::string value;
    xml.get_element_name(&scope, &name);
    EXPECT_TRUE(xml.get_named_attribute(&scope, 5, "x", &value));
    EXPECT_EQ(value, "2");
    EXPECT_TRUE(xml.get_named_attribute(&scope, 0, "x", &value)) << "no default namespace";
    EXPECT_EQ(value, "1");
    EXPECT_FALSE(xml.get_named_attribute(&scope, 5, "y", &value));
    EXPECT_FALSE(xml.get_named_attribute(&scope, 5, "z", &value)) << "its value fails";
    int ns_id = 0;
    EXPECT_TRUE(xml.get_xsi_type(&scope, &ns_id, &value));
    EXPECT_EQ(ns_id, 1000);
    EXPECT_EQ(value, "T");
    EXPECT_EQ(xml.get_attribute_name(&name, false), lmx::EXE_NAME);
    EXPECT_EQ(name, "x") << "the attribute loop still starts at the first one";
}

TEST(tokeniser, without_a_scope_declarations_are_attributes) {
    const std::string text = "<a xmlns='u'/>";
    lmx::c_read_string source(text);
    recorder errors;
    lmx::c_xml xml(source, errors, true);
    std::string name;
    xml.get_element_name(nullptr, &name);
    EXPECT_EQ(xml.get_attribute_name(&name, false), lmx::EXE_NAME);
    EXPECT_EQ(name, "xmlns");
}

TEST(tokeniser, rewinds_to_the_first_byte) {
    const std::string text = "<?xml version='1.0'?><!DOCTYPE a [<!ENTITY e 'v'>]><a xmlns:p='u'>&e;</a>";
    lmx::c_read_string source(text);
    recorder errors;
    lmx::c_xml xml(source, errors, true);
    for (int round = 0; round < 2; ++round) {
        lmx::c_xml_local scope;
        std::string name;
        EXPECT_EQ(xml.get_element_name(&scope, &name), lmx::EXE_NAME) << "declaration and document type again";
        EXPECT_EQ(scope.find_namespace_id("p"), 1000);
        EXPECT_EQ(xml.find_enumerated_namespace("u"), 1000);
        xml.move_to_start_tag_end(nullptr);
        EXPECT_EQ(xml.get_element_name(&scope, &name), lmx::EXE_CHARS);
        EXPECT_EQ(name, "v");
        xml.rewind();
        EXPECT_EQ(xml.find_enumerated_namespace("u"), 0);
    }
    EXPECT_EQ(errors.reports, "");
}

} // namespace
