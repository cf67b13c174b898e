// Integers and decimals of any size.

#include <climits>
#include <cmath>

#include "hqf/values/c_big_int.h"
#include "hqf/values/c_decimal.h"
#include "tests/support/table.h"

namespace {

using namespace lmx;
using support::rows, support::words, support::stands, support::expect_order;

TEST(c_big_int, canonical_text) {
    for (const auto& [text, canonical] : rows<2>(R"(
        '' 0   -0 0   +000 0   abc 0   - 0   --5 0   _5 0   -0012 -12   +7 7   12abc 12   12.5 12   -00x5 0
        123456789012345678901234567890 123456789012345678901234567890)")) {
        EXPECT_EQ(c_big_int(text).get_as_string(), canonical) << text;
        EXPECT_EQ(c_big_int(text.c_str()).get_as_string(), canonical) << text;
        c_big_int assigned(77L), by_pointer(77L);
        EXPECT_EQ((assigned = text).get_as_string() + (by_pointer = text.c_str()).get_as_string(),
                  canonical + canonical);
    }
    const char* const null = nullptr;
    c_big_int assigned(LONG_MIN);
    EXPECT_EQ(assigned.get_as_string(), std::to_string(LONG_MIN));
    EXPECT_EQ(c_big_int().get_as_string() + c_big_int(null).get_as_string() + (assigned = null).get_as_string(), "000");
    std::ostringstream os;
    os << c_big_int("-007");
    EXPECT_EQ(os.str(), "-7");
}

TEST(c_big_int, get_keeps_32_bits_and_says_so) {
    for (const auto& [text, value, overflows] : rows<3>(R"(
        0 0 0   -17 -17 0   2147483647 2147483647 0   -2147483647 -2147483647 0   2147483648 -2147483648 1
        -2147483648 -2147483648 1   -4294967297 -1 1   123456789012345678901234567890 1312754386 1)")) {
        bool overflow = overflows == "0";
        EXPECT_EQ(c_big_int(text).get(&overflow), std::stol(value)) << text;
        EXPECT_EQ(overflow, overflows == "1") << text;
        EXPECT_EQ(c_big_int(text).get(nullptr), std::stol(value)) << text;
        EXPECT_DOUBLE_EQ(c_big_int(text).get_as_float(), std::stod(text)) << text;
    }
}

TEST(c_big_int, compares_with_any_text) {
    for (const auto& [number, relation, text] : rows<3>(R"(
        0 = -0   0 = +00   0 = +   0 > -   0 = -0x   0 > -01   0 > -1   0 < ''   5 < ''   -5 < ''   12 = +12
        12 = 0012   12 < 12abc   12 > 9   12 < 13   12 < 100   12 > -12   12 > 0   12 < 1a   -5 > -6   -5 < -4
        -5 = -005   -5 > -10   -10 < -5   -5 < 5   -5 < 0   -5 < -0   -5 < -   -5 < +   5 > -0
        99999999999999999999 < 100000000000000000000)")) {
        const c_big_int value(number);
        const char mirrored = relation == "<" ? '>' : relation == ">" ? '<' : '=';
        EXPECT_TRUE(stands(value, relation[0], text) && stands(text, mirrored, value) &&
                    stands(value, relation[0], text.c_str()) && stands(text.c_str(), mirrored, value))
            << number << relation << text;
    }
    const char* const null = nullptr;
    EXPECT_TRUE(stands(c_big_int("5"), '>', null) && stands(c_big_int(), '=', null) &&
                stands(null, '>', c_big_int(-5L)));
    const auto ascending = words("-100 -20 -3 0 3 20 100 99999999999999999999");
    expect_order<c_big_int>(ascending, ascending);
    c_big_int a("1"), b("-2");
    a.swap(b);
    EXPECT_TRUE(a == "-2" && b == "1");
}

TEST(c_decimal, from_text_and_back) {
    for (const auto& [text, text_written, valid] : rows<3>(R"(
        '' 0 0   . 0 0   - -0 0   -. -0 0   1e5 1 0   1.2.3 1.2 0   _1 0 0   1_ 1 0   -x.5 -0 0   -0 -0 1   1. 1 1
        .5 .5 1   0.5 .5 1   -0.50 -.50 1   +0.10 .10 1   1.50 1.50 1   007 7 1   0.0 .0 1
        12345678901234567890.5 12345678901234567890.5 1)")) {
        EXPECT_EQ(c_decimal::is_valid(text.c_str()), valid == "1") << text;
        EXPECT_EQ(c_decimal(text.c_str()).get_as_string(), text_written) << text;
        c_decimal assigned("-77.77");
        std::ostringstream os;
        os << (assigned = text);
        EXPECT_EQ(os.str(), text_written) << text;
    }
    EXPECT_EQ(c_decimal(nullptr), c_decimal());
}

TEST(c_decimal, from_numbers) {
    for (const auto& [value, scale, text] : rows<3>(R"(
        12345 2 123.45   5 2 .05   5 -2 500   0 -3 0   0 2 .00   500 2 5.00   -123 3 -.123   -7 5 -.00007
        12 30 .000000000000000000000000000012   -9223372036854775808 1 -922337203685477580.8)")) {
        EXPECT_EQ(c_decimal(std::stol(value), std::stoi(scale)).get_as_string(), text) << value << " " << scale;
        c_decimal set("-9.99");
        set.set_scaled(std::stol(value), std::stoi(scale));
        EXPECT_EQ(set.get_as_string(), text);
    }
    EXPECT_EQ(c_decimal(1L, -1000).get_as_string(), "1" + std::string(1000, '0'));
    EXPECT_EQ(c_decimal(12L).get_as_string(), "12");
    for (const auto& [value, digits, text] :
         rows<3>("1.5 2 1.50   2.5 0 2   -0.004 2 -.00   1.5 99 1.500000000000000   123456.789 3 123456.789"))
        EXPECT_EQ(c_decimal(std::stod(value), static_cast<unsigned>(std::stoi(digits))).get_as_string(), text) << value;
    c_decimal assigned;
    EXPECT_EQ((assigned = 0.1).get_as_string() + c_decimal(0.1).get_as_string(), ".100000000000000.100000000000000");
    EXPECT_EQ(c_decimal(1e308).get_as_string().size(), 309u + 16) << "the longest text";
    EXPECT_EQ(c_decimal(-HUGE_VAL).get_as_string(), "-0") << "no digit in it";
    EXPECT_DOUBLE_EQ(c_decimal("-12.34").get_as_float(), -12.34);
    EXPECT_TRUE(std::signbit(c_decimal("-0").get_as_float()));
}

TEST(c_decimal, parts_and_scaled_values) {
    bool overflow = true;
    for (const auto& [text, scale, value, overflows] : rows<4>(R"(
        1.234 2 123 0   125.9 -1 12 0   125.9 -3 0 0   125.9 -2147483648 0 0   -125.9 0 -125 0   0.0 2147483647 0 0
        21474836.47 2 2147483647 0   21474836.48 2 -2147483648 1   214748364 1 2147483640 0
        -3 10 64771072 1   1 2147483647 0 1)")) {
        EXPECT_EQ(c_decimal(text.c_str()).get_scaled(std::stoi(scale), &overflow), std::stol(value)) << text << scale;
        EXPECT_EQ(overflow, overflows == "1") << text << " " << scale;
    }
    for (const auto& [text, digits, value, overflows] : rows<4>(R"(
        1.5 3 500 0   1.56 1 5 0   1.56 -1 0 0   0.4294967295 10 4294967295 0   0.4294967296 10 0 1
        0.5 11 2755359744 1   0.1 2147483647 0 1)")) {
        EXPECT_EQ(c_decimal(text.c_str()).get_fractional(std::stoi(digits), &overflow), std::stoul(value))
            << text << " " << digits;
        EXPECT_EQ(overflow, overflows == "1") << text << " " << digits;
    }
    c_decimal value("-7.5");
    for (const auto& [part, width, text] : rows<3>("5 3 -7.005   12345 2 -7.12   5 0 -7   0 2 -7.00   5 1 -7.5")) {
        value.set_fractional(std::stoul(part), static_cast<unsigned>(std::stoul(width)));
        EXPECT_EQ(value.get_as_string(), text);
    }
    EXPECT_TRUE(value.get_integral(&overflow) == -7 && !overflow);
    EXPECT_TRUE(c_decimal("-2147483648").get_integral(&overflow) == -2147483648L && overflow);
    value.set_integral(-12);
    c_decimal other("3");
    other.swap(value);
    EXPECT_TRUE(other.get_as_string() == "-12.5" && value.get_as_string() == "3");
}

TEST(c_decimal, order) {
    expect_order<c_decimal>(words("-10.5 -9    -0.51 -0.5  -0     0    0.49 0.5 0.51  1.05 9 10"),
                            words("-10.5 -9.00 -.51  -0.50 -00.00 0.00 .49  .50 00.51 1.05 9 10."));
}

} // namespace
