// Documents in archives: which archives load, how a written one looks byte by byte, which files come and go, and what
// other programs make of ours.

#include <gtest/gtest.h>

#include <cerrno>
#include <cstdlib>
#include <ctime>
#include <iostream>
#include <set>
#include <sstream>

#include "tests/document/support.h"
#include "tests/support/documents.h"
#include "tests/zip/archives.h"

namespace {

using document_test::bytes_of, document_test::make_file, document_test::wide, document_test::written;
using zip_test::archive, zip_test::build, zip_test::entry;

const std::string chart = support::document("documents/rendition-chart.hqf");

/// "0" and other codes as they are, an exception as "cause 118".
template<class Operation>
std::string outcome_of(const std::filesystem::path& path, Operation operation) {
    try {
        return std::to_string(operation(wide(path)));
    } catch (const CZipException& e) {
        EXPECT_EQ(e.GetFileName(), wide(path));
        return "cause " + std::to_string(e.GetCause());
    }
}

std::string loading(hqf_v2::Hqf& document, const std::filesystem::path& path) {
    return outcome_of(path, [&](const std::wstring& name) { return document.loadFile(name); });
}

std::string writing(hqf_v2::Hqf& document, const std::filesystem::path& path) {
    return outcome_of(path, [&](const std::wstring& name) { return document.writeFile(name); });
}

TEST(archives, samples_load_or_fail_as_their_table_says) {
    const auto data = std::filesystem::path(HQF_TEST_DATA) / "archives";
    std::istringstream table(support::document("archives/expected.tsv"));
    std::set<std::string> listed;
    std::string row, name, code;
    std::getline(table, row);
    while (std::getline(table, row)) {
        std::istringstream fields(row);
        std::getline(std::getline(fields, name, '\t'), code, '\t');
        listed.insert(name);
        hqf_v2::Hqf document;
        EXPECT_EQ(loading(document, data / name), code) << row;
        EXPECT_EQ(written(document) == chart, code == "0") << row;
    }
    for (const auto& file : std::filesystem::directory_iterator(data))
        EXPECT_EQ(file.path().extension() == ".hqfz", listed.count(file.path().filename().string()) != 0) << file;
}

TEST(archives, what_stands_around_and_in_the_entry) {
    const support::folder place;
    const auto sound = [](const std::string& comment = "") { return build({entry(chart, 8)}, comment).bytes; };
    const auto named = [](const std::string& content, const std::string& entry_name) {
        entry made(content, 8);
        made.name = entry_name;
        return made;
    };
    entry claiming_nothing(chart, 8);
    claiming_nothing.size = claiming_nothing.crc = 0;
    const struct {
        std::string bytes;
        const char *outcome, *why;
    } rows[] = {
        {sound(std::string(65535, 'c')), "0", "the longest comment"},
        {sound(std::string(65535, 'c')) + "j", "cause 118", "and one byte of junk: beyond the search"},
        {sound() + std::string(65535, 'j'), "0", "junk, as far as the search goes"},
        {sound() + std::string(65536, 'j'), "cause 118", "one byte more"},
        {std::string(100000, 'f') + sound(), "0", "bytes in front"},
        {build({entry(chart, 0)}).bytes, "0", "stored"},
        {build({named(chart, ""), named("no XML", "a.hqf")}).bytes, "0", "a first entry without a name"},
        {build({named(chart, "b.txt"), named("no XML", "a.hqf")}, "", true).bytes, "0", "the directory in reverse"},
        {build({named("no XML", "b"), named(chart, "a.hqf")}).bytes, "34", "the first entry is no XML"},
        {build({entry("", 8)}).bytes, "34", "an empty entry"},
        {build({claiming_nothing}).bytes, "1000", "an entry that claims to be empty and isn't"},
        {chart, "cause 118", "a plain document of that name"},
        {"", "cause 118", "an empty file"},
    };
    for (const auto& row : rows) {
        make_file(place / "a.hqfz", row.bytes);
        hqf_v2::Hqf document;
        EXPECT_EQ(loading(document, place / "a.hqfz"), row.outcome) << row.why;
        EXPECT_EQ(written(document) == chart, row.outcome == std::string("0")) << row.why;
    }
}

/// The archive that `writeFile` has to make of a plain file, at the time that the found one tells.
archive expected_archive(const std::string& plain, const std::string& found, std::time_t& time) {
    entry made(plain, 8);
    made.time = hqf::read_little_endian<std::uint16_t>(&found[10]);
    made.date = hqf::read_little_endian<std::uint16_t>(&found[12]);
    std::tm local{};
    local.tm_year = (made.date >> 9) + 80, local.tm_mon = (made.date >> 5 & 15) - 1, local.tm_mday = made.date & 31;
    local.tm_hour = made.time >> 11, local.tm_min = made.time >> 5 & 63, local.tm_sec = (made.time & 31) * 2;
    local.tm_isdst = -1;
    time = std::mktime(&local);
    return build({made});
}

TEST(archives, written_byte_for_byte_and_nothing_beside) {
    const support::folder place;
    hqf_v2::Hqf document;
    ASSERT_EQ(document.unmarshal(chart), 0);
    ASSERT_EQ(writing(document, place / "plain.hqf"), "0");
    const std::string plain = bytes_of(place / "plain.hqf");
    ASSERT_GT(plain.size(), 131072u) << "longer than the buffer of a compressor";
    for (const char* before : {"nothing", "files of both names"}) {
        if (*before == 'f') {
            make_file(place / "a.hqf", "old");
            make_file(place / "a.hqfz", std::string(1000000, 'o'));
        }
        const std::time_t start = std::time(nullptr);
        EXPECT_EQ(writing(document, place / "a.hqfz"), "0") << before;
        EXPECT_EQ(place.size(), 2u) << before << ": the archive and the plain file of another name";
        const std::string found = bytes_of(place / "a.hqfz");
        ASSERT_GT(found.size(), 30u);
        std::time_t time = 0;
        const std::string expected = expected_archive(plain, found, time).bytes;
        EXPECT_TRUE(found == expected)
            << before << ": they differ at byte "
            << std::mismatch(found.begin(), found.end(), expected.begin(), expected.end()).first - found.begin();
        EXPECT_GE(time, start - 2) << "two seconds are the unit";
        EXPECT_LE(time, std::time(nullptr));
    }
}

TEST(archives, failures_tell_what_failed_and_leave_what_they_must) {
    const support::folder place;
    const auto xml = place / "a.hqf", packed = place / "a.hqfz";
    hqf_v2::Hqf incomplete, small, large;
    document_test::fill_header(small);
    ASSERT_EQ(large.unmarshal(chart), 0);
    make_file(packed, "old");
    EXPECT_EQ(writing(incomplete, packed), "46");
    EXPECT_EQ(bytes_of(packed), "old") << "an archive is touched only once its document is written";
    EXPECT_FALSE(std::filesystem::exists(xml));
    std::filesystem::remove(packed);
    EXPECT_EQ(writing(incomplete, packed), "46");
    EXPECT_EQ(place.size(), 0u);
    EXPECT_EQ(loading(incomplete, packed), "cause " + std::to_string(ENOENT));

    std::filesystem::create_directory(place / "folder");
    const struct {
        std::filesystem::path target; // of a link in the place of the archive
        std::string outcome, load;
        const char* why;
    } rows[] = {
        {place / "folder", "cause " + std::to_string(EISDIR), "cause " + std::to_string(EISDIR), "a folder"},
        {place / "none" / "a", "cause " + std::to_string(ENOENT), "cause " + std::to_string(ENOENT), "no folder"},
        // By a link, so that nothing can ever delete the device.
        {"/dev/full", "1000", "cause 118", "no room"},
    };
    for (const auto& row : rows)
        for (hqf_v2::Hqf* const document : {&small, &large}) {
            ASSERT_EQ(writing(*document, place / "plain.hqf"), "0");
            std::filesystem::create_symlink(row.target, packed);
            EXPECT_EQ(writing(*document, packed), row.outcome) << row.why;
            EXPECT_TRUE(bytes_of(xml) == bytes_of(place / "plain.hqf")) << row.why << ": the document stays";
            EXPECT_EQ(loading(incomplete, packed), row.load) << row.why;
            std::filesystem::remove(packed);
            std::filesystem::remove(xml);
        }
}

/// Each lists one entry of the right name, tests it, and gives back the plain file.
TEST(archives, other_programs_open_what_is_written) {
    const support::folder place;
    hqf_v2::Hqf document;
    ASSERT_EQ(document.unmarshal(chart), 0);
    ASSERT_EQ(writing(document, place / "a.hqfz"), "0");
    ASSERT_EQ(writing(document, place / "plain.hqf"), "0");
    ::setenv("ARCHIVE", (place / "a.hqfz").c_str(), 1);
    ::setenv("PLAIN", (place / "plain.hqf").c_str(), 1);
    const std::pair<std::string, const char*> programs[] = {
        {"unzip", R"sh(test "$(unzip -Z1 "$ARCHIVE")" = a.hqf && unzip -tqq "$ARCHIVE" &&
                       unzip -p "$ARCHIVE" | cmp - "$PLAIN")sh"},
        {"bsdtar", R"sh(test "$(bsdtar -tf "$ARCHIVE")" = a.hqf && bsdtar -xOf "$ARCHIVE" | cmp - "$PLAIN")sh"},
        {"7z", R"sh(7z t "$ARCHIVE" >/dev/null && 7z e -so "$ARCHIVE" a.hqf | cmp - "$PLAIN")sh"},
        {"python3", R"sh(python3 -c 'if True:
            import os, zipfile
            archive = zipfile.ZipFile(os.environ["ARCHIVE"])
            (entry,) = archive.infolist()
            assert archive.testzip() is None
            assert (entry.filename, entry.compress_type) == ("a.hqf", zipfile.ZIP_DEFLATED)
            assert archive.comment == entry.comment == entry.extra == b""
            assert archive.read(entry) == open(os.environ["PLAIN"], "rb").read()')sh"},
    };
    for (const auto& [name, command] : programs) {
        const bool is_here = std::system(("command -v " + name + " >/dev/null").c_str()) == 0;
        EXPECT_TRUE(!is_here || std::system(command) == 0) << command;
        if (!is_here) std::cout << name << " is not on this machine\n";
    }
}

} // namespace
