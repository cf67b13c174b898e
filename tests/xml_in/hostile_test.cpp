// Documents that mean harm. Each must end in an answer, soon, and without memory that it hasn't paid for; the
// sanitizers watch the rest.

#include "support.h"

#include "tests/support/patterns.h"

namespace {

using namespace xml_in_test;

using support::expanded;

std::string run(const driver& drive, const std::string& text) {
    lmx::c_read_string source(text);
    return drive(source);
}
const driver content = value_in(lmx::preserve);
const driver attribute = attribute_value_in(lmx::preserve);

const std::string too_much = " {0 9 Entities expand to too much text}";

// Ten entities, each ten times the one before: 10^9 times `innermost`.
std::string laughter(const std::string& innermost) {
    return "<!DOCTYPE a [<!ENTITY e0 '" + innermost + "'>" +
           expanded("{<!ENTITY e^ '&e@;&e@;&e@;&e@;&e@;&e@;&e@;&e@;&e@;&e@;'>}]>", 9);
}

TEST(hostile, entities_that_grow) {
    for (const char* const innermost : {"ha", "", "<!---->", "&#65;"}) {
        const std::string subset = laughter(innermost);
        EXPECT_EQ(run(content, subset + "<a>&e9;</a>"), "!" + too_much) << "in text: " << innermost;
        EXPECT_EQ(run(attribute, subset + "<a b='&e9;'/>"), "!") << "in a value: " << innermost;
        EXPECT_EQ(run(tokens, subset + "<a xmlns='&e9;'/>"), "!@1") << "in a namespace: " << innermost;
    }
    const std::string empty = "<!DOCTYPE a [<!ENTITY e ''><!ENTITY v '" + expanded("{&e;}", 1000) + "'><!ENTITY w '" +
                              expanded("{&v;}", 100) + "'>]>";
    EXPECT_EQ(run(content, empty + "<a>&w;&w;</a>"), "()</a>");
    EXPECT_EQ(run(content, empty + "<a>&w;&w;&w;</a>"), "!" + too_much) << "references to nothing weigh too";
    const std::string doubled = expanded("{<!ENTITY % p^ '%p@;%p@;'>}", 39);
    EXPECT_EQ(run(tokens, "<!DOCTYPE a [<!ENTITY % p0 'xxxxxxxxxxxxxxxx'>" + doubled + "]><a/>"), "!@1" + too_much)
        << "parameter entities";
    EXPECT_EQ(run(content, "<!DOCTYPE a [<!ENTITY e '.'>]><a>" + expanded("{&e;}", 1000000) + "</a>").size(), 1000006u)
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
                              std::string(3000, ' ') + "<!ENTITY e '1'>\"> %p; %p; ]><a>&e;</a>"),
              "<a>[2]</a>.@1")
        << "one that defines itself anew";
}

TEST(hostile, entities_nested_deeply) {
    for (const unsigned int length : {900u, 20000u}) {
        const std::string subset = expanded("<!DOCTYPE a [<!ENTITY e$ 'v'>{<!ENTITY e@ '&e^;'>}", length);
        EXPECT_EQ(run(content, subset + "]><a>&e0;</a>"), "(v)</a>");
        EXPECT_EQ(run(attribute, subset + "]><a b='&e0;'/>"), length == 900 ? "(v)" : "!");
    }
}

TEST(hostile, entities_defined_anew_deep_inside) {
    // For the reference itself, and then for the value that is being read.
    const std::string innermost = expanded("{<!ENTITY &#37; e@ '<!ENTITY v@ &#34;new&#34;>'>}", 40);
    const std::string outer = expanded("{<!ENTITY % e^ '&#37;e@; <!ENTITY w^ &#34;old&#34;>'>}", 39);
    const std::string subset = "<!ENTITY % e0 \"" + innermost + "\">" + outer + " %e39; %e39; %e20; %e0; ";
    EXPECT_EQ(run(tokens, "<!DOCTYPE a [" + subset + "]><a>&w1;&w16;&w17;&w39;&v39;&v20;&v0;</a>"),
              "<a>[oldoldoldoldnewnewnew]</a>.@1")
        << "each value is read to its end, and the next reference gives the new one";
}

} // namespace
