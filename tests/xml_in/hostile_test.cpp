#include "support.h"

#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml.h"
#include "hqf/xml_in/limits.h"

#include <gtest/gtest.h>

// Documents that mean harm. Each must end in an answer, soon, and without memory that it hasn't paid for; the
// sanitizers watch the rest.

namespace {

using namespace xml_in_test;

std::string repeat(std::string_view text, std::size_t count) {
    std::string out;
    while (count-- > 0)
        out += text;
    return out;
}

std::string run(const driver& drive, const std::string& text) {
    lmx::c_read_string source(text);
    return drive(source);
}

// Ten entities, each ten times the one before: 10^9 times `innermost`.
std::string laughter(const std::string& innermost) {
    std::string subset = "<!ENTITY e0 '" + innermost + "'>";
    for (int i = 1; i < 10; ++i)
        subset += "<!ENTITY e" + std::to_string(i) + " '" + repeat("&e" + std::to_string(i - 1) + ";", 10) + "'>";
    return "<!DOCTYPE a [" + subset + "]>";
}

TEST(hostile, entities_that_grow) {
    const std::string refusal = "! {0 9 Entities expand to too much text}";
    for (const char* const innermost : {"ha", "", "<!---->", "&#65;"}) {
        const std::string subset = laughter(innermost);
        EXPECT_EQ(run(value_in(lmx::preserve), subset + "<a>&e9;</a>"), refusal) << "in text: " << innermost;
        EXPECT_EQ(run(attribute_value_in(lmx::preserve), subset + "<a b='&e9;'/>"), "!") << "in a value: " << innermost;
        EXPECT_EQ(run(tokens, subset + "<a xmlns='&e9;'/>"), "!@1") << "in a namespace: " << innermost;
    }
    const std::string empty = "<!DOCTYPE a [<!ENTITY e ''><!ENTITY v '" + repeat("&e;", 1000) + "'><!ENTITY w '" +
                              repeat("&v;", 100) + "'>]>";
    EXPECT_EQ(run(value_in(lmx::preserve), empty + "<a>&w;&w;</a>"), "()</a>");
    EXPECT_EQ(run(value_in(lmx::preserve), empty + "<a>&w;&w;&w;</a>"), refusal) << "references to nothing weigh too";
    std::string doubled = "<!DOCTYPE a [<!ENTITY % p0 'xxxxxxxxxxxxxxxx'>";
    for (int i = 1; i < 40; ++i) {
        const std::string before = "%p" + std::to_string(i - 1) + ";";
        doubled += "<!ENTITY % p" + std::to_string(i) + " '" + before + before + "'>";
    }
    EXPECT_EQ(run(tokens, doubled + "]><a/>"), "!@1 {0 9 Entities expand to too much text}") << "parameter entities";
}

TEST(hostile, honest_abbreviations_pass) {
    const std::string subset = "<!DOCTYPE a [<!ENTITY e '" + std::string(1000, 'x') + "'>]>";
    const std::string references = repeat("&e;", 2000);
    EXPECT_EQ(run(value_in(lmx::preserve), subset + "<a>" + references + "</a>").size(), 2000006u);
    const std::string many = repeat("&e;", 1000000);
    EXPECT_EQ(run(value_in(lmx::preserve), "<!DOCTYPE a [<!ENTITY e '.'>]><a>" + many + "</a>").size(), 1000006u)
        << "a long document may use short ones as often as it likes";
}

TEST(hostile, entities_that_hold_themselves) {
    const std::string two = "<!DOCTYPE a [<!ENTITY e 'x&f;y'><!ENTITY f '&e;'>]>";
    const std::string report = "! {0 9 Recursive entity definition for: x&f;y}";
    EXPECT_EQ(run(value_in(lmx::preserve), two + "<a>&e;</a>"), report);
    EXPECT_EQ(run(attribute_value_in(lmx::preserve), two + "<a b='&e;'/>"), report);
    EXPECT_EQ(run(attribute_value_in(lmx::preserve), "<!DOCTYPE a [<!ENTITY e '&#37;e;'>]><a b='&e;'/>"),
              "! {0 9 Recursive entity definition for: %e;}")
        << "with a percent sign";
    EXPECT_EQ(run(value_in(lmx::preserve), "<!DOCTYPE a [<!ENTITY e '&e'>]><a>&e;</a>"),
              "! {0 9 Entities expand to too much text}")
        << "one that ends with its reference is used up before it comes again";
    EXPECT_EQ(run(attribute_value_in(lmx::preserve), two + "<a b='&e;' c='2'/>").substr(0, 1), "!");
}

TEST(hostile, entities_nested_deeply) {
    const auto chain = [](std::size_t length) {
        std::string subset;
        for (std::size_t i = 0; i < length; ++i)
            subset += "<!ENTITY e" + std::to_string(i) + " '&e" + std::to_string(i + 1) + ";'>";
        return "<!DOCTYPE a [" + subset + "<!ENTITY e" + std::to_string(length) + " 'v'>]>";
    };
    EXPECT_EQ(run(value_in(lmx::preserve), chain(900) + "<a>&e0;</a>"), "(v)</a>");
    EXPECT_EQ(run(attribute_value_in(lmx::preserve), chain(900) + "<a b='&e0;'/>"), "(v)");
    EXPECT_EQ(run(value_in(lmx::preserve), chain(20000) + "<a>x&e0;</a>"), "! {0 9 Entities nested too deeply}");
    EXPECT_EQ(run(attribute_value_in(lmx::preserve), chain(20000) + "<a b='&e0;'/>"), "!");
}

TEST(hostile, entity_defined_anew_while_it_is_read) {
    const std::string long_value(3000, ' ');
    EXPECT_EQ(run(tokens, "<!DOCTYPE a [<!ENTITY % p \"<!ENTITY &#37; p '<!ENTITY e &#34;2&#34;>'>" + long_value +
                              "<!ENTITY e '1'>\"> %p; %p; ]><a>&e;</a>"),
              "<a>[2]</a>.@1");
}

TEST(hostile, elements_nested_deeply) {
    const auto nested = [](std::size_t depth) { return repeat("<b>", depth) + "x" + repeat("</b>", depth); };
    const struct {
        std::size_t depth;
        bool passes;
    } rows[] = {{hqf::limits::skip_depth - 1, true}, {hqf::limits::skip_depth, false}, {1000000, false}};
    for (const auto& row : rows) {
        const std::string text = "<a>" + nested(row.depth) + "</a>";
        std::string out;
        recorder errors;
        lmx::c_read_string source(text);
        lmx::c_xml xml(source, errors, true);
        xml.get_element_name(nullptr, &out);
        EXPECT_EQ(xml.skip_rest_of_element("a"), row.passes) << "skipping " << row.depth;
        xml.rewind();
        xml.get_element_name(nullptr, &out);
        EXPECT_EQ(xml.get_any_element("a", &out, lmx::preserve, true), row.passes) << "capturing " << row.depth;
        if (row.passes) {
            EXPECT_EQ(out, text);
        }
    }
}

TEST(hostile, very_many_names) {
    std::string prefixes;
    std::string entities;
    for (int i = 0; i < 50000; ++i) {
        prefixes += " xmlns:p" + std::to_string(i) + "='u" + std::to_string(i) + "'";
        entities += "<!ENTITY e" + std::to_string(i) + " '" + std::to_string(i) + "'>";
    }
    EXPECT_EQ(run(tokens, "<a" + prefixes + "/>"), "<a/>.@1");
    EXPECT_EQ(run(value_in(lmx::preserve), "<!DOCTYPE a [" + entities + "]><a>&e49999;</a>"), "(49999)</a>");
}

} // namespace
