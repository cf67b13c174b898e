// UTF-8 and UTF-16: conversions, single characters, and the escapes of documents.

#include <algorithm>
#include <iomanip>

#include "hqf/values/c_as_xml.h"
#include "hqf/values/text.h"
#include "hqf/values/transcode.h"
#include "hqf/values/xml_escape.h"
#include "tests/support/table.h"

namespace {

using namespace lmx;

const std::string clef8 = "\xF0\x9D\x84\x9E";               // U+1D11E
const std::string split_clef8 = "\xED\xA0\xB4\xED\xB4\x9E"; // the same as two surrogates of three bytes
const std::wstring clef16 = {wchar_t(0xD834), wchar_t(0xDD1E)};
const std::wstring high = {wchar_t(0xD834)};
const std::wstring low = {wchar_t(0xDD1E)};

// Each row also runs behind ASCII of every length up to 17, which moves it through every step of the word-wise scan.
TEST(convert, utf8_to_wide) {
    // A split pair is a pair, a lone low surrogate is kept, overlong forms pass. A high surrogate without its low one
    // ends the text, as does whatever is no character.
    using row = std::pair<std::string, std::wstring>;
    const auto rows = support::list(
        row{"", L""}, row{"a\x7F", L"a\x7F"}, row{std::string("a\0b", 3), std::wstring(L"a\0b", 3)},
        row{"\xC2\x80\xDF\xBF", L"\x80\x7FF"}, row{"\xE0\xA0\x80\xEF\xBF\xBF", L"\x800\xFFFF"},
        row{clef8 + "x", clef16 + L"x"}, row{split_clef8 + "x", clef16 + L"x"}, row{"\xED\xB4\x9Ex", low + L"x"},
        row{"\xC0\xAF", L"/"}, row{"a\xED\xA0\xB4x", L"a"}, row{"a\xED\xA0\xB4", L"a"},
        row{"a\xED\xA0\xB4" + clef8, L"a"}, row{"a\xC3", L"a"}, row{"a\xE2\x82", L"a"}, row{"a\xF0\x9D\x84", L"a"},
        row{"a\xC3(b", L"a"}, row{"a\xE2\x82(b", L"a"}, row{"a\x80z", L"a"}, row{"a\xF8\x88\x80\x80\x80z", L"a"});
    for (const auto& [in, expected] : rows)
        for (std::size_t prefix = 0; prefix < 1028; prefix += prefix == 17 ? 1000 : 1) { // long ones go in pieces
            std::wstring out = L"old";
            EXPECT_EQ(convert(&out, std::string(prefix, '.') + in), std::wstring(prefix, L'.') + expected)
                << in << " behind " << prefix;
            std::string accents;
            while (accents.size() < 2 * prefix)
                accents += "\xC3\xA9";
            EXPECT_EQ(convert(&out, accents + in), std::wstring(prefix, L'\xE9') + expected) << in << prefix;
        }
    std::string narrow = "old";
    EXPECT_EQ(vtostring(narrow, "a\xC3"), "a\xC3") << "the narrow form is a plain copy";
    std::wstring wide = L"kept ";
    hqf::append_wide(wide, clef8.data(), clef8.size());
    EXPECT_EQ(wide, L"kept " + clef16);
}

TEST(convert, wide_to_utf8_and_escaped) {
    // An unpaired high surrogate loses the next element, and ends the escaping. What is no character is replaced, even
    // if its low byte is a less-than sign.
    using row = std::tuple<std::wstring, std::string, std::string>;
    const auto rows = support::list(
        row{L"a>b&c<'\"", "a>b&c<'\"", "a>b&amp;c&lt;&apos;&quot;"},
        row{L"\x7F\x80\x7FF", "\x7F\xC2\x80\xDF\xBF", "\x7F\xC2\x80\xDF\xBF"},
        row{L"\x800\xFFFF", "\xE0\xA0\x80\xEF\xBF\xBF", "\xE0\xA0\x80\xEF\xBF\xBF"},
        row{clef16 + L"x", clef8 + "x", clef8 + "x"}, row{L"a" + high + L"Az", "a\xED\xA0\xB4z", "a"},
        row{L"a" + high, "a\xED\xA0\xB4", "a"}, row{L"a" + high + clef16, "a\xED\xA0\xB4\xED\xB4\x9E", "a"},
        row{low + L"&", "\xED\xB4\x9E&", "\xED\xB4\x9E&amp;"}, row{std::wstring(1, wchar_t(0x1D11E)), clef8, clef8},
        row{std::wstring(1, wchar_t(0x110000)), "\xEF\xBF\xBD", "\xEF\xBF\xBD"},
        row{std::wstring(1, wchar_t(0xFFFFFF3C)), "\xEF\xBF\xBD", "\xEF\xBF\xBD"});
    for (const auto& [text, plain, escaped] : rows) {
        std::string out = "old";
        for (const std::size_t prefix : {0u, 1022u, 1023u, 1024u})
            EXPECT_EQ(convert(&out, std::wstring(prefix, L'.') + text), std::string(prefix, '.') + plain) << prefix;
        for (const std::size_t prefix : {0u, 1u, 505u, 506u, 507u, 512u, 1100u}) { // around the size of a block
            const std::wstring in = std::wstring(prefix, L'.') + text;
            std::ostringstream os;
            os << c_as_xml(in);
            EXPECT_EQ(os.str(), std::string(prefix, '.') + escaped) << plain << " behind " << prefix;
            std::string appended = "kept";
            hqf::append_xml_escaped(appended, in.data(), in.size());
            EXPECT_EQ(appended, "kept" + os.str()) << plain;
        }
    }
}

TEST(c_as_xml, narrow_text) {
    const std::string in = "a>b&c\"'<\xFF" + std::string(600, '&');
    std::string expected = "a>b&amp;c&quot;&apos;&lt;\xFF";
    for (int i = 0; i < 600; ++i)
        expected += "&amp;";
    std::ostringstream os;
    os << c_as_escaped<std::string>(in) << std::setw(5) << c_as_xml(in);
    EXPECT_EQ(os.str(), expected + expected);
    std::string appended = "kept";
    hqf::append_xml_escaped(appended, in.data(), in.size());
    EXPECT_EQ(appended, "kept" + expected);
}

TEST(c_as_ascii, everything_above_ascii_is_a_point) {
    std::ostringstream os;
    os << c_as_ascii<std::wstring>(L"a&\x7F\x80" + clef16 + std::wstring{wchar_t(0x1D11E), wchar_t(0xFFFFFF41)});
    EXPECT_EQ(os.str(), "a&\x7F.....");
}

TEST(utf8_to_unicode_char, and_back) {
    // What was built before the fault is given, too.
    using row = std::tuple<const char*, bool, int>;
    const auto rows =
        support::list(row{"\x7F", true, 0x7F}, row{"\xC2\x80", true, 0x80}, row{"\xDF\xBF", true, 0x7FF},
                      row{"\xE0\xA0\x80", true, 0x800}, row{"\xED\xA0\xB4", true, 0xD834},
                      row{"\xEF\xBF\xBF", true, 0xFFFF}, row{"\xF0\x90\x80\x80", true, 0x10000},
                      row{"\xF4\x8F\xBF\xBF", true, 0x10FFFF}, row{"\xC3(", false, 3}, row{"\xE2\x82(", false, 0x82},
                      row{"\xF0", false, 0}, row{"\x80", false, -1}, row{"\xF8\x88\x80\x80\x80", false, -1});
    char out[5];
    for (const auto& [utf8, ok, expected] : rows) {
        int value = 99;
        EXPECT_EQ(utf8_to_unicode_char(utf8, &value), ok) << utf8;
        EXPECT_EQ(value, expected) << utf8;
        if (ok) {
            EXPECT_STREQ(unicode_char_to_utf8(expected, out), utf8);
        }
    }
    EXPECT_STREQ(unicode_char_to_utf8(-1, out), "\xFF");
}

TEST(is_valid_utf8_char_sequence, first_two_bytes_decide) {
    for (int first = 0; first < 256; ++first)
        for (int second = 0; second < 256; ++second) {
            const bool is_continuation = second >= 0x80 && second < 0xC0, is_low = second < 0xA0;
            const bool expected = first == 0xE0   ? is_continuation && !is_low
                                  : first == 0xED ? is_continuation && is_low
                                  : first == 0xF0 ? is_continuation && second >= 0x90
                                  : first == 0xF4 ? is_continuation && second < 0x90
                                                  : first < 0x80 || (first >= 0xC2 && first < 0xF5);
            const char in[] = {static_cast<char>(first), static_cast<char>(second), '\0'};
            ASSERT_EQ(is_valid_utf8_char_sequence(in), expected) << first << " " << second;
        }
}

} // namespace
