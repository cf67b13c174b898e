#include "archives.h"

#include <gtest/gtest.h>

using namespace zip_test;

TEST(zip_samples, load_or_fail_with_their_cause) {
    const auto data = std::filesystem::path(HQF_TEST_DATA) / "archives";
    const std::string chart = load(data / "rendition-chart.hqfz").content;
    ASSERT_EQ(chart.size(), 149544U);
    const struct {
        const char* name;
        std::vector<int> causes;
        const char* why;
    } rows[] = {
        {"bzip2", {0}, "method 12"},
        {"data-before", {0}, "bytes in front"},
        {"data-descriptor", {0}, "sizes behind the data"},
        {"two-entries", {0}, "the first in the file, not in the directory"},
        {"archive-cut", {118}, "no end record"},
        {"archive-damaged-data", {102, 504}, "a byte of the packed data changed"},
        {"archive-encrypted", {112}, "flag of encryption"},
        {"archive-headers-disagree", {101}, "CRC-32 of the local header"},
        {"archive-size-absurd", {refused}, "4 GB claimed for 1,111 bytes"},
        {"archive-size-too-large", {100}, "100 bytes too many claimed"},
        {"archive-size-too-small", {101}, "100 bytes too few"},
        {"archive-twin-offsets", {101}, "two entries at one offset"},
        {"archive-unknown-method", {100, refused}, "method 99"},
        {"archive-without-entry", {no_entry}, "a sound archive of nothing"},
        {"archive-wrong-crc", {102}, "both headers hold another CRC-32"},
        {"archive-zip64", {120}, "the end record refers to ZIP64"},
    };
    for (const auto& row : rows) {
        const outcome got = load(data / (std::string(row.name) + ".hqfz"));
        EXPECT_NE(std::find(row.causes.begin(), row.causes.end(), got.cause), row.causes.end())
            << row.name << ": " << row.why << ", got " << got.cause;
        if (got.cause == 0) {
            EXPECT_TRUE(got.content == chart) << row.name;
        }
    }
}
