// Dates, times and durations: forms, assignment, text, order.

#include <gtest/gtest.h>

#include <cfloat>
#include <climits>
#include <cmath>
#include <iomanip>
#include <random>
#include <sstream>
#include <string>

#include "hqf/values/c_datetime.h"
#include "hqf/values/c_duration.h"
#include "hqf/values/c_pattern.h"
#include "hqf/values/datetime_text.h"

namespace {

using namespace lmx;

std::string fields(const c_datetime_base& v) {
    std::ostringstream os;
    os << v.year << ' ' << v.month << ' ' << v.day << ' ' << v.hours << ' ' << v.mins << ' ' << v.secs << ' '
       << v.total_offset_mins << (v.is_utc ? " Z" : "");
    return os.str();
}

struct row {
    const char* text;
    bool valid;
    const char* written;     // from a default value; null for the text itself
    const char* stored = ""; // fields after assignment to a default value; empty: not looked at
};

template<class T, std::size_t n>
void expect_rows(const char* name, const row (&rows)[n]) {
    for (const row& r : rows) {
        EXPECT_EQ(T::is_valid(r.text), r.valid) << name << " " << r.text;
        EXPECT_EQ(T(r.text).get_as_string(), r.written ? r.written : r.text) << name << " " << r.text;
        T assigned;
        std::ostringstream os;
        os << (assigned = std::string(r.text));
        EXPECT_EQ(os.str(), T(std::string(r.text)).get_as_string()) << name << " " << r.text;
        EXPECT_TRUE(*r.stored == '\0' || fields(assigned) == r.stored) << name << " " << r.text << fields(assigned);
    }
}

TEST(c_datetime, forms) {
    const row rows[] = {
        {"2001-12-31T23:59:59Z", true, nullptr, "2001 12 31 23 59 59 0 Z"},
        {"2001-12-31T23:59:59", true, nullptr},
        {"2001-12-31T23:59:59+05:30", true, nullptr, "2001 12 31 23 59 59 330"},
        {"2001-12-31T23:59:59-00:30", true, nullptr, "2001 12 31 23 59 59 -30"},
        {"2001-12-31T23:59:59+00:00", true, "2001-12-31T23:59:59", "2001 12 31 23 59 59 0"},
        {"2001-02-31T25:61:61.5+99:99", true, "2001-02-31T25:61:61.5+100:39", "2001 2 31 25 61 61.5 6039"},
        {"2001-01-01T00:00:00.", true, "2001-01-01T00:00:00"},
        {"2001-01-01T00:00:05.5Z", true, nullptr},
        {"2001-01-01T00:00:12.25Z", true, nullptr},
        {"2001-01-01T00:00:00.0005Z", true, "2001-01-01T00:00:00.000500Z"},
        {"-0099-01-01T00:00:00Z", true, nullptr, "-99 1 1 0 0 0 0 Z"},
        {"+2001-01-01T00:00:00Z", true, "2001-01-01T00:00:00Z"},
        {"12345-01-01T00:00:00Z", true, nullptr},
        {"", false, "0000-00-00T00:00:00"},
        {"x", false, "0000-00-00T00:00:00"},
        {"--2001-01-01T00:00:00Z", false, "0000-00-00T00:00:00"},
        {"201-01-01T00:00:00Z", false, "0201-00-00T00:00:00", "201 0 0 0 0 0 0"},
        {"-201-01-01T00:00:00Z", false, "0201-00-00T00:00:00", "201 0 0 0 0 0 0"},
        {"2001-1-01T00:00:00Z", false, "2001-01-00T00:00:00", "2001 1 0 0 0 0 0"},
        {"2001-123-01T00:00:00Z", false, "2001-123-00T00:00:00"},
        {"2001/01-01T00:00:00Z", false, "2001-00-00T00:00:00"},
        {"2001-01-1T00:00:00Z", false, "2001-01-01T00:00:00"},
        {"2001-01-01 00:00:00Z", false, "2001-01-01T00:00:00"},
        {"2001-01-01T7:08:09Z", false, "2001-01-01T07:00:00"},
        {"2001-01-01T07:8:09Z", false, "2001-01-01T07:08:00"},
        {"2001-01-01T07:08:9Z", false, "2001-01-01T07:08:09", "2001 1 1 7 8 9 0"},
        {"2001-01-01T07:08:9.Z", false, "2001-01-01T07:08:09Z"},   // two characters, the point included
        {"-2001-01-01T07:08:9Z", false, "2001-01-01T07:08:09"},    // the zone isn't reached: no sign
        {"-2001-01-01T07:08:09+1", false, "-2001-01-01T07:08:09"}, // reached, though it is bad
        {"2001-01-01T07:08:09z", false, "2001-01-01T07:08:09"},
        {"2001-01-01T07:08:09Z ", false, "2001-01-01T07:08:09"},
        {"2001-01-01T07:08:09+01:0", false, "2001-01-01T07:08:09"},
        {"2001-01-01T07:08:09+0100", false, "2001-01-01T07:08:09"},
        {" 2001-01-01T07:08:09Z", false, "0000-00-00T00:00:00"}};
    expect_rows<c_datetime>("c_datetime", rows);
}

TEST(date_family, forms) {
    const row dates[] = {{"2001-12-31", true, nullptr},
                         {"2001-12-31Z", true, nullptr},
                         {"-0099-01-01", true, nullptr},
                         {"+2001-01-01", true, "2001-01-01"},
                         {"12345-01-01", true, nullptr},
                         {"2001-12-31-14:00", true, nullptr},
                         {"2001-12-31T00:00:00", false, "2001-12-31"}};
    const row times[] = {{"12:00:00", true, nullptr},          {"12:00:00Z", true, nullptr},
                         {"12:00:00+00:00", true, "12:00:00"}, {"12:00:00.5-01:30", true, nullptr},
                         {"+12:00:00", true, "00:00:00"}, // assignment skips no sign
                         {"1:00:00", false, "01:00:00"},       {"12:00", false, "12:00:00"}};
    const row gyearmonths[] = {{"2001-12", true, nullptr}, {"-2001-12Z", true, nullptr}, {"2001", false, "2001-00"}};
    const row gyears[] = {{"2001", true, nullptr}, {"-12345+01:00", true, nullptr}, {"201", false, "0201"}};
    const row gmonthdays[] = {{"--12-31", true, nullptr},   {"--12-31+01:00", true, nullptr},
                              {"--12-1", false, "--12-01"}, {"--12-131", false, "--12-131"},
                              {"--12-", false, "--12-00"},  {"---12-31", false, "--00-00"},
                              {"-12-31", false, "--00-00"}};
    const row gmonths[] = {
        {"--05--", true, nullptr}, {"--05--Z", true, nullptr}, {"--05", false, "--05--"}, {"--5--", false, "--05--"}};
    const row gdays[] = {{"---31", true, nullptr},
                         {"---31Z", true, nullptr},
                         {"---1", false, "---01"},
                         {"---1Z", false, "---01Z"},
                         {"--31", false, "---00"}};
    expect_rows<c_date>("c_date", dates);
    expect_rows<c_time>("c_time", times);
    expect_rows<c_gyearmonth>("c_gyearmonth", gyearmonths);
    expect_rows<c_gyear>("c_gyear", gyears);
    expect_rows<c_gmonthday>("c_gmonthday", gmonthdays);
    expect_rows<c_gmonth>("c_gmonth", gmonths);
    expect_rows<c_gday>("c_gday", gdays);
}

TEST(c_datetime, assignment_keeps_what_lies_behind_the_stopping_point) {
    const struct {
        const char *text, *stored;
    } rows[] = {{"1999-01-01T00:00:00", "1999 1 1 0 0 0 0"},
                {"1999-1", "1999 1 31 23 59 58.5 0 Z"},
                {"1999-01-01T00:00:00+1", "1999 1 1 0 0 0 0 Z"},
                {"1999-01-01T00:00:00+01:00", "1999 1 1 0 0 0 60"},
                {"", "0 12 31 23 59 58.5 0 Z"},
                {"1999-01-01T00:00:", "1999 1 1 0 0 0 0 Z"}};
    for (const auto& r : rows) {
        c_datetime value("2001-12-31T23:59:58.5Z");
        value = r.text;
        EXPECT_EQ(fields(value), r.stored) << r.text;
    }
}

TEST(c_datetime, defaults_and_setters) {
    c_datetime v;
    EXPECT_EQ(v.get_as_string(), "0001-00-00T00:00:00");
    v.set_is_utc(true);
    v.set_total_offset_mins(60);
    EXPECT_TRUE(v.get_is_utc()) << "the offset setter leaves the flag alone";
    EXPECT_EQ(v.get_as_string(), "0001-00-00T00:00:00Z");
    v.set_offset(0, 0);
    EXPECT_TRUE(v.get_is_utc()) << "an offset of 0 doesn't clear it";
    const struct {
        int hours;
        unsigned int mins;
        int offset;
        const char* text;
    } rows[] = {{5, 30, 330, "+05:30"},
                {-5, 30, -330, "-05:30"},
                {0, 30, 30, "+00:30"},
                {-1, 0, -60, "-01:00"},
                {100, 5, 6005, "+100:05"}};
    for (const auto& r : rows) {
        v.set_is_utc(true);
        v.set_offset_mins(r.hours, r.mins);
        EXPECT_EQ(v.get_total_offset_mins(), r.offset);
        EXPECT_FALSE(v.get_is_utc());
        EXPECT_EQ(v.get_as_string(), "0001-00-00T00:00:00" + std::string(r.text));
    }
    v.set_offset(INT_MAX, UINT_MAX);
    v.set_year(INT_MIN);
    v.set_total_offset_mins(INT_MIN);
    EXPECT_EQ(v.get_as_string(), "-2147483648-00-00T00:00:00-35791394:08") << "no overflow at the limits";
}

TEST(c_datetime, order_ignores_the_zone) {
    const char* const ascending[] = {"-0002-01-01T00:00:00", "0001-12-31T23:59:59",  "2001-01-31T23:59:59",
                                     "2001-02-01T23:59:59",  "2001-02-02T00:59:59",  "2001-02-02T01:00:59.5",
                                     "2001-02-02T01:01:00",  "2001-02-02T01:01:00.5"};
    for (int i = 0; i < 8; ++i)
        for (int j = 0; j < 8; ++j) {
            const c_datetime a(std::string(ascending[i]) + "Z"), b(std::string(ascending[j]) + "+05:00");
            EXPECT_TRUE((a == b) == (i == j) && (a != b) == (i != j) && (a < b) == (i < j) && (a <= b) == (i <= j) &&
                        (a > b) == (i > j) && (a >= b) == (i >= j))
                << ascending[i] << " " << ascending[j];
        }
    EXPECT_TRUE(c_time("12:00:00Z") == c_time("12:00:00+00:00"));
}

TEST(c_datetime, seconds_in_the_streams_precision) {
    const struct {
        float secs;
        const char* text;
    } rows[] = {{0, "00"},       {5, "05"},          {9.999f, "09.999"},      {10, "10"},
                {61.5f, "61.5"}, {0.001f, "00.001"}, {0.0005f, "00.000500"},  {1e-9f, "00.000000"},
                {-0.0f, "0-0"},  {-5, "0-5.000000"}, {1234567, "1.23457e+06"}};
    for (const auto& r : rows) {
        c_time time;
        time.set_secs(r.secs);
        EXPECT_EQ(time.get_as_string(), std::string("00:00:") + r.text);
    }
    std::ostringstream os;
    os << std::fixed << std::setprecision(2) << c_time("00:00:05.678") << ' ' << 0.5 << ' ' << std::setw(3) << 7;
    EXPECT_EQ(os.str(), "00:00:05.68 0.5 007") << "fixed is cleared afterwards and the fill stays";
}

bool agrees_with_engine(const std::string& text) {
    static const c_pattern pattern(".+T.+(Z|[+\\-].+)");
    const hqf::zone_pattern known = hqf::match_zone_pattern(text.data(), text.data() + text.size());
    return known == hqf::zone_pattern::ask_engine || pattern.is_match(text) == (known == hqf::zone_pattern::matched);
}

// The short roads against the long ones, over the common form and over everything one change away from it.
TEST(datetime_text, short_roads_agree_with_the_long_ones) {
    std::mt19937 random(3);
    const std::string seeds[] = {"2001-02-28T13:59:07.25Z", "1999-12-31T00:00:00+05:30", "2024-01-01T10:20:30-00:00",
                                 "2024-01-01T10:20:30"};
    const std::string alphabet = "0123456789-+:.TZ \xC3\xA4\n\x01";
    int short_roads = 0;
    for (int i = 0; i < 60000; ++i) {
        std::string text = seeds[random() % 4];
        for (auto changes = random() % 3; changes > 0; --changes) {
            const std::size_t at = random() % text.size();
            text.replace(at, random() % 2, 1, alphabet[random() % alphabet.size()]);
        }
        const char* const end = text.data() + text.size();
        ASSERT_TRUE(agrees_with_engine(text)) << text;
        ASSERT_EQ(hqf::is_datetime(text.data(), end), c_datetime::is_valid(text)) << text;
        c_datetime value("-0007-07-07T07:07:07+07:07");
        const std::string before = fields(value);
        if (hqf::read_zoned_datetime(text.data(), end, value)) {
            ++short_roads;
            ASSERT_TRUE(c_datetime::is_valid(text)) << text;
            ASSERT_EQ(hqf::match_zone_pattern(text.data(), end), hqf::zone_pattern::matched) << text;
            ASSERT_EQ(fields(value), fields(c_datetime(text))) << text;
            char out[hqf::datetime_text_size];
            ASSERT_EQ(std::string(out, hqf::write_datetime(out, value)), value.get_as_string()) << text;
        } else {
            ASSERT_EQ(fields(value), before) << text;
        }
    }
    EXPECT_GT(short_roads, 10000) << "the common form must take the short road";
}

TEST(datetime_text, zone_pattern_on_any_short_text) {
    const char* const pieces[] = {"T", "Z", "+", "-", "\xC3\xA4", "a", "\n", "\r", "\t", "\x01", "\xFF"};
    std::mt19937 random(4);
    for (int i = 0; i < 100000; ++i) {
        std::string text;
        for (auto count = random() % 9; count > 0; --count)
            text += pieces[random() % (random() % 8 == 0 ? 11 : 6)];
        ASSERT_TRUE(agrees_with_engine(text)) << testing::PrintToString(text);
    }
}

TEST(datetime_text, extreme_values_are_written_as_by_the_stream) {
    c_datetime v;
    for (const float secs : {0.0f, -0.0f, 0.5f, 59.999f, 99.0f, 100.0f, 1e6f, 1e7f, FLT_MAX, -FLT_MAX, 1e-9f, -0.5f,
                             HUGE_VALF, -HUGE_VALF, NAN}) {
        v.set_secs(secs);
        v.set_year(v.get_year() == INT_MIN ? INT_MAX : INT_MIN);
        v.set_month(UINT_MAX), v.set_day(UINT_MAX), v.set_hours(UINT_MAX), v.set_mins(100);
        v.set_total_offset_mins(-v.get_total_offset_mins() - 1);
        char out[hqf::datetime_text_size];
        EXPECT_EQ(std::string(out, hqf::write_datetime(out, v)), v.get_as_string()) << secs;
    }
}

TEST(c_duration, forms) {
    const struct {
        const char* text;
        bool valid;
        const char* written;
    } rows[] = {{"P", true, "P"},
                {"-P", true, "-P"},
                {"PT0S", true, "P"},
                {"P1Y", true, "P1Y"},
                {"P1M", true, "P1M"},
                {"P1D", true, "P1D"},
                {"PT1H", true, "PT1H"},
                {"PT1M", true, "PT1M"},
                {"PT1S", true, "PT1S"},
                {"PT1.5S", true, "PT1.5S"},
                {"PT.5S", true, "PT0.5S"},
                {"+P1D", true, "P1D"},
                {"-P1Y2M3DT4H5M6.7S", true, "-P1Y2M3DT4H5M6.7S"},
                {"P0012M", true, "P12M"},
                {"PT1H.5S", true, "PT1H0.5S"},
                {"P1YT2M", true, "P1YT2M"},
                {"PT5.5S", true, "PT5.5S"},
                {"PT0.0005S", true, "PT0.000500S"},
                {"", false, "P"},
                {"-", false, "-P"},
                {"1Y", false, "P"},
                {"P1", false, "P"},
                {"P1S", false, "P"},
                {"P1YT", false, "P1Y"},
                {"PT", false, "P"},
                {"PT1", false, "P"},
                {"P1D1", false, "P1D"},
                {"P1Y2", false, "P1Y"},
                {"P1M1Y", false, "P1M"},
                {"P1YM", false, "P1Y"},
                {"PT1M1H", false, "PT1M"},
                {"PT1S1M", false, "PT1S"},
                {"PT1H.", false, "PT1H"},
                {"PT1.5", false, "P"},
                {"PT1H.S", false, "PT1H"},
                {"PT1.S", true, "PT1S"},
                {"P1Y ", false, "P1Y"},
                {"P-1Y", false, "P"},
                {"PT5.5H", false, "P"},
                {"--P1Y", false, "-P"},
                {"P4294967295Y", true, "P4294967295Y"}};
    for (const auto& r : rows) {
        EXPECT_EQ(c_duration::is_valid(r.text), r.valid) << r.text;
        EXPECT_EQ(c_duration::is_valid(std::string(r.text)), r.valid) << r.text;
        EXPECT_EQ(c_duration(r.text).get_as_string(), r.written) << r.text;
        c_duration assigned("-P9Y9M9DT9H9M9.5S");
        std::ostringstream os;
        os << (assigned = std::string(r.text));
        EXPECT_EQ(os.str(), r.written) << r.text << ": the old fields are cleared first";
    }
}

TEST(c_duration, normalize_carries_up_to_days_and_years) {
    const struct {
        const char *text, *normal;
    } rows[] = {{"PT90S", "PT1M30S"},
                {"P12M", "P1Y"},
                {"P31M", "P2Y7M"},
                {"PT3600S", "PT1H"},
                {"PT1439M120.5S", "P1DT1M0.5S"},
                {"P400D", "P400D"},
                {"-P1M40DT25H", "-P1M41DT1H"}};
    for (const auto& r : rows) {
        c_duration value(r.text);
        value.normalize();
        EXPECT_EQ(value.get_as_string(), r.normal) << r.text;
    }
    c_duration endless;
    endless.set_secs(HUGE_VALF);
    endless.normalize();
    EXPECT_EQ(endless.get_mins(), 0u) << "infinite seconds stay";
}

TEST(c_duration, order_exists_only_where_months_leave_it_settled) {
    const struct {
        const char *a, *b;
        char relation; // '<', '=', '>', or '?' where the length of months leaves it open
    } rows[] = {{"PT90S", "PT1M30S", '='}, {"P12M", "P1Y", '='},  {"P1M", "P30D", '?'},     {"P30D", "P1M", '?'},
                {"P1M", "P32D", '>'},      {"P32D", "P1M", '<'},  {"P1M", "P29D", '?'},     {"P1M", "P28D", '>'},
                {"P28D", "P1M", '<'},      {"P2M", "P60D", '?'},  {"P2M", "P59D", '>'},     {"P2M", "P62D", '>'},
                {"P2M", "P61D", '?'},      {"P1Y", "P365D", '>'}, {"P1Y1M", "P1Y29D", '?'}, {"P2Y", "P1Y1M", '>'},
                {"P1Y1M", "P2Y", '<'},     {"P1Y", "-P1Y", '!'},  {"PT1S", "PT2S", '<'},    {"P1D", "PT24H", '='},
                {"P1DT1H", "PT24H", '>'},  {"P5M", "P12M1D", '<'}};
    for (const auto& r : rows) {
        const c_duration a(r.a), b(r.b);
        const bool equal = r.relation == '=', less = r.relation == '<', greater = r.relation == '>';
        EXPECT_EQ(a == b, equal) << r.a << " " << r.b;
        EXPECT_EQ(a != b, !equal) << r.a << " " << r.b;
        if (r.relation == '!') continue; // different signs are never equal; their order is left open
        EXPECT_EQ(a < b, less) << r.a << " " << r.b;
        EXPECT_EQ(a > b, greater) << r.a << " " << r.b;
        EXPECT_EQ(a <= b, less || equal) << r.a << " " << r.b;
        EXPECT_EQ(a >= b, greater || equal) << r.a << " " << r.b;
    }
}

} // namespace
