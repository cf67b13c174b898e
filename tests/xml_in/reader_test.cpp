// Names into events, namespaces and their scopes, values, unknown elements, errors, and a look before loading.

#include "support.h"

#include "hqf/values/s_ns_map.h"
#include "hqf/xml_in/c_known_elements_selector.h"
#include "hqf/xml_in/c_xml_reader_file.h"
#include "hqf/xml_in/c_xml_reader_local.h"
#include "hqf/xml_in/c_xml_reader_memory.h"
#include "hqf/xml_in/must_understand.h"

#include <algorithm>
#include <list>
#include <map>
#include <random>

namespace {

using namespace xml_in_test;

const lmx::s_ns_map format[] = {{1000, "f", "urn:f"}, {0, nullptr, nullptr}};
const lmx::s_event_map names[] = {
    {1000, "root", 4, 12}, {1000, "item", 4, 13}, {1, "item", 4, 14}, {1, "size", 4, 15},
    {1000, "item", 4, 99}, {5, "type", 4, 98},    {0, nullptr, 0, 1},
};

struct memory_reader : lmx::c_xml_reader_memory {
    explicit memory_reader(const std::string& text)
        : c_xml_reader_memory(text.data(), static_cast<unsigned int>(text.size())) {
        set_ns_map(format);
    }
    int next_name() {
        get_element_event(nullptr, &error, &item_name);
        return get_current_event();
    }
    lmx::elmx_error error = lmx::err_no_error;
};

void expect_rows(const std::function<std::string(memory_reader&)>& run, const std::vector<row>& rows) {
    for (const row& r : rows) {
        memory_reader reader(r.bytes);
        EXPECT_EQ(run(reader), r.expected) << r.why;
    }
}

// Walks a document the way the model's classes do, one scope a level, and writes events and namespace numbers down.
std::string walk(lmx::c_xml_reader& reader) {
    lmx::c_xml_reader_local scope(&reader);
    std::string out;
    for (;;) {
        lmx::elmx_error error = lmx::err_no_error;
        reader.get_element_event(names, &error, &reader.item_name);
        out += std::to_string(reader.get_current_event());
        if (error != 0) out += "(" + std::to_string(error) + ")";
        if (!reader.is_current_event_tokenisable()) return out;
        out += "#" + std::to_string(reader.get_element_ns_id()) + reader.get_local_name();
        std::string attribute;
        while (reader.get_attribute_event(names, &error, &attribute)) {
            out += " " + std::to_string(reader.get_current_event()) + attribute;
            if (error != 0) return out + "(" + std::to_string(error) + ")";
            reader.skip_attribute_value();
        }
        if (reader.get_current_event() == lmx::EXE_START_TAG_END) out += "[" + walk(reader) + "]";
        out += " ";
    }
}

TEST(reader, turns_names_into_events) {
    expect_rows(walk, cases("events"));
    const temporary_file on_disk("<item/>");
    lmx::c_xml_reader_file by_wide_path(std::wstring(on_disk.path.begin(), on_disk.path.end()).c_str());
    lmx::c_xml_reader_file by_handle(std::fopen(on_disk.path.c_str(), "rb"));
    EXPECT_EQ(walk(by_wide_path) + walk(by_handle), "14#1item 0(34)14#1item 0(34)");
    EXPECT_EQ(by_wide_path.get_source_id(), on_disk.path);
    EXPECT_FALSE(lmx::c_xml_reader_file("/nowhere.hqf").is_open());
}

TEST(reader, namespaces) {
    const std::string text = "<p:a xmlns:p='urn:f' xmlns:q='urn:q' xmlns='urn:d' xmlns:n=''/>";
    memory_reader reader(text);
    reader.add_namespace_mapping("m", "urn:m");
    reader.add_default_namespace_mapping("urn:default");
    EXPECT_EQ(reader.get_namespace("m:x", &reader.value_buffer), " ") << "mappings wait for set_ns_map";
    reader.set_ns_map(format);
    lmx::c_xml_reader_local scope(&reader);
    EXPECT_EQ(reader.get_namespace("x", &reader.value_buffer), "urn:default");
    EXPECT_EQ(reader.next_name(), lmx::EXE_NAME) << "no table, no look-up";
    const std::tuple<const char*, const char*, bool> qnames[] = {
        {"p:x", "urn:f", true},    {"x", "urn:d", true},    {"m:x", "urn:m", true},  {"s:x", " ", false},
        {"n:x", "", true},         {"p:", "urn:f", false},  {"p:1", "urn:f", false}, {"p:\xC3\xA9", "urn:f", false},
        {"p:_-.9", "urn:f", true}, {"p::x", "urn:f", true}, {":x", "urn:d", false},  {"p:x y", "urn:f", false}};
    for (const auto& [qname, uri, is_valid] : qnames) {
        EXPECT_EQ(reader.get_namespace(qname, &reader.value_buffer), uri) << qname;
        EXPECT_EQ(reader.is_valid_qname(qname), is_valid) << qname;
    }
    EXPECT_EQ(reader.get_namespace("xml:x", &reader.value_buffer), "http://www.w3.org/XML/1998/namespace");
    EXPECT_EQ(reader.find_enumerated_namespace("urn:m"), 1001) << "after the table's own 1000";
}

TEST(reader, scopes_find_prefixes_and_numbers) {
    lmx::c_xml_local outer;
    outer.add_namespace("p", 1000);
    lmx::c_xml_local middle(outer), inner(middle);
    EXPECT_EQ(inner.find_namespace_id("p"), 1000) << "through a scope without declarations";
    for (const auto& [prefix, id] : {std::pair{"i", 1000}, {"p", 1002}, {"p", 1003}})
        inner.add_namespace(prefix, id);
    EXPECT_EQ(inner.find_namespace_id("p"), 1003);
    EXPECT_STREQ(inner.find_namespace_prefix(1000), "i") << "the innermost";
    EXPECT_STREQ(inner.find_first_namespace_prefix(1000), "p") << "the outermost";
    EXPECT_STREQ(inner.find_namespace_prefix(2), "xml");
    EXPECT_EQ(inner.find_namespace_prefix(1002), nullptr);
    inner.clear();
    EXPECT_EQ(inner.find_namespace_id("p"), 1000);
    lmx::c_enumerated_namespaces table;
    table.add_namespace("u", 1500);
    table.add_namespace("u", 1700);
    EXPECT_EQ(table.find_namespace("u"), 1500) << "a known URI keeps its number";
    EXPECT_EQ(table.add_namespace("v"), 1701) << "new ones begin above";
}

// A look-up finds what a walk from scope to scope would, also where an index stands beside a long chain, and when the
// outermost scope gets a declaration after the fact.
TEST(reader, scopes_find_what_a_walk_finds) {
    std::minstd_rand random(20240601);
    std::list<lmx::c_xml_local> chain(1);
    std::vector<std::map<std::string, int>> told = {{{"outermost", 1}}};
    chain.front().add_namespace("outermost", 1);
    for (int step = 2; step < 3000; ++step) {
        const std::string prefix = "p" + std::to_string(random() % 40);
        switch (random() % 16) {
        case 0: chain.back().clear(), told.back().clear(); break;
        case 1: chain.front().add_namespace(prefix.c_str(), step), told.front()[prefix] = step; break;
        case 2:
        case 3:
            if (told.size() > 1) chain.pop_back(), told.pop_back();
            break;
        case 4:
        case 5:
        case 6:
        case 7: chain.emplace_back(chain.back()), told.emplace_back(); break;
        default: chain.back().add_namespace(prefix.c_str(), step), told.back()[prefix] = step;
        }
        lmx::c_xml_local sibling(chain.back());
        if (step % 4 == 0) sibling.add_namespace("p0", -step);
        for (const std::string& sought : {prefix, std::string("p0"), std::string("outermost")}) {
            const auto found =
                std::find_if(told.rbegin(), told.rend(), [&](const auto& scope) { return scope.count(sought) != 0; });
            const int id = found == told.rend() ? 0 : found->at(sought);
            const bool is_own = step % 4 == 0 && sought == "p0";
            ASSERT_EQ(chain.back().find_namespace_id(sought), id) << sought << ", step " << step;
            ASSERT_EQ(sibling.find_namespace_id(sought), is_own ? -step : id) << sought << ", step " << step;
        }
    }
}

// The value of the first element, the code, the event in between where asked for, and whether the element was empty.
std::string value_of_first(memory_reader& r, bool is_simple) {
    const lmx::c_xml_reader_local scope(&r);
    r.next_name();
    bool empty = false;
    std::string v = "old";
    if (!(is_simple ? r.get_simple_type_value("e", lmx::collapse, &v, &r.error, &empty)
                    : r.get_element_ur_value("e", &v, &r.error, &empty)))
        v = "!";
    return v + ", " + std::to_string(r.error) + (is_simple ? "" : ", " + std::to_string(r.get_current_event())) +
           (is_simple && empty ? ", empty" : "");
}

TEST(reader, values) {
    expect_rows([](memory_reader& r) { return value_of_first(r, true); }, cases("simple value"));
    expect_rows([](memory_reader& r) { return value_of_first(r, false); }, cases("any value"));
}

TEST(reader, passes_unknown_elements_over) {
    const lmx::s_known_elements known[] = {{1, "known", 5}, {0, nullptr, 0}};
    const std::string text = "<u><item/></u><v a='1'/><item/><known/><u/>x<known/><w><x></y></w>";
    memory_reader reader(text);
    const lmx::c_xml_reader_local scope(&reader);
    const auto next = [&](const lmx::s_event_map* map) {
        reader.get_known_element_event(map, &reader.error, &reader.item_name);
        const std::string seen = std::to_string(reader.get_current_event()) + reader.item_name;
        if (reader.is_current_event_tokenisable()) reader.skip_start_tag(nullptr);
        return seen + "," + std::to_string(reader.error);
    };
    {
        const lmx::c_known_elements_selector selector(reader, known);
        EXPECT_EQ(next(names), "14item,0") << "the table's element, behind two unknown ones";
        EXPECT_EQ(next(names), "1known,0") << "a known element, with no event";
        EXPECT_EQ(next(names), "5x,0") << "text is not passed over";
        EXPECT_EQ(next(nullptr), "7known,0") << "without a table";
    }
    EXPECT_EQ(reader.get_known_elements(), nullptr) << "the selector puts the old table back";
    EXPECT_EQ(next(names), "1w,5") << "an element that can't be skipped";
}

TEST(reader, handles_errors_as_its_user_says) {
    struct lenient : memory_reader {
        using memory_reader::memory_reader;
        using memory_reader::user_handle_error;
        lmx::elmx_error user_handle_error(lmx::elmx_error code) override {
            return code == lmx::err_length_too_long ? lmx::err_no_error : code;
        }
    };
    const std::string text = "\n\n\n\n\n\n< >";
    lenient reader(text);
    const lmx::c_xml_reader_local scope(&reader);
    std::string message;
    lmx::elmx_error_type type{};
    int line = 0;
    EXPECT_FALSE(reader.get_error_info(&type, &reader.error, &line));
    reader.next_name();
    EXPECT_EQ(reader.get_error(), lmx::err_not_well_formed);
    EXPECT_TRUE(reader.get_error_info(&type, &reader.error, &line) && type == lmx::error_error && line == 7);
    EXPECT_EQ(reader.get_error_message(&message), "No Error") << "a record of its own";
    EXPECT_EQ(reader.handle_error(lmx::err_mandatory_element_missing, "Hqf:L", "Hqf", 3), 21);
    EXPECT_EQ(reader.get_error_message(&message), "line:7-'Hqf:L'-Mandatory element missing");
    EXPECT_EQ(reader.handle_error(lmx::err_length_too_long, "y", "", 0), 0);
    EXPECT_EQ(reader.get_error_message(&message), "No Error") << "what the user lets pass is no error";
    EXPECT_EQ(reader.get_error_item_name(), "y");
}

TEST(must_understand, looks_through_a_document_before_it_is_loaded) {
    expect_rows(
        [](memory_reader& reader) {
            return std::to_string(lmx::has_must_understand(reader, "urn:m", "u", lmx::bool_must_understand));
        },
        cases("must understand"));
    const auto look_and_walk = [](memory_reader& reader) {
        std::string out = "old";
        out.insert(0, std::to_string(lmx::get_instance_namespace(reader, &out)));
        EXPECT_EQ(reader.find_enumerated_namespace("urn:f"), 0) << "the table is at its new state";
        reader.set_ns_map(format);
        return out + " " + walk(reader);
    };
    expect_rows(look_and_walk, cases("instance namespace"));
}

} // namespace
