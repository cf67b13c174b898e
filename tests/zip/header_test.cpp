// Headers of entries: attributes, times, names, extra fields; and what compressors make of their libraries' results.

#include "archives.h"

#include <gtest/gtest.h>

#include <ctime>

using namespace zip_test;

extern "C" void bz_internal_error(int code);

TEST(zip_header, attributes_by_host) {
    const std::tuple<std::uint8_t, std::uint32_t, std::uint32_t, std::uint32_t, const char*> rows[] = {
        {0, 0x20, 0x81B40020, 0x20, "writable file with the archive bit"},
        {0, 0x23, 0x80000023, 0x23, "hidden and read-only"},
        {0, 0x10, 0x41FD0010, 0x10, "folder"},
        {3, 0x20, 0x81B40000, 0x20, "Unix keeps the mode alone"},
        {3, 0x13, 0x40490010, 0x13, "and the folder bit"},
        {6, 0x27, 0x00000027, 0x27, "as DOS"},
        {7, 0x37, 0x00000011, 0x11, "folder and read-only are all there is"},
        {10, 0x27, 0x00000027, 0x27, "as DOS"},
    };
    for (const auto& [host, dos, external, back, why] : rows) {
        CZipFileHeader header;
        header.SetHost(host);
        header.SetSystemAttr(dos);
        EXPECT_EQ(header.GetExternalAttr(), external) << why;
        EXPECT_EQ(header.GetSystemAttr(), back) << why;
        EXPECT_EQ(header.IsDirectory(), (dos & 0x10) != 0) << why;
    }
    for (int host : {1, 5, 9, 11, 255})
        EXPECT_EQ(cause_of([=] { CZipFileHeader().SetHost(static_cast<std::uint8_t>(host)); }), 117) << host;
}

TEST(zip_header, times_in_ms_dos_form) {
    const std::tuple<const char*, int, int, int, const char*> rows[] = {
        // what is lost on the way back; -1: there is none
        {"2024-05-01 09:00:31", 0x58A1, 0x480F, 1, "odd seconds lose one"},
        {"1975-02-03 04:05:06", 0x0043, 0x20A3, -1, "earlier years become 1980"},
        {"2107-01-01 00:00:00", 0xFE21, 0, 0, "the last year"},
        {"2150-01-01 00:00:00", 0xFE21, 0, -1, "no wrap into the past"},
    };
    CZipFileHeader header;
    for (const auto& [text, date, time_of_day, lost, why] : rows) {
        std::tm local{};
        ASSERT_NE(::strptime(text, "%Y-%m-%d %H:%M:%S", &local), nullptr);
        local.tm_isdst = -1;
        const std::time_t time = std::mktime(&local);
        header.SetTime(time);
        EXPECT_EQ(header.GetDosDate(), date) << why;
        EXPECT_EQ(header.GetDosTime(), time_of_day) << why;
        EXPECT_EQ(header.GetTime() == time - lost, lost >= 0) << why;
    }
    header.SetTime(INT64_MAX);
    EXPECT_EQ(header.GetDosDate(), 1 << 5 | 1) << "a time without a local form";
}

TEST(zip_header, names_turn_their_separators_by_host) {
    CZipFileHeader header;
    EXPECT_EQ(header.GetFileName(), L"");
    header.SetFileName(L"a\\b/c");
    EXPECT_EQ(header.GetStoredName(), "a/b/c");
    for (int host : {0, 3, 10}) {
        header.SetHost(static_cast<std::uint8_t>(host));
        EXPECT_EQ(header.GetFileName(), host == 3 ? L"a/b/c" : L"a\\b\\c") << host;
        EXPECT_EQ(header.GetNameCodePage(), host == 0 ? 1U : 0U) << host;
    }
    header.SetFileName(L"\u00E9");
    header.SetNameCodePage(1252);
    EXPECT_EQ(header.GetStoredName(), "?") << "stored anew in the new code page";
}

// The record of code pages and names in a central header: version, flags, then what they announce.
TEST(zip_header, record_of_names_overrides_code_page_and_name) {
    using std::string_literals::operator""s;
    const std::string page("\xE2\x04\0\0", 4), comment_page("\xE9\xFD\0\0", 4); // 1250, 65001
    const std::tuple<std::string, int, const char*, std::uint32_t, std::uint32_t, const char*> rows[] = {
        {"\0\1"s + page, 0, "a.hqf", 1250, 0, "code page of the name, version 0"},
        {"\2\1"s + page, 0, "a.hqf", 1, 0, "a later version says nothing"},
        {"\1\7"s + page + "other" + comment_page, 0, "other", 1250, 65001, "the name itself, and all there is"},
        {"\1\4"s + comment_page, 0, "a.hqf", 1, 65001, "code page of the comment"},
        {"\1\2"s, 0, "a.hqf", 1, 0, "bit 1 without bit 0 is no name"},
        {"\1"s, 101, "", 0, 0, "no flags"},
        {"\1\1\1\1\1"s, 101, "", 0, 0, "half a code page"},
        {"\1\4\1\1\1"s, 101, "", 0, 0, "half a code page of the comment"},
        {"\1\7"s + page + "abc", 101, "", 0, 0, "no room for the second code page"},
    };
    for (const auto& [data, cause, name, name_page, page_of_comment, why] : rows) {
        entry e("content", 0);
        e.extra = hqf::field_writer()(std::uint16_t{0x5A4C})(static_cast<std::uint16_t>(data.size())).get() + data;
        make_file(folder() / "names.zip", build({e}).bytes);
        CZipArchive zip;
        EXPECT_EQ(cause_of([&] { zip.Open(wide(folder() / "names.zip"), 1); }), cause) << why;
        if (cause != 0) continue;
        const CZipFileHeader& header = *zip.GetFileInfo(0);
        EXPECT_EQ(header.GetStoredName(), name) << why;
        EXPECT_EQ(header.GetNameCodePage(), name_page) << why;
        EXPECT_EQ(header.GetCommentCodePage(), page_of_comment) << why;
    }
}

TEST(zip_compressors, causes_of_library_results) {
    CZipStorage storage;
    ZipArchiveLib::CDeflateCompressor deflate(&storage);
    ZipArchiveLib::CBzip2Compressor bzip2(&storage);
    for (int code = -10; code < 4; ++code) {
        const bool is_stream_end_or_dictionary = code == 1 || code == 2;
        const int by_zlib = code < -6 || code >= 0 ? 100 : 501 - code;
        EXPECT_EQ(deflate.ConvertInternalError(code), is_stream_end_or_dictionary ? 499 + code : by_zlib) << code;
        EXPECT_EQ(bzip2.ConvertInternalError(code), code < -9 || code >= 0 ? 100 : 599 - code) << code;
        EXPECT_EQ(deflate.IsCodeErrorOK(code), code == 0 || code == 2) << code;
        EXPECT_EQ(bzip2.IsCodeErrorOK(code), code >= 0 && code <= 3) << code;
    }
    EXPECT_EQ(cause_of([] { bz_internal_error(1007); }), 609);
}
