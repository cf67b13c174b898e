// What an archive gets: shape, methods, names, limits, and what is left of it after a failure.

#include "archives.h"
#include "hqf/platform/file_access.h"

#include <gtest/gtest.h>

#include <ctime>

using namespace zip_test;

namespace {

const auto path = folder() / "written.zip";

struct new_archive : CZipArchive {
    new_archive() { Open(wide(path), CZipStorage::create); }
};

CZipFileHeader named(const std::wstring& name) {
    CZipFileHeader header;
    header.SetFileName(name);
    return header;
}

void add(CZipArchive& zip, const std::wstring& name, const std::string& content, int level = -1) {
    const auto size = static_cast<unsigned int>(content.size());
    ASSERT_TRUE(zip.OpenNewFile(named(name), level) && zip.WriteNewFile(content.data(), size) && zip.CloseNewFile());
}

/// All entries of the archive, with a bar behind each.
std::string contents() {
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::openReadOnly);
    std::string all;
    for (unsigned int i = 0; i < zip.GetCount(); ++i) {
        std::string content(zip.GetFileInfo(i)->GetUncompressedSize(), '\0');
        zip.OpenFile(i);
        zip.ReadFile(content.data(), static_cast<unsigned int>(content.size()));
        EXPECT_EQ(zip.CloseFile(), 1);
        all += content + '|';
    }
    return all;
}

} // namespace

TEST(zip_write, a_packed_file_has_exactly_this_shape) {
    std::tm local{0, 0, 9, 1, 4, 124, 0, 0, -1, 0, nullptr};
    const std::time_t begin = std::mktime(&local);
    std::filesystem::create_directories(folder() / "dir");
    const auto source = folder() / "dir" / "a.hqf";
    for (const std::string& content : {std::string("1234"), std::string("12345"), sample_text(200000)}) {
        make_file(source, content);
        ASSERT_TRUE(hqf::set_file_time(wide(source), begin + 1));
        new_archive zip;
        ASSERT_TRUE(zip.AddNewFile(wide(source), -1, false, 7, 65536));
        zip.Close();
        const entry expected(content, content.size() < 5 ? 0 : 8);
        EXPECT_TRUE(bytes_of(path) == build({expected}).bytes) << content.size();
    }
}

TEST(zip_write, levels_choose_method_and_flags) {
    const std::tuple<int, int, int> rows[] = {{-1, 8, 0}, {0, 0, 0}, {1, 8, 6},  {2, 8, 4}, {3, 8, 0},
                                              {8, 8, 2},  {9, 8, 2}, {10, 8, 0}, {-2, 8, 0}};
    const std::string text = sample_text(50000);
    for (const auto& [level, method, flags] : rows) {
        new_archive zip;
        add(zip, L"a", text, level);
        const CZipFileHeader& header = *zip.GetFileInfo(0);
        EXPECT_TRUE(header.GetMethod() == method && header.GetFlags() == flags) << level;
        EXPECT_EQ(header.GetCompressedSize() == deflated(text).size(), level < 0 || level > 9) << level;
        zip.Close();
        EXPECT_TRUE(contents() == text + '|') << level;
    }
    CZipFileHeader spanned;
    spanned.PrepareData(1, true);
    EXPECT_EQ(spanned.GetFlags(), 14) << "sizes behind the data";
}

TEST(zip_write, misuse_is_told_by_results) {
    CZipArchive zip;
    for (const std::uint16_t method : std::initializer_list<std::uint16_t>{0, 9})
        EXPECT_FALSE(zip.SetCompressionMethod(method)) << method;
    zip.Open(wide(path), CZipStorage::create);
    ASSERT_TRUE(zip.OpenNewFile(named(L"a")));
    EXPECT_EQ(zip.GetFileInfo(0)->GetMethod(), 8) << "the refused method changes nothing";
    EXPECT_FALSE(zip.SetCompressionMethod(8)) << "an entry is being written";
    EXPECT_FALSE(zip.OpenNewFile(named(L"b")) || zip.OpenFile(0)) << "one entry at a time";
    EXPECT_TRUE(zip.CloseNewFile() && zip.SetCompressionMethod(12));
    EXPECT_FALSE(zip.OpenNewFile(named(L"b"))) << "packing with bzip2 is not built";
    EXPECT_TRUE(zip.OpenNewFile(named(L"b"), 0) && zip.CloseNewFile()) << "but storing is";
    EXPECT_FALSE(zip.OpenNewFile(named(L"c"), 0, L"", 0)) << "no entry is replaced";
    EXPECT_FALSE(zip.OpenNewFile(named(L"c"), 0, wide(folder() / "none"))) << "no such file";
    EXPECT_FALSE(zip.AddNewFile(wide(folder() / "none")));
    zip.Close();
    EXPECT_EQ(contents(), "||");
}

TEST(zip_write, names_of_entries_come_from_the_path) {
    const auto dir = folder() / "names" / "sub";
    std::filesystem::create_directories(dir);
    make_file(dir / "file.hqf", "content");
    const std::string full = dir.string().substr(1);
    const std::tuple<std::wstring, bool, std::string> rows[] = {{L"/file.hqf", false, "file.hqf"},
                                                                {L"/file.hqf", true, full + "/file.hqf"},
                                                                {L"", false, "sub/"},
                                                                {L"//", false, "sub/"},
                                                                {L"/", true, full + "/"}};
    for (const auto& [behind, full_path, name] : rows) {
        new_archive zip;
        ASSERT_TRUE(zip.AddNewFile(wide(dir) + behind, -1, full_path));
        const CZipFileHeader& header = *zip.GetFileInfo(0);
        const bool is_folder = name.back() == '/';
        EXPECT_EQ(header.GetStoredName(), name);
        EXPECT_EQ(header.GetExternalAttr(), is_folder ? 0x41FD0010 : 0x81B40020) << name;
        EXPECT_EQ(header.GetMethod(), is_folder ? 0 : 8) << name;
        EXPECT_EQ(header.GetVersionNeeded(), is_folder ? 10 : 20) << name;
        zip.Close();
    }
}

TEST(zip_write, fields_of_65536_bytes_are_refused_and_leave_no_entry) {
    const std::string bytes65532(65532, 'x');
    const std::tuple<std::size_t, std::size_t, std::size_t, std::size_t, int> rows[] = {
        {65535, 0, 0, 0, 0}, {65536, 0, 0, 0, 110}, {1, 65535, 0, 0, 0}, {1, 65536, 0, 0, 110},
        {1, 0, 65531, 0, 0}, {1, 0, 65532, 0, 110}, {1, 0, 0, 65531, 0}, {1, 0, 0, 65532, 110}};
    for (const auto& [name, comment, local, central, cause] : rows) {
        CZipFileHeader header = named(std::wstring(name, L'n'));
        header.SetComment(std::wstring(comment, L'c'));
        if (local != 0) header.GetLocalExtra().Add(1, bytes65532.data(), local);
        if (central != 0) header.GetCentralExtra().Add(1, bytes65532.data(), central);
        new_archive zip;
        EXPECT_EQ(cause_of([&] { zip.OpenNewFile(header, 0) && zip.CloseNewFile(); }), cause);
        zip.Close();
        EXPECT_EQ(contents(), cause == 0 ? "|" : "") << name << comment << local << central;
    }
}

TEST(zip_write, record_of_names_is_written_only_where_it_says_something) {
    const std::tuple<std::uint32_t, std::uint32_t, bool, std::string> rows[] = {
        {1, 0, false, ""},
        {65001, 0, false, std::string("\1\1\xE9\xFD\0\0", 6)},
        {1, 65001, false, std::string("\1\4\xE9\xFD\0\0", 6)},
        {65001, 65001, true, std::string("\1\7\xE9\xFD\0\0\xC3\xA9\xE9\xFD\0\0", 12)}};
    for (const auto& [name_page, comment_page, in_extra, record] : rows) {
        CZipFileHeader header = named(L"\u00E9");
        header.SetNameCodePage(name_page);
        header.SetCommentCodePage(comment_page);
        header.SetNameInExtra(in_extra);
        new_archive zip;
        ASSERT_TRUE(zip.OpenNewFile(header) && zip.CloseNewFile());
        zip.Close();
        zip.Open(wide(path), CZipStorage::openReadOnly);
        const CZipFileHeader& read = *zip.GetFileInfo(0);
        const CZipExtraData* const found = read.GetCentralExtra().Find(0x5A4C);
        EXPECT_EQ(found == nullptr ? "" : std::string(found->data.GetBuffer(), found->data.GetSize()), record);
        EXPECT_EQ(read.GetFileName(), L"\u00E9");
    }
}

TEST(zip_write, adds_behind_what_is_there) {
    // An archive made on another host, with something in front of it and a comment, which all stay.
    entry first("first", 8);
    first.made_by = 3 << 8 | 30;
    const std::string before = "front" + build({first}, "comment").bytes;
    make_file(path, before);
    CZipArchive zip;
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openExisting));
    zip.Close();
    EXPECT_EQ(bytes_of(path), before) << "nothing added, nothing written";
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openExisting));
    CZipFileHeader header = named(L"b");
    header.SetSystemAttr(0x20);
    ASSERT_TRUE(zip.OpenNewFile(header) && zip.CloseNewFile());
    EXPECT_EQ(zip.GetFileInfo(1)->GetExternalAttr(), 0x81B40000U) << "a new entry takes the archive's host";
    add(zip, L"c", "third", 0);
    zip.Close();
    EXPECT_EQ(bytes_of(path).substr(0, 5) + bytes_of(path).substr(bytes_of(path).size() - 7), "frontcomment");
    EXPECT_EQ(contents(), "first||third|");

    // An archive behind a file that is none.
    make_file(path, "a program");
    EXPECT_EQ(cause_of([&] { zip.Open(wide(folder() / "none"), CZipStorage::append); }), ENOENT);
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::append));
    add(zip, L"a", "first");
    zip.Close();
    EXPECT_EQ(bytes_of(path).substr(0, 9), "a program");
    EXPECT_EQ(contents(), "first|");
}

TEST(zip_write, an_exception_leaves_no_directory_and_a_dropped_entry_no_trace) {
    for (bool closes : {true, false}) {
        new_archive zip;
        add(zip, L"a", "abc");
        zip.OpenNewFile(named(L"b"));
        if (closes) zip.Close(CZipArchive::closeAfterException);
    }
    EXPECT_EQ(load(path).cause, 118) << "a destructor writes nothing";
    new_archive zip;
    add(zip, L"a", "kept");
    zip.OpenNewFile(named(L"b"));
    zip.WriteNewFile("dropped", 7);
    EXPECT_TRUE(zip.CloseNewFile(true));
    add(zip, L"c", "kept too");
    zip.Close();
    EXPECT_EQ(contents(), "kept|kept too|");
}

TEST(zip_write, holds_65535_entries_and_no_more) {
    new_archive zip;
    CZipFileHeader header = named(L"n");
    header.SetTime(1714554000);
    for (int i = 0; i < 65535; ++i)
        ASSERT_TRUE(zip.OpenNewFile(header, 0) && zip.CloseNewFile()) << i;
    EXPECT_FALSE(zip.OpenNewFile(header, 0));
    zip.Close();
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openReadOnly)) << "a count of all ones without a ZIP64 locator";
    EXPECT_EQ(zip.GetCount(), 65535U);
}

TEST(zip_write, time_without_a_source_is_now_and_close_can_stamp_the_file) {
    new_archive zip;
    CZipFileHeader old = named(L"old");
    old.SetTime(1000000000);
    ASSERT_TRUE(zip.OpenNewFile(old) && zip.CloseNewFile());
    zip.Close(CZipArchive::closeNormal, true);
    hqf::file_status status;
    ASSERT_TRUE(hqf::get_file_status(wide(path), status));
    EXPECT_EQ(status.modified, 1000000000);
    const std::time_t before = std::time(nullptr);
    zip.Open(wide(path), CZipStorage::create);
    ASSERT_TRUE(zip.OpenNewFile(named(L"now")));
    EXPECT_GE(zip.GetFileInfo(0)->GetTime(), before - 2);
}
