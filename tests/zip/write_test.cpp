#include "archives.h"

#include <gtest/gtest.h>

using namespace zip_test;

namespace {

const auto path = folder() / "written.zip";

CZipFileHeader named(const std::wstring& name) {
    CZipFileHeader header;
    header.SetFileName(name);
    return header;
}

void add(CZipArchive& zip, const std::wstring& name, const std::string& content, int level = -1) {
    ASSERT_TRUE(zip.OpenNewFile(named(name), level));
    ASSERT_TRUE(zip.WriteNewFile(content.data(), static_cast<unsigned int>(content.size())));
    ASSERT_TRUE(zip.CloseNewFile());
}

std::string read_entry(unsigned int index) {
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::openReadOnly);
    std::string content(zip.GetFileInfo(index)->GetUncompressedSize(), '\0');
    zip.OpenFile(index);
    zip.ReadFile(content.data(), static_cast<unsigned int>(content.size()));
    EXPECT_EQ(zip.CloseFile(), 1);
    return content;
}

} // namespace

TEST(zip_write, a_packed_file_has_exactly_this_shape) {
    const auto folder_of_source = folder() / "dir";
    std::filesystem::create_directories(folder_of_source);
    for (const std::string& content : {std::string("1234"), std::string("12345"), sample_text(200000)}) {
        const auto source = folder_of_source / "a.hqf";
        put(source, content);
        std::tm local{};
        local.tm_year = 124, local.tm_mon = 4, local.tm_mday = 1, local.tm_hour = 9, local.tm_sec = 31;
        local.tm_isdst = -1;
        std::filesystem::last_write_time(
            source, std::chrono::file_clock::from_sys(std::chrono::system_clock::from_time_t(std::mktime(&local))));
        CZipArchive zip;
        ASSERT_TRUE(zip.Open(wide(path), CZipStorage::create));
        ASSERT_TRUE(zip.SetCompressionMethod(8));
        ASSERT_TRUE(zip.AddNewFile(wide(source), -1, false, 7, 65536));
        zip.Close();

        const std::string bytes = get(path);
        const std::uint16_t method = content.size() < 5 ? 0 : 8;
        ASSERT_GT(bytes.size(), 103U);
        const std::string data = bytes.substr(35, bytes.size() - 35 - 51 - 22);
        hqf::field_writer common;
        common(std::uint16_t{20})(std::uint16_t{0})(method)(std::uint16_t{0x480F})(std::uint16_t{0x58A1});
        common(crc_of(content))(static_cast<std::uint32_t>(data.size()))(static_cast<std::uint32_t>(content.size()));
        common(std::uint16_t{5})(std::uint16_t{0});
        hqf::field_writer central, end;
        central(0x02014B50U)(std::uint16_t{46}).bytes(common.get().data(), common.get().size());
        central(std::uint16_t{0})(std::uint16_t{0})(std::uint16_t{0})(0x81B40020U)(0U);
        end(0x06054B50U)(0U)(std::uint16_t{1})(std::uint16_t{1})(51U);
        end(static_cast<std::uint32_t>(35 + data.size()))(std::uint16_t{0});
        EXPECT_TRUE(bytes == "PK\3\4" + common.get() + "a.hqf" + data + central.get() + "a.hqf" + end.get())
            << content.size();
        if (method == 0) {
            EXPECT_EQ(data, content);
        }
        EXPECT_TRUE(load(path).content == content) << content.size();
    }
}

TEST(zip_write, levels_choose_method_and_flags) {
    const struct {
        int level;
        std::uint16_t method, flags;
    } rows[] = {{-1, 8, 0}, {0, 0, 0}, {1, 8, 6},  {2, 8, 4},  {3, 8, 0},
                {8, 8, 2},  {9, 8, 2}, {10, 8, 0}, {-2, 8, 0}, {100, 8, 0}};
    const std::string text = sample_text(50000);
    std::size_t default_size = 0;
    for (const auto& row : rows) {
        CZipArchive zip;
        zip.Open(wide(path), CZipStorage::create);
        add(zip, L"a", text, row.level);
        EXPECT_EQ(zip.GetFileInfo(0)->GetMethod(), row.method) << row.level;
        EXPECT_EQ(zip.GetFileInfo(0)->GetFlags(), row.flags) << row.level;
        if (row.level == -1) default_size = zip.GetFileInfo(0)->GetCompressedSize();
        if (row.level < -1 || row.level > 9) {
            EXPECT_EQ(zip.GetFileInfo(0)->GetCompressedSize(), default_size) << "as the default: " << row.level;
        }
        zip.Close();
        EXPECT_TRUE(read_entry(0) == text) << row.level;
    }
}

TEST(zip_write, only_deflate_and_bzip2_can_be_chosen) {
    CZipArchive zip;
    for (const std::uint16_t method : std::initializer_list<std::uint16_t>{0, 1, 9, 14, 99})
        EXPECT_FALSE(zip.SetCompressionMethod(method)) << method;
    zip.Open(wide(path), CZipStorage::create);
    EXPECT_FALSE(zip.SetCompressionMethod(0));
    ASSERT_TRUE(zip.OpenNewFile(named(L"a")));
    EXPECT_EQ(zip.GetFileInfo(0)->GetMethod(), 8) << "the refused method changes nothing";
    EXPECT_FALSE(zip.SetCompressionMethod(8)) << "an entry is being written";
    EXPECT_FALSE(zip.OpenNewFile(named(L"b"))) << "one entry at a time";
    EXPECT_FALSE(zip.OpenFile(0));
    EXPECT_TRUE(zip.CloseNewFile());
    EXPECT_TRUE(zip.SetCompressionMethod(12));
    EXPECT_FALSE(zip.OpenNewFile(named(L"b"))) << "packing with bzip2 is not built";
    EXPECT_TRUE(zip.OpenNewFile(named(L"b"), 0)) << "but storing is";
    EXPECT_TRUE(zip.CloseNewFile());
    EXPECT_FALSE(zip.OpenNewFile(named(L"c"), 0, L"", 0)) << "no entry is replaced";
    EXPECT_FALSE(zip.OpenNewFile(named(L"c"), 0, wide(folder() / "none"))) << "no such file";
    EXPECT_FALSE(zip.AddNewFile(wide(folder() / "none")));
    zip.Close();
    EXPECT_EQ(read_entry(1), "");
}

TEST(zip_write, names_of_entries_come_from_the_path) {
    const auto dir = folder() / "names" / "sub";
    std::filesystem::create_directories(dir);
    put(dir / "file.hqf", "content");
    const std::wstring base = wide(dir);
    std::wstring full = base.substr(1);
    const struct {
        std::wstring path;
        bool full_path;
        std::wstring name;
        std::uint32_t external;
    } rows[] = {
        {base + L"/file.hqf", false, L"file.hqf", 0x81B40020},
        {base + L"/file.hqf", true, full + L"/file.hqf", 0x81B40020},
        {base, false, L"sub/", 0x41FD0010},
        {base + L"//", false, L"sub/", 0x41FD0010},
        {base + L"/", true, full + L"/", 0x41FD0010},
    };
    for (const auto& row : rows) {
        CZipArchive zip;
        zip.Open(wide(path), CZipStorage::create);
        ASSERT_TRUE(zip.AddNewFile(row.path, -1, row.full_path));
        const CZipFileHeader& header = *zip.GetFileInfo(0);
        EXPECT_EQ(header.GetStoredName(), std::filesystem::path(row.name).string());
        EXPECT_EQ(header.GetExternalAttr(), row.external);
        EXPECT_EQ(header.GetMethod(), row.external == 0x41FD0010 ? 0 : 8);
        EXPECT_EQ(header.GetVersionNeeded(), row.external == 0x41FD0010 ? 10 : 20);
        zip.Close();
    }
}

TEST(zip_write, fields_of_65536_bytes_are_refused_and_leave_no_entry) {
    const std::string bytes65532(65532, 'x');
    const struct {
        std::size_t name, comment, local, central;
        int cause;
    } rows[] = {{65535, 0, 0, 0, 0}, {65536, 0, 0, 0, 110}, {1, 65535, 0, 0, 0}, {1, 65536, 0, 0, 110},
                {1, 0, 65531, 0, 0}, {1, 0, 65532, 0, 110}, {1, 0, 0, 65531, 0}, {1, 0, 0, 65532, 110}};
    for (const auto& row : rows) {
        CZipFileHeader header = named(std::wstring(row.name, L'n'));
        header.SetComment(std::wstring(row.comment, L'c'));
        if (row.local != 0) header.GetLocalExtra().Add(1, bytes65532.data(), row.local);
        if (row.central != 0) header.GetCentralExtra().Add(1, bytes65532.data(), row.central);
        CZipArchive zip;
        zip.Open(wide(path), CZipStorage::create);
        EXPECT_EQ(cause_of([&] { zip.OpenNewFile(header, 0) && zip.CloseNewFile(); }), row.cause) << row.cause;
        zip.Close();
        ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openReadOnly));
        EXPECT_EQ(zip.GetCount(), row.cause == 0 ? 1U : 0U);
    }
}

TEST(zip_write, record_of_names_is_written_only_where_it_says_something) {
    const struct {
        std::uint32_t name_page, comment_page;
        bool in_extra;
        std::string record;
    } rows[] = {
        {1, 0, false, ""},
        {65001, 0, false, std::string("\1\1\xE9\xFD\0\0", 6)},
        {1, 65001, false, std::string("\1\4\xE9\xFD\0\0", 6)},
        {1, 0, true, std::string("\1\3\1\0\0\0\xC3\xA9", 8)},
        {65001, 65001, true, std::string("\1\7\xE9\xFD\0\0\xC3\xA9\xE9\xFD\0\0", 12)},
    };
    for (const auto& row : rows) {
        CZipFileHeader header = named(L"\u00E9");
        header.SetNameCodePage(row.name_page);
        header.SetCommentCodePage(row.comment_page);
        header.SetNameInExtra(row.in_extra);
        CZipArchive zip;
        zip.Open(wide(path), CZipStorage::create);
        ASSERT_TRUE(zip.OpenNewFile(header) && zip.CloseNewFile());
        zip.Close();
        zip.Open(wide(path), CZipStorage::openReadOnly);
        const CZipFileHeader& read = *zip.GetFileInfo(0);
        const CZipExtraData* const found = read.GetCentralExtra().Find(0x5A4C);
        EXPECT_EQ(found == nullptr ? "" : std::string(found->data.GetBuffer(), found->data.GetSize()), row.record);
        EXPECT_EQ(read.GetFileName(), L"\u00E9");
        EXPECT_EQ(read.GetNameCodePage(), row.name_page);
        EXPECT_EQ(read.GetCommentCodePage(), row.comment_page);
    }
}

TEST(zip_write, adds_behind_what_is_there) {
    // An existing archive with something in front of it and a comment, which both stay.
    put(path, "front" + build({entry("first", 8)}, "comment").bytes);
    const std::string before = get(path);
    CZipArchive zip;
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openExisting));
    zip.Close();
    EXPECT_EQ(get(path), before) << "nothing added, nothing written";
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openExisting));
    add(zip, L"b", "second");
    add(zip, L"c", "third", 0);
    zip.Close();
    EXPECT_EQ(get(path).substr(0, 5), "front");
    EXPECT_EQ(get(path).substr(get(path).size() - 7), "comment");
    EXPECT_EQ(read_entry(0) + read_entry(1) + read_entry(2), "firstsecondthird");

    // An archive behind a file that is none.
    put(path, "a program");
    EXPECT_EQ(cause_of([&] { zip.Open(wide(folder() / "none"), CZipStorage::append); }), ENOENT);
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::append));
    add(zip, L"a", "first");
    zip.Close();
    EXPECT_EQ(get(path).substr(0, 9), "a program");
    EXPECT_EQ(read_entry(0), "first");
}

TEST(zip_write, an_entry_takes_the_host_of_the_archive) {
    entry e("first", 0);
    e.made_by = 3 << 8 | 30;
    put(path, build({e}).bytes);
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::openExisting);
    CZipFileHeader header = named(L"b");
    header.SetSystemAttr(0x20);
    ASSERT_TRUE(zip.OpenNewFile(header) && zip.CloseNewFile());
    EXPECT_EQ(zip.GetFileInfo(1)->GetHost(), 3);
    EXPECT_EQ(zip.GetFileInfo(1)->GetExternalAttr(), 0x81B40000U);
}

TEST(zip_write, an_exception_leaves_no_directory_and_a_dropped_entry_no_trace) {
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::create);
    zip.OpenNewFile(named(L"a"));
    zip.WriteNewFile("abc", 3);
    zip.Close(CZipArchive::closeAfterException);
    zip.Close(CZipArchive::closeAfterException);
    EXPECT_EQ(load(path).cause, 118);
    {
        CZipArchive unclosed;
        unclosed.Open(wide(path), CZipStorage::create);
        add(unclosed, L"a", "abc");
    }
    EXPECT_EQ(load(path).cause, 118) << "a destructor writes nothing";
    zip.Open(wide(path), CZipStorage::create);
    add(zip, L"a", "kept");
    zip.OpenNewFile(named(L"b"));
    zip.WriteNewFile("dropped", 7);
    EXPECT_TRUE(zip.CloseNewFile(true));
    add(zip, L"c", "kept too");
    zip.Close();
    EXPECT_EQ(read_entry(0) + read_entry(1), "keptkept too");
}

TEST(zip_write, holds_65535_entries_and_no_more) {
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::create);
    CZipFileHeader header = named(L"n");
    header.SetTime(1714554000);
    for (int i = 0; i < 65535; ++i)
        ASSERT_TRUE(zip.OpenNewFile(header, 0) && zip.CloseNewFile()) << i;
    EXPECT_FALSE(zip.OpenNewFile(header, 0));
    zip.Close();
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openReadOnly)) << "a count of all ones without a ZIP64 locator";
    EXPECT_EQ(zip.GetCount(), 65535U);
    EXPECT_TRUE(zip.OpenFile(65534));
}

TEST(zip_write, time_without_a_source_is_now_and_close_can_stamp_the_file) {
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::create);
    CZipFileHeader old = named(L"old");
    old.SetTime(1000000000);
    ASSERT_TRUE(zip.OpenNewFile(old) && zip.CloseNewFile());
    EXPECT_EQ(zip.GetFileInfo(0)->GetTime(), 1000000000);
    zip.Close(CZipArchive::closeNormal, true);
    const auto stamp = std::filesystem::last_write_time(path);
    EXPECT_EQ(std::chrono::file_clock::to_sys(stamp).time_since_epoch(), std::chrono::seconds(1000000000));
    const std::time_t before = std::time(nullptr);
    zip.Open(wide(path), CZipStorage::create);
    ASSERT_TRUE(zip.OpenNewFile(named(L"now")));
    EXPECT_GE(zip.GetFileInfo(0)->GetTime(), before - 2);
}

TEST(zip_write, other_tools_open_what_is_written) {
    const std::string text = sample_text(300000);
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::create);
    add(zip, L"a.hqf", text);
    add(zip, L"dir\\stored", "stored", 0);
    CZipFileHeader dir = named(L"empty");
    dir.SetSystemAttr(0x10);
    ASSERT_TRUE(zip.OpenNewFile(dir) && zip.CloseNewFile());
    zip.Close();
    put(folder() / "expected", text);
    const std::string archive_path = path.string();
    const struct {
        const char* is_there;
        std::string command;
    } rows[] = {
        {"python3 -c pass",
         "python3 -c \"import sys,zipfile as z; a=z.ZipFile(sys.argv[1]); assert a.testzip() is None; "
         "assert a.namelist()==['a.hqf','dir/stored','empty/']; assert a.read('a.hqf')==open(sys.argv[2],'rb').read(); "
         "assert [i.compress_type for i in a.infolist()]==[8,0,0]; assert a.infolist()[2].is_dir()\" '" +
             archive_path + "' '" + (folder() / "expected").string() + "'"},
        {"unzip -v > /dev/null 2>&1", "unzip -tqq '" + archive_path + "'"},
    };
    for (const auto& row : rows)
        if (std::system(row.is_there) == 0) {
            EXPECT_EQ(std::system(row.command.c_str()), 0) << row.command;
        }
}
