// Documents into strings: how much was expected must not show in what comes out.

#include <gtest/gtest.h>

#include <cstdint>
#include <random>
#include <stdexcept>

#include "hqf/values/text.h"
#include "hqf/xml_out/text_stream.h"
#include "tests/support/files.h"

namespace {

// Puts a text on a stream in pieces of all sizes, at times through one character at a time.
bool put_in_pieces(std::ostream& stream, const std::string& text) {
    std::minstd_rand random(7);
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t size = std::min<std::size_t>(text.size() - at, 1 + random() % (200u << random() % 12));
        if (size == 1)
            stream.put(text[at]);
        else
            stream.write(text.data() + at, static_cast<std::streamsize>(size));
        at += size;
    }
    return stream.good();
}

TEST(gather, whatever_was_expected) {
    std::string text, bad;
    while (text.size() < 1500000)
        text += "<a b='1'>caf\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x8E\xA8</a>\n";
    bad = text;
    bad[900001 + bad.substr(900001).find('<')] = '\xFF';
    for (const std::string* each : {&text, &bad})
        for (const std::size_t expected : {std::size_t{0}, std::size_t{1}, std::size_t{100000}, text.size() - 70000,
                                           text.size(), 4 * text.size(), SIZE_MAX / 4 * 3}) {
            const auto write = [&](std::ostream& stream) { return put_in_pieces(stream, *each); };
            std::string narrow = "before";
            hqf::gather(narrow, expected, write);
            ASSERT_TRUE(narrow == *each) << expected;
            EXPECT_LE(narrow.capacity(), 3 * text.size()) << expected;
            std::wstring wide = L"before", all;
            hqf::gather(wide, expected, write);
            ASSERT_TRUE(wide == lmx::convert(&all, *each)) << expected;
            EXPECT_LE(wide.capacity(), 3 * text.size()) << expected;
        }
}

TEST(file_stream, sizes_around_pages_and_blocks) {
    const support::folder folder;
    const std::string name = (folder / "f").string();
    std::string text;
    while (text.size() < 600000)
        text += std::to_string(text.size()) + ' ';
    for (const std::size_t size : {0u, 1u, 4095u, 4096u, 4097u, 262143u, 262144u, 262145u, 524288u, 600000u}) {
        hqf::file_stream stream(name.c_str());
        ASSERT_TRUE(put_in_pieces(stream, text.substr(0, size)) && stream.close()) << size;
        EXPECT_EQ(support::bytes_of(name), text.substr(0, size)) << size;
    }
}

TEST(gather, leaves_the_string_alone_without_success) {
    for (const std::size_t expected : {0u, 100u}) {
        std::string narrow = "before";
        std::wstring wide = L"before";
        const auto refuse = [](std::ostream& stream) { return !(stream << "half a document"); };
        const auto fail = [](std::ostream& stream) -> bool { stream << "half", throw std::runtime_error("full"); };
        hqf::gather(narrow, expected, refuse), hqf::gather(wide, expected, refuse);
        EXPECT_THROW(hqf::gather(narrow, expected, fail), std::runtime_error);
        EXPECT_THROW(hqf::gather(wide, expected, fail), std::runtime_error);
        EXPECT_EQ(narrow, "before");
        EXPECT_EQ(wide, L"before");
    }
}

} // namespace
