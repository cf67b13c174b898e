// Bytes, characters and entities: sources, decoding, line ends, characters given back, values in place of references.

#include "support.h"

#include "hqf/values/text.h"
#include "hqf/xml_in/reader_access.h"
#include "hqf/xml_in/wide_source.h"

#include <algorithm>
#include <random>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;

std::string read_all(lmx::c_read& source) {
    std::string out;
    for (int c = source.read(); c != -1; c = source.read())
        out += static_cast<char>(c);
    return out;
}

template<class getter_type>
std::string next(getter_type& getter, std::size_t count) {
    std::string out(count, ' ');
    std::generate(out.begin(), out.end(), [&] { return static_cast<char>(getter.get()); });
    return out;
}

// Every byte that a getter gives, control characters as <decimal>, then "@line".
std::string rest_of(lmx::c_get_as_utf8& getter) {
    std::string out;
    for (int c = getter.get(); c != -1; c = getter.get())
        out += c < ' ' ? "<" + std::to_string(c) + ">" : std::string(1, static_cast<char>(c));
    return out + "@" + std::to_string(getter.get_line_num());
}

TEST(byte_source, gives_every_byte_and_the_same_again_after_rewind) {
    for (const std::size_t size : {0u, 1u, 511u, 512u, 513u, 5000u}) {
        std::string bytes;
        for (std::size_t i = 0; i < size; ++i)
            bytes += static_cast<char>(255 - i % 256);
        const driver read_thrice = [&](lmx::c_read& source) {
            for (const std::size_t part : {std::size_t{0}, size / 3, size}) {
                for (std::size_t i = 0; i < part; ++i)
                    source.read();
                source.rewind();
                if (read_all(source) != bytes || source.read() != -1) return "rewound after " + std::to_string(part);
                source.rewind();
            }
            return bytes;
        };
        given{read_thrice}.from_every_source({{bytes, bytes, std::to_string(size) + " bytes"}});
    }
}

TEST(byte_source, wide_text_as_its_conversion_block_by_block) {
    std::minstd_rand random(5);
    const std::wstring parts[] = {L"a",
                                  L"<Lab>50.25</Lab>\n",
                                  L"\xE9",
                                  L"\x20AC",
                                  L"\xD83C\xDFA8",
                                  L"\xD83C",
                                  L"\xDFA8",
                                  L"\xD83Cx",
                                  std::wstring(1, L'\0'),
                                  std::wstring(200, L'.')};
    for (int round = 0; round < 40; ++round) {
        std::wstring text = L"<Hqf";
        while (text.size() < 150000)
            text += parts[random() % (round % 2 == 0 ? 2 : std::size(parts))];
        if (round % 3 == 0) text.back() = 0xD83C;
        std::string bytes;
        lmx::convert(&bytes, text);
        hqf::wide_source source(text);
        ASSERT_TRUE(read_all(source) == bytes) << round;
        source.rewind();
        recorder errors;
        lmx::c_get_with_entities through_window(source, errors);
        std::string read = next(through_window, text.find(L'f') + 1);
        while (hqf::window* const w = hqf::reader_access::begin_step(through_window)) {
            const char* const from = w->p;
            w->room(from, 1 + random() % 1000);
            w->p = std::min(w->edge(), from + 1 + random() % 1000);
            read.append(from, w->p);
            if (w->p == from) break;
        }
        ASSERT_EQ(read, bytes.substr(0, read.size())) << round;
        EXPECT_TRUE(round % 2 != 0 || read.size() + 300 > bytes.size()) << "ASCII is never left: " << read.size();
    }
}

TEST(byte_source, copies_of_memory_share_the_bytes_and_start_where_the_original_stands) {
    const std::string bytes = "abc";
    lmx::c_read_string original(bytes);
    original.read();
    lmx::c_read_string copy(original);
    EXPECT_TRUE(copy.read() == 'b' && original.read() == 'b') << "the copy has a cursor of its own";
    copy.rewind();
    EXPECT_EQ(copy.read(), 'a') << "and rewinds to the start of the bytes";
}

TEST(byte_source, files_by_path_and_by_handle) {
    lmx::c_read_file missing("/nowhere/at all.hqf");
    EXPECT_TRUE(!missing.is_open() && missing.read() == -1);
    EXPECT_STREQ(missing.get_source_id(), "/nowhere/at all.hqf");
    EXPECT_STREQ(lmx::c_read_file(L"/no/\xD834\xDD1E\xE9").get_source_id(), "/no/\xED\xA0\xB4\xED\xB4\x9E\xC3\xA9");
    const temporary_file on_disk(std::string(1000, 'x'));
    std::wstring path;
    lmx::c_read_file wide(lmx::convert(&path, on_disk.path).c_str());
    wide.read();
    wide.close();
    EXPECT_FALSE(wide.is_open());
    EXPECT_EQ(read_all(wide).size(), 511u) << "what the block holds is still read after close";
    std::FILE* const handle = std::fopen(on_disk.path.c_str(), "rb");
    {
        lmx::c_read_file file(handle);
        EXPECT_TRUE(file.get_source_id() == ""s && file.read() == 'x');
        file.leave_file_open_on_delete(true);
    }
    std::rewind(handle);
    EXPECT_EQ(std::fgetc(handle), 'x') << "left open";
    std::fclose(handle);
}

TEST(unget, gives_characters_back_in_reverse_order_and_counts_no_line_twice) {
    reading<lmx::c_get_as_utf8> r("<a\nb"s);
    EXPECT_EQ(next(r.in, 3), "<a\n");
    for (const char c : {'\n', 'a', '<'})
        r.in.unget(c);
    EXPECT_EQ(next(r.in, 4), "<a\nb");
    EXPECT_EQ(r.in.get_line_num(), 2);
    r.in.unget('b');
    r.in.error(lmx::error_fatal, lmx::err_not_well_formed, "stop");
    EXPECT_EQ(r.in.get(), -1) << "a fatal report ends the input, characters given back included";
}

TEST(entity_stream, values_come_in_place_of_the_document) {
    reading<lmx::c_get_with_entities> r("<\ndoc"s);
    const char* value = nullptr;
    const auto push = [&](const char* name) {
        return r.in.get_general_entity(name, &value) && r.in.set_input_entity_value(value);
    };
    for (const auto& [name, text] : {std::pair{"a", "old"}, {"a", "1\r\n2"}, {"b", "1\r\n2"}})
        r.in.add_general_entity(name, text);
    EXPECT_EQ(next(r.in, 2), "<\n");
    EXPECT_TRUE(push("a") && next(r.in, 1) == "1") << "the later definition is read";
    EXPECT_TRUE(push("b")) << "an equal text is another entity";
    EXPECT_EQ(next(r.in, 3), "1\r\n") << "line ends of a value are not folded";
    r.in.unget('\n');
    EXPECT_EQ(next(r.in, 2), "\n2");
    EXPECT_EQ(r.in.get_entity_stack_depth(), 2u) << "a value counts until the read behind it";
    EXPECT_EQ(r.in.get_line_num(), 2) << "and counts no lines";
    EXPECT_TRUE(next(r.in, 1) == "\r" && r.in.get_entity_stack_depth() == 1);
    EXPECT_FALSE(push("a")) << "it is being read";
    EXPECT_EQ(r.errors.reports, " {0 9 Recursive entity definition for: 1\r\n2}");
    EXPECT_EQ(next(r.in, 3), "\n2\xFF") << "what was begun is read to its end, then the fatal report shows";
    r.in.rewind();
    EXPECT_FALSE(r.in.get_general_entity("a", &value)) << "rewinding forgets entities";
}

const std::string unrecognised = " {0 6 Unrecognised character encoding}";

// All there is; and the same again after a rewind, wherever the first reading stopped.
std::string decoded(lmx::c_read& source) {
    reading<lmx::c_get_as_utf8> r(source);
    const std::string first = rest_of(r.in) + r.errors.reports;
    for (std::size_t part = 0; part < 4 && r.errors.reports.empty(); ++part) {
        r.in.unget('x');
        r.in.rewind();
        next(r.in, part);
        r.in.rewind();
        EXPECT_EQ(rest_of(r.in), first) << "after " << part;
    }
    return first;
}

TEST(decoding, finds_the_encoding_and_ends_at_what_is_no_character) {
    given{decoded}.from_every_source(cases("decoded"));
    reading<lmx::c_get_as_utf8> r("<\x80z"s);
    EXPECT_EQ(next(r.in, 1), "<");
    for (const char c : {'3', '2', '1'})
        r.in.unget(c);
    EXPECT_EQ(next(r.in, 5), "123\xFFz") << "what is no UTF-8 reads as the end, right behind the first character too";
    reading<lmx::c_get_as_utf8> refused("\xFF\xFE\xE9\0"s);
    EXPECT_EQ(next(refused.in, 1), "\xFF");
    EXPECT_FALSE(refused.in.set_encoding("UTF-16")) << "the mark alone decides nothing";
    EXPECT_EQ(lmx::c_read_memory("", 0).read(), -1);
}

TEST(decoding, utf16_joins_surrogates) {
    const std::vector<row> rows = {
        {"\xD8\x34\xDD\x1E"s, "<\xF0\x9D\x84\x9E@1", "a pair"},
        {"\xD8\x34\x00\x61"s, "<@1" + unrecognised, "a high one and something else"},
        {"\xD8\x34\xE0\x00"s, "<@1" + unrecognised, "and one just above the low ones"},
        {"\xDD\x1E\x00\x61"s, "<\xED\xB4\x9E"s + "a@1", "a low one alone is a character"},
        {"\xD8\x34\xDD"s, "<@1", "cut off, without a report"},
        {"\x00"s, "<@1", "half a unit"},
        {"\x00\x85\x20\x28\x00\x0D\x00\x0A\x00\x61"s, "<<10><10><10>a@4", "line ends of all kinds"}};
    for (const auto& [units, expected, why] : rows) {
        std::string swapped = units;
        for (std::size_t i = 0; i + 1 < units.size(); i += 2)
            std::swap(swapped[i], swapped[i + 1]);
        given{decoded}.from_every_source({{"\0<"s + units, expected, why}, {"<\0"s + swapped, expected, why}});
    }
}

TEST(decoding, takes_the_declared_encoding_only_where_it_fits) {
    const std::string mismatch = "refused@1 {0 15 Mis-match between specfied encoding and byte format}";
    const std::string unknown = "refused@1 {0 6 Unknown character encoding specified}";
    const std::string big = "\0<\0a\x00\xE9\xD8\x00\x00z"s, little = "<\0a\0\xE9\0\x00\xD8z\0"s;
    const std::string cut = "\xC3\xA9@1" + unrecognised, taken = "\xC3\xA9\xED\xA0\x80z@1";
    for (const row& r : {is("<a\xC3\xA9", "\xC3\xA9@1", "utf-8"), is("<a\xE9\x85", "\xC3\xA9<10>@2", "ISO-8859-1"),
                         is("<a\x7F\xE9", "\x7F\xC3\xA9@1", "us-ascii"), is("<az", mismatch, "UTF-16"),
                         is("<az", mismatch, "ISO-10646-UCS-2"), is("<az", unknown, "UTF-8 "), is(big, cut, "UTF-16"),
                         is(big, taken, "iso-10646-ucs-2"), is(little, taken, "ISO-10646-UCS-2"),
                         is(big, mismatch, "UTF-8"), is(little, mismatch, "ISO-8859-1")})
        given{[&r](lmx::c_read& source) {
            reading<lmx::c_get_as_utf8> in(source);
            next(in.in, 2);
            const bool is_taken = in.in.set_encoding(r.why.c_str());
            return (is_taken ? "" : "refused") + rest_of(in.in) + in.errors.reports;
        }}.from_every_source({r});
}

TEST(error_object, has_no_line_when_nobody_reads_any_more) {
    recorder errors;
    callers_source source("<");
    lmx::c_get_as_utf8(source, errors).get();
    errors.error(lmx::error_error, lmx::err_badly_formed_dtd, "nowhere");
    EXPECT_EQ(errors.last_line, -1);
}

} // namespace
