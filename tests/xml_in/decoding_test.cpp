#include "support.h"

#include "hqf/xml_in/c_get_as_utf8.h"
#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_read_string.h"

#include <gtest/gtest.h>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

const std::string unrecognised = " {0 6 Unrecognised character encoding}";

// Text of characters below 256 in another width.
std::string wide(const std::string& text, bool is_big_endian) {
    std::string out;
    for (const char c : text)
        out += is_big_endian ? std::string{'\0', c} : std::string{c, '\0'};
    return out;
}

TEST(decoding, finds_the_encoding_from_the_first_bytes) {
    const struct {
        std::string bytes;
        std::string decoded;
        const char* why;
    } rows[] = {
        {"", "@1", "empty input is reported by nobody"},
        {"<a>", "<a>@1", "UTF-8 by default"},
        {"\xEF\xBB\xBF<a>", "<a>@1", "UTF-8 by its mark"},
        {"\xEF\xBB\xBF", "@1", "a mark and nothing else"},
        {"\xEF\xBB<a>", "@1" + unrecognised, "half a mark"},
        {"\xFF\xFE"s + wide("<a>", false), "<a>@1", "UTF-16 little-endian by its mark"},
        {"\xFE\xFF"s + wide("<a>", true), "<a>@1", "UTF-16 big-endian by its mark"},
        {"\xFF\xFE"s + "\xE9\x00"s, "@1" + unrecognised, "no ASCII character behind a mark"},
        {"\xFF\xFE\x00\x00"s, "@1" + unrecognised, "nor U+0000"},
        {"\xFE\xFF\x01<"s, "@1" + unrecognised, "nor one of the wrong half"},
        {"\xFF<", "@1" + unrecognised, "half a mark of UTF-16"},
        {wide(" <a>", false), " <a>@1", "a blank in UTF-16 little-endian without mark"},
        {wide("\n<a>", true), "<10><a>@2", "a line feed in UTF-16 big-endian without mark"},
        {"\0a"s, "@1" + unrecognised, "zero before a letter"},
        {"a<", "@1" + unrecognised, "a letter first"},
        {" ", " @1", "one blank alone"},
        {"<\xC3\xA9>", "<\xC3\xA9>@1", "the second character may have several bytes"},
        {"<\xC3", "<@1", "and may be cut off"},
        {"\r\n<", "<10><@2", "or be the second half of a line end"},
        {"\n\xE2\x80\xA8<", "<10><10><@3", "or be a line separator"},
    };
    for (const auto& row : rows)
        expect_from_every_source(row.bytes, decoded, row.decoded, row.why);
}

TEST(decoding, folds_line_ends_and_ends_at_what_is_no_character) {
    const struct {
        std::string bytes;
        std::string decoded;
        const char* why;
    } rows[] = {
        {"<\ra\nb\r\nc\n\rd", "<<10>a<10>b<10>c<10><10>d@6", "CR, LF and CR LF are one line end each"},
        {"<\r\n\n", "<<10><10>@3", "a LF behind CR LF is another"},
        {"<\xC2\x85\xE2\x80\xA8\xE2\x80\xA9", "<<10><10>\xE2\x80\xA9@3", "U+0085 and U+2028, but not U+2029"},
        {"<\xF0\x9D\x84\x9E", "<\xF0\x9D\x84\x9E@1", "four bytes"},
        {"<a\xED\xA0\x80z", "<a@1", "a surrogate in three bytes"},
        {"<a\x80z", "<a@1", "a continuation byte alone"},
        {"<a\xC0\x80z", "<a@1", "an overlong lead"},
        {"<a\xF8\x88\x80\x80\x80z", "<a@1", "five bytes"},
        {"<a\xF4\x90\x80\x80z", "<a@1", "above U+10FFFF"},
        {"<a\xE2\x82", "<a@1", "cut off"},
        {"<a\xE1zzb", "<a\xE1zzb@1", "the bytes behind the second one are not looked at, nor that one always"},
        {"<a\xE1\x82\0b"s, "<a\xE1\x82"s + "b@1", "a NUL cuts its sequence short"},
    };
    for (const auto& row : rows)
        expect_from_every_source(row.bytes, decoded, row.decoded, row.why);
}

TEST(decoding, reads_on_behind_a_sequence_that_is_none) {
    const std::string bytes = "<\x80z";
    lmx::c_read_string source(bytes);
    recorder errors;
    lmx::c_get_as_utf8 getter(source, errors);
    EXPECT_EQ(getter.get(), '<');
    EXPECT_EQ(getter.get(), -1) << "what is no UTF-8 reads as the end, right behind the first character too";
    EXPECT_EQ(getter.get(), 'z');
}

TEST(decoding, utf16_joins_surrogates) {
    const struct {
        std::string units;
        std::string decoded;
        const char* why;
    } rows[] = {
        {"\xD8\x34\xDD\x1E"s, "<\xF0\x9D\x84\x9E@1", "a pair"},
        {"\xD8\x34\x00\x61"s, "<@1" + unrecognised, "a high one and something else"},
        {"\xDD\x1E\x00\x61"s, "<\xED\xB4\x9E"s + "a@1", "a low one alone is a character"},
        {"\xD8\x34\xDD"s, "<@1", "cut off, without a report"},
        {"\x00"s, "<@1", "half a unit"},
        {"\x00\x85\x20\x28\x00\x0D\x00\x0A\x00\x61"s, "<<10><10><10>a@4", "line ends of all kinds"},
    };
    for (const auto& row : rows) {
        expect_from_every_source("\0<"s + row.units, decoded, row.decoded, row.why);
        std::string swapped;
        for (std::size_t i = 0; i + 1 < row.units.size(); i += 2)
            swapped += {row.units[i + 1], row.units[i]};
        if (row.units.size() % 2 != 0) swapped += row.units.back();
        expect_from_every_source("<\0"s + swapped, decoded, row.decoded, row.why);
    }
}

TEST(decoding, takes_the_declared_encoding_only_where_it_fits) {
    const std::string mismatch = " {0 15 Mis-match between specfied encoding and byte format}";
    const std::string unknown = " {0 6 Unknown character encoding specified}";
    const std::string big = "\0<\0a\x00\xE9\xD8\x00\x00z"s;
    const std::string little = "<\0a\0\xE9\0\x00\xD8z\0"s;
    const struct {
        std::string bytes;
        const char* name;
        std::string rest;
        const char* why;
    } rows[] = {
        {"<a\xC3\xA9", "utf-8", "\xC3\xA9", "any case of letters"},
        {"<a\xE9\x85", "ISO-8859-1", "\xC3\xA9\n", "a byte a character, U+0085 included"},
        {"<a\xE9", "us-ascii", "\xC3\xA9", "which is read the same way"},
        {"<a\x7F", "US-ASCII", "\x7F", "up to 127 unchanged"},
        {"<az", "UTF-16", mismatch, "UTF-16 of single bytes"},
        {"<az", "ISO-10646-UCS-2", mismatch, "UCS-2 of single bytes"},
        {"<az", "windows-1252", unknown, "a name that is not read"},
        {"<az", "UTF-8 ", unknown, "names are exact"},
        {big, "UTF-16", "\xC3\xA9" + unrecognised, "a surrogate counts"},
        {big, "iso-10646-ucs-2", "\xC3\xA9\xED\xA0\x80z", "until UCS-2 is declared"},
        {little, "ISO-10646-UCS-2", "\xC3\xA9\xED\xA0\x80z", "in either order"},
        {big, "UTF-8", mismatch, "UTF-8 of double bytes"},
        {little, "ISO-8859-1", mismatch, "single bytes of double bytes"},
    };
    for (const auto& row : rows) {
        const auto rest_after_declaring = [&](lmx::c_read& source) {
            recorder errors;
            lmx::c_get_as_utf8 getter(source, errors);
            getter.get();
            getter.get();
            const bool is_taken = getter.set_encoding(row.name);
            EXPECT_EQ(is_taken, errors.reports.empty()) << row.why;
            std::string out;
            for (int c = getter.get(); c != -1; c = getter.get())
                out += static_cast<char>(c);
            return out + errors.reports;
        };
        expect_from_every_source(row.bytes, rest_after_declaring, row.rest, row.why);
    }
}

TEST(decoding, rewind_gives_the_same_bytes_and_lines_again) {
    const std::string texts[] = {"\xEF\xBB\xBF<\r\n\xC2\x85z", "\0<\0\n\0z"s, "<a" + std::string(700, '\n') + "z",
                                 "\n\r<z"};
    for (const std::string& text : texts) {
        const temporary_file on_disk(text);
        lmx::c_read_file file(on_disk.path.c_str());
        recorder errors;
        lmx::c_get_as_utf8 getter(file, errors);
        const auto read_all = [&] {
            std::string out;
            for (int c = getter.get(); c != -1; c = getter.get())
                out += static_cast<char>(c);
            return out + std::to_string(getter.get_line_num());
        };
        const std::string first = read_all();
        for (int part = 0; part < 5; ++part) {
            getter.rewind();
            EXPECT_EQ(getter.get_line_num(), 1);
            for (int i = 0; i < part; ++i)
                getter.get();
            getter.unget('x');
            getter.rewind();
            EXPECT_EQ(read_all(), first) << "after " << part;
        }
    }
}

TEST(error_object, gets_source_and_line_from_whoever_reads) {
    const std::string bytes = "<\n\n";
    lmx::c_read_string source(bytes);
    recorder errors;
    {
        lmx::c_get_as_utf8 getter(source, errors);
        for (int i = 0; i < 3; ++i)
            getter.get();
        errors.error(lmx::error_error, lmx::err_badly_formed_dtd, "here");
        EXPECT_EQ(errors.last_line, 3);
    }
    errors.error(lmx::error_error, lmx::err_badly_formed_dtd, "nowhere");
    EXPECT_EQ(errors.last_line, -1) << "nobody reads any more";
}

} // namespace
