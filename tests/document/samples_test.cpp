// The sample documents: sound ones come back byte for byte, all spellings of one document read alike, and broken ones
// give the code, item and line of bad/expected.tsv.

#include <gtest/gtest.h>

#include <set>
#include <sstream>

#include "tests/document/support.h"
#include "tests/support/documents.h"
#include "tests/support/memory.h"

namespace {

using namespace document_test;

TEST(samples, sound_documents_round_trip) {
    const folder place;
    const auto documents = support::documents("documents");
    ASSERT_GE(documents.size(), 8u);
    for (const auto& [name, text] : documents) {
        const auto file = place / "in.hqf", copy = place / "out.hqf", archive = place / "out.hqfz";
        make_file(file, text);
        hqf_v2::Hqf from_file, from_text, from_archive;
        EXPECT_EQ(from_file.loadFile(wide(file)), 0) << name;
        EXPECT_EQ(from_file.writeFile(wide(copy)), 0) << name;
        EXPECT_TRUE(bytes_of(copy) == text) << name;
        EXPECT_EQ(from_text.loadString(wide(text)), 0) << name;
        EXPECT_TRUE(from_text.writeString().getXmlDocument() == wide(text)) << name;
        EXPECT_EQ(from_text.writeFile(wide(archive)), 0) << name;
        EXPECT_EQ(from_archive.loadFile(wide(archive)), 0) << name;
        EXPECT_TRUE(written(from_archive) == text) << name;
    }
}

TEST(samples, spellings_of_one_document) {
    const auto documents = support::documents("syntax");
    EXPECT_EQ(documents.size(), 25u);
    for (const auto& [path, text] : documents) {
        const std::string name = path.substr(7, path.size() - 11);
        hqf_v2::Hqf document;
        EXPECT_EQ(document.unmarshal(text), 0) << name;
        const bool unicode = name == "character-references" || name == "unicode" || name.rfind("utf16", 0) == 0;
        EXPECT_EQ(written(document), support::document(unicode ? "syntax/unicode.hqf" : "syntax/plain.hqf")) << name;
    }
}

/// "*" leaves the outcome open: such a load must end, and its memory is bounded like that of all others.
TEST(samples, broken_documents) {
    std::istringstream table(support::document("bad/expected.tsv"));
    std::set<std::string> listed;
    std::string row;
    std::getline(table, row);
    while (std::getline(table, row)) {
        std::istringstream fields(row);
        std::string name, code, item, line, why;
        std::getline(fields, name, '\t') && std::getline(fields, code, '\t') && std::getline(fields, item, '\t') &&
            std::getline(fields, line, '\t') && std::getline(fields, why);
        ASSERT_FALSE(why.empty()) << row;
        listed.insert("bad/" + name);
        const std::string text = support::document("bad/" + name);
        const std::int64_t before = support::bytes_asked;
        hqf_v2::Hqf document;
        lmx::c_xml_reader_memory reader(text.data(), static_cast<unsigned int>(text.size()));
        const int found = document.unmarshal(reader);
        // No document may cost memory that it hasn't paid for.
        EXPECT_LT(support::bytes_asked - before, static_cast<std::int64_t>(16'000'000 + 100 * text.size())) << row;
        if (code == "*") continue;
        const bool loads = code.rfind("write ", 0) == 0;
        EXPECT_EQ(loads ? written(document) : std::to_string(found), loads ? "code " + code.substr(6) : code) << row;
        EXPECT_TRUE(!loads || found == 0) << row;
        EXPECT_EQ(item == "-" ? item : reader.get_error_item_name(), item) << row;
        EXPECT_EQ(line == "-" ? line : std::to_string(reader.get_line_no()), line) << row;
    }
    for (const auto& [name, text] : support::documents("bad"))
        EXPECT_TRUE(listed.count(name)) << name;
}

} // namespace
