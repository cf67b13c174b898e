// Names into events, namespaces and their scopes, values, unknown elements, errors, and a look before loading.

#include "support.h"

#include "hqf/values/s_ns_map.h"
#include "hqf/xml_in/c_known_elements_selector.h"
#include "hqf/xml_in/c_xml_reader_file.h"
#include "hqf/xml_in/c_xml_reader_local.h"
#include "hqf/xml_in/c_xml_reader_memory.h"
#include "hqf/xml_in/must_understand.h"

#include <list>

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
    const std::string default_one = "<root xmlns='urn:f'>";
    expect_rows(walk,
                {is("<p:root xmlns:p='urn:f'><p:item/></p:root>", "12#1000root[13#1000item 6] 0(34)"),
                 is(default_one + "<item size='1'/></root>", "12#1000root[13#1000item 15size 6] 0(34)", "no attribute"),
                 is(default_one + "<item xmlns=''/><item/></root>", "12#1000root[14#1item 13#1000item 6] 0(34)",
                    "the default namespace switched off for one child alone"),
                 is("<q:item q:size='1'/>", "1#0item 1q:size 0(34)", "an undeclared prefix"),
                 is("<p:it xmlns:p='urn:f'/>", "1#1000it 0(34)", "a name that is only the start of a row's"),
                 is("<r><p:item xmlns:p='urn:f'/><p:item/></r>", "1#1r[13#1000item 1#0item 6] 0(34)",
                    "a sibling's declaration is gone"),
                 is("<r xmlns:p='urn:f'><p:item><p:item xmlns:p='u'/><p:item/></p:item></r>",
                    "1#1r[13#1000item[1#1001item 13#1000item 6] 6] 0(34)", "the nearest declaration wins"),
                 is("<r xmlns:xsi='http://www.w3.org/2001/XMLSchema-instance' xsi:type='' xsi:nil='' "
                    "xsi:schemaLocation='' xsi:noNamespaceSchemaLocation='' xsi:x=''/>",
                    "1#1r 8xsi:type 9xsi:nil 10xsi:schemaLocation 11xsi:noNamespaceSchemaLocation 1xsi:x 0(34)",
                    "the table is not asked about instance attributes"),
                 is("<xml:item/>", "1#2item 0(34)", "xml is always declared"), is("<item>text</item>", "14#1item[5] 6"),
                 is("<item></", "14#1item[3] 0(34)", "a failure without a report has no code"), is("", "0(34)"),
                 is("<item>< >", "14#1item[3(23)] 0(34)", "one with a report has its code"),
                 is("<item a='1' !>", "14#1item 1a 3(23)", "in the attribute loop too")});
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

// As many scopes as an index stands beside, and what a walk from scope to scope would find.
TEST(reader, many_scopes_find_what_few_do) {
    const auto id_in = [](const lmx::c_xml_local& scope, const char* prefix) {
        return scope.find_namespace_id(prefix);
    };
    std::list<lmx::c_xml_local> chain(1);
    for (int i = 0; i < 60; ++i) {
        if (i != 0) chain.emplace_back(chain.back());
        if (i % 4 == 3) continue; // a scope without declarations
        chain.back().add_namespace("p", 2000 + i);
        chain.back().add_namespace(("p" + std::to_string(i)).c_str(), 1000 + i);
        chain.back().add_namespace(("p" + std::to_string(i)).c_str(), 3000 + i);
    }
    for (int i = 59; i >= 0; --i, chain.pop_back()) {
        const lmx::c_xml_local& inner = chain.back();
        EXPECT_EQ(id_in(inner, "p"), 2000 + (i % 4 == 3 ? i - 1 : i));
        for (int j = 0; j < 60; ++j)
            EXPECT_EQ(id_in(inner, ("p" + std::to_string(j)).c_str()), j > i || j % 4 == 3 ? 0 : 3000 + j) << i;
        if (i == 40) {
            chain.back().clear();
            EXPECT_EQ(id_in(inner, "p"), 2038);
            chain.back().add_namespace("q", 7);
            EXPECT_TRUE(id_in(inner, "q") == 7 && id_in(inner, "p40") == 0) << "other declarations in the same scope";
        }
        if (i == 37) {
            EXPECT_EQ(id_in(inner, "q"), 0) << "gone with its scope";
            lmx::c_xml_local one(inner);
            lmx::c_xml_local other(inner);
            one.add_namespace("one", 8);
            EXPECT_TRUE(id_in(one, "one") == 8 && id_in(other, "one") == 0) << "two scopes in the same one";
            EXPECT_TRUE(id_in(inner, "one") == 0 && id_in(one, "p37") == 3037 && id_in(other, "p") == 2037);
            chain.front().add_namespace("late", 9);
            EXPECT_TRUE(id_in(other, "late") == 9 && id_in(one, "late") == 9) << "declared outside, after the fact";
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
    expect_rows([](memory_reader& r) { return value_of_first(r, true); },
                {is("<e a='1'>v </e>", "v, 0"), is("<e/>", ", 0, empty"), is("<e></e>", ", 0"),
                 is("<e/x>", "!, 11, empty"), is("<e>&nope;</e>", "!, 29"), is("<e>v<b/></e>", "!, 10")});
    expect_rows([](memory_reader& r) { return value_of_first(r, false); },
                {is("<e> x<b/>y</e>", " x<b/>y, 0, 6"), is("<e/>", ", 0, 7"), is("<e/x>", "!, 11, 7"),
                 is("<e><b></e>", "!, 29, 7"), is("<e></f>", "!, 10, 6")});
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
    const auto look = [](memory_reader& reader) {
        return std::to_string(lmx::has_must_understand(reader, "urn:m", "u", lmx::bool_must_understand));
    };
    const std::string root = "<a xmlns:m='urn:m'>";
    expect_rows(look, rows("2", {root + "<b>x<c m:u='true'/></b></a>"}));
    expect_rows(look, rows("0", {root + "<b m:v='1' u='1'/></a>", root + "<b xmlns:m='urn:n' m:u='1'/></a>",
                                 root + "<b m:u='false'/></a>"}));
    expect_rows(look,
                rows("1", {root + "<b m:u='0'/><c m:u='maybe'/><d m:u='true'/></a>", root + "<b m:u='&nope;'/></a>",
                           root + "<b m:u='True'/></a>", "<a><b></c></a>", "<a><b/>", "<a !>", "x"}));
    const auto look_and_walk = [](memory_reader& reader) {
        std::string out = "old";
        out.insert(0, std::to_string(lmx::get_instance_namespace(reader, &out)));
        EXPECT_EQ(reader.find_enumerated_namespace("urn:f"), 0) << "the table is at its new state";
        reader.set_ns_map(format);
        return out + " " + walk(reader);
    };
    expect_rows(look_and_walk, {is("<p:item xmlns:p='urn:f'/>", "1urn:f 13#1000item 0(34)"),
                                is("<item xmlns=''/>", "1 14#1item 0(34)"),
                                is("<p:item/>", "0  1#0item 0(34)", "an undeclared prefix"),
                                is("<item/>", "0  14#1item 0(34)"), is(" &amp;", "0old 5", "no element")});
}

} // namespace
