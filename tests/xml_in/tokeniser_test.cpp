// Tags, attributes and values, as the tokeniser gives them and as it refuses them.

#include "support.h"

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

const std::string not_well_formed = " {1 23 XML not Well-Formed}";

TEST(tokeniser, yields_tags_and_text) {
    given{tokens}.everywhere(
        {is("<a>\n <b/> t\tx</c \n>y", "<a><b/>[t\tx]</c>[y].@3",
            "tags need not match here, the end may come anywhere"),
         is("<_:-.9\xC3\xA9/>", "<_:-.9\xC3\xA9/>.@1", "all that a name may hold"),
         is("<a>x&lt;<b>&amp;x", "<a>[x<]<b>[&x].@1", "references in text and at its start"),
         is("<a><![CDATA[a]]]></a><![CDATA[]>]]]] >]]>", "<a>[a]]</a>[]>]]]] >].@1", "brackets that end nothing"),
         is("<a><![CDATA[x]]]]", "<a>[x]]].@1", "ended by the end of input: all but the last two brackets are text")});
    given{tokens}.everywhere(rows("<a>!@1" + not_well_formed, {"<a>< b>", "<a><1>", "<a></a b>", "<a></a"}));
    given{tokens}.everywhere(rows("<a>!@1", {"<a></>", "<a><!x>", "<a><!-x>", "<a>&nope;", "<a>x&nope;"}));
    given{tokens}.everywhere(
        {is("<a", "!@1" + not_well_formed),
         is("<a><1 q='>'/x>", "<a>!@1" + not_well_formed + " {1 12 Illegal character(s) after / at end of tag - x}",
            "what is no tag is read over, quotes minded"),
         is("<a><![CDAT[x]]>", "<a>!@1" + not_well_formed + not_well_formed)});
}

TEST(tokeniser, passes_comments_and_instructions_over) {
    given{tokens}.everywhere(
        {is("<!-- a -- b > -> --><!--->--><a><!----></a>", "<a></a>.@1", "hyphens in the middle, one too few to end"),
         is("<!-- a --->\n<a/>", "<a/>.@2 {2 8 End of comment not Well-Formed}", "one hyphen too many is a warning"),
         is("<?x?><?y a > b ?\?><?\?><?xm?><a/>", "<a/>.@1", "instructions end at their own ?>")});
    given{tokens}.everywhere(rows("!@1", {"<!-- a", "<!-- a --", "<?x >", "<!DOCTYP x>"}));
}

TEST(tokeniser, reads_the_xml_declaration) {
    const std::string no_version = " {1 13 Version not present in XML Decl}";
    given{tokens}.everywhere(
        {is("<!-- c --><?p?><?xmlversion=\"1.0\"standalone='maybe'?><a/>", "<a/>.@1", "no blanks, not quite first"),
         is("<?xml version='2.0'?>", "!@1 {1 14 XML version 2.0 not understood}"),
         is("<?xml version='1.0' standalone='no'?>", "!@1 {1 13 XML Document is not standalone}"),
         is("<?xml version='1.0' encoding='UTF-16'?><a/>",
            "!@1 {0 15 Mis-match between specfied encoding and byte format}"),
         is(" &amp;<?xml version='1.0'?>", "[&]!@1 {0 13 XML declaration not at start of document}", "behind text")});
    given{tokens}.everywhere(rows("!@1" + no_version, {"<?xml-stylesheet href='x'?><a/>", "<?xml version=1.0?>"}));
    given{tokens}.everywhere(rows("!@1", {"<?xml version='1.0' standalone='yes' encoding='UTF-8'?>",
                                          "<?xml version='1.0' encoding?>", "<?xml version='1.0' ? ><a/>"}));
}

TEST(tokeniser, reads_attributes) {
    const std::string no_equals = " {0 23 Schema is not Well Formed (expected '=', got '";
    const std::string no_quote = " {0 23 Schema is not Well Formed (expected '\"' or ''', got ";
    given{tokens}.everywhere(
        {is("<a b=\"1\"c='2\"'\nd\n=\n'x\ny'\n e = '5' / >", "<a b='1' c='2\"' d='x\ny' e='5'/>.@6"),
         is("<a b='<>/&#65;&lt;' c='&nope;x' d='2'/>", "<a b='<>/A<' c=! d='2'/>.@1", "a bad reference spoils one"),
         is("<a xmlns='u' b='1' xmlns:p='v' b='2' xmlnsx='3' xmln='4' xmlns.='5'/>",
            "<a b='1' b='2' xmlnsx='3' xmln='4' xmlns.='5'/>.@1", "only declarations are kept apart"),
         is("<a b='x\0y'/>"s, "<a b='x' y=''/>.@1", "a NUL splits a value, and nothing worse")});
    given{tokens}.everywhere({is("<a b>", "!@1" + no_equals + ">')}"), is("<a b=c>", "!@1" + no_quote + "c)}"),
                              is("<a b='1 >", "!@1" + no_quote + ")}"), is("<a b", "!@1 {0 34 Unexpected end of file}"),
                              is("<a b='1'", "!@1")});
    given{tokens}.everywhere(rows("<a b='1'!@1 {1 23 XML not well-formed}", {"<a b='1' /x>", "<a b='1' ?>"}));
}

TEST(tokeniser, finds_attributes_out_of_order) {
    reading<lmx::c_xml> r("<a x='1' p:x='2' p:type='q:T' p:z='&nope;' xmlns:q='u' "
                          "xmlns:p='http://www.w3.org/2001/XMLSchema-instance'/><a xmlns='u'/>"s,
                          true);
    r.in.get_element_name(&r.scope, &r.name);
    const auto named = [&](int ns_id, const char* name) {
        return r.in.get_named_attribute(&r.scope, ns_id, name, &r.value) ? r.value : "!";
    };
    EXPECT_EQ(named(5, "x") + named(0, "x"), "21") << "no default namespace";
    EXPECT_EQ(named(5, "y") + named(5, "z"), "!!") << "none, or a value that fails";
    int ns_id = 0;
    EXPECT_TRUE(r.in.get_xsi_type(&r.scope, &ns_id, &r.value) && r.value == "T" && ns_id == 1000);
    r.in.get_attribute_name(&r.name, false);
    EXPECT_EQ(r.name, "x") << "the attribute loop still starts at the first one";
    r.in.move_to_start_tag_end(nullptr);
    r.in.get_element_name(nullptr, &r.name);
    r.in.get_attribute_name(&r.name, false);
    EXPECT_EQ(r.name, "xmlns") << "without a scope declarations are attributes";
}

TEST(value, keeps_replaces_or_collapses_white_space) {
    const std::string rows[][5] = {
        // text, preserved, replaced, collapsed
        {"\ta\r\n\vb\f", "\ta\n\vb\f", " a  b ", "a b", "each character from tab to carriage return"},
        {" \t ", " \t ", "   ", "", "nothing else"},
        {"a &lt; b", "a < b", "a < b", "a < b", "a predefined reference keeps the blanks around it"},
        {" &lt;", " <", " <", "<", "but no blank goes in front of everything"},
        {"a&#9;&#32;b&#10;", "a\t b\n", "a  b ", "a b", "white space from references"},
        {"a&#x85;&#x2028;b", "a\n\nb", "a  b", "a b", "line ends from references"},
        {"a &#233; b", "a \xC3\xA9 b", "a \xC3\xA9 b", "a \xC3\xA9 b", "characters above ASCII"},
    };
    const std::string left_alone[] = {" \n   x\n", " \n   x\n", "\n x\n"};
    for (const auto mode : {lmx::preserve, lmx::replace, lmx::collapse}) {
        for (const auto& row : rows) {
            const std::string value = "(" + row[1 + mode] + ")", why = row[4] + ", mode " + std::to_string(mode);
            given{value_in(mode)}.everywhere({{"<a>" + row[0] + "</a>", value + "</a>", why}});
            given{attribute_value_in(mode)}.everywhere({{"<a b=\"" + row[0] + "\"/>", value, why}});
        }
        reading<lmx::c_xml> r("<a b=' &#10; &#32; x&#x85;'/>"s, false);
        r.in.get_element_name(nullptr, &r.name);
        r.in.get_attribute_name(&r.name, false);
        r.in.get_attribute_value(&r.value, mode);
        EXPECT_EQ(r.value, left_alone[mode]) << "white space from references is left alone where told so: " << mode;
    }
}

TEST(value, goes_on_behind_markup_that_vanishes) {
    const given value{value_in(lmx::collapse)};
    value.everywhere(
        {is("<a>x<!--c-->y<?p ?>z<!-- > --></a>", "(xyz)</a>", "comments and instructions"),
         is("<a> x <![CDATA[ & ]]> y</a>", "(x  &  y)</a>", "CDATA keeps its own blanks, and those around it count"),
         is("<a> x <b c='u&amp;v'/>yz", "(x)<b c='u&v'/>[yz]", "a child comes back whole, and no blank is owed to it"),
         is("<a></b>", "()</b>", "stops before any end tag"), is("<a><![CDATA[a]]></a>", "(a)</a>", "CDATA alone"),
         is("<a>x<", "(x)!" + not_well_formed, "a < at the very end"), is("<a>x&nope;", "!"),
         is("<a>x<![CDATE[", "!" + not_well_formed + " {1 23 XML not well-formed}", "half a CDATA section")});
    value.everywhere(rows("! {1 34 Premature end of file encountered}", {"<a>x", "<a>x<!--"}));
    value.everywhere(rows("! {1 23 XML not well-formed}", {"<a>x<!D", "<a>x<!-y"}));
}

// What an operation on the tokeniser makes of the first element, then what comes next.
given element(bool (*operate)(lmx::c_xml&, const std::string& name, std::string& out)) {
    return {[operate](lmx::c_read& source) {
        reading<lmx::c_xml> r(source, true);
        std::string out = "done";
        r.in.get_element_name(&r.scope, &r.name);
        if (!operate(r.in, r.name, out)) out = "failed";
        const int event = r.in.get_element_name(&r.scope, &r.name);
        return out + " then " + std::to_string(event) + r.name + r.errors.reports;
    }};
}

TEST(element, tags_end_as_they_must) {
    const given end = element([](auto& xml, auto& name, auto&) {
        xml.move_to_start_tag_end(nullptr);
        return xml.is_element_end_tag(name);
    });
    end.everywhere({is("<a> \n</a\t><n/>", "done then 7n", "white space"),
                    is("<a></a b><n/>", "failed then 5>", "more in it"), is("<a></ab><n/>", "failed then 5>", "longer"),
                    is("<ab></a><n/>", "failed then 7n", "shorter"), is("<a>x</a>", "failed then 6a", "text before")});
    const given move = element([](auto& xml, auto&, auto& out) {
        bool empty = false;
        out = xml.skip_start_tag(&empty) ? "found" : "not found";
        out += empty ? ", empty" : "";
        return true;
    });
    const std::string report = " {1 12 Illegal character(s) after / at end of tag - x}";
    move.everywhere({is("<a ,'/>\"'>\"><n/>", "found then 5\">", "quotes"), is("<a ,", "not found then 0", "the end"),
                     is("<a / \n><n/>", "found, empty then 7n", "a gap"),
                     is("<a /", "found, empty then 0", "> implied"),
                     is("<a /xy><n/>", "not found, empty then 7n" + report, "one report for all behind /")});
}

TEST(element, skipping_checks_nested_tags) {
    const given skip = element([](auto& in, auto& a, auto&) { return in.skip_rest_of_element(a); });
    skip.everywhere(
        {is("<a/><n/>", "done then 7n", "an empty element"),
         is("<a>x<b>&lt;<c/></b><!--</a>--><![CDATA[</a>]]></a ><n/>", "done then 7n", "a full one"),
         is("<a><b><c><d></e></c></b></a>", "failed then 6c {1 23 Element start tag (d) and end tag (e) do not match}"),
         is("<a><b>", "failed then 0"), is("<a>&nope;</a>", "failed then 6a", "a reference that fails")});
    const given skip_empty = element([](auto& in, auto& a, auto&) { return in.skip_rest_of_empty_element(a); });
    skip_empty.everywhere(rows("done then 7n", {"<a/><n/>", "<a> </a><n/>"}));
    skip_empty.everywhere(rows("failed then 5/>", {"<a><b/></a>"}));
}

TEST(element, is_captured_as_raw_text) {
    const given capture =
        element([](auto& in, auto& a, auto& out) { return in.get_any_element(a, &out, lmx::preserve, true); });
    capture.everywhere(
        {is("<p r=\"&amp;\" xmlns:q='u'>text</p><n/>", "<p xmlns:q='u' r=\"&amp;\">text</p> then 7n",
            "declarations first, references as they are"),
         is("<p r='1'/><n/>", "<p r='1'/> then 7n", "an empty element"),
         is("<p r='1'><b  x = '/>'  /> \n <c/> t \n<d>u&e;</d></p ><n/>",
            "<p r='1'><b  x = '/>'  /><c/> t \n<d>u&e;</d></p> then 7n", "white space goes between tags alone"),
         is("<p>a<!--c-->b<?i?>c<!x d</p>", "<p>abc d</p> then 0", "comments, instructions and other markup go"),
         is("<p>x <![CDATA[ </p> ]]]> <1>x</1></p>", "<p>x <![CDATA[ </p> ]]]><1>x</1></p> then 0",
            "CDATA stays, names are not judged"),
         is("<p></p q>", "failed then 5>", "no end tag"), is("<p>< b></p>", "failed then 5b>", "no tag"),
         is("<p>x", "failed then 0", "the end")});
    capture.everywhere(rows("failed then 6p", {"<p><b / x></b></p>", "<p><b></c></p>"}));
    element([](auto& in, auto& a, auto& out) {
        return in.get_any_element(a, &out, lmx::collapse, true);
    }).everywhere({is("<p>  a  b <c/> d </p>", "<p>a b<c/>d</p> then 0", "each text collapsed by itself")});
    const given nested = element([](auto& xml, auto&, auto& out) {
        std::string end;
        xml.move_to_start_tag_end(nullptr);
        const bool is_found = xml.get_nested_element_value(&out, &end, lmx::preserve, true);
        out += "|" + end;
        return is_found;
    });
    nested.everywhere({is("<a>x<b>y</b>z</a><n/>", "x<b>y</b>z|a then 7n", "text and children, up to an end tag"),
                       is("<a q='1'><b r='2'/></c>", "<b r='2'/>|c then 0", "any end tag; no attribute from before"),
                       is("<a>x", "failed then 0", "the end of input")});
}

} // namespace
