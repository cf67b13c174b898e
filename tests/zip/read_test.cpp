#include "archives.h"

#include <gtest/gtest.h>

using namespace zip_test;

TEST(zip_read, every_method_in_pieces_of_every_size) {
    const std::string contents[] = {"", "x", sample_text(300000), std::string(400000, 'z')};
    for (const std::string& content : contents)
        for (const std::uint16_t method : std::initializer_list<std::uint16_t>{0, 8, 12})
            for (unsigned int piece : {1U, 7U, 4096U, 131072U, 0xFFFFFFFFU}) {
                if (piece == 1 && content.size() > 300000) continue;
                const outcome got = load_bytes(build({entry(content, method)}).bytes, piece);
                EXPECT_EQ(got.cause, 0) << content.size() << " bytes, method " << method << ", pieces of " << piece;
                EXPECT_TRUE(got.content == content) << content.size() << " bytes, method " << method;
            }
}

TEST(zip_read, input_larger_than_the_working_buffer) {
    // Packed data longer than one piece of 131,072 bytes, also where a piece ends just before the end of the stream.
    std::string noise(140000, '\0');
    std::uint32_t state = 1;
    for (char& byte : noise)
        byte = static_cast<char>((state = state * 1664525 + 1013904223) >> 24);
    for (std::size_t size = 131072 - 60; size < 131072 + 4; ++size) {
        const outcome got = load_bytes(build({entry(noise.substr(0, size), 8)}).bytes);
        EXPECT_EQ(got.cause, 0) << size;
        EXPECT_TRUE(got.content == noise.substr(0, size)) << size;
    }
    EXPECT_EQ(load_bytes(build({entry(noise, 12)}).bytes).cause, 0);
    EXPECT_EQ(load_bytes(build({entry(noise, 0)}).bytes).cause, 0);
}

TEST(zip_read, archive_with_company) {
    const std::string text = sample_text(2000);
    entry with_descriptor(text, 8);
    with_descriptor.flags = 8;
    with_descriptor.behind_data = "PK\7\b" + std::string(12, 'x');
    entry other("other", 0);
    const auto prefixed = [&](std::size_t count) {
        archive made = build({entry(text, 8)});
        return std::string(count, 'p') + made.bytes;
    };
    const struct {
        std::string bytes;
        int cause;
        const char* why;
    } rows[] = {
        {prefixed(1), 0, "one byte in front"},
        {prefixed(100000), 0, "more in front than the search looks at"},
        {prefixed(3) + "", 0, "in front, odd"},
        {build({entry(text, 8)}, std::string(65535, 'c')).bytes, 0, "the longest comment"},
        {build({entry(text, 8)}, std::string(65535, 'c')).bytes + "j", 118, "and one byte behind it"},
        {build({entry(text, 8)}).bytes + "junk", 0, "bytes behind the end record"},
        {build({entry(text, 8)}, "c PK\5\6 and no record").bytes, 101, "a comment hides the end record"},
        {build({entry(text, 8)}, "PK\5\6 0123456789012345678901").bytes, 101, "and with bytes enough for a record"},
        {build({entry(text, 8), other}, "", true).bytes, 0, "directory in reverse order"},
        {build({with_descriptor, other}).bytes, 0, "data descriptor"},
        {build({}).bytes, no_entry, "no entry"},
        {"", 118, "nothing"},
        {std::string(32768 - 2, 'p') + build({}).bytes, no_entry, "a signature across the first chunk's border"},
        {build({}, std::string(32768 - 20, 'c')).bytes, no_entry, "a signature across a chunk's border"},
    };
    for (const auto& row : rows) {
        const outcome got = load_bytes(row.bytes);
        EXPECT_EQ(got.cause, row.cause) << row.why;
        EXPECT_TRUE(got.content == (row.cause == 0 ? text : "")) << row.why;
    }
}

TEST(zip_storage, locates_the_last_signature) {
    const std::string sign = "PK\5\6";
    const struct {
        std::string bytes;
        std::uint32_t depth;
        std::int64_t position;
        const char* why;
    } rows[] = {
        {sign, 100, 0, "alone"},
        {sign + sign + "x", 100, 4, "the last one"},
        {"xx" + sign + "yyy", 7, 2, "just within the depth"},
        {"xx" + sign + "yyy", 6, -1, "its first byte beyond the depth"},
        {"PPK\5\6K\5\6", 100, 1, "a partial match before it in the search"},
        {"PK\5\6\6", 100, 0, "the byte that breaks a match begins the next"},
        {"K\5\6", 100, -1, "a partial match at the beginning"},
        {"", 100, -1, "nothing"},
        {std::string(9, 'x') + sign + std::string(32768 - 1, 'y'), 0xFFFFFFFF, 9, "one byte in the second chunk"},
        {std::string(9, 'x') + sign + std::string(32768 - 2, 'y'), 0xFFFFFFFF, 9, "half and half"},
        {std::string(9, 'x') + sign + std::string(32768 - 3, 'y'), 0xFFFFFFFF, 9, "one byte in the first chunk"},
    };
    for (const auto& row : rows) {
        put(folder() / "located", row.bytes);
        CZipStorage storage;
        ASSERT_TRUE(storage.Open(wide(folder() / "located"), CZipStorage::openReadOnly));
        EXPECT_EQ(storage.LocateSignature(0x06054B50, row.depth), row.position) << row.why;
        storage.Close();
    }
}

TEST(zip_read, misuse_is_told_by_results) {
    const auto path = folder() / "misuse.zip";
    put(path, build({entry("abcdefgh", 0), entry("second", 8)}).bytes);
    CZipArchive zip;
    char bytes[8];
    EXPECT_TRUE(zip.IsClosed());
    EXPECT_EQ(zip.GetFileInfo(0), nullptr);
    EXPECT_FALSE(zip.OpenFile(0));
    EXPECT_EQ(zip.ReadFile(bytes, 1), 0U);
    EXPECT_EQ(zip.CloseFile(), 0);
    zip.Close();
    zip.Close(CZipArchive::closeAfterException);
    EXPECT_FALSE(zip.Open(wide(path), 3)) << "no such mode";
    EXPECT_FALSE(zip.Open(wide(path), 2, 1000)) << "no volumes";
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::openReadOnly));
    EXPECT_FALSE(zip.Open(wide(path), CZipStorage::openReadOnly)) << "already open";
    EXPECT_FALSE(zip.OpenFile(2));
    EXPECT_FALSE(zip.OpenFile(0xFFFFFFFF));
    EXPECT_EQ(zip.GetFileInfo(2), nullptr);
    EXPECT_FALSE(zip.is_size_credible(2));
    EXPECT_FALSE(zip.OpenNewFile(CZipFileHeader())) << "opened for reading";
    EXPECT_FALSE(zip.AddNewFile(wide(path)));
    EXPECT_FALSE(zip.WriteNewFile("x", 1));
    EXPECT_FALSE(zip.CloseNewFile());
    ASSERT_TRUE(zip.OpenFile(0));
    EXPECT_FALSE(zip.OpenFile(1)) << "one entry at a time";
    EXPECT_EQ(zip.ReadFile(nullptr, 4), 0U);
    EXPECT_EQ(zip.ReadFile(bytes, 0), 0U);
    EXPECT_EQ(zip.ReadFile(bytes, 4), 4U);
    EXPECT_EQ(zip.CloseFile(), -1) << "data left unread";
    ASSERT_TRUE(zip.OpenFile(1));
    EXPECT_EQ(zip.ReadFile(bytes, 8), 6U);
    EXPECT_EQ(zip.CloseFile(wide(folder() / "none")), -2) << "no file to give the time to";
    EXPECT_EQ(zip.CreateCompressor(9), nullptr);
    EXPECT_EQ(zip.CreateCryptograph(0), nullptr);
    CZipCompressor* const kept = zip.CreateCompressor(8);
    EXPECT_EQ(zip.CreateCompressor(0), kept) << "deflate processes both";
    ASSERT_TRUE(zip.OpenFile(0));
    zip.Close();
    EXPECT_TRUE(zip.IsClosed());
    EXPECT_EQ(zip.GetCount(), 0U);
    EXPECT_EQ(cause_of([&] { zip.Open(wide(folder() / "none" / "a"), 2); }), ENOENT);
    EXPECT_TRUE(zip.IsClosed());
}

TEST(zip_read, close_file_hands_time_and_attributes_to_a_file) {
    entry e("abc", 0);
    e.external = 0x01;
    put(folder() / "given.zip", build({e}).bytes);
    const auto path = folder() / "unpacked";
    put(path, "abc");
    CZipArchive zip;
    zip.Open(wide(folder() / "given.zip"), CZipStorage::openReadOnly);
    char bytes[3];
    ASSERT_TRUE(zip.OpenFile(0));
    zip.ReadFile(bytes, 3);
    EXPECT_EQ(zip.CloseFile(wide(path)), 1);
    CZipFileHeader header;
    header.SetTime(std::chrono::duration_cast<std::chrono::seconds>(
                       std::chrono::file_clock::to_sys(std::filesystem::last_write_time(path)).time_since_epoch())
                       .count());
    EXPECT_EQ(header.GetDosDate(), 0x58A1);
    EXPECT_EQ(header.GetDosTime(), 0x4800);
    EXPECT_EQ(std::filesystem::status(path).permissions() & std::filesystem::perms::owner_write,
              std::filesystem::perms::none);
}

TEST(zip_read, exhaustive_goes_past_the_count) {
    archive made = build({entry("1", 0), entry("2", 0), entry("3", 0)});
    made.bytes[made.end + 10] = 1;
    put(folder() / "many.zip", made.bytes);
    for (bool exhaustive : {false, true}) {
        CZipArchive zip;
        zip.SetExhaustiveRead(exhaustive);
        zip.Open(wide(folder() / "many.zip"), CZipStorage::openReadOnly);
        EXPECT_EQ(zip.GetCount(), exhaustive ? 3U : 1U);
    }
}

TEST(zip_read, consistency_flags_switch_single_checks_off) {
    enum what { method, sizes, crc, flags, content, descriptor };
    const struct {
        what broken;
        std::uint32_t off;
        int cause;
    } rows[] = {
        {method, 0x100, 101},  {method, 0x02, 0},  {sizes, 0x100, 101},  {sizes, 0x04, 0},       {sizes, 0x08, 0},
        {crc, 0x04, 0},        {crc, 0x08, 0},     {crc, 0x01, 101},     {flags, 0x100, 101},    {flags, 0x10, 0},
        {content, 0x100, 102}, {content, 0x01, 0}, {descriptor, 0, 101}, {descriptor, 0x100, 0},
    };
    for (const auto& row : rows) {
        entry e("content", 0);
        if (row.broken == content) e.crc ^= 1;
        if (row.broken == descriptor) e.flags = 8, e.behind_data = std::string(12, 'x');
        archive made = build({e});
        if (row.broken == method) made.bytes[8] = 8;
        if (row.broken == sizes) made.bytes[22] ^= 1;
        if (row.broken == crc) made.bytes[14] ^= 1;
        if (row.broken == flags) made.bytes[6] ^= 2;
        put(folder() / "flags.zip", made.bytes);
        CZipArchive zip;
        zip.SetConsistencyFlags(row.off);
        zip.Open(wide(folder() / "flags.zip"), CZipStorage::openReadOnly);
        char bytes[8];
        EXPECT_EQ(cause_of([&] {
                      zip.OpenFile(0);
                      zip.ReadFile(bytes, 8);
                      EXPECT_EQ(zip.CloseFile(), 1);
                  }),
                  row.cause)
            << row.broken << " with " << row.off;
    }
}

TEST(zip_read, descriptor_may_have_a_signature) {
    for (const char* signature : {"", "PK\7\b"}) {
        entry e("content", 8);
        e.flags = 8;
        e.behind_data = signature + hqf::field_writer()(e.crc)(e.packed_size)(e.size).get();
        put(folder() / "descriptor.zip", build({e}).bytes);
        CZipArchive zip;
        zip.SetConsistencyFlags(0);
        zip.Open(wide(folder() / "descriptor.zip"), CZipStorage::openReadOnly);
        char bytes[8];
        ASSERT_TRUE(zip.OpenFile(0));
        zip.ReadFile(bytes, 8);
        EXPECT_EQ(zip.CloseFile(), 1) << signature;
    }
}

TEST(zip_read, options_reach_the_compressor) {
    const std::string text = sample_text(5000);
    entry e(text, 8);
    e.size = 4000; // the stream goes on
    e.crc = crc_of(text.substr(0, 4000));
    put(folder() / "options.zip", build({e}).bytes);
    for (bool checks : {true, false}) {
        ZipArchiveLib::CDeflateCompressor::COptions options;
        options.check_last_block = checks;
        options.buffer_size = 1;
        options.detect_leaks = checks;
        CZipArchive zip;
        zip.SetCompressionOptions(8, options);
        zip.Open(wide(folder() / "options.zip"), CZipStorage::openReadOnly);
        ASSERT_TRUE(zip.OpenFile(0));
        std::string got(5000, '\0');
        EXPECT_EQ(cause_of([&] { EXPECT_EQ(zip.ReadFile(got.data(), 5000), 4000U); }), checks ? 101 : 0);
        EXPECT_EQ(got.substr(0, 4000), text.substr(0, 4000));
        EXPECT_EQ(zip.CloseFile(), 1) << "nothing is left unread";
    }
}

TEST(zip_read, code_page_setting_wins_unless_it_is_the_default) {
    for (const std::uint16_t host : std::initializer_list<std::uint16_t>{0, 3}) {
        entry e("x", 0);
        e.made_by = static_cast<std::uint16_t>(46 | host << 8);
        put(folder() / "page.zip", build({e}).bytes);
        for (std::uint32_t setting : {1U, 850U}) {
            CZipArchive zip;
            zip.SetNameCodePage(setting);
            zip.Open(wide(folder() / "page.zip"), CZipStorage::openReadOnly);
            EXPECT_EQ(zip.GetFileInfo(0)->GetNameCodePage(), setting == 850 ? 850U : host == 0 ? 1U : 0U) << host;
        }
    }
}
