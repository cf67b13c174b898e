// Binary values in both text forms, and pattern facets.

#include <gtest/gtest.h>

#include <iomanip>
#include <sstream>
#include <stdexcept>
#include <string>

#include "hqf/values/c_binary.h"
#include "hqf/values/c_empty.h"
#include "hqf/values/c_pattern.h"

namespace {

using namespace lmx;

std::string bytes_of(const c_binary& value) {
    std::string text;
    for (unsigned int i = 0; i < value.size(); ++i)
        text += static_cast<char>(value[i]);
    return text;
}

c_binary from_bytes(const std::string& text) {
    return c_binary(reinterpret_cast<const unsigned char*>(text.data()), static_cast<unsigned int>(text.size()));
}

TEST(c_binary, hex) {
    const struct {
        const char* text;
        bool valid;
        std::string bytes;
    } rows[] = {
        {"", true, ""},         {"0", false, ""},           {"0G", false, "\x10"}, {"0aF1", true, "\x0A\xF1"},
        {"0aF", false, "\x0A"}, {"fFAa", true, "\xFF\xAA"}, {"0 ", false, "\xE9"}, {"00", true, std::string(1, '\0')}};
    for (const auto& row : rows) {
        EXPECT_EQ(c_binary::is_valid_hex(row.text), row.valid) << row.text;
        c_binary value = from_bytes("old");
        value.from_hex(row.text);
        EXPECT_EQ(bytes_of(value), row.bytes) << row.text;
    }
    std::ostringstream os;
    os << std::showbase << std::left << c_as_hex(from_bytes("\x0A\xFF")) << ' ' << std::setw(4) << 10;
    EXPECT_EQ(os.str(), "0AFF 1000") << "flags are put back, the fill stays";
}

TEST(c_binary, base64) {
    const struct {
        const char* text;
        bool valid;
        std::string bytes;
        const char* why;
    } rows[] = {{"", true, "", "empty"},
                {"QUJD", true, "ABC", "three bytes"},
                {"QUI=", true, "AB", "two bytes"},
                {"QQ==", true, "A", "one byte"},
                {"QU JD", true, "ABC", "whitespace inside"},
                {"QU\n\tJD \r\n", true, "ABC", "and behind"},
                {" QUJD", true, "ABC", "and before"},
                {"QQ=\n", true, "A", "whitespace behind padding ends the check"},
                {"+/+/", true, "\xFB\xFF\xBF", "the last two digits"},
                {"A", false, std::string(1, '\0'), "one digit"},
                {"=", false, "", "padding alone"},
                {"==", false, "", "two of them"},
                {" ", false, "", "whitespace alone"},
                {"QUJ", false, "AB", "three isn't a multiple of four"},
                {"Q===", false, "@", "three characters remain"},
                {"QUJD====", false, "ABC", "four remain"},
                {"QQ=Q", false, "A\x04", "a digit behind padding"},
                {"QU-D", false, "A@", "outside the alphabet"},
                {"QQ= =", false, "A", "blank between padding"},
                {"QUI\n=", true, "AB", "whitespace before padding"},
                {"QU\xA0JD", false, "ABC", "a byte above ASCII"}};
    for (const auto& row : rows) {
        EXPECT_EQ(c_binary::is_valid_base64(row.text), row.valid) << row.why;
        c_binary value = from_bytes("old");
        value.from_base64(row.text);
        EXPECT_EQ(bytes_of(value), row.bytes) << row.why;
    }
}

TEST(c_binary, base64_round_trip_on_one_line) {
    for (const unsigned int size : {0u, 1u, 2u, 3u, 767u, 768u, 769u, 1000u, 5000u}) {
        std::string bytes;
        for (unsigned int i = 0; i < size; ++i)
            bytes += static_cast<char>(i * 37);
        std::ostringstream os;
        os << std::setw(9) << c_as_base64(from_bytes(bytes));
        EXPECT_EQ(os.str().size(), (size + 2) / 3 * 4);
        EXPECT_EQ(os.str().find_first_of("\r\n "), std::string::npos);
        EXPECT_TRUE(c_binary::is_valid_base64(os.str())) << size;
        c_binary back;
        back.from_base64(os.str());
        EXPECT_EQ(bytes_of(back), bytes) << size;
    }
    std::ostringstream os;
    from_bytes("A\xFF").out_base64(os);
    EXPECT_EQ(os.str(), "Qf8=");
}

TEST(c_binary, holds_bytes) {
    c_binary value;
    EXPECT_EQ(value.size(), 0u);
    value.append('a');
    (value += 'b') += 'c';
    value[1] = 'B';
    EXPECT_EQ(value, from_bytes("aBc"));
    EXPECT_NE(value, from_bytes("aB"));
    EXPECT_TRUE(value.equal(reinterpret_cast<const unsigned char*>("aBc"), 3));
    EXPECT_FALSE(value.equal(reinterpret_cast<const unsigned char*>("aBcd"), 4));
    EXPECT_TRUE(c_binary().equal(nullptr, 0));
    EXPECT_EQ(c_binary(nullptr, 0), c_binary());
    unsigned char buffer[5] = {'x', 'x', 'x', 'x', 'x'};
    EXPECT_EQ(value.get(buffer, 5), buffer);
    EXPECT_EQ(std::string(buffer, buffer + 5), "aBcxx") << "only the value's bytes";
    EXPECT_EQ(std::string(value.get(buffer, 1), buffer + 2), "aB") << "only as many as asked";
    value.at(0) = 'A';
    EXPECT_EQ(value.at(0), 'A');
    try {
        value.at(3);
        ADD_FAILURE() << "the index is checked";
    } catch (const std::out_of_range& caught) {
        EXPECT_STREQ(caught.what(), "invalid vector<T> subscript");
    }
    c_binary other = from_bytes("z");
    other.swap(value);
    EXPECT_EQ(bytes_of(other), "ABc");
    value.set(buffer, 2);
    EXPECT_EQ(bytes_of(value), "aB");
}

TEST(c_pattern, matches_whole_texts) {
    const struct {
        const char *pattern, *text;
        bool matches;
        const char* why;
    } rows[] = {{".+T.+(Z|[+\\-].+)", "2001-01-01T00:00:00Z", true, "UTC"},
                {".+T.+(Z|[+\\-].+)", "2001-01-01T00:00:00+01:00", true, "ahead"},
                {".+T.+(Z|[+\\-].+)", "2001-01-01T00:00:00-05:00", true, "behind"},
                {".+T.+(Z|[+\\-].+)", "2001-01-01T00:00:00", false, "no zone"},
                {"a+", "xaaa", false, "anchored in front"},
                {"a+", "aaax", false, "anchored behind"},
                {"", "", true, "the empty pattern on the empty text"},
                {"([", "", false, "an invalid pattern, the empty text too"},
                {"([", "([", false, "nor any other"},
                {"\xC3\xA4.", "\xC3\xA4\xE2\x82\xAC", true, "a point is a character, not a byte"}};
    for (const auto& row : rows) {
        testing::internal::CaptureStderr();
        const c_pattern pattern(row.pattern);
        EXPECT_EQ(testing::internal::GetCapturedStderr(), "") << row.why << ": nothing is printed";
        EXPECT_EQ(pattern.is_match(std::string(row.text)), row.matches) << row.why;
        EXPECT_EQ(c_regex(row.pattern).is_match(row.text), row.matches) << row.why;
    }
    EXPECT_TRUE(c_pattern("\xC3\xA4.").is_match(std::wstring{wchar_t(0xE4), wchar_t(0xD834), wchar_t(0xDD1E)}));
    EXPECT_FALSE(c_pattern("\xC3\xA4.").is_match(std::wstring(L"ab")));
    EXPECT_TRUE(c_pattern_null().is_match(std::string("any")) && c_pattern_null().is_match(std::wstring()));
}

} // namespace
