// Numbers from text and into text, held against the C library and the streams.

#include <bit>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <iomanip>
#include <limits>
#include <random>

#include "hqf/values/c_as_xml.h"
#include "hqf/values/lexical.h"
#include "hqf/values/number_text.h"
#include "hqf/values/short_decimal.h"
#include "hqf/values/to_number.h"
#include "tests/support/table.h"

namespace {

using support::rows, support::words;

constexpr double inf = std::numeric_limits<double>::infinity();

bool same(double a, double b) {
    return (std::isnan(a) && std::isnan(b)) || std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

// The process runs in the "C" locale, where `strtod` is the reference. On text that passes its check the reading forms
// must agree with it to the bit; on all other text the tolerant form must.
void expect_as_strtod(const std::string& text) {
    double value = 42;
    const double expected = std::atof(text.c_str());
    const char* const end = text.data() + text.size();
    const bool read = hqf::scan_double(text.data(), end, value) == end;
    EXPECT_EQ(read, lmx::is_valid_float(text)) << text;
    EXPECT_TRUE(!read || same(value, expected)) << text << " gave " << value;
    EXPECT_TRUE(same(hqf::to_double(text), expected)) << text << " gave " << hqf::to_double(text);
    // The short roads read on to what ends the value, with bytes of anything behind it.
    const std::string padded = text + '<' + std::string(32, '7');
    for (const auto scan : {hqf::scan_few_digits, hqf::scan_short_decimal}) {
        const char* const stop = scan(padded.data(), value);
        const bool is_all = stop == padded.data() + text.size();
        EXPECT_TRUE(!is_all || (read && same(value, expected))) << text << " gave " << value;
    }
}

TEST(scan_double, hard_cases_as_strtod) {
    const std::string nines(400, '9'), zeros(400, '0');
    // Exact integers and the first that isn't, halfway cases, 19 and 20 digits, 22 and 23 powers of ten, denormal
    // numbers, the halfway point to the smallest, and far beyond on both sides.
    auto texts = words(R"(
        0 -0 -0.0 +0 -0e99999 1. .5 -.5 +1E-2 00000000000000000000001.50 INF -INF NaN 9007199254740992 9007199254740993
        9007199254740993.0000000000000000000001 9007199254740994.9999 1234567890123456789 12345678901234567890 1e22
        1e23 9007199254740991e22 123e-22 123e-23 8.5e-22 0.30000000000000004 5e-1 6.02214076e23 1.7976931348623157e308
        1.7976931348623159e308 2.2250738585072011e-308 4.9e-324 2.4703282292062327e-324 2.4703282292062328e-324 1e-400
        -1e-400 1e400 -1e400 1e99999999999999999999 1e-99999999999999999999 0e99999999999999999999)");
    for (const auto& text : {"0." + zeros + "1e401", "0." + zeros + "1e9", nines, nines + "e-400",
                             nines + "." + nines + "e-99", "1" + zeros + "e-400", "1" + zeros + "e-800"})
        texts.push_back(text);
    for (const auto& text : texts)
        expect_as_strtod(text);
}

TEST(to_double, failed_text_as_atof_in_the_c_locale) {
    for (const auto& text : words(R"(
        '' _ . - + --5 +-5 -+5 __-1.5x 1e 1e+ 1e-x 1.5.5 1,5 .e1 abc inf -Infinity +INF infx nan nan(12) 0x 0xg -0xg 0x.p1 -0x. -0x.g
        0x1p3 -0X1.8P+1 0x.8 0x1p99999 0x1p-99999 0x0.0001p1020 0x0.0000000000000001p1080 0x10000000000000000p1000
        1e400x)"))
        expect_as_strtod(text);
    for (const char* text : {" \t\n\v\f\r-1.5x", "\xA0\x35"})
        expect_as_strtod(text);
    EXPECT_EQ(hqf::to_double(std::string_view("12345", 2)), 12.0) << "a span ends where it ends";
}

TEST(scan_double, random_texts_as_strtod) {
    std::mt19937_64 random(20240229);
    const auto below = [&](std::uint64_t n) { return random() % n; };
    const char alphabet[] = "0123456789+-.eE xINFNa";
    char text[64];
    for (int i = 0; i < 200000; ++i) {
        std::snprintf(text, sizeof text, "%.*g", static_cast<int>(1 + below(19)), std::bit_cast<double>(random()));
        if (std::isfinite(std::atof(text))) expect_as_strtod(text);
        std::snprintf(text, sizeof text, "%llu.%0*llu", static_cast<unsigned long long>(below(1000)),
                      static_cast<int>(1 + below(9)), static_cast<unsigned long long>(below(1000000)));
        expect_as_strtod(text);
        std::string noise;
        for (auto size = below(8); size > 0; --size)
            noise += alphabet[below(sizeof alphabet - 1)];
        expect_as_strtod(noise);
        if (HasFailure()) FAIL() << "first failure is enough";
    }
}

TEST(scan_double, takes_the_longest_form) {
    for (const auto& [text, size, expected] : rows<3>(R"(
        1.5< 3 1.5   1e< 1 1   1e+< 1 1   1.e5x 4 1e5   -INFx 4 -inf   1.. 2 1   5e-3e 4 .005   -< -1 42   .< -1 42
        -NaN -1 42)")) {
        double value = 42;
        const char* const end = hqf::scan_double(text.data(), text.data() + text.size(), value);
        EXPECT_EQ(end == nullptr ? -1 : end - text.data(), std::stol(size)) << text;
        EXPECT_TRUE(same(value, std::stod(expected))) << text << " gave " << value;
    }
}

TEST(integers, as_atoi_and_strtoul) {
    for (const auto& text : words(R"(
        0 -0 +7 007 -12 __12x x '' - +-1 12.9 2147483647 2147483648 -2147483649 4294967295 4294967296 -4294967295
        9223372036854775807 9223372036854775808 -9223372036854775808 -9223372036854775809 18446744073709551615
        18446744073709551616 99999999999999999999999 -99999999999999999999999)")) {
        EXPECT_EQ(hqf::to_int(text), std::atoi(text.c_str())) << text;
        EXPECT_EQ(hqf::to_unsigned(text), static_cast<unsigned int>(std::strtoul(text.c_str(), nullptr, 10))) << text;
    }
    for (const auto& [text, expected] : rows<2>(R"(
        12 12   -007 -7   +999999999999999999 999999999999999999   9999999999999999999 42   '' 42   - 42   1_ 42
        1.0 42)")) {
        std::int64_t value = 42;
        EXPECT_EQ(hqf::read_short_integer(text.data(), text.data() + text.size(), value), expected != "42") << text;
        EXPECT_EQ(value, std::stol(expected)) << text;
    }
}

TEST(booleans, true_and_1_are_true) {
    for (const auto& [text, valid, value] :
         rows<3>("true 1 1   1 1 1   false 1 0   0 1 0   TRUE 0 0   '' 0 0   11 0 0")) {
        bool read = value == "0";
        EXPECT_EQ(hqf::to_bool(text), value == "1") << text;
        EXPECT_EQ(hqf::read_bool(text.data(), text.data() + text.size(), read), valid == "1") << text;
        EXPECT_TRUE(read == (value == "1") || valid == "0") << text;
    }
}

template<class number>
std::string inserted(number value) {
    std::ostringstream os;
    os << lmx::c_as_xml(value);
    return os.str();
}

template<class number>
std::string written(number value) {
    char text[hqf::number_text_size];
    return std::string(text, hqf::write_number(text, value));
}

TEST(c_as_xml, numbers) {
    for (const auto& [value, text] : rows<2>(R"(
        0 0.0   -0.0 -0.0   inf INF   -inf -INF   nan NaN   -nan NaN   1 1   -12.25 -12.25
        33.333333333333333 33.333333333333
        12345678901234567 1.2345678901235e+16   99999999999999 99999999999999   1e14 1e+14   1e-4 0.0001
        0.00001234 1.234e-05   0.30000000000000004 0.3   9.9999999999999 9.9999999999999   9.99999999999996 10)")) {
        EXPECT_EQ(inserted(std::stod(value)), text);
        EXPECT_EQ(written(std::stod(value)), text);
    }
    EXPECT_EQ(inserted(0.1f) + inserted(1.0f / 3) + inserted(-0.0f), "0.10.3333333-0.0");
    EXPECT_EQ(written(123456789) + written(std::numeric_limits<int>::min()) + written(4294967295u),
              "123456789-21474836484294967295");
}

TEST(c_as_xml, precision_is_put_back_and_flags_are_the_streams) {
    std::ostringstream os;
    os << std::setprecision(3) << lmx::c_as_xml(1.0 / 3) << ' ' << 1.0 / 3 << ' ' << std::fixed << lmx::c_as_xml(0.5f)
       << std::showpos << ' ' << lmx::c_as_xml(1e-7) << ' ' << 0.5;
    EXPECT_EQ(os.str(), "0.33333333333333 0.333 0.5000000 +0.00000010000000 +0.500");
    os.str("");
    os << std::noboolalpha << lmx::c_as_xml(true) << lmx::c_as_xml(false) << std::boolalpha
       << lmx::c_as_bool_digit(true) << lmx::c_as_bool_digit(false);
    EXPECT_EQ(os.str(), "truefalse10");
}

TEST(write_number, as_the_stream_on_random_numbers) {
    std::mt19937_64 random(7);
    for (int i = 0; i < 300000; ++i) {
        const std::uint64_t bits = random();
        const double digits = static_cast<double>(bits % 100000000000000);
        // short decimals, their neighbours one step away, and numbers of every size
        const double decimal = digits / std::pow(10, static_cast<double>(bits % 19));
        for (const double value :
             {decimal, std::nextafter(decimal, inf), std::nextafter(-decimal, 0.0), std::floor(decimal),
              std::bit_cast<double>(bits), std::ldexp(digits, static_cast<int>(bits % 80) - 90)})
            ASSERT_EQ(written(value), inserted(value)) << std::setprecision(17) << value;
        const float single = std::bit_cast<float>(static_cast<std::uint32_t>(bits));
        for (const float value : {single, static_cast<float>(decimal)})
            ASSERT_EQ(written(value), inserted(value)) << std::setprecision(9) << value;
    }
}

} // namespace
