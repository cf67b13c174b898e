// Lexical checks, counts and the small helpers beside them.

#include "hqf/values/c_xml_list_tokeniser.h"
#include "hqf/values/ct_qname.h"
#include "hqf/values/lexical.h"
#include "tests/support/table.h"

namespace {

using namespace lmx;
using support::rows, support::words;

const std::string clef = "\xF0\x9D\x84\x9E";               // U+1D11E
const std::string split_clef = "\xED\xA0\xB4\xED\xB4\x9E"; // the same as two surrogates of three bytes

TEST(length, counts_characters) {
    // A split pair is one character, and a step of six bytes. A byte that starts nothing is counted and ends the count;
    // continuation bytes aren't checked.
    using row = std::pair<std::string, unsigned int>;
    const auto rows = support::list(row{"", 0}, row{"abc", 3}, row{"\xC3\xA4\xE2\x82\xAC" + clef, 3},
                                    row{split_clef + split_clef + "x", 3}, row{"\xED\x9F\xBFx", 2}, row{"\xED", 1},
                                    row{"ab\x80zz", 3}, row{"\xF8xxxx", 1}, row{"a\xE2", 2}, row{"\xC3zz", 2});
    for (const auto& [text, expected] : rows)
        EXPECT_EQ(length(text), expected) << text;
}

TEST(is_length_ok, byte_size_decides_outside_the_band) {
    // Six bytes exceed four times one, though they are one character; twelve reach four times three. Four times a large
    // bound mustn't wrap.
    using row = std::tuple<std::string, unsigned int, bool, bool>;
    const auto rows = support::list(
        row{"", 0, true, true}, row{"", 1, false, true}, row{"abc", 3, true, true}, row{"abc", 4, false, true},
        row{"abc", 2, true, false}, row{"\xC3\xA4\xC3\xA4", 2, true, true}, row{"\xC3\xA4\xC3\xA4", 3, false, true},
        row{"\xC3\xA4\xC3\xA4", 1, true, false}, row{split_clef, 1, true, false},
        row{split_clef + split_clef, 3, true, true}, row{clef + clef + clef, 4, false, true},
        row{"abcd", 0x40000000, false, true}, row{"abcd", 0xC0000000, false, true});
    for (const auto& [text, bound, min, max] : rows) {
        EXPECT_EQ(is_min_length_ok(text, bound), min) << text << " " << bound;
        EXPECT_EQ(is_max_length_ok(text, bound), max) << text << " " << bound;
    }
}

TEST(digits, total_and_behind_the_point) {
    for (const auto& [text, total, fraction] :
         rows<3>("'' 0 0   007.50 5 2   -0.00 3 2   5 1 0   5. 1 0   .5 1 1   +1.50e3 4 3   1.2.3 3 2")) {
        EXPECT_EQ(total_digits(text.c_str()), std::stoi(total)) << text;
        EXPECT_EQ(fraction_digits(text.c_str()), std::stoi(fraction)) << text;
    }
}

enum : int { as_bool = 1, as_integer = 2, as_float = 4 };

TEST(validators, accept_exactly_their_forms) {
    const std::pair<const char*, int> groups[] = {
        {"true false", as_bool},
        {"1 0", as_bool | as_integer | as_float},
        {"10 -0 +007 007", as_integer | as_float},
        {"1.0 1. .5 -.5 .5e1 +1E-2 1e+02 1.e5 INF -INF NaN", as_float},
        {"TRUE true_ '' + - --1 1- _1 1_ ١ . -. .e1 1e 1e+ 1e1.5 1ee1 1.2.3 0x10 1,5 +INF -NaN inf nan INF_ e1", 0}};
    for (const auto& [texts, valid] : groups)
        for (const auto& text : words(texts)) {
            EXPECT_EQ(is_valid_bool(text), (valid & as_bool) != 0) << text;
            EXPECT_EQ(is_valid_integer(text), (valid & as_integer) != 0) << text;
            EXPECT_EQ(is_valid_float(text), (valid & as_float) != 0) << text;
        }
    EXPECT_TRUE(is_valid_integer(std::string(400, '9')) && is_valid_float(std::string(400, '9')));
    EXPECT_FALSE(is_valid_integer(std::string("1\0", 2)) || is_valid_float(std::string("1\0", 2)));
}

TEST(c_xml_list_tokeniser, items_between_any_whitespace) {
    c_xml_list_tokeniser tokens("\t a\n\v\fbc \r\xA0 d ");
    std::string item;
    for (const char* expected : {"a", "bc", "\xA0", "d"}) {
        ASSERT_TRUE(tokens.get(&item)) << expected;
        EXPECT_EQ(item, expected);
    }
    EXPECT_TRUE(!tokens.get(&item) && item == "d") << "left alone at the end";
    tokens.set("x");
    EXPECT_TRUE(tokens.get(&item) && item == "x") << "set starts over";
    tokens.set("");
    EXPECT_FALSE(tokens.get(&item));
}

TEST(make_qname, each_result_takes_its_own_arguments) {
    std::string narrow;
    std::wstring wide;
    ct_qname<std::string> narrow_pair;
    ct_qname<std::wstring> wide_pair;
    make_qname(&narrow, "1", "2", "3");
    make_qname(&wide, "\xC3\xA4", "2", "3");
    make_qname(&narrow_pair, "1", "2", "3");
    make_qname(&wide_pair, "1", "2", "\xC3\xA4");
    EXPECT_EQ(narrow + narrow_pair.text + narrow_pair.narrow + wide_pair.narrow, "1322");
    EXPECT_EQ(wide + wide_pair.text, L"\x00E4\x00E4");
}

TEST(helpers, bswap_and_stringncompare) {
    char a[] = "abcd", b[] = "1234";
    bswap(a, b, 0);
    EXPECT_STREQ(a, "abcd");
    bswap(a, b, 3);
    EXPECT_EQ(std::string(a) + b, "123dabc4");
    EXPECT_EQ(stringncompare("xabcy", "abc", 1, 3), 0);
    EXPECT_LT(stringncompare("xabcy", "abcd", 1, 3), 0) << "all of the second text counts";
    EXPECT_GT(stringncompare("xabcy", "abc", 1, 9), 0) << "at most what is there";
    EXPECT_THROW(stringncompare("abc", "", 4, 1), std::out_of_range);
}

} // namespace
