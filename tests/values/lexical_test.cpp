// Lexical checks, counts and the small helpers beside them.

#include <gtest/gtest.h>

#include <string>

#include "hqf/values/c_xml_list_tokeniser.h"
#include "hqf/values/ct_qname.h"
#include "hqf/values/lexical.h"
#include "hqf/values/scan.h"

namespace {

using namespace lmx;

const std::string clef = "\xF0\x9D\x84\x9E";               // U+1D11E
const std::string split_clef = "\xED\xA0\xB4\xED\xB4\x9E"; // the same as two surrogates of three bytes

TEST(length, counts_characters) {
    const struct {
        std::string text;
        unsigned int length;
        const char* why;
    } rows[] = {{"", 0, "nothing"},
                {"abc", 3, "ASCII"},
                {"\xC3\xA4\xE2\x82\xAC" + clef, 3, "two, three and four bytes"},
                {split_clef, 1, "a split pair is one character"},
                {split_clef + split_clef + "x", 3, "and its step is six bytes"},
                {"\xED\x9F\xBFx", 2, "0xED without a surrogate has three bytes"},
                {"\xED", 1, "0xED with nothing behind it"},
                {"ab\x80"
                 "cd",
                 3, "a byte that starts nothing is counted and ends it"},
                {"\xF8xxxx", 1, "five-byte lead"},
                {"a\xE2", 2, "a cut sequence is counted"},
                {"\xC3zz", 2, "continuation bytes aren't checked"}};
    for (const auto& row : rows)
        EXPECT_EQ(length(row.text), row.length) << row.why;
}

TEST(is_length_ok, byte_size_decides_outside_the_band) {
    const struct {
        std::string text;
        unsigned int n;
        bool min, max;
        const char* why;
    } rows[] = {{"", 0, true, true, "empty"},
                {"", 1, false, true, "empty against 1"},
                {"abc", 3, true, true, "exact"},
                {"abc", 4, false, true, "one short"},
                {"abc", 2, true, false, "one long"},
                {"\xC3\xA4\xC3\xA4", 2, true, true, "walked inside the band"},
                {"\xC3\xA4\xC3\xA4", 3, false, true, "two characters in four bytes"},
                {"\xC3\xA4\xC3\xA4", 1, true, false, "4 bytes for 1: inside the band, and too many"},
                {split_clef, 1, true, false, "six bytes exceed four, though it is one character"},
                {split_clef + split_clef, 3, true, true, "twelve bytes reach twelve, though there are two"},
                {"abcd", 0x40000000, false, true, "four times n mustn't wrap"},
                {"abcd", 0xC0000000, false, true, "nor here"}};
    for (const auto& row : rows) {
        EXPECT_EQ(is_min_length_ok(row.text, row.n), row.min) << row.why;
        EXPECT_EQ(is_max_length_ok(row.text, row.n), row.max) << row.why;
    }
}

TEST(digits, total_and_behind_the_point) {
    const struct {
        const char* text;
        int total, fraction;
    } rows[] = {{"", 0, 0},   {"007.50", 5, 2}, {"-0.00", 3, 2},   {"5", 1, 0},
                {"5.", 1, 0}, {".5", 1, 1},     {"+1.50e3", 4, 3}, {"1.2.3", 3, 2}};
    for (const auto& row : rows) {
        EXPECT_EQ(total_digits(row.text), row.total) << row.text;
        EXPECT_EQ(fraction_digits(row.text), row.fraction) << row.text;
    }
}

enum : int { as_bool = 1, as_integer = 2, as_float = 4 };

TEST(validators, accept_exactly_their_forms) {
    const struct {
        std::string text;
        int valid;
    } rows[] = {{"true", as_bool},
                {"false", as_bool},
                {"1", as_bool | as_integer | as_float},
                {"0", as_bool | as_integer | as_float},
                {"TRUE", 0},
                {"true ", 0},
                {"10", as_integer | as_float},
                {"-0", as_integer | as_float},
                {"+007", as_integer | as_float},
                {std::string(400, '9'), as_integer | as_float},
                {"", 0},
                {"+", 0},
                {"-", 0},
                {"--1", 0},
                {"1-", 0},
                {" 1", 0},
                {"1 ", 0},
                {std::string("1\0", 2), 0},
                {"\xD9\xA1", 0}, // an Arabic digit
                {"1.0", as_float},
                {"1.", as_float},
                {".5", as_float},
                {"-.5", as_float},
                {".5e1", as_float},
                {"+1E-2", as_float},
                {"1e+02", as_float},
                {"1.e5", as_float},
                {".", 0},
                {"-.", 0},
                {".e1", 0},
                {"1e", 0},
                {"1e+", 0},
                {"1e1.5", 0},
                {"1ee1", 0},
                {"1.2.3", 0},
                {"0x10", 0},
                {"1,5", 0},
                {"INF", as_float},
                {"-INF", as_float},
                {"NaN", as_float},
                {"+INF", 0},
                {"-NaN", 0},
                {"inf", 0},
                {"nan", 0},
                {"INFINITY", 0},
                {"INF ", 0},
                {"e1", 0}};
    for (const auto& row : rows) {
        EXPECT_EQ(is_valid_bool(row.text), (row.valid & as_bool) != 0) << row.text;
        EXPECT_EQ(is_valid_integer(row.text), (row.valid & as_integer) != 0) << row.text;
        EXPECT_EQ(is_valid_float(row.text), (row.valid & as_float) != 0) << row.text;
    }
}

TEST(scan, moves_over_what_it_recognises) {
    const struct {
        const char* text;
        unsigned int number, digits;
        std::size_t behind_number;
    } rows[] = {{"12.5x", 4, 2, 4}, {".5", 2, 0, 2}, {"5.", 2, 1, 2},
                {".", 0, 0, 0},     {"x", 0, 0, 0},  {"1.2.3", 3, 1, 3}};
    for (const auto& row : rows) {
        const std::string text = row.text;
        const char* const end = text.data() + text.size();
        const char* cursor = text.data();
        EXPECT_EQ(scan_number(cursor, end), row.number) << text;
        EXPECT_EQ(static_cast<std::size_t>(cursor - text.data()), row.behind_number) << text;
        cursor = text.data();
        EXPECT_EQ(scan_digits(cursor, end), row.digits) << text;
    }
    const std::string text = "4294967298T";
    const char* cursor = text.data();
    std::uint32_t value = 7;
    EXPECT_EQ(scan_unsigned(cursor, text.data() + 10, value), 10u);
    EXPECT_EQ(value, 2u) << "wraps at 32 bits";
    const char* const at_t = cursor;
    EXPECT_FALSE(scan_literal(cursor, text.data() + text.size(), "TU")) << "longer than what is left";
    EXPECT_EQ(cursor, at_t);
    EXPECT_TRUE(scan_literal(cursor, text.data() + text.size(), "")) << "the empty text always stands";
}

TEST(c_xml_list_tokeniser, items_between_any_whitespace) {
    c_xml_list_tokeniser tokens("\t a\n\v\fbc \r\xA0 d ");
    std::string item;
    for (const char* expected : {"a", "bc", "\xA0", "d"}) {
        ASSERT_TRUE(tokens.get(&item)) << expected;
        EXPECT_EQ(item, expected);
    }
    EXPECT_FALSE(tokens.get(&item));
    EXPECT_EQ(item, "d") << "left alone at the end";
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
    EXPECT_EQ(narrow, "1");
    EXPECT_EQ(wide, L"\x00E4");
    EXPECT_TRUE(narrow_pair.text == "3" && narrow_pair.narrow == "2");
    EXPECT_TRUE(wide_pair.text == L"\x00E4" && wide_pair.narrow == "2");
}

TEST(helpers, bswap_stringncompare_and_character_tests) {
    char a[] = "abcd", b[] = "1234";
    bswap(a, b, 0);
    EXPECT_STREQ(a, "abcd");
    bswap(a, b, 3);
    EXPECT_STREQ(a, "123d");
    EXPECT_STREQ(b, "abc4");

    EXPECT_EQ(stringncompare("xabcy", "abc", 1, 3), 0);
    EXPECT_LT(stringncompare("xabcy", "abcd", 1, 3), 0) << "all of the second text counts";
    EXPECT_GT(stringncompare("xabcy", "abc", 1, 9), 0) << "at most what is there";
    EXPECT_EQ(stringncompare("abc", "", 3, 1), 0);
    EXPECT_THROW(stringncompare("abc", "", 4, 1), std::out_of_range);

    EXPECT_TRUE(xisalpha('a') && xisalnum('7') && xisdigit('7') && xisprint(' ') && xisspace('\v') && xisxdigit('F'));
    EXPECT_FALSE(xisalpha('7') || xisalnum('-') || xisdigit('a') || xisprint('\t') || xisspace('x') || xisxdigit('g'));
    for (const int c : {-1000, -1, 0, 256, 1 << 20})
        EXPECT_FALSE(xisalpha(c) || xisalnum(c) || xisdigit(c) || xisprint(c) || xisspace(c) || xisxdigit(c)) << c;
    EXPECT_EQ(float_zero(), 0.0);
}

} // namespace
