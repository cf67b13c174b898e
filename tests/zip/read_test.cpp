// Archives that are sound, if not like our own, and the switches of a reader.

#include "archives.h"
#include "hqf/platform/file_access.h"

#include <gtest/gtest.h>

using namespace zip_test;

namespace {

const auto path = folder() / "read.zip";

/// Opens, reads and closes the first entry with `zip` as it is set; the cause, or 0 when all was well.
int read_with(CZipArchive& zip, const std::string& bytes) {
    make_file(path, bytes);
    zip.Open(wide(path), CZipStorage::openReadOnly);
    return cause_of([&] {
        std::string content(zip.GetFileInfo(0)->GetUncompressedSize(), '\0');
        zip.OpenFile(0);
        zip.ReadFile(content.data(), static_cast<unsigned int>(content.size()));
        EXPECT_EQ(zip.CloseFile(), 1);
    });
}

} // namespace

TEST(zip_read, every_method_in_pieces_of_every_size) {
    std::string noise(140000, '\0');
    std::uint32_t state = 1;
    for (char& byte : noise)
        byte = static_cast<char>((state = state * 1664525 + 1013904223) >> 24);
    const auto expect_loads = [](const std::string& content, std::uint16_t method, unsigned int piece) {
        const outcome got = load_bytes(build({entry(content, method)}).bytes, piece);
        EXPECT_TRUE(got.cause == 0 && got.content == content)
            << content.size() << " bytes, method " << method << ", pieces of " << piece << ": " << got.cause;
    };
    for (const std::string& content : {std::string(), std::string("x"), sample_text(300000), noise})
        for (const std::uint16_t method : std::initializer_list<std::uint16_t>{0, 8, 12})
            for (unsigned int piece : {1U, 4096U, 131072U, 0xFFFFFFFFU})
                expect_loads(content, method, piece);
    // Packed data of about one piece of 131,072 bytes: it may end just before, at and behind the end of the stream.
    for (std::size_t size = 131072 - 60; size < 131072 + 4; ++size)
        expect_loads(noise.substr(0, size), 8, 0xFFFFFFFF);
}

TEST(zip_storage, locates_the_last_signature) {
    const std::string sign = "PK\5\6", behind_nine = "xxxxxxxxx" + sign;
    const std::tuple<std::string, std::uint32_t, std::int64_t, const char*> rows[] = {
        {sign + sign + "x", 100, 4, "the last one"},
        {"xx" + sign + "yyy", 7, 2, "just within the depth"},
        {"xx" + sign + "yyy", 6, -1, "its first byte beyond the depth"},
        {"PPK\5\6K\5\6", 100, 1, "a partial match before it in the search"},
        {"PK\5\6\6", 100, 0, "the byte that breaks a match begins the next"},
        {"K\5\6", 100, -1, "a partial match at the beginning"},
        {"", 100, -1, "nothing"},
        {behind_nine + std::string(32768 - 1, 'y'), 0xFFFFFFFF, 9, "one byte in the second chunk"},
        {behind_nine + std::string(32768 - 2, 'y'), 0xFFFFFFFF, 9, "half and half"},
        {behind_nine + std::string(32768 - 3, 'y'), 0xFFFFFFFF, 9, "one byte in the first chunk"},
    };
    for (const auto& [bytes, depth, position, why] : rows) {
        make_file(path, bytes);
        CZipStorage storage;
        ASSERT_TRUE(storage.Open(wide(path), CZipStorage::openReadOnly));
        EXPECT_EQ(storage.LocateSignature(0x06054B50, depth), position) << why;
    }
}

TEST(zip_read, misuse_is_told_by_results) {
    make_file(path, build({entry("abcdefgh", 0), entry("second", 8)}).bytes);
    CZipArchive zip;
    char bytes[8];
    EXPECT_FALSE(zip.GetFileInfo(0) || zip.OpenFile(0) || zip.ReadFile(bytes, 1) || zip.CloseFile()) << "not open";
    zip.Close();
    EXPECT_FALSE(zip.Open(wide(path), 3)) << "no such mode";
    EXPECT_FALSE(zip.Open(wide(path), 2, 1000)) << "no volumes";
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openReadOnly));
    EXPECT_FALSE(zip.Open(wide(path), CZipStorage::openReadOnly)) << "already open";
    EXPECT_FALSE(zip.OpenFile(2) || zip.GetFileInfo(2) || zip.is_size_credible(2)) << "two entries";
    EXPECT_FALSE(zip.OpenNewFile(CZipFileHeader()) || zip.WriteNewFile("x", 1) || zip.CloseNewFile())
        << "opened for reading";
    ASSERT_TRUE(zip.OpenFile(0));
    EXPECT_FALSE(zip.OpenFile(1)) << "one entry at a time";
    EXPECT_EQ(zip.ReadFile(nullptr, 4) + zip.ReadFile(bytes, 0), 0U);
    EXPECT_EQ(zip.ReadFile(bytes, 4), 4U);
    EXPECT_EQ(zip.CloseFile(), -1) << "data left unread";
    ASSERT_TRUE(zip.OpenFile(1));
    EXPECT_EQ(zip.ReadFile(bytes, 8), 6U);
    EXPECT_EQ(zip.CloseFile(wide(folder() / "none")), -2) << "no file to give the time to";
    EXPECT_EQ(zip.CreateCompressor(9), nullptr);
    CZipCompressor* const kept = zip.CreateCompressor(8);
    EXPECT_EQ(zip.CreateCompressor(0), kept) << "deflate processes both";
    ASSERT_TRUE(zip.OpenFile(0));
    zip.Close();
    EXPECT_TRUE(zip.IsClosed() && zip.GetCount() == 0) << "an open entry is no obstacle";
}

TEST(zip_read, close_file_hands_time_and_attributes_to_a_file) {
    entry e("abc", 0);
    e.external = 0x01;
    make_file(path, build({e}).bytes);
    make_file(folder() / "unpacked", "abc");
    CZipArchive zip;
    zip.Open(wide(path), CZipStorage::openReadOnly);
    char bytes[3];
    ASSERT_TRUE(zip.OpenFile(0) && zip.ReadFile(bytes, 3) == 3);
    EXPECT_EQ(zip.CloseFile(wide(folder() / "unpacked")), 1);
    hqf::file_status status;
    ASSERT_TRUE(hqf::get_file_status(wide(folder() / "unpacked"), status));
    EXPECT_TRUE(status.modified == zip.GetFileInfo(0)->GetTime() && status.attributes == 0x21);
    ASSERT_TRUE(hqf::set_file_attributes(wide(folder() / "unpacked"), 0));
    ASSERT_TRUE(hqf::get_file_status(wide(folder() / "unpacked"), status));
    EXPECT_EQ(status.attributes, 0x20U) << "writable again";
}

TEST(zip_read, exhaustive_goes_past_the_count) {
    archive made = build({entry("1", 0), entry("2", 0), entry("3", 0)});
    made.bytes[made.end + 10] = 1;
    for (bool exhaustive : {false, true}) {
        CZipArchive zip;
        zip.SetExhaustiveRead(exhaustive);
        EXPECT_EQ(read_with(zip, made.bytes), 0);
        EXPECT_EQ(zip.GetCount(), exhaustive ? 3U : 1U);
    }
}

TEST(zip_read, consistency_flags_switch_single_checks_off) {
    enum what : std::size_t { flags = 6, method = 8, crc = 14, sizes = 22, content = 100, descriptor };
    const std::tuple<what, std::uint32_t, int> rows[] = {
        {method, 0x100, 101}, {method, 0x02, 0},    {sizes, 0x100, 101},   {sizes, 0x04, 0}, {sizes, 0x08, 0},
        {crc, 0x04, 0},       {crc, 0x01, 101},     {flags, 0x100, 101},   {flags, 0x10, 0}, {content, 0x100, 102},
        {content, 0x01, 0},   {descriptor, 0, 101}, {descriptor, 0x100, 0}};
    for (const auto& [broken, off, cause] : rows) {
        entry e("content", 0);
        if (broken == content) e.crc ^= 1;
        if (broken == descriptor) e.flags = 8, e.behind_data = std::string(12, 'x');
        archive made = build({e});
        if (broken < content) made.bytes[broken] ^= broken == method ? 8 : broken == flags ? 2 : 1;
        CZipArchive zip;
        zip.SetConsistencyFlags(off);
        EXPECT_EQ(read_with(zip, made.bytes), cause) << broken << " with " << off;
    }
    for (const std::string signature : {"", "PK\7\b"})
        for (const int wrong : {0, 1, 2, 3}) { // none, or one field of the descriptor
            entry e("content", 8);
            e.flags = 8;
            hqf::field_writer descriptor;
            descriptor(e.crc + (wrong == 1))(e.packed_size + (wrong == 2))(e.size + (wrong == 3));
            e.behind_data = signature + descriptor.get();
            CZipArchive zip;
            zip.SetConsistencyFlags(0);
            EXPECT_EQ(read_with(zip, build({e}).bytes), wrong == 0 ? 0 : 101) << wrong << signature;
        }
}

TEST(zip_read, one_zero_byte_is_made_up_behind_a_deflated_stream) {
    // A NUL, deflated, is 63 00 00; with one byte alone the text is there, but no end.
    for (const auto& [packed_size, cause] : {std::pair{3U, 0}, {2U, 0}, {1U, 101}}) {
        entry e(std::string(1, '\0'), 8);
        e.data.resize(e.packed_size = packed_size);
        EXPECT_EQ(load_bytes(build({e}).bytes).cause, cause) << packed_size;
    }
}

TEST(zip_read, options_reach_the_compressor) {
    const std::string text = sample_text(5000);
    entry e(text, 8);
    e.size = 4000; // the stream goes on
    e.crc = crc_of(text.substr(0, 4000));
    for (bool checks : {true, false}) {
        ZipArchiveLib::CDeflateCompressor::COptions options;
        options.check_last_block = options.detect_leaks = checks;
        options.buffer_size = 1;
        CZipArchive zip;
        zip.SetCompressionOptions(8, options);
        EXPECT_EQ(read_with(zip, build({e}).bytes), checks ? 101 : 0);
    }
}

TEST(zip_read, code_page_setting_wins_unless_it_is_the_default) {
    for (const auto& [host, setting, code_page] :
         {std::tuple{0, 1U, 1U}, {0, 850U, 850U}, {3, 1U, 0U}, {3, 850U, 850U}}) {
        entry e("x", 0);
        e.made_by = static_cast<std::uint16_t>(46 | host << 8);
        CZipArchive zip;
        zip.SetNameCodePage(setting);
        EXPECT_EQ(read_with(zip, build({e}).bytes), 0);
        EXPECT_EQ(zip.GetFileInfo(0)->GetNameCodePage(), code_page) << host;
    }
}
