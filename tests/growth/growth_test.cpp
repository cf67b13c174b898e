// Twice the input costs about twice the work, the allocations and the memory, whatever the input is made of: for each
// way to make a document, a value or an archive large, the counts at 2n stay under 2.2 times those at n.

#include <gtest/gtest.h>

#include <cstdio>
#include <iostream>
#include <list>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "hqf/hqf.h"
#include "hqf/xml_in/must_understand.h"
#include "tests/growth/counters.h"
#include "tests/support/callers_source.h"
#include "tests/support/files.h"
#include "tests/support/patterns.h"
#include "tests/zip/archives.h"

namespace {

using namespace growth;
using namespace support;
using std::string;

/// n, 2n and 4n.
constexpr unsigned int steps[] = {1, 2, 4};

template<class action>
counts count(const action& act) {
    restart();
    act();
    return counted();
}

/// \param block bytes that memory may grow by at a time
void expect_linear(const string& name, unsigned int n, const std::vector<counts>& seen, std::uint64_t block = 1024) {
    const struct {
        const char* name;
        std::uint64_t counts::*of;
        std::uint64_t slack;
    } kinds[] = {{"work", &counts::work, 0}, {"allocations", &counts::allocations, 8}, {"peak", &counts::peak, block}};
    std::ostringstream line;
    line.precision(3);
    line << name << ", n = " << n;
    for (const auto& kind : kinds) {
        line << "\t" << kind.name << ' ' << seen[0].*kind.of;
        for (std::size_t i = 1; i < seen.size(); ++i) {
            const std::uint64_t before = seen[i - 1].*kind.of;
            const std::uint64_t now = seen[i].*kind.of;
            line << ' ' << now << " (" << static_cast<double>(now) / static_cast<double>(before) << ')';
            EXPECT_LT(now * 10, before * 22 + kind.slack * 10)
                << name << ": " << kind.name << " from " << n * steps[i - 1] << " to " << n * steps[i];
        }
    }
    std::cout << line.str() << '\n';
}

/// Shows every fault, and goes on.
class tolerant_reader : public lmx::c_xml_reader {
public:
    using c_xml_reader::c_xml_reader;
    lmx::elmx_error user_handle_error(lmx::elmx_error) override {
        ++faults;
        get_error_message(&message_);
        return lmx::err_no_error;
    }
    unsigned int faults = 0;

private:
    string message_;
};

struct load {
    explicit load(lmx::c_read& source)
        : reader(source)
        , code(document.unmarshal(reader)) {}
    tolerant_reader reader;
    hqf_v2::Hqf document;
    lmx::elmx_error code;
};

struct document_row {
    const char* name;
    unsigned int n;
    parts pattern;
    unsigned int faults = 0; // for each of the n
    bool is_deep = false;
};

// Depth is held to 1,000 elements, and in attributes to as many entities; a parent colour space is two elements.
const document_row documents[] = {
    {"attributes, unknown", 500, {.colour = "{ a@='v'}"}, 1},
    {"attributes, of the instance", 500, {.colour = "{ xsi:a@='v'}"}},
    {"attributes, one again and again", 500, {.colour = " ColorNumber=''{ ColorNumber='1'}"}, 1},
    {"attributes, where none is read", 500, {.owner = "<Hqf:Company{ a@='v'}>c</Hqf:Company>"}},
    {"attributes, foreign", 500, {.header = element("Revision", "<x{ a@='v'}/>")}},
    {"prefixes, in one tag", 500, {.root = "{ xmlns:p@='urn:@'}", .header = element("Revision", "{<p@:x/>}")}},
    {"prefixes, one again and again", 500, {.root = "{ xmlns:p='urn:@'}"}},
    {"prefixes, a tag each", 500, {.header = element("Revision", "{<p:x xmlns:p='urn:@'/>}")}},
    {"prefixes, a scope each", 120, {.in_colour = nested(" xmlns:p@='urn:@'")}, 0, true},
    {"prefixes, the format's, a scope each", 120, {.in_colour = nested(" xmlns:Hqf='http://hqf.example/v2'")}, 0, true},
    {"depth", 120, {.in_colour = nested()}, 0, true},
    {"depth, foreign", 200, {.header = element("Revision", "{<x>}{</x>}")}},
    {"text", 20000, company("{text}")},
    {"text, beyond ASCII", 20000, company("{\xC3\xA9\xF0\x9D\x84\x9E}")},
    {"text, in CDATA", 20000, company("<![CDATA[{]te}]]>")},
    {"text, of CDATA sections", 2000, company("{<![CDATA[x]]>}")},
    {"text, cut by comments", 2000, company("{x<!--x-->}")},
    {"text, of an attribute", 20000, {.colour = " Comments='{text}'"}},
    {"comment", 20000, {.owner = "<!--{text}-->"}},
    {"comments", 2000, {.owner = "{<!--x-->}"}},
    {"instruction", 20000, {.owner = "<?p {text}?>"}},
    {"white space", 20000, {.owner = "{ \n\t\r}"}},
    {"names, foreign", 20000, {.header = element("Revision", "<{n} {n}=''></{n}>")}},
    {"names, prefix", 20000, {.root = " xmlns:{n}='http://hqf.example/v2'", .owner = "<{n}:Company>c</{n}:Company>"}},
    {"names, unknown attribute", 20000, {.owner = "<Hqf:Company {n}=''>c</Hqf:Company>"}},
    {"references, to characters", 2000, company("{&#65;&#x1D11E;}")},
    {"references, to characters, attribute", 2000, {.colour = " Comments='{&#65;&#x1D11E;}'"}},
    {"references, to one entity", 2000, {.subset = "<!ENTITY e 'text'>", .owner = element("Company", "{&e;&amp;}")}},
    {"references, to one entity, attribute",
     2000,
     {.subset = "<!ENTITY e 'text'>", .colour = " Comments='{&e;&amp;}'"}},
    {"references, in namespaces", 500, {.subset = "<!ENTITY e 'text'>", .root = "{ xmlns:p@='&e;@'}"}},
    {"references, to tags", 500, {.subset = "<!ENTITY e '<Hqf:Company>c</Hqf:Company>'>", .owner = "{&e;}"}},
    {"declarations", 500, {.subset = "{<!ELEMENT a@ ANY><!ATTLIST a@ b CDATA 'c'><?p @?><!--@-->}"}},
    {"entities, each used", 500, {.subset = "{<!ENTITY e@ 'v'>}", .owner = element("Company", "{&e@;}")}},
    {"entities, one again and again", 500, {.subset = "{<!ENTITY e 'value'>}"}},
    {"entities, in one another", 200, {.subset = general_entities, .owner = element("Company", "&e$;")}},
    {"entities, in one another, attribute", 200, {.subset = general_entities, .colour = " Comments='&e$;'"}},
    {"entities, in one another, parameters", 200, {.subset = parameters(" ")}},
    {"entities, anew while many are read", 200, {.subset = "<!ENTITY x ''>" + parameters("{<!ENTITY x 'v'>}")}},
    {"entities, anew while they are read", 200, {.subset = parameters("{<!ENTITY &#37; e@ 'v'>}")}},
    {"list of texts", 1000, {.owner = "{" + element("Company", "c") + "}"}},
    {"list of dates", 1000, {.in_colour = "{" + date + "}"}},
    {"list of objects", 500, {.palette = "{" + element("Color", date + notation, " ColorName='c'") + "}"}},
    {"list of a group's members", 500, {.in_colour = "{" + notation + "}"}},
    {"list of points",
     1000,
     {.in_colour = space("Spectral", "Spectral", "{" + element("ReflectancePoint", "0.5", " Wavelength='400'") + "}")}},
    {"list of foreign elements", 500, {.header = element("Revision", "{<x>t</x>}")}},
    {"digits of a number",
     20000,
     {.in_colour = space("CIELab", "Tristimulus",
                         element("L", "{0}1.{7}") + element("A", "{0}1.{7}") + element("B", "{0}1e-{0}1"))}},
    {"digits of an integer",
     20000,
     {.owner =
          element("CustomAttribute", element("Name", "n") + element("ValueChoice", element("IntegerValue", "-{0}1")))}},
    {"digits of a second", 20000, {.in_colour = element("ChangeHistory", "2024-05-01T09:00:00.{7}Z")}},
    {"faults of values", 500, {.in_colour = "{" + element("ChangeHistory", "never") + "}"}, 2},
    {"faults of attributes", 500, {.palette = "{" + element("Color", date + notation) + "}"}, 1},
};

TEST(growth, documents) {
    const auto path = zip_test::folder() / "document.hqf";
    for (const document_row& row : documents) {
        std::vector<counts> window, general, copied, written;
        for (const unsigned int step : steps) {
            const string text = patterned_document(row.pattern, row.n * step);
            callers_source own(text);
            lmx::c_read_memory memory(text.data(), static_cast<unsigned int>(text.size()));
            make_file(path, text);
            lmx::c_read_file on_disk(path.c_str());
            general.push_back(count([&] { EXPECT_EQ(load(own).code, 0) << row.name; }));
            const counts file = count([&] { EXPECT_EQ(load(on_disk).code, 0) << row.name; });
            std::unique_ptr<load> loaded;
            window.push_back(count([&] { loaded = std::make_unique<load>(memory); }));
            // Of a file the window shows one block after the other: what doesn't fit into one is read twice at most.
            EXPECT_LT(file.work, window.back().work + general.back().work + 20000) << row.name << ", file";
            EXPECT_EQ(loaded->code, 0) << row.name;
            EXPECT_EQ(loaded->reader.faults, row.faults * row.n * step) << row.name;
            copied.push_back(count([&] {
                const hqf_v2::Hqf copy(loaded->document);
                EXPECT_TRUE(hqf::equal(copy, loaded->document) || row.faults != 0) << row.name;
            }));
            written.push_back(count([&] {
                string out;
                EXPECT_TRUE(loaded->document.marshal(&out) == 0 || row.faults != 0) << row.name;
            }));
        }
        const string name = row.name;
        expect_linear(name + "; window", row.n, window);
        expect_linear(name + "; caller's source", row.n, general);
        expect_linear(name + "; copied, compared", row.n, copied);
        // Indented by one tab more for each level, deep documents are longer than that. The first blocks of output have
        // 64 and 128 KiB.
        if (!row.is_deep) expect_linear(name + "; written", row.n, written, 128 * 1024);
    }
}

/// What the colours of a document cost doesn't depend on how many there are.
TEST(growth, palettes) {
    counts few;
    for (const unsigned int colours : {1000U, 2000U, 4000U, 8000U}) { // of 900 bytes
        const string lab =
            space("CIELab", "Tristimulus", element("L", "52.25") + element("A", "-38.5") + element("B", "0.125"));
        const string text = patterned_document(
            {.palette = "{\n" + element("Color", date + lab + notation + lab, " ColorName=\"c@\"") + "}"}, colours);
        const counts many = count([&] { EXPECT_EQ(hqf_v2::Hqf().unmarshal(text), 0); });
        if (colours == 1000) few = many;
        for (const auto of : {&counts::work, &counts::allocations, &counts::peak}) {
            const double ratio = static_cast<double>(many.*of) / static_cast<double>(few.*of) * 1000 / colours;
            EXPECT_NEAR(ratio, 1, 0.1) << colours << " colours, " << text.size() << " bytes";
        }
    }
}

/// A tag behind one that has used up what entities may add.
void read_beyond_the_limit(const string& text, counts& seen) {
    const string document = "<!DOCTYPE a [<!ENTITY big '" + text + "'>]><a b='" + expanded("{&big;}", 2000) + "'/><a" +
                            expanded("{ b='&big;'}", static_cast<unsigned int>(text.size() / 20)) + "/>";
    lmx::c_read_string source(document);
    lmx::c_error errors;
    lmx::c_xml in(source, errors, true);
    string name, value;
    in.get_element_name(nullptr, &name);
    in.get_attribute_name(&name, false);
    EXPECT_FALSE(in.get_attribute_value(&value, lmx::preserve));
    in.get_attribute_name(&name, false);
    in.get_element_name(nullptr, &name);
    int refused = 0, accepted = 0; // a few are paid for by the bytes of their own tag
    seen = count([&] {
        while (in.get_attribute_name(&name, false) == lmx::EXE_NAME)
            ++(in.get_attribute_value(&value, lmx::preserve) ? accepted : refused);
    });
    EXPECT_GT(refused, 20 * accepted);
}

template<class action>
void with_reader(const string& text, const action& act) {
    lmx::c_read_string source(text);
    lmx::c_xml_reader reader(source);
    act(reader);
}

const struct {
    const char* name;
    unsigned int n;
    const char* pattern;
    void (*use)(const string& text);
} values[] = {
    {"c_big_int", 20000, "-{07}",
     [](const string& text) {
         lmx::c_big_int value(text);
         value.get(nullptr);
         EXPECT_TRUE(value.get_as_float() < 0 && value >= text && !(value > lmx::c_big_int(text)));
     }},
    {"c_decimal", 20000, "-{7}.{7}",
     [](const string& text) {
         const lmx::c_decimal value(text);
         value.get_scaled(9, nullptr);
         EXPECT_TRUE(value == lmx::c_decimal(text) && value.get_as_float() < 0 && value.get_as_string() == text);
     }},
    {"c_duration", 20000, "P{0}1Y{0}1DT{0}1.{0}S",
     [](const string& text) {
         EXPECT_TRUE(lmx::c_duration::is_valid(text) && lmx::c_duration(text).get_years() == 1);
     }},
    {"c_datetime", 20000, "{0}1-01-01T00:00:00.{0}Z",
     [](const string& text) { EXPECT_TRUE(lmx::c_datetime::is_valid(text) && lmx::c_datetime(text).get_year() == 1); }},
    {"c_binary", 20000, "{QUJD}",
     [](const string& text) {
         lmx::c_binary value;
         value.from_base64(text);
         std::ostringstream out;
         value.out_base64(out);
         value.out_hex(out);
         EXPECT_TRUE(lmx::c_binary::is_valid_base64(text) && out.str().substr(0, text.size()) == text);
     }},
    {"list items", 5000, "{item }",
     [](const string& text) {
         lmx::c_xml_list_tokeniser list(text);
         for (string item; list.get(&item);)
             EXPECT_EQ(item, "item");
     }},
    {"wide text", 20000, "{\xC3\xA9\xF0\x9D\x84\x9E &}",
     [](const string& text) {
         std::wstring wide;
         string narrow;
         EXPECT_EQ(lmx::convert(&narrow, lmx::convert(&wide, text)), text);
     }},
    {"scopes of an application", 200, "{.}",
     [](const string& text) {
         std::list<lmx::c_xml_local> chain(1);
         chain.back().add_namespace("outermost", 1000);
         for (std::size_t i = 0; i < text.size(); ++i) {
             chain.emplace_back(chain.back());
             chain.back().add_namespace(("p" + std::to_string(i)).c_str(), 1001);
             EXPECT_EQ(chain.back().find_namespace_id("outermost"), 1000);
         }
     }},
    {"attributes that must be understood", 200, "<x xmlns:p='urn:p'>{<x xmlns:p@='urn:@' p:a='@'>}{</x>}</x>",
     [](const string& text) {
         with_reader(text, [](lmx::c_xml_reader& reader) {
             EXPECT_EQ(lmx::has_must_understand(reader, "urn:none", "a", lmx::bool_must_understand), 0);
         });
     }},
    {"elements skipped", 200, "<x>{<y xmlns:p@='urn:@'>t}{</y>}{<z/>}</x>",
     [](const string& text) {
         with_reader(text, [](lmx::c_xml_reader& reader) {
             EXPECT_TRUE(reader.get_element_name(nullptr, &reader.item_name) == lmx::EXE_NAME &&
                         reader.skip_rest_of_element("x"));
         });
     }},
};

TEST(growth, values) {
    for (const auto& row : values) {
        std::vector<counts> seen;
        for (const unsigned int step : steps) {
            const string text = expanded(row.pattern, row.n * step);
            seen.push_back(count([&] { row.use(text); }));
        }
        expect_linear(row.name, row.n, seen);
    }
    std::vector<counts> beyond(3);
    for (std::size_t i = 0; i < 3; ++i)
        read_beyond_the_limit(string(10000 * steps[i], 't'), beyond[i]);
    expect_linear("references beyond the limit", 500, beyond);
}

TEST(growth, archives) {
    const auto path = zip_test::folder() / "many.zip";
    const auto open = [&] {
        CZipArchive zip;
        EXPECT_TRUE(zip.Open(path.wstring(), CZipStorage::openReadOnly));
        for (unsigned int i = 0; i < zip.GetCount(); ++i)
            EXPECT_TRUE(zip.OpenFile(i) && zip.CloseFile() == -1 && !zip.GetFileInfo(i)->GetFileName().empty());
        zip.Close();
    };
    const auto make = [&](unsigned int n) {
        CZipArchive zip;
        EXPECT_TRUE(zip.Open(path.wstring(), CZipStorage::create));
        for (CZipFileHeader header; zip.GetCount() < n;) {
            header.SetFileName(std::to_wstring(1000000 + zip.GetCount()));
            EXPECT_TRUE(zip.OpenNewFile(header, 0) && zip.WriteNewFile("x", 1) && zip.CloseNewFile());
        }
        zip.Close();
    };
    for (const bool reversed : {false, true}) {
        std::vector<counts> opened, made;
        for (const unsigned int step : steps) {
            std::vector<zip_test::entry> entries(1000 * step, zip_test::entry("x", 0));
            for (zip_test::entry& entry : entries)
                entry.name += std::to_string(&entry - entries.data());
            make_file(path, zip_test::build(entries, "", reversed).bytes);
            opened.push_back(count(open));
            made.push_back(count([&] { make(1000 * step); }));
        }
        expect_linear(reversed ? "archive, entries from the last" : "archive, entries", 1000, opened);
        expect_linear("archive, made", 1000, made);
    }
    std::vector<counts> searched;
    for (const unsigned int step : steps) {
        make_file(path, expanded("{PK\5PK}", 3000 * step)); // up to what a comment can take
        searched.push_back(count([&] { EXPECT_EQ(zip_test::load(path).cause, 118); }));
    }
    expect_linear("archive, search for the end record", 3000, searched);
}

} // namespace
