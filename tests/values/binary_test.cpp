// Binary values in both text forms, and pattern facets.

#include <algorithm>
#include <iomanip>
#include <stdexcept>

#include "hqf/values/c_binary.h"
#include "hqf/values/c_empty.h"
#include "hqf/values/c_pattern.h"
#include "tests/support/table.h"

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

std::string hex_of(const c_binary& value) {
    std::ostringstream os;
    os << c_as_hex(value);
    return os.str();
}

TEST(c_binary, hex) {
    for (const auto& [text, valid, bytes] :
         support::rows<3>("'' 1 ''   0 0 ''   0G 0 10   0aF1 1 0AF1   0aF 0 0A   fFAa 1 FFAA   0_ 0 E9   00 1 00")) {
        EXPECT_EQ(c_binary::is_valid_hex(text.c_str()), valid == "1") << text;
        c_binary value = from_bytes("old");
        value.from_hex(text.c_str());
        EXPECT_EQ(hex_of(value), bytes) << text;
    }
    std::ostringstream os;
    os << std::showbase << std::left << c_as_hex(from_bytes("\x0A\xFF")) << ' ' << std::setw(4) << 10;
    EXPECT_EQ(os.str(), "0AFF 1000") << "flags are put back, the fill stays";
}

TEST(c_binary, base64) {
    for (const auto& [pattern, valid, bytes] : support::rows<3>(R"(
        '' 1 ''   QUJD 1 414243   QUI= 1 4142   QQ== 1 41   +/+/ 1 FBFFBF   __QU_JD_ 1 414243   QUI_= 1 4142
        QQ=_= 0 41   A 0 00   = 0 ''   == 0 ''   _ 0 ''   QUJ 0 4142   Q=== 0 40   QUJD==== 0 414243   QQ=Q 0 4104
        QUJDQ=== 0 41424340   QU-D 0 4140)"))
        for (const char blank : {' ', '\n', '\t', '\r'}) {
            std::string text = pattern;
            std::replace(text.begin(), text.end(), ' ', blank);
            EXPECT_EQ(c_binary::is_valid_base64(text.c_str()), valid == "1") << text;
            c_binary value = from_bytes("old");
            value.from_base64(text.c_str());
            EXPECT_EQ(hex_of(value), bytes) << text;
        }
    EXPECT_FALSE(c_binary::is_valid_base64("QU\xA0JD")) << "above ASCII";
    for (const unsigned int size : {767u, 768u, 769u, 1000u}) { // around the size of a block
        std::string bytes;
        for (unsigned int i = 0; i < size; ++i)
            bytes += static_cast<char>(i * 37);
        std::ostringstream os;
        os << std::setw(9) << c_as_base64(from_bytes(bytes));
        EXPECT_EQ(os.str().size(), (size + 2) / 3 * 4) << "one line";
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
    value.append('a');
    (value += 'b') += 'c';
    value[1] = 'B';
    EXPECT_TRUE(value == from_bytes("aBc") && value != from_bytes("aB") && !value.equal(nullptr, 0));
    EXPECT_TRUE(c_binary().equal(nullptr, 0) && c_binary(nullptr, 0) == c_binary());
    unsigned char buffer[] = "xxxxx";
    EXPECT_EQ(value.get(buffer, 5), buffer);
    EXPECT_EQ(std::string(buffer, buffer + 5), "aBcxx") << "only the value's bytes";
    buffer[2] = 'x';
    EXPECT_EQ(std::string(value.get(buffer, 2), buffer + 3), "aBx") << "only as many as asked";
    value.at(0) = 'A';
    try {
        value.at(3);
        ADD_FAILURE() << "the index is checked";
    } catch (const std::out_of_range& caught) {
        EXPECT_STREQ(caught.what(), "invalid vector<T> subscript");
    }
    c_binary other = from_bytes("z");
    other.swap(value);
    EXPECT_EQ(bytes_of(other) + bytes_of(value), "ABcz");
    value.set(buffer, 2);
    EXPECT_EQ(bytes_of(value), "aB");
}

TEST(c_pattern, matches_whole_texts) {
    for (const auto& [expression, text, matches] : support::rows<3>(R"(
        .+T.+(Z|[+\-].+) 2001-01-01T00:00:00-05:00 1   .+T.+(Z|[+\-].+) 2001-01-01T00:00:00 0
        a+ xaaa 0   a+ aaax 0   '' '' 1   ([ '' 0   ([ ([ 0   ä. ä€ 1)")) {
        testing::internal::CaptureStderr();
        const c_pattern pattern(expression.c_str());
        EXPECT_EQ(testing::internal::GetCapturedStderr(), "") << expression << ": nothing is printed";
        EXPECT_EQ(pattern.is_match(text), matches == "1") << expression << " " << text;
        EXPECT_EQ(c_regex(expression.c_str()).is_match(text.c_str()), matches == "1") << expression << " " << text;
    }
    EXPECT_TRUE(c_pattern("\xC3\xA4.").is_match(std::wstring{wchar_t(0xE4), wchar_t(0xD834), wchar_t(0xDD1E)}));
    EXPECT_FALSE(c_pattern("\xC3\xA4.").is_match(std::wstring(L"ab")));
    EXPECT_TRUE(c_pattern_null().is_match(std::string("any")) && c_pattern_null().is_match(std::wstring()));
}

} // namespace
