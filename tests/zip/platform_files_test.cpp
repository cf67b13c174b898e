// What stands under the archive classes: code pages, attributes, path splitting, files over descriptors, buffers.

#include "archives.h"
#include "hqf/platform/file_access.h"

#include <gtest/gtest.h>

#include <cerrno>

using namespace zip_test;

TEST(platform_files, code_pages_keep_text_and_replace_what_is_none) {
    const std::wstring grin = {wchar_t(0xD83D), wchar_t(0xDE00)}, half = L"\uFFFD";
    const std::string utf8_grin = "\xF0\x9F\x98\x80", utf8_half = "\xEF\xBF\xBD";
    const std::tuple<std::wstring, std::string, std::wstring, std::uint32_t, const char*> rows[] = {
        // without a text: only the way from bytes
        {grin, utf8_grin, grin, 65001, "a pair"},
        {std::wstring(1, wchar_t(0x1F600)), utf8_grin, grin, 1, "one element above U+FFFF"},
        {wchar_t(0xD83D) + grin, utf8_half + utf8_grin, half + grin, 1, "half a pair before a pair"},
        {L"a\u00E9", "a?", L"a?", 1252, "a code page that is not known keeps ASCII"},
        {L"", "\x84x", half + L'x', 1, "a byte of another code page"},
        {L"", "\xC0\x80", half + half, 1, "overlong"},
        {L"", "\xED\xA0\x80", half + half + half, 1, "a surrogate"},
        {L"", "\xF4\x90\x80\x80", half + half + half + half, 1, "above U+10FFFF"},
        {L"", "\xE9", half, 850, "no ASCII"},
    };
    for (const auto& [text, bytes, back, code_page, why] : rows) {
        EXPECT_EQ(hqf::from_code_page(bytes, code_page), back) << why;
        EXPECT_TRUE(text.empty() || hqf::to_code_page(text, code_page) == bytes) << why;
    }
}

TEST(platform_files, path_component_splits) {
    const std::pair<const wchar_t*, const wchar_t*> rows[] = {
        // prefix, drive, directory, title, extension, file name
        {L"C:\\dir\\sub\\a.b.txt", L"|C:|dir\\sub|a.b|txt|a.b.txt"},
        {L"\\\\?\\UNC\\server\\share\\a", L"\\\\?\\UNC\\||server\\share|a||a"},
        {L"\\\\?\\c:\\a.x", L"\\\\?\\|c:||a|x|a.x"},
        {L"\\\\server\\a", L"\\\\||server|a||a"},
        {L"\\\\?\\un\\a", L"\\\\?\\||un|a||a"},
        {L"\\a", L"|||a||a"},
        {L"//x/y//.hid", L"||x/y||hid|.hid"},
        {L"d.d/name", L"||d.d|name||name"},
        {L"dir/", L"||dir|||"},
        {L"1:x", L"|||1:x||1:x"},
    };
    for (const auto& [path, expected] : rows) {
        const CZipPathComponent parts(path);
        EXPECT_EQ(parts.GetPrefix() + L'|' + parts.GetDrive() + L'|' + parts.GetDirectory() + L'|' + parts.GetTitle() +
                      L'|' + parts.GetExtension() + L'|' + parts.GetFileName(),
                  expected);
    }
}

TEST(zip_file, flags_decide_what_open_does) {
    using file = CZipFile;
    const unsigned int all = file::modeReadWrite | file::modeCreate;
    const std::tuple<bool, unsigned int, int, const char*, const char*> rows[] = {
        {false, file::modeRead, ENOENT, "", "reading makes nothing"},
        {false, file::modeReadWrite, ENOENT, "", "nor does writing without the flag"},
        {false, all, 0, "", "creates"},
        {true, all, 0, "", "empties"},
        {true, all | file::modeNoTruncate, 0, "old", "keeps"},
        {true, file::modeRead | file::modeCreate | file::shareDenyNone, 0, "old", "a read-only open never empties"},
        {true, file::modeWrite | file::shareDenyRead, 0, "", "write alone empties"},
    };
    for (const auto& [is_there, flags, cause, content, why] : rows) {
        const auto path = folder() / "flags";
        std::filesystem::remove(path);
        if (is_there) make_file(path, "old");
        CZipFile tested;
        EXPECT_EQ(cause_of([&, mode = flags] { tested.Open(wide(path), mode, true); }), cause) << why;
        EXPECT_EQ(tested.IsClosed(), cause != 0) << why;
        EXPECT_EQ(bytes_of(path), content) << why;
    }
}

TEST(zip_file, reads_writes_and_fails_by_errno) {
    const auto path = folder() / "file";
    CZipFile file(wide(path), 0x27);
    file.Write("0123456789", 10);
    EXPECT_EQ(file.GetPosition(), 10U);
    EXPECT_EQ(file.Seek(-3, SEEK_END), 7U);
    char bytes[8] = {};
    EXPECT_EQ(file.Read(bytes, 8), 3U) << "a short count at the end is the caller's";
    EXPECT_STREQ(bytes, "789");
    file.SeekToBegin();
    EXPECT_TRUE(file.GetLength() == 10 && file.GetPosition() == 0) << "the length is asked for without moving";
    file.SetLength(4);
    CZipFile second(wide(path), 0x45);
    EXPECT_FALSE(second.IsClosed()) << "sharing is advisory";
    EXPECT_EQ(cause_of([&] { second.Write("x", 1); }), EBADF);
    EXPECT_EQ(cause_of([&] { file.Seek(-1, SEEK_SET); }), EINVAL);
    EXPECT_EQ(cause_of([&] { file.Seek(0x80000000, SEEK_SET); }), EOVERFLOW);
    file.Seek(0x7FFFFFFF, SEEK_SET);
    EXPECT_EQ(cause_of([&] { file.Write("x", 1); }), EFBIG) << "would end at 2 GiB";
    file.Close();
    file.Close();
    EXPECT_EQ(cause_of([&] { file.Flush(); }), EBADF);
    EXPECT_EQ(bytes_of(path), "0123");
    EXPECT_EQ(cause_of([&] { file.Open(wide(folder()), 0x45, true); }), EISDIR);
    EXPECT_FALSE(file.Open(wide(folder()), 0x45, false));
    hqf::file_status status;
    EXPECT_FALSE(hqf::get_file_status(wide(path) + L"-none", status));
    EXPECT_FALSE(hqf::get_file_status(wide(path) + L'\0' + L"x", status)) << "a NUL must not name the file before it";
}

TEST(zip_auto_buffer, owns_copies_and_keeps_a_block_of_the_same_size) {
    CZipAutoBuffer buffer(4, true);
    char* const block = buffer.GetBuffer();
    EXPECT_EQ(std::string(block, 4), std::string(4, '\0'));
    block[0] = 'x';
    EXPECT_EQ(buffer.Allocate(4), block);
    const CZipAutoBuffer copy = buffer;
    EXPECT_EQ(buffer.Allocate(4, true)[0], '\0');
    EXPECT_EQ(copy.GetBuffer()[0], 'x') << "a copy has bytes of its own";
    EXPECT_TRUE(buffer.Allocate(0) == nullptr && buffer.GetSize() == 0);
}
