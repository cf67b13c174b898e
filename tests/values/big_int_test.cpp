// Integers and decimals of any size.

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <sstream>
#include <string>

#include "hqf/values/c_big_int.h"
#include "hqf/values/c_decimal.h"

namespace {

using namespace lmx;

TEST(c_big_int, canonical_text) {
    const struct {
        const char *text, *canonical;
    } rows[] = {{nullptr, "0"},   {"", "0"},
                {"-0", "0"},      {"+000", "0"},
                {"abc", "0"},     {"-x", "0"},
                {"-", "0"},       {"--5", "0"},
                {" 5", "0"},      {"0012", "12"},
                {"-0012", "-12"}, {"+7", "7"},
                {"12abc", "12"},  {"12.5", "12"},
                {"-00x5", "0"},   {"123456789012345678901234567890", "123456789012345678901234567890"}};
    for (const auto& row : rows) {
        EXPECT_EQ(c_big_int(row.text).get_as_string(), row.canonical) << (row.text ? row.text : "null");
        c_big_int assigned(77L);
        EXPECT_EQ((assigned = row.text).get_as_string(), row.canonical);
        if (row.text == nullptr) continue;
        EXPECT_EQ(c_big_int(std::string(row.text)).get_as_string(), row.canonical) << row.text;
        EXPECT_EQ((assigned = std::string(row.text)).get_as_string(), row.canonical);
    }
    EXPECT_EQ(c_big_int().get_as_string(), "0");
    EXPECT_EQ(c_big_int(-120L).get_as_string(), "-120");
    EXPECT_EQ(c_big_int(LONG_MIN).get_as_string(), std::to_string(LONG_MIN));
    std::ostringstream os;
    os << c_big_int("-007");
    EXPECT_EQ(os.str(), "-7");
}

TEST(c_big_int, get_keeps_32_bits_and_says_so) {
    const struct {
        const char* text;
        long value;
        bool overflow;
        double as_float;
    } rows[] = {{"0", 0, false, 0},
                {"-17", -17, false, -17},
                {"2147483647", 2147483647, false, 2147483647.0},
                {"-2147483647", -2147483647, false, -2147483647.0},
                {"2147483648", -2147483648L, true, 2147483648.0},
                {"-2147483648", -2147483648L, true, -2147483648.0},
                {"2147483650", -2147483646, true, 2147483650.0},
                {"4294967297", 1, true, 4294967297.0},
                {"-4294967297", -1, true, -4294967297.0},
                {"123456789012345678901234567890", 1312754386, true, 123456789012345678901234567890.0}};
    for (const auto& row : rows) {
        bool overflow = !row.overflow;
        EXPECT_EQ(c_big_int(row.text).get(&overflow), row.value) << row.text;
        EXPECT_EQ(overflow, row.overflow) << row.text;
        EXPECT_EQ(c_big_int(row.text).get(nullptr), row.value) << row.text;
        EXPECT_DOUBLE_EQ(c_big_int(row.text).get_as_float(), row.as_float) << row.text;
    }
}

// `relation` is how the value stands to the text: '<', '=' or '>'.
void expect_relation(const char* value, const char* text, char relation) {
    const c_big_int v(value);
    const bool equal = relation == '=', greater = relation == '>';
    const auto hold = [&](const auto& t) {
        return (v == t) == equal && (v != t) == !equal && (v > t) == greater && (v >= t) == (equal || greater) &&
               (v < t) == (!equal && !greater) && (v <= t) == !greater && (t == v) == equal && (t != v) == !equal &&
               (t < v) == greater && (t <= v) == (equal || greater) && (t > v) == (!equal && !greater) &&
               (t >= v) == !greater;
    };
    EXPECT_TRUE(hold(text)) << value << relation << (text ? text : "null");
    EXPECT_TRUE(text == nullptr || hold(std::string(text))) << value << relation << text;
}

TEST(c_big_int, compares_with_any_text) {
    const struct {
        const char *value, *text;
        char relation;
    } rows[] = {{"0", "0", '='},      {"0", "-0", '='},
                {"0", "+00", '='},    {"0", "-000", '='},
                {"0", nullptr, '='},  {"0", "+", '='},
                {"0", "-", '>'},      {"0", "-0x", '='},
                {"0", "-01", '>'},    {"0", "-1", '>'},
                {"0", "", '<'},       {"5", "", '<'},
                {"-5", "", '<'},      {"5", nullptr, '>'},
                {"-5", nullptr, '<'}, {"12", "12", '='},
                {"12", "+12", '='},   {"12", "0012", '='},
                {"12", "12abc", '<'}, {"12", "9", '>'},
                {"12", "13", '<'},    {"12", "100", '<'},
                {"12", "-12", '>'},   {"12", "0", '>'},
                {"12", "1a", '<'},    {"-5", "-6", '>'},
                {"-5", "-4", '<'},    {"-5", "-5", '='},
                {"-5", "-005", '='},  {"-5", "-10", '>'},
                {"-10", "-5", '<'},   {"-5", "5", '<'},
                {"-5", "0", '<'},     {"-5", "-0", '<'},
                {"-5", "-", '<'},     {"-5", "+", '<'},
                {"5", "-0", '>'},     {"99999999999999999999", "100000000000000000000", '<'}};
    for (const auto& row : rows)
        expect_relation(row.value, row.text, row.relation);
}

TEST(c_big_int, compares_with_another) {
    const char* const ascending[] = {"-100", "-20", "-3", "0", "3", "20", "100", "99999999999999999999"};
    for (int i = 0; i < 8; ++i)
        for (int j = 0; j < 8; ++j) {
            const c_big_int a(ascending[i]), b(ascending[j]);
            EXPECT_TRUE((a == b) == (i == j) && (a != b) == (i != j) && (a < b) == (i < j) && (a <= b) == (i <= j) &&
                        (a > b) == (i > j) && (a >= b) == (i >= j))
                << ascending[i] << " " << ascending[j];
        }
    c_big_int a("1"), b("-2");
    a.swap(b);
    EXPECT_TRUE(a == "-2" && b == "1");
}

TEST(c_decimal, from_text_and_back) {
    const struct {
        const char *text, *written;
        bool valid;
    } rows[] = {{"", "0", false},
                {".", "0", false},
                {"+", "0", false},
                {"-", "-0", false},
                {"-.", "-0", false},
                {"0", "0", true},
                {"-0", "-0", true},
                {"1", "1", true},
                {"1.", "1", true},
                {".5", ".5", true},
                {"0.5", ".5", true},
                {"-.5", "-.5", true},
                {"-0.50", "-.50", true},
                {"+0.10", ".10", true},
                {"1.50", "1.50", true},
                {"007", "7", true},
                {"1e5", "1", false},
                {"1.2.3", "1.2", false},
                {" 1", "0", false},
                {"1 ", "1", false},
                {"-x.5", "-0", false},
                {"0.0", ".0", true},
                {"12345678901234567890.5", "12345678901234567890.5", true}};
    for (const auto& row : rows) {
        EXPECT_EQ(c_decimal::is_valid(row.text), row.valid) << row.text;
        EXPECT_EQ(c_decimal(row.text).get_as_string(), row.written) << row.text;
        c_decimal assigned("-77.77");
        std::ostringstream os;
        os << (assigned = std::string(row.text));
        EXPECT_EQ(os.str(), row.written) << row.text;
    }
    EXPECT_EQ(c_decimal(nullptr), c_decimal());
}

TEST(c_decimal, from_scaled_numbers) {
    const struct {
        long value;
        int scale;
        const char* written;
    } rows[] = {{12345, 2, "123.45"}, {5, 2, ".05"},
                {5, -2, "500"},       {-5, 0, "-5"},
                {0, -3, "0"},         {0, 2, ".00"},
                {500, 2, "5.00"},     {-123, 3, "-.123"},
                {-7, 5, "-.00007"},   {12, 30, ".000000000000000000000000000012"}};
    for (const auto& row : rows) {
        EXPECT_EQ(c_decimal(row.value, row.scale).get_as_string(), row.written) << row.value << " " << row.scale;
        c_decimal set("-9.99");
        set.set_scaled(row.value, row.scale);
        EXPECT_EQ(set.get_as_string(), row.written);
    }
    EXPECT_EQ(c_decimal(LONG_MIN, 1).get_as_string(), std::to_string(LONG_MIN / 10) + ".8");
    EXPECT_EQ(c_decimal(1L, -1000).get_as_string(), "1" + std::string(1000, '0'));
    EXPECT_EQ(c_decimal(12L).get_as_string(), "12");
}

TEST(c_decimal, from_doubles) {
    const struct {
        double value;
        unsigned int digits;
        const char* written;
    } rows[] = {{1.5, 2, "1.50"},
                {1.5, 0, "2"},
                {2.5, 0, "2"},
                {-0.004, 2, "-.00"},
                {1.5, 99, "1.500000000000000"},
                {-0.0, 1, "-.0"},
                {123456.789, 3, "123456.789"}};
    for (const auto& row : rows)
        EXPECT_EQ(c_decimal(row.value, row.digits).get_as_string(), row.written) << row.value;
    EXPECT_EQ(c_decimal(0.1).get_as_string(), ".100000000000000");
    c_decimal assigned;
    EXPECT_EQ(assigned = 0.1, c_decimal(0.1, 15u));
    EXPECT_EQ(c_decimal(1e308).get_as_string().size(), 309u + 16) << "the longest text";
    EXPECT_EQ(c_decimal(-HUGE_VAL).get_as_string(), "-0") << "no digit in it";
    EXPECT_DOUBLE_EQ(c_decimal("-12.34").get_as_float(), -12.34);
    EXPECT_TRUE(std::signbit(c_decimal("-0").get_as_float()));
}

TEST(c_decimal, parts_and_scaled_values) {
    bool overflow = true;
    const struct {
        const char* text;
        int scale;
        long value;
        bool overflow;
    } scaled[] = {{"1.5", 2, 150, false},
                  {"1.234", 2, 123, false},
                  {"125.9", -1, 12, false},
                  {"125.9", -3, 0, false},
                  {"125.9", -2, 1, false},
                  {"125.9", INT_MIN, 0, false},
                  {"-125.9", 0, -125, false},
                  {"0.0", INT_MAX, 0, false},
                  {"21474836.47", 2, 2147483647, false},
                  {"21474836.48", 2, -2147483648L, true},
                  {"214748364", 1, 2147483640, false},
                  {"214748365", 1, -2147483646, true},
                  {"-3", 10, 64771072, true},
                  {"1", INT_MAX, 0, true}};
    for (const auto& row : scaled) {
        EXPECT_EQ(c_decimal(row.text).get_scaled(row.scale, &overflow), row.value) << row.text << " " << row.scale;
        EXPECT_EQ(overflow, row.overflow) << row.text << " " << row.scale;
    }
    const struct {
        const char* text;
        int digits;
        unsigned long value;
        bool overflow;
    } fractional[] = {{"1.5", 3, 500, false},
                      {"1.56", 1, 5, false},
                      {"1.56", 0, 0, false},
                      {"1.56", -1, 0, false},
                      {"1", 4, 0, false},
                      {"0.4294967295", 10, 4294967295, false},
                      {"0.4294967296", 10, 0, true},
                      {"0.429496729", 10, 4294967290, false},
                      {"0.5", 11, 2755359744, true},
                      {"0.1", INT_MAX, 0, true}};
    for (const auto& row : fractional) {
        EXPECT_EQ(c_decimal(row.text).get_fractional(row.digits, &overflow), row.value)
            << row.text << " " << row.digits;
        EXPECT_EQ(overflow, row.overflow) << row.text << " " << row.digits;
    }
    const struct {
        unsigned long value;
        unsigned int width;
        const char* written;
    } set[] = {{5, 3, "-7.005"}, {12345, 2, "-7.12"}, {0, 2, "-7.00"}, {5, 0, "-7"}};
    for (const auto& row : set) {
        c_decimal value("-7.5");
        value.set_fractional(row.value, row.width);
        EXPECT_EQ(value.get_as_string(), row.written);
    }
    c_decimal value("-7.50");
    EXPECT_EQ(value.get_integral(&overflow), -7);
    EXPECT_FALSE(overflow);
    EXPECT_EQ(c_decimal("-2147483648").get_integral(&overflow), -2147483648L);
    EXPECT_TRUE(overflow);
    value.set_integral(12);
    EXPECT_EQ(value.get_as_string(), "12.50");
    value.set_integral(-12);
    EXPECT_EQ(value.get_as_string(), "-12.50");
    c_decimal other("3");
    other.swap(value);
    EXPECT_TRUE(other.get_as_string() == "-12.50" && value.get_as_string() == "3");
}

TEST(c_decimal, order) {
    const char* const ascending[] = {"-10.5", "-9",  "-0.51", "-0.5", "-0", "0",
                                     "0.49",  "0.5", "0.51",  "1.05", "9",  "10"};
    for (int i = 0; i < 12; ++i)
        for (int j = 0; j < 12; ++j) {
            // trailing zeros on one side make no difference
            const c_decimal a(ascending[i]), b(std::string(ascending[j]) + (j == 1 || j == 4 || j == 5 ? ".00" : ""));
            EXPECT_TRUE((a == b) == (i == j) && (a != b) == (i != j) && (a < b) == (i < j) && (a <= b) == (i <= j) &&
                        (a > b) == (i > j) && (a >= b) == (i >= j))
                << ascending[i] << " " << ascending[j];
        }
    EXPECT_EQ(c_decimal("1.50"), c_decimal("1.5"));
}

} // namespace
