#include "support.h"

#include "hqf/values/text.h"
#include "hqf/xml_in/c_get_with_entities.h"
#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_read_string.h"

#include <gtest/gtest.h>

namespace {

using namespace xml_in_test;

std::string read_all(lmx::c_read& source) {
    std::string out;
    for (int c = source.read(); c != -1; c = source.read())
        out += static_cast<char>(c);
    return out;
}

TEST(byte_source, gives_every_byte_and_the_same_again_after_rewind) {
    for (const std::size_t size : {0u, 1u, 511u, 512u, 513u, 1024u, 5000u}) {
        std::string bytes;
        for (std::size_t i = 0; i < size; ++i)
            bytes += static_cast<char>(255 - i % 256);
        const auto check = [&](lmx::c_read& source, const char* kind) {
            for (const std::size_t part : {std::size_t{0}, size / 3, size}) {
                source.rewind();
                for (std::size_t i = 0; i < part; ++i)
                    source.read();
                source.rewind();
                EXPECT_EQ(read_all(source), bytes) << kind << " of " << size << ", rewound after " << part;
                EXPECT_EQ(source.read(), -1) << kind << " stays at its end";
            }
        };
        lmx::c_read_memory memory(bytes.data(), static_cast<unsigned int>(size));
        check(memory, "memory");
        lmx::c_read_string string(bytes);
        check(string, "string");
        const temporary_file on_disk(bytes);
        lmx::c_read_file file(on_disk.path.c_str());
        check(file, "file");
    }
}

TEST(byte_source, copies_of_memory_share_the_bytes_and_start_where_the_original_stands) {
    const std::string bytes = "abc";
    lmx::c_read_string original(bytes);
    original.read();
    lmx::c_read_string copy(original);
    EXPECT_EQ(copy.read(), 'b');
    EXPECT_EQ(original.read(), 'b') << "the copy has a cursor of its own";
    copy.rewind();
    EXPECT_EQ(copy.read(), 'a') << "and rewinds to the start of the bytes";
}

TEST(byte_source, a_missing_file_is_not_open_and_reads_as_ended) {
    lmx::c_read_file file("/nowhere/at all.hqf");
    EXPECT_FALSE(file.is_open());
    EXPECT_EQ(file.read(), -1);
    EXPECT_STREQ(file.get_source_id(), "/nowhere/at all.hqf");
    lmx::c_read_file wide(L"/nowhere/\xD834\xDD1E\xE9");
    EXPECT_STREQ(wide.get_source_id(), "/nowhere/\xED\xA0\xB4\xED\xB4\x9E\xC3\xA9") << "each unit by itself";
}

TEST(byte_source, what_the_block_holds_is_still_read_after_close) {
    const temporary_file on_disk(std::string(1000, 'x'));
    lmx::c_read_file file(on_disk.path.c_str());
    file.read();
    file.close();
    EXPECT_FALSE(file.is_open());
    EXPECT_EQ(read_all(file).size(), 511u);
}

TEST(byte_source, a_wide_path_opens_the_file_of_its_utf8_name) {
    const temporary_file on_disk("wide");
    std::wstring path;
    lmx::c_read_file file(lmx::convert(&path, on_disk.path).c_str());
    EXPECT_EQ(read_all(file), "wide");
}

TEST(byte_source, an_open_handle_is_taken_over_unless_told_otherwise) {
    const temporary_file on_disk("handle");
    std::FILE* const handle = std::fopen(on_disk.path.c_str(), "rb");
    {
        lmx::c_read_file file(handle);
        EXPECT_STREQ(file.get_source_id(), "");
        EXPECT_EQ(file.read(), 'h');
        file.leave_file_open_on_delete(true);
    }
    std::rewind(handle);
    EXPECT_EQ(std::fgetc(handle), 'h') << "left open";
    std::fclose(handle);
}

TEST(unget, gives_characters_back_in_reverse_order_and_counts_no_line_twice) {
    const std::string bytes = "<a\nb";
    lmx::c_read_string source(bytes);
    recorder errors;
    lmx::c_get_as_utf8 getter(source, errors);
    for (int i = 0; i < 3; ++i)
        getter.get();
    EXPECT_EQ(getter.get_line_num(), 2);
    getter.unget('\n');
    getter.unget('a');
    getter.unget('<');
    for (const char c : {'<', 'a', '\n', 'b'})
        EXPECT_EQ(getter.get(), c);
    EXPECT_EQ(getter.get_line_num(), 2);
    getter.unget('b');
    getter.error(lmx::error_fatal, lmx::err_not_well_formed, "stop");
    EXPECT_EQ(getter.get(), -1) << "a fatal report ends the input, characters given back included";
}

TEST(entity_stream, values_come_in_place_of_the_document) {
    const std::string bytes = "<\ndoc";
    lmx::c_read_string source(bytes);
    recorder errors;
    lmx::c_get_with_entities getter(source, errors);
    const auto push = [&](const char* name) {
        const char* value = nullptr;
        EXPECT_TRUE(getter.get_general_entity(name, &value)) << name;
        return getter.set_input_entity_value(value);
    };
    const auto next = [&](int count) {
        std::string out;
        while (count-- > 0)
            out += static_cast<char>(getter.get());
        return out;
    };
    getter.add_general_entity("a", "old");
    getter.add_general_entity("a", "1\r\n2");
    getter.add_general_entity("b", "1\r\n2");
    EXPECT_EQ(next(2), "<\n");
    EXPECT_TRUE(push("a"));
    EXPECT_EQ(next(1), "1") << "the later definition is read";
    EXPECT_TRUE(push("b")) << "an equal text is another entity";
    EXPECT_EQ(getter.get_entity_stack_depth(), 2u);
    EXPECT_EQ(next(3), "1\r\n") << "line ends of a value are not folded";
    getter.unget('\n');
    EXPECT_EQ(next(2), "\n2");
    EXPECT_EQ(getter.get_entity_stack_depth(), 2u) << "a value counts until the read behind it";
    EXPECT_EQ(getter.get_line_num(), 2) << "and counts no lines";
    EXPECT_EQ(next(1), "\r");
    EXPECT_EQ(getter.get_entity_stack_depth(), 1u);
    EXPECT_FALSE(push("a")) << "it is being read";
    EXPECT_EQ(errors.reports, " {0 9 Recursive entity definition for: 1\r\n2}");
    EXPECT_EQ(next(2), "\n2") << "what was begun is read to its end";
    EXPECT_EQ(getter.get(), -1) << "then the fatal report shows";
    const char* value = nullptr;
    getter.rewind();
    EXPECT_FALSE(getter.get_general_entity("a", &value)) << "rewinding forgets entities";
}

TEST(repository, is_an_ordered_list_also_where_it_is_long) {
    for (const int count : {3, 40}) {
        lmx::c_repository<int> numbers;
        EXPECT_TRUE(numbers.empty());
        for (int i = 0; i < count; ++i)
            numbers.add(("k" + std::to_string(i)).c_str(), 7);
        EXPECT_STREQ(numbers.find_key(7), "k0") << "the first key of a value";
        numbers.add("k0", 8);
        EXPECT_STREQ(numbers.find_key(7), "k1");
        int value = 0;
        EXPECT_TRUE(numbers.find("k0", &value));
        EXPECT_EQ(value, 8) << "the last definition wins";
        EXPECT_TRUE(numbers.find(("k" + std::to_string(count - 1)).c_str(), &value));
        EXPECT_FALSE(numbers.has_key("k"));
        EXPECT_EQ(numbers.find_key(9), nullptr);
        numbers.clear();
        EXPECT_FALSE(numbers.has_key("k1"));
    }
}

} // namespace
