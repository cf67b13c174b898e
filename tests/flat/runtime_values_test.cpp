// The runtime's constants, functions and values through their exports: each forwards to the operation of its name, so a
// row or two tells whether it is the right one, with its arguments in order.

#include <climits>
#include <cstdint>
#include <initializer_list>
#include <memory>

#include <gtest/gtest.h>

#include "support.h"

using namespace flat_test;

namespace {

template<class T>
struct ender;

template<class T>
std::unique_ptr<T, ender<T>> own(T* value) {
    return std::unique_ptr<T, ender<T>>(value);
}

#define VALUE(name)                                                                                                    \
    template<>                                                                                                         \
    struct ender<lmx_##name> {                                                                                         \
        void operator()(lmx_##name* value) const { CSharp_delete_##name(value); }                                      \
    }
// clang-format off
VALUE(c_any_info); VALUE(c_big_int); VALUE(c_decimal); VALUE(c_duration); VALUE(c_datetime); VALUE(c_date);
VALUE(c_time); VALUE(c_gyear); VALUE(c_gyearmonth); VALUE(c_gmonth); VALUE(c_gmonthday); VALUE(c_gday);
VALUE(c_binary); VALUE(c_pattern); VALUE(c_pattern_null); VALUE(c_empty); VALUE(c_datetime_base);
// clang-format on

std::string str(lmx_c_decimal* value) {
    return taken(CSharp_c_decimal_get_as_string(own(value).get()));
}
std::string str(lmx_c_big_int* value) {
    return taken(CSharp_c_big_int_get_as_string(own(value).get()));
}

/// A call, named by its own text, and what it gives.
struct answer {
    answer(const char* text, double gives, double should_give)
        : call(text)
        , value(gives)
        , expected(should_give) {}
    const char* call;
    double value, expected;
};
#define IS(call, expected) answer(#call, static_cast<double>(call), static_cast<double>(expected))

void check(std::initializer_list<answer> answers) {
    for (const answer& each : answers)
        EXPECT_EQ(each.value, each.expected) << each.call;
}

TEST(RuntimeConstants, AreThoseOfTheBuild) {
    check({IS(CSharp_LMXNULL_get(), 0), IS(CSharp_LMX_XML_STRICT_get(), 1), IS(CSharp_LMX_VALIDATE_PATTERNS_get(), 1),
           IS(CSharp_LMX_WANT_DECIMAL_FLOAT_SET_get(), 1), IS(CSharp_LMX_USE_EXCEPTIONS_get(), 0),
           IS(CSharp_LMX_NARROW_UNICODE_STRINGS_get(), 0), IS(CSharp_LMX_WANT_DLL_get(), 0),
           IS(CSharp_LMX_WANT_GEN_IMPORT_DLL_get(), 0), IS(CSharp_LMX_ATOFLOAT_MODE_get(), 0),
           IS(CSharp_LMX_ATOFLOAT_MODE_DEFAULT_get(), 0), IS(CSharp_LMX_ATOFLOAT_MODE_USE_FACET_get(), 1),
           IS(CSharp_LMX_ATOFLOAT_MODE_IOSTREAM_get(), 2), IS(CSharp_LMX_ATOFLOAT_MODE_SIMPLE_get(), 3)});
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
}

TEST(RuntimeFunctions, TestCharactersAboveZeroAlone) {
    using test = int32_t (*)(int32_t);
    const struct {
        test is;
        const char* yes;
        const char* no;
    } rows[] = {{CSharp_xisalnum, "aZ0", " -"}, {CSharp_xisalpha, "aZ", "0 "},  {CSharp_xisdigit, "09", "a "},
                {CSharp_xisprint, "a0 ", "\n"}, {CSharp_xisspace, " \n", "a0"}, {CSharp_xisxdigit, "09afAF", "gG "}};
    for (const auto& row : rows) {
        for (const char* c = row.yes; *c != '\0'; ++c)
            EXPECT_EQ(row.is(*c), 1) << row.yes << ": " << *c;
        for (const char* c = row.no; *c != '\0'; ++c)
            EXPECT_EQ(row.is(*c), 0) << row.yes << ": " << *c;
        for (const int c : {0, -1, -97, INT_MIN, INT_MAX})
            EXPECT_EQ(row.is(c), 0) << row.yes << ": " << c;
    }
}

TEST(RuntimeValues, BigIntegers) {
    EXPECT_EQ(str(CSharp_new_c_big_int__SWIG_0()), "0");
    EXPECT_EQ(str(CSharp_new_c_big_int__SWIG_4(INT_MIN)), "-2147483648");
    const auto large = own(CSharp_new_c_big_int__SWIG_2("2147483648")), small = own(CSharp_new_c_big_int__SWIG_4(-7));
    EXPECT_EQ(str(CSharp_new_c_big_int__SWIG_1(large.get())), "2147483648");
    bool overflow = false;
    EXPECT_EQ(CSharp_c_big_int_get(large.get(), &overflow), INT_MIN) << "wrapped";
    EXPECT_TRUE(overflow);
    EXPECT_EQ(CSharp_c_big_int_get(small.get(), &overflow), -7);
    EXPECT_FALSE(overflow);
    EXPECT_EQ(CSharp_c_big_int_get(small.get(), nullptr), -7) << "nobody asks for overflow";
    EXPECT_EQ(CSharp_c_big_int_get_as_float(large.get()), 2147483648.0);
    CSharp_c_big_int_swap(large.get(), small.get());
    EXPECT_EQ(CSharp_c_big_int_get(large.get(), nullptr), -7);
}

TEST(RuntimeValues, Decimals) {
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_0()), "0");
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_4(12345, 2)), "123.45");
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_5(-12)), "-12");
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_6(1.25, 1)), "1.2");
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_7(1.5)), str(CSharp_new_c_decimal__SWIG_6(1.5, 15)));
    EXPECT_NE(str(CSharp_new_c_decimal__SWIG_7(1.5)), str(CSharp_new_c_decimal__SWIG_6(1.5, 14)));
    const auto value = own(CSharp_new_c_decimal__SWIG_2("-1.56"));
    lmx_c_decimal* const d = value.get();
    EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_1(d)), "-1.56");
    EXPECT_DOUBLE_EQ(CSharp_c_decimal_get_as_float(d), -1.56);
    bool overflow = true;
    EXPECT_EQ(CSharp_c_decimal_get_integral(d, &overflow), -1);
    EXPECT_FALSE(overflow);
    check({IS(CSharp_c_decimal_get_fractional(d, 3, nullptr), 560u),
           IS(CSharp_c_decimal_get_scaled(d, 1, nullptr), -15)});
    const auto becomes = [d](const char* text) { EXPECT_EQ(str(CSharp_new_c_decimal__SWIG_1(d)), text); };
    CSharp_c_decimal_set__SWIG_0(d, 2.25, 2), becomes("2.25");
    CSharp_c_decimal_set__SWIG_1(d, 2.25), becomes("2.250000000000000");
    CSharp_c_decimal_set_fractional(d, 5, 3), becomes("2.005");
    CSharp_c_decimal_set_integral(d, -3), becomes("-3.005");
    CSharp_c_decimal_set_scaled__SWIG_0(d, 5, -2), becomes("500");
    CSharp_c_decimal_set_scaled__SWIG_1(d, 7), becomes("7");
    const auto other = own(CSharp_new_c_decimal__SWIG_0());
    CSharp_c_decimal_swap(d, other.get()), becomes("0");
    check({IS(CSharp_c_decimal_is_valid(".5"), 1), IS(CSharp_c_decimal_is_valid("."), 0)});
}

TEST(RuntimeValues, Durations) {
    const auto value = own(CSharp_new_c_duration__SWIG_1("-P1Y2M3DT4H5M6.5S"));
    lmx_c_duration* const d = value.get();
    check({IS(CSharp_c_duration_get_is_neg(d), 1), IS(CSharp_c_duration_get_years(d), 1u),
           IS(CSharp_c_duration_get_months(d), 2u), IS(CSharp_c_duration_get_days(d), 3u),
           IS(CSharp_c_duration_get_hours(d), 4u), IS(CSharp_c_duration_get_mins(d), 5u),
           IS(CSharp_c_duration_get_secs(d), 6.5f)});
    const auto fresh = own(CSharp_new_c_duration__SWIG_0());
    CSharp_c_duration_set_is_neg(fresh.get(), 2);
    CSharp_c_duration_set_years(fresh.get(), 1);
    CSharp_c_duration_set_months(fresh.get(), 12);
    CSharp_c_duration_set_days(fresh.get(), 3);
    CSharp_c_duration_set_hours(fresh.get(), 4);
    CSharp_c_duration_set_mins(fresh.get(), 5);
    CSharp_c_duration_set_secs(fresh.get(), 66.5f);
    EXPECT_EQ(taken(CSharp_c_duration_get_as_string(fresh.get())), "-P1Y12M3DT4H5M66.5S");
    CSharp_c_duration_normalize(fresh.get());
    EXPECT_EQ(taken(CSharp_c_duration_get_as_string(fresh.get())), "-P2Y3DT4H6M6.5S");
    check({IS(CSharp_c_duration_is_valid__SWIG_0("P1D"), 1), IS(CSharp_c_duration_is_valid__SWIG_0("PT"), 0)});
}

TEST(RuntimeValues, DatesAndTimes) {
    // Every class: its own text, one that only another class takes, and each field by a setter of its own.
#define CHECK_DATE(name, good, bad)                                                                                    \
    {                                                                                                                  \
        const auto value = own(CSharp_new_##name##__SWIG_1(good));                                                     \
        EXPECT_EQ(taken(CSharp_##name##_get_as_string(value.get())), good);                                            \
        EXPECT_EQ(CSharp_##name##_is_valid(good), 1) << good;                                                          \
        EXPECT_EQ(CSharp_##name##_is_valid(bad), 0) << bad;                                                            \
        const auto empty = own(CSharp_new_##name##__SWIG_0());                                                         \
        EXPECT_EQ(CSharp_##name##_get_is_utc(empty.get()), 0);                                                         \
        CSharp_##name##_set_is_utc(empty.get(), 4);                                                                    \
        EXPECT_EQ(CSharp_##name##_get_is_utc(empty.get()), 1);                                                         \
        CSharp_##name##_set_offset(empty.get(), -1, 30);                                                               \
        EXPECT_EQ(CSharp_##name##_get_total_offset_mins(empty.get()), -90);                                            \
        EXPECT_EQ(CSharp_##name##_get_is_utc(empty.get()), 0) << "an offset ends UTC";                                 \
        CSharp_##name##_set_offset_mins(empty.get(), 2, 15);                                                           \
        EXPECT_EQ(CSharp_##name##_get_total_offset_mins(empty.get()), 135);                                            \
        CSharp_##name##_set_total_offset_mins(empty.get(), -7);                                                        \
        EXPECT_EQ(CSharp_##name##_get_total_offset_mins(empty.get()), -7);                                             \
    }
    CHECK_DATE(c_datetime, "2001-02-03T04:05:06.5Z", "2001-02-03")
    CHECK_DATE(c_date, "2001-02-03Z", "2001-02")
    CHECK_DATE(c_time, "04:05:06.5Z", "2001-02-03")
    CHECK_DATE(c_gyear, "2001Z", "2001-02")
    CHECK_DATE(c_gyearmonth, "2001-02Z", "2001")
    CHECK_DATE(c_gmonth, "--02--Z", "--02-03")
    CHECK_DATE(c_gmonthday, "--02-03Z", "--02--")
    CHECK_DATE(c_gday, "---03Z", "--02-03")
#undef CHECK_DATE
    check({IS(CSharp_c_date_get_year(own(CSharp_new_c_date__SWIG_1("2001-02-03")).get()), 2001),
           IS(CSharp_c_date_get_month(own(CSharp_new_c_date__SWIG_1("2001-02-03")).get()), 2),
           IS(CSharp_c_date_get_day(own(CSharp_new_c_date__SWIG_1("2001-02-03")).get()), 3),
           IS(CSharp_c_time_get_hours(own(CSharp_new_c_time__SWIG_1("04:05:06")).get()), 4),
           IS(CSharp_c_time_get_mins(own(CSharp_new_c_time__SWIG_1("04:05:06")).get()), 5),
           IS(CSharp_c_time_get_secs(own(CSharp_new_c_time__SWIG_1("04:05:06")).get()) == 6, 1),
           IS(CSharp_c_gyear_get_year(own(CSharp_new_c_gyear__SWIG_1("2001")).get()), 2001),
           IS(CSharp_c_gyearmonth_get_month(own(CSharp_new_c_gyearmonth__SWIG_1("2001-02")).get()), 2),
           IS(CSharp_c_gmonth_get_month(own(CSharp_new_c_gmonth__SWIG_1("--02--")).get()), 2),
           IS(CSharp_c_gmonthday_get_day(own(CSharp_new_c_gmonthday__SWIG_1("--02-03")).get()), 3),
           IS(CSharp_c_gday_get_day(own(CSharp_new_c_gday__SWIG_1("---03")).get()), 3)});
    const auto instant = own(CSharp_new_c_datetime__SWIG_0());
    CSharp_c_datetime_set_year(instant.get(), -44);
    CSharp_c_datetime_set_month(instant.get(), 3);
    CSharp_c_datetime_set_day(instant.get(), 15);
    CSharp_c_datetime_set_hours(instant.get(), 11);
    CSharp_c_datetime_set_mins(instant.get(), 12);
    CSharp_c_datetime_set_secs(instant.get(), 13.5f);
    EXPECT_EQ(taken(CSharp_c_datetime_get_as_string(instant.get())), "-0044-03-15T11:12:13.5");
    check({IS(CSharp_c_datetime_get_year(instant.get()), -44), IS(CSharp_c_datetime_get_month(instant.get()), 3u),
           IS(CSharp_c_datetime_get_day(instant.get()), 15u), IS(CSharp_c_datetime_get_hours(instant.get()), 11u),
           IS(CSharp_c_datetime_get_mins(instant.get()), 12u), IS(CSharp_c_datetime_get_secs(instant.get()), 13.5f)});
    own(CSharp_new_c_datetime_base());
}

TEST(RuntimeValues, Bytes) {
    const unsigned char abc[] = {'a', 'b', 'c'};
    const auto value = own(CSharp_new_c_binary__SWIG_2(abc, 2)), empty = own(CSharp_new_c_binary__SWIG_0());
    lmx_c_binary* const b = value.get();
    EXPECT_EQ(CSharp_c_binary_size(b), 2u);
    CSharp_c_binary_append(b, 'c');
    check({IS(CSharp_c_binary_equal(b, abc, 3), 1), IS(CSharp_c_binary_equal(b, abc, 2), 0),
           IS(CSharp_c_binary_equal(own(CSharp_new_c_binary__SWIG_1(b)).get(), abc, 3), 1)});
    CSharp_c_binary_swap(b, empty.get());
    EXPECT_EQ(CSharp_c_binary_size(b), 0u);
    CSharp_c_binary_set(b, abc + 1, 2);
    EXPECT_EQ(CSharp_c_binary_equal(b, abc + 1, 2), 1);
    CSharp_c_binary_set(b, nullptr, 0);
    EXPECT_EQ(CSharp_c_binary_size(b), 0u);
    check({IS(CSharp_c_binary_is_valid_base64("QQ=="), 1), IS(CSharp_c_binary_is_valid_hex("QQ=="), 0),
           IS(CSharp_c_binary_is_valid_base64("0F1"), 0), IS(CSharp_c_binary_is_valid_hex("0aF1"), 1)});
}

TEST(RuntimeValues, PatternsAndEntries) {
    const auto pattern = own(CSharp_new_c_pattern("[ab]+")), broken = own(CSharp_new_c_pattern("["));
    EXPECT_EQ(CSharp_c_pattern_is_match__SWIG_0(pattern.get(), "aba"), 1);
    EXPECT_EQ(CSharp_c_pattern_is_match__SWIG_0(pattern.get(), "abc"), 0) << "the whole text";
    EXPECT_EQ(CSharp_c_pattern_is_match__SWIG_0(broken.get(), "["), 0) << "an invalid pattern matches nothing";
    const auto none = own(CSharp_new_c_pattern_null());
    EXPECT_EQ(CSharp_c_pattern_null_is_match__SWIG_0(none.get(), ""), 1);
    EXPECT_NE(own(CSharp_new_c_empty()), nullptr);

    const auto parts = [](lmx_c_any_info* made) {
        const auto info = own(made);
        return taken(CSharp_c_any_info_get_namespace(made)) + '|' + taken(CSharp_c_any_info_get_name(made)) + '|' +
               taken(CSharp_c_any_info_get_value(made));
    };
    EXPECT_EQ(parts(CSharp_new_c_any_info__SWIG_0()), "||");
    EXPECT_EQ(parts(CSharp_new_c_any_info__SWIG_1("n", "m", "v")), "n|m|v");
    EXPECT_EQ(parts(CSharp_new_c_any_info__SWIG_2("m", "v")), "|m|v");
    EXPECT_EQ(parts(CSharp_new_c_any_info__SWIG_3("v")), "||v");
    lmx_c_any_info* const info = CSharp_new_c_any_info__SWIG_0();
    CSharp_c_any_info_set_namespace(info, "1");
    CSharp_c_any_info_set_name(info, "2");
    CSharp_c_any_info_set_value(info, "3");
    EXPECT_EQ(parts(info), "1|2|3");
}

} // namespace
