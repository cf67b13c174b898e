// The runtime's functions and values through their exports, each of which forwards to the operation of its name: for
// every shape of call and every overload, whether it is the right one, with its arguments in order.

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

TEST(RuntimeValues, DatesAndTimes) {
    // All classes have their operations and fields from one list of names.
    const auto read = MAKE_VALUE(c_gmonthday, 1, "--02-03Z");
    EXPECT_EQ(taken(CSharp_c_gmonthday_get_as_string(read)), "--02-03Z");
    check({IS(CSharp_c_gmonthday_is_valid("--02-03Z"), 1), IS(CSharp_c_gmonthday_is_valid("--02--"), 0)});
    const auto instant = MAKE_VALUE(c_datetime, 0);
    CSharp_c_datetime_set_year(instant, -44);
    CSharp_c_datetime_set_month(instant, 3);
    CSharp_c_datetime_set_day(instant, 15);
    CSharp_c_datetime_set_hours(instant, 11);
    CSharp_c_datetime_set_mins(instant, 12);
    CSharp_c_datetime_set_secs(instant, 13.5f);
    CSharp_c_datetime_set_is_utc(instant, 4);
    EXPECT_EQ(taken(CSharp_c_datetime_get_as_string(instant)), "-0044-03-15T11:12:13.5Z");
    check({IS(CSharp_c_datetime_get_is_utc(instant), 1)});
    CSharp_c_datetime_set_offset(instant, -1, 30);
    EXPECT_EQ(CSharp_c_datetime_get_total_offset_mins(instant), -90);
    CSharp_c_datetime_set_offset_mins(instant, 2, 15);
    EXPECT_EQ(CSharp_c_datetime_get_total_offset_mins(instant), 135);
    CSharp_c_datetime_set_total_offset_mins(instant, -7);
    EXPECT_EQ(CSharp_c_datetime_get_total_offset_mins(instant), -7);
    const auto span = MAKE_VALUE(c_duration, 0), long_one = MAKE_VALUE(c_duration, 1, "P1Y12M3DT4H5M66.5S");
    CSharp_c_duration_set_is_neg(span, 2);
    CSharp_c_duration_set_years(span, 1);
    CSharp_c_duration_set_months(span, 2);
    CSharp_c_duration_set_days(span, 3);
    CSharp_c_duration_set_hours(span, 4);
    CSharp_c_duration_set_mins(span, 5);
    CSharp_c_duration_set_secs(span, 6.5f);
    EXPECT_EQ(taken(CSharp_c_duration_get_as_string(span)), "-P1Y2M3DT4H5M6.5S");
    CSharp_c_duration_normalize(long_one);
    EXPECT_EQ(taken(CSharp_c_duration_get_as_string(long_one)), "P2Y3DT4H6M6.5S");
    check({IS(CSharp_c_datetime_get_year(instant), -44), IS(CSharp_c_datetime_get_month(instant), 3),
           IS(CSharp_c_datetime_get_day(instant), 15), IS(CSharp_c_datetime_get_hours(instant), 11),
           IS(CSharp_c_datetime_get_mins(instant), 12), IS(CSharp_c_datetime_get_secs(instant), 13.5),
           IS(CSharp_c_duration_get_is_neg(span), 1), IS(CSharp_c_duration_get_years(span), 1),
           IS(CSharp_c_duration_get_months(span), 2), IS(CSharp_c_duration_get_days(span), 3),
           IS(CSharp_c_duration_get_hours(span), 4), IS(CSharp_c_duration_get_mins(span), 5),
           IS(CSharp_c_duration_get_secs(span), 6.5)});
    check({IS(CSharp_c_duration_is_valid__SWIG_0("P1D"), 1), IS(CSharp_c_duration_is_valid__SWIG_0("PT"), 0)});
}

TEST(RuntimeValues, BytesPatternsAndEntries) {
    const unsigned char abc[] = {'a', 'b', 'c'};
    const auto b = MAKE_VALUE(c_binary, 2, abc, 2), empty = MAKE_VALUE(c_binary, 0);
    EXPECT_EQ(CSharp_c_binary_size(b), 2u);
    CSharp_c_binary_append(b, 'c');
    check({IS(CSharp_c_binary_equal(b, abc, 3), 1), IS(CSharp_c_binary_equal(b, abc, 2), 0),
           IS(CSharp_c_binary_equal(MAKE_VALUE(c_binary, 1, b), abc, 3), 1)});
    CSharp_c_binary_swap(b, empty);
    EXPECT_EQ(CSharp_c_binary_size(b), 0u);
    CSharp_c_binary_set(b, abc + 1, 2);
    EXPECT_EQ(CSharp_c_binary_equal(b, abc + 1, 2), 1);
    CSharp_c_binary_set(b, nullptr, 0);
    EXPECT_EQ(CSharp_c_binary_size(b), 0u);
    const auto pattern = own(CSharp_new_c_pattern("[ab]+"), CSharp_delete_c_pattern);
    const auto broken = own(CSharp_new_c_pattern("["), CSharp_delete_c_pattern);
    const auto none = own(CSharp_new_c_pattern_null(), CSharp_delete_c_pattern_null);
    check({IS(CSharp_c_binary_is_valid_base64("QQ=="), 1), IS(CSharp_c_binary_is_valid_hex("QQ=="), 0),
           IS(CSharp_c_binary_is_valid_base64("0F1"), 0), IS(CSharp_c_binary_is_valid_hex("0aF1"), 1),
           IS(CSharp_c_pattern_is_match__SWIG_0(pattern, "aba"), 1),
           IS(CSharp_c_pattern_is_match__SWIG_0(pattern, "abc"), 0),
           IS(CSharp_c_pattern_is_match__SWIG_0(broken, "["), 0),
           IS(CSharp_c_pattern_null_is_match__SWIG_0(none, ""), 1)});
    EXPECT_NE(own(CSharp_new_c_empty(), CSharp_delete_c_empty), nullptr);
    EXPECT_NE(own(CSharp_new_c_datetime_base(), CSharp_delete_c_datetime_base), nullptr);

    const auto parts = [](lmx_c_any_info* made) {
        const auto info = own(made, CSharp_delete_c_any_info);
        return taken(CSharp_c_any_info_get_namespace(made)) + '|' + taken(CSharp_c_any_info_get_name(made)) + '|' +
               taken(CSharp_c_any_info_get_value(made)) + ' ';
    };
    lmx_c_any_info* const info = CSharp_new_c_any_info__SWIG_0();
    CSharp_c_any_info_set_namespace(info, "1");
    CSharp_c_any_info_set_name(info, "2");
    CSharp_c_any_info_set_value(info, "3");
    EXPECT_EQ(parts(info) + parts(CSharp_new_c_any_info__SWIG_0()), "1|2|3 || ");
    EXPECT_EQ(parts(CSharp_new_c_any_info__SWIG_1("n", "m", "v")) + parts(CSharp_new_c_any_info__SWIG_2("m", "v")) +
                  parts(CSharp_new_c_any_info__SWIG_3("v")),
              "n|m|v |m|v ||v ");
}

} // namespace
