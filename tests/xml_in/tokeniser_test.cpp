// Tags, attributes and values, as the tokeniser gives them and as it refuses them.

#include "support.h"

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

TEST(tokeniser, tags_of_the_table) {
    given{tokens}.everywhere(cases("tags"));
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

TEST(element, operations_of_the_table) {
    element([](auto& xml, auto& name, auto&) {
        xml.move_to_start_tag_end(nullptr);
        return xml.is_element_end_tag(name);
    }).everywhere(cases("end tag"));
    element([](auto& xml, auto&, auto& out) {
        bool empty = false;
        out = xml.skip_start_tag(&empty) ? "found" : "not found";
        out += empty ? ", empty" : "";
        return true;
    }).everywhere(cases("start tag end"));
    element([](auto& xml, auto& name, auto&) { return xml.skip_rest_of_element(name); }).everywhere(cases("skipped"));
    element([](auto& xml, auto& name, auto&) {
        return xml.skip_rest_of_empty_element(name);
    }).everywhere(cases("skipped empty"));
    element([](auto& xml, auto& name, auto& out) {
        return xml.get_any_element(name, &out, lmx::preserve, true);
    }).everywhere(cases("captured"));
    element([](auto& xml, auto& name, auto& out) {
        return xml.get_any_element(name, &out, lmx::collapse, true);
    }).everywhere(cases("captured, collapsed"));
    element([](auto& xml, auto&, auto& out) {
        std::string end;
        xml.move_to_start_tag_end(nullptr);
        const bool is_found = xml.get_nested_element_value(&out, &end, lmx::preserve, true);
        out += "|" + end;
        return is_found;
    }).everywhere(cases("nested value"));
    given{value_in(lmx::collapse)}.everywhere(cases("collapsed value"));
}

} // namespace
