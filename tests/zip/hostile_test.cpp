// Archives that mean harm: records that lie, alone and together, cut and changed bytes, files of 2 GiB.

#include "archives.h"
#include "tests/support/documents.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <map>
#include <sstream>

using namespace zip_test;

namespace {

constexpr int any_failure = 1000000;
const std::string content = sample_text(700);

void set_field(std::string& bytes, std::size_t at, int width, std::uint64_t value) {
    for (int i = 0; i < width; ++i)
        bytes[at + static_cast<std::size_t>(i)] = static_cast<char>(value >> (8 * i));
}

/// Whatever was done to an archive: it loads as what it was, or it fails with a cause of the tables.
void expect_sound(const outcome& got, const std::string& what) {
    const int cause = got.cause;
    EXPECT_TRUE((cause >= 0 && cause <= 103) || cause == 112 || cause == 118 || cause == 120 ||
                (cause >= 500 && cause <= 507) || (cause >= 600 && cause <= 608) || cause == refused ||
                cause == no_entry)
        << what << " gives " << cause;
    EXPECT_TRUE(cause != 0 || got.content == content) << what << " loads as something else";
}

} // namespace

TEST(zip_hostile, each_field_wrong_alone) {
    const archive sound = build({entry(content, 8)});
    const std::map<std::string, std::size_t> records = {{"local", 0}, {"central", sound.central}, {"end", sound.end}};
    const std::map<std::string, std::size_t> bases = {
        {"", 0}, {"DIRECTORY", sound.central}, {"SIZE", sound.end - sound.central}};
    std::istringstream table(support::document("archives/fields.tsv"));
    int rows = 0;
    for (std::string row; std::getline(table, row);) {
        if (row[0] == '#') continue;
        ++rows;
        std::istringstream fields(row);
        std::string record, value, cause;
        std::size_t at = 0;
        int width = 0;
        fields >> record >> at >> width >> value >> cause;
        const std::size_t digits = std::min(value.find_first_of("+-0123456789"), value.size());
        const std::string offset = value.substr(digits);
        archive made = sound;
        set_field(made.bytes, records.at(record) + at, width,
                  bases.at(value.substr(0, digits)) + (offset.empty() ? 0 : std::stoull(offset, nullptr, 0)));
        const outcome got = load_bytes(made.bytes);
        EXPECT_TRUE(cause == "*" ? got.cause != 0 : std::to_string(got.cause) == cause) << row << ", got " << got.cause;
        expect_sound(got, row);
    }
    EXPECT_EQ(rows, 33);
}

TEST(zip_hostile, both_headers_lie_alike) {
    const auto lie = [](std::uint16_t method, auto change) {
        entry e(content, method);
        change(e);
        return build({e}).bytes;
    };
    std::vector<entry> twins = {entry(content, 8), entry("x", 0)};
    twins[1].shift = 0 - static_cast<std::uint32_t>(build({twins[0]}).central);
    const std::tuple<std::string, int, const char*> rows[] = {
        {lie(8, [](entry& e) { e.size += 1; }), 100, "deflate: one byte more"},
        {lie(8, [](entry& e) { e.size -= 1; }), 101, "deflate: one byte less"},
        {lie(8, [](entry& e) { e.size = 0; }), 101, "deflate: nothing"},
        {lie(8, [](entry& e) { e.size = e.packed_size * 1032; }), 100, "deflate: the most it could be"},
        {lie(8, [](entry& e) { e.size = e.packed_size * 1032 + 1; }), refused, "deflate: one more than that"},
        {lie(8, [](entry& e) { e.packed_size -= 1; }), any_failure, "deflate: packed data cut"},
        {lie(8, [](entry& e) { e.packed_size += 1, e.data += "x"; }), 0, "deflate: more than the stream takes"},
        {lie(8, [](entry& e) { e.packed_size += 6; }), 0, "deflate: packed data reach into the directory"},
        {lie(8, [](entry& e) { e.size = e.packed_size = 0, e.data = ""; }), 101, "deflate: no stream at all"},
        {lie(0, [](entry& e) { e.size += 1; }), refused, "stored: one byte more"},
        {lie(0, [](entry& e) { e.crc = crc_of(content.substr(0, --e.size)); }), 101, "stored: less, and it agrees"},
        {lie(0, [](entry& e) { e.packed_size = e.size = 0xFFFFFFFE; }), refused, "stored: 4 GB of it"},
        {lie(12, [](entry& e) { e.size += 1; }), 100, "bzip2: one byte more"},
        {lie(12, [](entry& e) { e.size = e.packed_size * 10000 + 1; }), refused, "bzip2: more than is believed"},
        {lie(12, [](entry& e) { e.packed_size -= 1; }), 101, "bzip2: packed data cut"},
        {lie(12, [](entry& e) { e.data[0] = 'x'; }), 604, "bzip2: no bzip2 (BZ_DATA_ERROR_MAGIC)"},
        {lie(8, [](entry& e) { e.flags = 1; }), 112, "encrypted"},
        {lie(99, [](entry& e) { e.flags = 1; }), 100, "AES: the method, which is not read, is looked at first"},
        {build({entry(content, 8)}, "c PK\5\6 and no record").bytes, 101, "a comment hides the end record"},
        {build({entry(content, 8)}, "PK\5\6 0123456789012345678901").bytes, 101, "and with bytes for a record"},
        {build(twins).bytes, 101, "two entries at one offset"},
    };
    for (const auto& [bytes, cause, why] : rows) {
        const outcome got = load_bytes(bytes);
        EXPECT_TRUE(cause == any_failure ? got.cause != 0 : got.cause == cause) << why << ", got " << got.cause;
        expect_sound(got, why);
    }
}

TEST(zip_hostile, all_ones_in_the_end_record_mean_zip64_behind_its_locator) {
    for (const auto& [at, width] : {std::pair{4, 2}, {6, 2}, {8, 2}, {10, 2}, {12, 4}, {16, 4}, {0, 0}}) {
        entry e(content, 8);
        e.comment = "PK\6\7";
        archive made = build({e});
        set_field(made.bytes, made.end + static_cast<std::size_t>(at), width, ~std::uint64_t{0});
        EXPECT_EQ(load_bytes(made.bytes).cause, width == 0 ? 0 : 120) << at;
    }
    archive empty = build({});
    set_field(empty.bytes, empty.end + 16, 4, 1);
    EXPECT_EQ(load_bytes(empty.bytes).cause, 101) << "an empty directory behind its end record";
}

TEST(zip_hostile, cut_anywhere) {
    for (const std::uint16_t method : std::initializer_list<std::uint16_t>{0, 8, 12}) {
        const archive made = build({entry(content, method)}, "comment");
        for (std::size_t size = 0; size < made.bytes.size(); ++size)
            EXPECT_EQ(load_bytes(made.bytes.substr(0, size)).cause, size < made.end + 4 ? 118 : 101)
                << "method " << method << ", first " << size << " bytes";
    }
}

TEST(zip_hostile, every_byte_changed) {
    entry described(content, 8), extra(content, 8);
    described.flags = 8;
    described.behind_data = std::string(16, 'd');
    extra.extra = extra.local_extra = std::string("\x4C\x5A\x0B\0\1\7\1\0\0\0n\1\0\0\0", 15);
    for (const std::string& bytes :
         {build({entry(content, 0)}).bytes, build({entry(content, 8)}).bytes, build({entry(content, 12)}).bytes,
          build({described}).bytes, build({extra, entry(content, 0)}, "comment").bytes}) {
        ASSERT_EQ(load_bytes(bytes).cause, 0);
        for (std::size_t at = 0; at < bytes.size(); ++at)
            for (int change : {0x01, 0x80, 0xFF, 0x08}) {
                std::string changed = bytes;
                changed[at] = static_cast<char>(changed[at] ^ change);
                expect_sound(load_bytes(changed), "byte " + std::to_string(at) + " ^ " + std::to_string(change));
            }
    }
}

TEST(zip_hostile, archives_of_2_gib) {
    const auto path = folder() / "large.zip";
    make_file(path, "");
    for (const auto& [size, cause] : {std::pair{0x7FFFFFFFU, 118}, {0x80000000U, EOVERFLOW}}) {
        std::filesystem::resize_file(path, size);
        EXPECT_EQ(load(path).cause, cause) << size;
    }
    // A write that would carry the file there is refused before anything wraps, and the entry is gone with it.
    std::filesystem::resize_file(path, 0x7FFFFFFF - 100);
    const std::string large(300000, 'x');
    CZipArchive zip;
    ASSERT_TRUE(zip.Open(wide(path), CZipStorage::append));
    CZipFileHeader header;
    header.SetFileName(L"a");
    ASSERT_TRUE(zip.OpenNewFile(header, 0));
    EXPECT_EQ(cause_of([&] { zip.WriteNewFile(large.data(), static_cast<unsigned int>(large.size())); }), EFBIG);
    EXPECT_FALSE(zip.CloseNewFile());
    EXPECT_EQ(zip.GetCount(), 0U);
    zip.Close(CZipArchive::closeAfterException);
    std::filesystem::remove(path);
}
