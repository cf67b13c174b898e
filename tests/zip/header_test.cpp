// Headers of entries: attributes, times, names, extra fields; and what compressors make of their libraries' results.

#include "archives.h"

#include <gtest/gtest.h>

#include <ctime>

using namespace zip_test;

extern "C" void bz_internal_error(int code);

TEST(zip_header, attributes_by_host) {
    const struct {
        std::uint8_t host;
        std::uint32_t dos, external, back;
        const char* why;
    } rows[] = {
        {0, 0x20, 0x81B40020, 0x20, "writable file with the archive bit"},
        {0, 0x21, 0x81240021, 0x21, "read-only"},
        {0, 0x22, 0x80900022, 0x22, "hidden"},
        {0, 0x10, 0x41FD0010, 0x10, "folder"},
        {3, 0x20, 0x81B40000, 0x20, "Unix keeps the mode alone"},
        {3, 0x13, 0x40490010, 0x13, "and the folder bit"},
        {6, 0x21, 0x00000021, 0x21, "as DOS"},
        {7, 0x31, 0x00000011, 0x11, "folder and read-only are all there is"},
        {10, 0x27, 0x00000027, 0x27, "as DOS"},
    };
    for (const auto& row : rows) {
        CZipFileHeader header;
        header.SetHost(row.host);
        header.SetSystemAttr(row.dos);
        EXPECT_EQ(header.GetExternalAttr(), row.external) << row.why;
        EXPECT_EQ(header.GetSystemAttr(), row.back) << row.why;
        EXPECT_EQ(header.IsDirectory(), (row.dos & 0x10) != 0) << row.why;
    }
    for (int host : {1, 2, 4, 5, 8, 9, 11, 255})
        EXPECT_EQ(cause_of([=] { CZipFileHeader().SetHost(static_cast<std::uint8_t>(host)); }), 117) << host;
}

TEST(zip_header, times_in_ms_dos_form) {
    const struct {
        const char* local;
        int date, time, lost; // -1: no way back
        const char* why;
    } rows[] = {
        {"2024-05-01 09:00:31", 0x58A1, 0x480F, 1, "odd seconds lose one"},
        {"1980-12-31 23:59:58", 0x019F, 0xBF7D, 0, "the first year"},
        {"1975-02-03 04:05:06", 0x0043, 0x20A3, -1, "earlier years become 1980"},
        {"2107-01-01 00:00:00", 0xFE21, 0, 0, "the last year"},
        {"2150-01-01 00:00:00", 0xFE21, 0, -1, "no wrap into the past"},
    };
    for (const auto& row : rows) {
        std::tm local{};
        ASSERT_NE(::strptime(row.local, "%Y-%m-%d %H:%M:%S", &local), nullptr);
        local.tm_isdst = -1;
        const std::time_t time = std::mktime(&local);
        CZipFileHeader header;
        header.SetTime(time);
        EXPECT_EQ(header.GetDosDate(), row.date) << row.why;
        EXPECT_EQ(header.GetDosTime(), row.time) << row.why;
        EXPECT_EQ(header.GetTime() == time - row.lost, row.lost >= 0) << row.why;
    }
    CZipFileHeader header;
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
    const struct {
        std::string data;
        int cause;
        std::string name;
        std::uint32_t name_page, comment_page;
        const char* why;
    } rows[] = {
        {"\1\0"s, 0, "a.hqf", 1, 0, "announces nothing"},
        {"\0\1"s + page, 0, "a.hqf", 1250, 0, "code page of the name, version 0"},
        {"\2\1"s + page, 0, "a.hqf", 1, 0, "a later version says nothing"},
        {"\1\3"s + page + "other", 0, "other", 1250, 0, "the name itself"},
        {"\1\7"s + page + "other" + comment_page, 0, "other", 1250, 65001, "all three"},
        {"\1\4"s + comment_page, 0, "a.hqf", 1, 65001, "code page of the comment"},
        {"\1\2"s, 0, "a.hqf", 1, 0, "bit 1 without bit 0 is no name"},
        {"\1"s, 101, "", 0, 0, "no flags"},
        {"\1\1\1\1\1"s, 101, "", 0, 0, "half a code page"},
        {"\1\4\1\1\1"s, 101, "", 0, 0, "half a code page of the comment"},
        {"\1\7"s + page + "abc", 101, "", 0, 0, "no room for the second code page"},
    };
    for (const auto& row : rows) {
        entry e("content", 0);
        e.extra = hqf::field_writer()(std::uint16_t{0x5A4C})(static_cast<std::uint16_t>(row.data.size())).get();
        e.extra += row.data;
        put(folder() / "names.zip", build({e}).bytes);
        CZipArchive zip;
        EXPECT_EQ(cause_of([&] { zip.Open(wide(folder() / "names.zip"), 1); }), row.cause) << row.why;
        if (row.cause != 0) continue;
        const CZipFileHeader& header = *zip.GetFileInfo(0);
        EXPECT_EQ(header.GetStoredName(), row.name) << row.why;
        EXPECT_EQ(header.GetNameCodePage(), row.name_page) << row.why;
        EXPECT_EQ(header.GetCommentCodePage(), row.comment_page) << row.why;
    }
}

TEST(zip_compressors, causes_of_library_results) {
    CZipStorage storage;
    ZipArchiveLib::CDeflateCompressor deflate(&storage);
    ZipArchiveLib::CBzip2Compressor bzip2(&storage);
    const struct {
        int code, zlib, bzip2;
    } rows[] = {{1, 500, 100},  {2, 501, 100},   {-1, 502, 600}, {-2, 503, 601}, {-3, 504, 602},
                {-4, 505, 603}, {-5, 506, 604},  {-6, 507, 605}, {-7, 100, 606}, {-8, 100, 607},
                {-9, 100, 608}, {-10, 100, 100}, {0, 100, 100},  {3, 100, 100}};
    for (const auto& row : rows) {
        EXPECT_EQ(deflate.ConvertInternalError(row.code), row.zlib) << row.code;
        EXPECT_EQ(bzip2.ConvertInternalError(row.code), row.bzip2) << row.code;
        EXPECT_EQ(deflate.IsCodeErrorOK(row.code), row.code == 0 || row.code == 2) << row.code;
        EXPECT_EQ(bzip2.IsCodeErrorOK(row.code), row.code >= 0 && row.code <= 3) << row.code;
    }
    EXPECT_EQ(cause_of([] { bz_internal_error(1007); }), 609);
}
