// Dates, times and durations: forms, assignment, text, order.

#include <cfloat>
#include <climits>
#include <cmath>
#include <iomanip>
#include <random>

#include "hqf/values/c_datetime.h"
#include "hqf/values/c_duration.h"
#include "hqf/values/c_pattern.h"
#include "hqf/values/datetime_text.h"
#include "tests/support/table.h"

namespace {

using namespace lmx;
using support::rows, support::words, support::stands, support::expect_order;

std::string fields(const c_datetime_base& v) {
    std::ostringstream os;
    os << v.year << ',' << v.month << ',' << v.day << ',' << v.hours << ',' << v.mins << ',' << v.secs << ','
       << v.total_offset_mins << (v.is_utc ? "Z" : "");
    return os.str();
}

/// `same`: valid texts, written as they are. `changed` and `refused`: each with what is written after reading it into a
/// default value.
template<class T>
void expect_forms(const char* same, const char* changed, const char* refused) {
    const auto expect = [](const std::string& text, bool valid, const std::string& written) {
        EXPECT_EQ(T::is_valid(text), valid) << text;
        EXPECT_EQ(T::is_valid(text.c_str()), valid) << text;
        EXPECT_EQ(T(text.c_str()).get_as_string(), written) << text;
        T assigned;
        std::ostringstream os;
        os << (assigned = text);
        EXPECT_EQ(os.str(), written) << text;
    };
    for (const auto& text : words(same))
        expect(text, true, text);
    for (const auto& [text, written] : rows<2>(changed))
        expect(text, true, written);
    for (const auto& [text, written] : rows<2>(refused))
        expect(text, false, written);
}

TEST(date_family, forms) {
    expect_forms<c_datetime>(
        "2001-12-31T23:59:59 2001-12-31T23:59:59+05:30 2001-12-31T23:59:59-00:30 2001-01-01T00:00:05.5Z "
        "-0099-01-01T00:00:00Z 12345-01-01T00:00:00Z",
        R"(
        2001-12-31T23:59:59+00:00 2001-12-31T23:59:59   2001-02-31T25:61:61.5+99:99 2001-02-31T25:61:61.5+100:39
        2001-01-01T00:00:00. 2001-01-01T00:00:00   2001-01-01T00:00:00.0005Z 2001-01-01T00:00:00.000500Z
        +2001-01-01T00:00:00Z 2001-01-01T00:00:00Z)",
        R"(
        '' 0000-00-00T00:00:00                         _2001-01-01T07:08:09Z 0000-00-00T00:00:00
        --2001-01-01T00:00:00Z 0000-00-00T00:00:00     -201-01-01T00:00:00Z 0201-00-00T00:00:00
        2001-1-01T00:00:00Z 2001-01-00T00:00:00        2001-123-01T00:00:00Z 2001-123-00T00:00:00
        2001/01-01T00:00:00Z 2001-00-00T00:00:00       2001-01-1T00:00:00Z 2001-01-01T00:00:00
        2001-01-01_00:00:00Z 2001-01-01T00:00:00       2001-01-01T7:08:09Z 2001-01-01T07:00:00
        2001-01-01T07:8:09Z 2001-01-01T07:08:00        -2001-01-01T07:08:9Z 2001-01-01T07:08:09
        2001-01-01T07:08:9.Z 2001-01-01T07:08:09Z      -2001-01-01T07:08:09+1 -2001-01-01T07:08:09
        2001-01-01T07:08:09z 2001-01-01T07:08:09       2001-01-01T07:08:09Z_ 2001-01-01T07:08:09
        2001-01-01T07:08:09+01:0 2001-01-01T07:08:09   2001-01-01T07:08:09+0100 2001-01-01T07:08:09)");
    expect_forms<c_date>("2001-12-31 -0099-01-01 2001-12-31-14:00", "+2001-01-01 2001-01-01",
                         "2001-12-31T00:00:00 2001-12-31");
    expect_forms<c_time>("12:00:00 12:00:00Z 12:00:00.5-01:30", "12:00:00+00:00 12:00:00   +12:00:00 00:00:00",
                         "1:00:00 01:00:00   12:00 12:00:00");
    expect_forms<c_gyearmonth>("2001-12 -2001-12Z", "", "2001 2001-00");
    expect_forms<c_gyear>("2001 -12345+01:00", "", "201 0201");
    expect_forms<c_gmonthday>("--12-31 --12-31+01:00", "", R"(
        --12-1 --12-01   --12-131 --12-131   --12- --12-00   ---12-31 --00-00   -12-31 --00-00)");
    expect_forms<c_gmonth>("--05-- --05--Z", "", "--05 --05--   --5-- --05--");
    expect_forms<c_gday>("---31 ---31Z", "", "---1 ---01   ---1Z ---01Z   --31 ---00");
}

TEST(c_datetime, assignment_keeps_what_lies_behind_the_stopping_point) {
    for (const auto& [text, stored] : rows<2>(R"(
        -0099-02-03T04:05:06-00:30 -99,2,3,4,5,6,-30  2001-02-31T25:61:61.5+99:99 2001,2,31,25,61,61.5,6039
        1999-1 1999,1,31,23,59,58.5,0Z                1999-01-01T00:00:00+1 1999,1,1,0,0,0,0Z
        '' 0,12,31,23,59,58.5,0Z                      1999-01-01T00:00: 1999,1,1,0,0,0,0Z)")) {
        c_datetime value("2001-12-31T23:59:58.5Z");
        value = text;
        EXPECT_EQ(fields(value), stored) << text;
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
    for (const auto& [hours, mins, offset, text] :
         rows<4>("5 30 330 +05:30   -5 30 -330 -05:30   0 30 30 +00:30   -1 0 -60 -01:00   100 5 6005 +100:05")) {
        v.set_is_utc(true);
        v.set_offset_mins(std::stoi(hours), static_cast<unsigned int>(std::stoi(mins)));
        EXPECT_EQ(v.get_total_offset_mins(), std::stoi(offset));
        EXPECT_EQ(v.get_as_string(), "0001-00-00T00:00:00" + text) << "the flag is cleared";
    }
    v.set_offset(INT_MAX, UINT_MAX);
    v.set_year(INT_MIN);
    v.set_total_offset_mins(INT_MIN);
    EXPECT_EQ(v.get_as_string(), "-2147483648-00-00T00:00:00-35791394:08") << "no overflow at the limits";
}

TEST(c_datetime, order_ignores_the_zone) {
    std::vector<std::string> zulu, ahead;
    for (const auto& text : words(R"(-0002-01-01T00:00:00 0001-12-31T23:59:59 2001-01-31T23:59:59 2001-02-01T23:59:59
            2001-02-02T00:59:59 2001-02-02T01:00:59.5 2001-02-02T01:01:00 2001-02-02T01:01:00.5)"))
        zulu.push_back(text + 'Z'), ahead.push_back(text + "+05:00");
    expect_order<c_datetime>(zulu, ahead);
}

TEST(c_datetime, seconds_in_the_streams_precision) {
    for (const auto& [secs, text] : rows<2>(R"(
        0 00   5 05   9.999 09.999   10 10   61.5 61.5   0.001 00.001   0.0005 00.000500   1e-9 00.000000
        -0.0 0-0   -5 0-5.000000   1234567 1.23457e+06)")) {
        c_time time;
        time.set_secs(std::stof(secs));
        EXPECT_EQ(time.get_as_string(), "00:00:" + text);
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

// The short roads against the long ones, over the common form and over everything one change away from it; the zone
// pattern over any short text, too.
TEST(datetime_text, short_roads_agree_with_the_long_ones) {
    std::mt19937 random(3);
    // Overlong forms (the last two) once counted as the characters that they spell, the NUL and the line end included.
    const char* const pieces[] = {"T",  "Z",  "+",    "-",    "\xC3\xA4", "a",       "\n",
                                  "\r", "\t", "\x01", "\xFF", "\xC0\x80", "\xC0\x8A"};
    for (int i = 0; i < 100000; ++i) {
        std::string text;
        for (auto count = random() % 9; count > 0; --count)
            text += pieces[random() % (random() % 8 == 0 ? 13 : 6)];
        ASSERT_TRUE(agrees_with_engine(text)) << testing::PrintToString(text);
    }
    const auto seeds = words("2001-02-28T13:59:07.25Z 1999-12-31T00:00:00+05:30 2024-01-01T10:20:30-00:00 "
                             "2024-01-01T10:20:30");
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
        const char* const stop = hqf::scan_zoned_datetime(text.data(), end, value);
        if (stop == end) {
            ++short_roads;
            ASSERT_TRUE(c_datetime::is_valid(text)) << text;
            ASSERT_EQ(hqf::match_zone_pattern(text.data(), end), hqf::zone_pattern::matched) << text;
            ASSERT_EQ(fields(value), fields(c_datetime(text))) << text;
            char out[hqf::datetime_text_size];
            ASSERT_EQ(std::string(out, hqf::write_datetime(out, value)), value.get_as_string()) << text;
        } else if (stop == nullptr) {
            ASSERT_EQ(fields(value), before) << text;
        }
    }
    EXPECT_GT(short_roads, 10000) << "the common form must take the short road";
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
    expect_forms<c_duration>("P -P P1Y P1M P1D PT1H PT1M PT1S PT5.5S -P1Y2M3DT4H5M6.7S P1YT2M P4294967295Y", R"(
        PT0S P   PT.5S PT0.5S   +P1D P1D   P0012M P12M   PT1H.5S PT1H0.5S   PT0.0005S PT0.000500S   PT1.S PT1S)",
                             R"(
        - -P   1Y P   P1 P   P1S P   P1YT P1Y   PT P   PT1 P   P1D1 P1D   P1M1Y P1M   P1YM P1Y   PT1M1H PT1M
        PT1S1M PT1S   PT1H. PT1H   PT1.5 P   PT1H.S PT1H   P1Y_ P1Y   P-1Y P   PT5.5H P   --P1Y -P)");
    c_duration assigned("-P9Y9M9DT9H9M9.5S");
    assigned = "x";
    EXPECT_EQ(assigned.get_as_string(), "P") << "the old fields are cleared first";
}

TEST(c_duration, normalize_carries_up_to_days_and_years) {
    for (const auto& [text, normal] : rows<2>(R"(
        PT90S PT1M30S   P31M P2Y7M   PT1439M120.5S P1DT1M0.5S   P400D P400D   -P1M40DT25H -P1M41DT1H)")) {
        c_duration value(text.c_str());
        value.normalize();
        EXPECT_EQ(value.get_as_string(), normal) << text;
    }
    c_duration endless;
    endless.set_secs(HUGE_VALF);
    endless.normalize();
    EXPECT_EQ(endless.get_mins(), 0u) << "infinite seconds stay";
}

TEST(c_duration, order_exists_only_where_months_leave_it_settled) {
    const auto expect = [](const std::string& a, char relation, const std::string& b) {
        EXPECT_TRUE(stands(c_duration(a.c_str()), relation, c_duration(b.c_str()))) << a << relation << b;
    };
    for (const auto& [a, relation, b] : rows<3>(R"(
        PT90S = PT1M30S   P12M = P1Y   P1M > P32D   P32D < P1M   P2D > P1D   P1Y > P365D   P1Y1M ? P1Y29D   P1Y1M < P2Y
        PT1S < PT2S   P1D = PT24H   P1DT1H > PT24H   P5M < P12M1D)"))
        expect(a, relation[0], b);
    // The days of the shortest and of the longest run of 1, 2, ... months.
    const int runs[][2] = {{28, 31},   {59, 62},   {89, 92},   {120, 123}, {150, 153}, {181, 184},
                           {212, 215}, {242, 245}, {273, 276}, {303, 306}, {334, 337}};
    for (const auto& run : runs)
        for (const auto& [days, relation] :
             {std::pair{run[0], '>'}, {run[0] + 1, '?'}, {run[1] - 1, '?'}, {run[1], '>'}})
            expect("P" + std::to_string(&run - runs + 1) + "M", relation, "P" + std::to_string(days) + "D");
    EXPECT_TRUE(c_duration("P1Y") != c_duration("-P1Y") && !(c_duration("P1Y") == c_duration("-P1Y")));
}

} // namespace
