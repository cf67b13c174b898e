// The runtime's functions and numbers through their exports, each of which forwards to the operation of its name: for
// every shape of call and every overload, whether it is the right one, with its arguments in order. Other values cross
// in the tests of the C# classes.

#include <climits>
#include <cstdint>
#include <initializer_list>

#include <gtest/gtest.h>

#include "support.h"

using namespace flat_test;

namespace {

std::string str(lmx_c_decimal* value) {
    return taken(CSharp_c_decimal_get_as_string(own(value, CSharp_delete_c_decimal)));
}
std::string str(lmx_c_big_int* value) {
    return taken(CSharp_c_big_int_get_as_string(own(value, CSharp_delete_c_big_int)));
}

/// A call, named by its own text, and what it gives.
struct answer {
    const char* call;
    double value, expected;
};
#define IS(call, expected)                                                                                             \
    answer {                                                                                                           \
#call, static_cast < double>(call), static_cast < double>(expected)                                            \
    }

void check(std::initializer_list<answer> answers) {
    for (const answer& each : answers)
        EXPECT_EQ(each.value, each.expected) << each.call;
}

TEST(RuntimeFunctions, ForwardByName) {
    check({IS(CSharp_length("\xC3\xA9z"), 2), IS(CSharp_total_digits("-007.50"), 5),
           IS(CSharp_fraction_digits("-007.50"), 2), IS(CSharp_is_valid_bool("true"), 1),
           IS(CSharp_is_valid_bool("1.5"), 0), IS(CSharp_is_valid_float("1.5"), 1),
           IS(CSharp_is_valid_float("true"), 0), IS(CSharp_is_valid_integer("15"), 1),
           IS(CSharp_is_valid_integer("1.5"), 0), IS(CSharp_is_min_length_ok("ab", 2), 1),
           IS(CSharp_is_min_length_ok("ab", 3), 0), IS(CSharp_is_max_length_ok("ab", 2), 1),
           IS(CSharp_is_max_length_ok("ab", 1), 0), IS(CSharp_stringncompare("xabz", "ab", 1, 2), 0),
           IS(CSharp_stringncompare("xabz", "ab", 1, 3) > 0, 1), IS(CSharp_stringncompare("xabz", "b", 1, 1) < 0, 1)});
    EXPECT_STREQ(CSharp_get_error_description(46), "min/max occurs error on marshaling");
    EXPECT_STREQ(CSharp_get_error_description(999), "");
    EXPECT_EQ(CSharp_get_error_description(46), CSharp_get_error_description(46)) << "the library's own text";
    const std::tuple<int32_t (*)(int32_t), std::string, std::string> tests[] = {
        {CSharp_xisalnum, "aZ0", " -"}, {CSharp_xisalpha, "aZ", "0 "},  {CSharp_xisdigit, "09", "a "},
        {CSharp_xisprint, "a0 ", "\n"}, {CSharp_xisspace, " \n", "a0"}, {CSharp_xisxdigit, "09afAF", "gG "}};
    for (const auto& [is, yes, no] : tests) {
        for (const char c : yes + no)
            EXPECT_EQ(is(c), yes.find(c) != std::string::npos) << yes << ": " << c;
        for (const int c : {0, -1, -97, INT_MIN, INT_MAX})
            EXPECT_EQ(is(c), 0) << yes << ": " << c;
    }
}

TEST(RuntimeValues, BigIntegers) {
    EXPECT_EQ(str(CSharp_new_c_big_int__SWIG_0()) + str(CSharp_new_c_big_int__SWIG_4(INT_MIN)), "0-2147483648");
    const auto large = MAKE_VALUE(c_big_int, 2, "2147483648"), small = MAKE_VALUE(c_big_int, 4, -7);
    EXPECT_EQ(str(CSharp_new_c_big_int__SWIG_1(large)), "2147483648");
    bool overflow = false;
    EXPECT_TRUE(CSharp_c_big_int_get(large, &overflow) == INT_MIN && overflow) << "wrapped";
    EXPECT_TRUE(CSharp_c_big_int_get(small, &overflow) == -7 && !overflow);
    EXPECT_EQ(CSharp_c_big_int_get(small, nullptr), -7) << "nobody asks for overflow";
    EXPECT_EQ(CSharp_c_big_int_get_as_float(large), 2147483648.0);
    CSharp_c_big_int_swap(large, small);
    EXPECT_EQ(CSharp_c_big_int_get(large, nullptr), -7);
}

TEST(RuntimeValues, Decimals) {
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_0()) + str(CSharp_new_c_decimal__SWIG_4(12345, 2)) +
                  str(CSharp_new_c_decimal__SWIG_5(-12)) + "|" + str(CSharp_new_c_decimal__SWIG_6(1.25, 1)),
              "0123.45-12|1.2");
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_7(1.5)), "1.500000000000000");
    const auto d = MAKE_VALUE(c_decimal, 2, "-1.56"), other = MAKE_VALUE(c_decimal, 0);
    bool overflow = true;
    EXPECT_TRUE(CSharp_c_decimal_get_integral(d, &overflow) == -1 && !overflow);
    check({IS(CSharp_c_decimal_get_as_float(d), -1.56), IS(CSharp_c_decimal_get_fractional(d, 3, nullptr), 560u),
           IS(CSharp_c_decimal_get_scaled(d, 1, nullptr), -15), IS(CSharp_c_decimal_is_valid(".5"), 1),
           IS(CSharp_c_decimal_is_valid("."), 0)});
    const auto becomes = [&d](const char* text) { EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_1(d)), text); };
    CSharp_c_decimal_set__SWIG_0(d, 2.25, 2), becomes("2.25");
    CSharp_c_decimal_set__SWIG_1(d, 2.25), becomes("2.250000000000000");
    CSharp_c_decimal_set_fractional(d, 5, 3), becomes("2.005");
    CSharp_c_decimal_set_integral(d, -3), becomes("-3.005");
    CSharp_c_decimal_set_scaled__SWIG_0(d, 5, -2), becomes("500");
    CSharp_c_decimal_set_scaled__SWIG_1(d, 7), becomes("7");
    CSharp_c_decimal_swap(d, other), becomes("0");
}

} // namespace
