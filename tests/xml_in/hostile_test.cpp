// Documents that mean harm. Each must end in an answer, soon, and without memory that it hasn't paid for; the
// sanitizers watch the rest.

#include "support.h"

#include "hqf/xml_in/limits.h"

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
const driver content = value_in(lmx::preserve);
const driver attribute = attribute_value_in(lmx::preserve);

const std::string too_much = " {0 9 Entities expand to too much text}";

// Ten entities, each ten times the one before: 10^9 times `innermost`.
std::string laughter(const std::string& innermost) {
    std::string subset = "<!ENTITY e0 '" + innermost + "'>";
    for (int i = 1; i < 10; ++i)
        subset += "<!ENTITY e" + std::to_string(i) + " '" + repeat("&e" + std::to_string(i - 1) + ";", 10) + "'>";
    return "<!DOCTYPE a [" + subset + "]>";
}

TEST(hostile, entities_that_grow) {
    for (const char* const innermost : {"ha", "", "<!---->", "&#65;"}) {
        const std::string subset = laughter(innermost);
        EXPECT_EQ(run(content, subset + "<a>&e9;</a>"), "!" + too_much) << "in text: " << innermost;
        EXPECT_EQ(run(attribute, subset + "<a b='&e9;'/>"), "!") << "in a value: " << innermost;
        EXPECT_EQ(run(tokens, subset + "<a xmlns='&e9;'/>"), "!@1") << "in a namespace: " << innermost;
    }
    const std::string empty = "<!DOCTYPE a [<!ENTITY e ''><!ENTITY v '" + repeat("&e;", 1000) + "'><!ENTITY w '" +
                              repeat("&v;", 100) + "'>]>";
    EXPECT_EQ(run(content, empty + "<a>&w;&w;</a>"), "()</a>");
    EXPECT_EQ(run(content, empty + "<a>&w;&w;&w;</a>"), "!" + too_much) << "references to nothing weigh too";
    std::string doubled = "<!DOCTYPE a [<!ENTITY % p0 'xxxxxxxxxxxxxxxx'>";
    for (int i = 1; i < 40; ++i)
        doubled += "<!ENTITY % p" + std::to_string(i) + " '" + repeat("%p" + std::to_string(i - 1) + ";", 2) + "'>";
    EXPECT_EQ(run(tokens, doubled + "]><a/>"), "!@1" + too_much) << "parameter entities";
    EXPECT_EQ(run(content, "<!DOCTYPE a [<!ENTITY e '.'>]><a>" + repeat("&e;", 1000000) + "</a>").size(), 1000006u)
        << "a long document may use short ones as often as it likes";
}

TEST(hostile, entities_that_hold_or_define_themselves) {
    const std::string two = "<!DOCTYPE a [<!ENTITY e 'x&f;y'><!ENTITY f '&e;'>]>";
    const std::string report = "! {0 9 Recursive entity definition for: ";
    EXPECT_EQ(run(content, two + "<a>&e;</a>"), report + "x&f;y}");
    EXPECT_EQ(run(attribute, two + "<a b='&e;'/>"), report + "x&f;y}");
    EXPECT_EQ(run(attribute, "<!DOCTYPE a [<!ENTITY e '&#37;e;'>]><a b='&e;'/>"), report + "%e;}");
    EXPECT_EQ(run(content, "<!DOCTYPE a [<!ENTITY e '&e'>]><a>&e;</a>"), "!" + too_much)
        << "one that ends with its reference is used up before it comes again";
    EXPECT_EQ(run(tokens, "<!DOCTYPE a [<!ENTITY % p \"<!ENTITY &#37; p '<!ENTITY e &#34;2&#34;>'>" +
                              repeat(" ", 3000) + "<!ENTITY e '1'>\"> %p; %p; ]><a>&e;</a>"),
              "<a>[2]</a>.@1")
        << "one that defines itself anew";
}

TEST(hostile, entities_nested_deeply) {
    for (const std::size_t length : {900u, 20000u}) {
        std::string subset = "<!DOCTYPE a [<!ENTITY e" + std::to_string(length) + " 'v'>";
        for (std::size_t i = 0; i < length; ++i)
            subset += "<!ENTITY e" + std::to_string(i) + " '&e" + std::to_string(i + 1) + ";'>";
        const bool passes = length == 900;
        EXPECT_EQ(run(content, subset + "]><a>&e0;</a>"), passes ? "(v)</a>" : "! {0 9 Entities nested too deeply}");
        EXPECT_EQ(run(attribute, subset + "]><a b='&e0;'/>"), passes ? "(v)" : "!");
    }
}

TEST(hostile, entities_defined_anew_deep_inside) {
    constexpr int depth = 40;
    std::string subset = "<!ENTITY % e0 \"";
    for (int i = 0; i < depth; ++i) // for the reference itself, and then for the value that is being read
        subset += "<!ENTITY &#37; e" + std::to_string(i) + " '<!ENTITY v" + std::to_string(i) + " &#34;new&#34;>'>";
    subset += "\">";
    for (int i = 1; i < depth; ++i)
        subset += "<!ENTITY % e" + std::to_string(i) + " '&#37;e" + std::to_string(i - 1) + "; <!ENTITY w" +
                  std::to_string(i) + " &#34;old&#34;>'>";
    subset += " %e39; %e39; %e20; %e0; ";
    EXPECT_EQ(run(tokens, "<!DOCTYPE a [" + subset + "]><a>&w1;&w16;&w17;&w39;&v39;&v20;&v0;</a>"),
              "<a>[oldoldoldoldnewnewnew]</a>.@1")
        << "each value is read to its end, and the next reference gives the new one";
}

TEST(hostile, elements_nested_deeply) {
    for (const std::size_t depth : {hqf::limits::skip_depth - 1, hqf::limits::skip_depth, 1000000u}) {
        const bool passes = depth < hqf::limits::skip_depth;
        const std::string text = "<a>" + repeat("<b>", depth) + "x" + repeat("</b>", depth) + "</a>";
        reading<lmx::c_xml> r(text, true);
        r.in.get_element_name(nullptr, &r.name);
        EXPECT_EQ(r.in.skip_rest_of_element("a"), passes) << "skipping " << depth;
        r.in.rewind();
        r.in.get_element_name(nullptr, &r.name);
        EXPECT_EQ(r.in.get_any_element("a", &r.value, lmx::preserve, true), passes) << "capturing " << depth;
        EXPECT_TRUE(!passes || r.value == text);
    }
}

} // namespace
