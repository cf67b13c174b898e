// Whatever the bytes are, the road over the window and the general road give the same codes, items, lines and objects.

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

#include "hqf/hqf.h"
#include "hqf/xml_in/c_read_memory.h"
#include "tests/model/corpus.h"
#include "tests/support/callers_source.h"
#include "tests/support/documents.h"
#include "tests/support/files.h"
#include "tests/support/table.h"
#include "tests/support/two_roads.h"

namespace {

using support::load, support::outcome;

void expect_same_on_both_roads(const std::string& text, const std::string& what,
                               std::initializer_list<bool> handlers = {false, true}) {
    for (const bool goes_on : handlers) {
        outcome fast;
        outcome general;
        lmx::c_read_memory memory(text.data(), static_cast<unsigned int>(text.size()));
        support::callers_source bytes(text);
        load(memory, goes_on, fast);
        load(bytes, goes_on, general);
        ASSERT_EQ(fast.log, general.log) << what << (goes_on ? ", with a handler that goes on" : "");
        ASSERT_TRUE(hqf::equal(fast.document, general.document)) << what << ": different objects\n" << fast.log;
    }
}

/// Pieces that meet the places where the two roads part.
std::vector<std::string> all_pieces() {
    auto pieces = support::words(
        "< > / & &amp; &#65; &nope; \" ' _ \xC2\x85 \xE2\x80\xA8 \xC3\xA9 \xF0\x9D\x84\x9E \xFF \x01 <!--_c_--> "
        "<![CDATA[x]]> <?p?> - 1e5 NaN INF -0.0 1.5 _2_ text </Hqf:Color> <Hqf:Color> <Hqf:L>1</Hqf:L> "
        "xsi:nil=\"true\" _xsi:nil=\"1\" _xmlns:Hqf=\"urn:x\" _xmlns=\"http://hqf.example/v2\" _Name=\"n\" "
        "_Comments='c' /> <Hqf:Version>v</Hqf:Version> <x/> 2024-05-01T09:00:00Z 2024-05-01T09:00:00 Hqf: "
        "<Hqf:Function>");
    for (const char* space : {"\n", "\r", "\r\n", "\t"})
        pieces.push_back(space);
    return pieces;
}

std::string mutate(std::string text, std::mt19937& random) {
    static const auto pieces = all_pieces();
    const auto below = [&](std::size_t n) { return n == 0 ? 0 : static_cast<std::size_t>(random()) % n; };
    for (std::size_t changes = 1 + below(3); changes != 0 && !text.empty(); --changes) {
        const std::size_t at = below(text.size());
        switch (below(7)) {
        case 0: text[at] = static_cast<char>(below(256)); break;
        case 1: text.erase(at, 1 + below(4)); break;
        case 2: text.insert(at, pieces[below(pieces.size())]); break;
        case 3: text.resize(at); break;
        case 4: { // an element or two once more
            const std::size_t from = text.find('<', at);
            const std::size_t to = from == std::string::npos ? from : text.find('\n', from);
            if (to != std::string::npos) text.insert(from, text.substr(from, to - from + 1));
            break;
        }
        case 5: { // one line less
            const std::size_t from = text.find('\n', at);
            const std::size_t to = from == std::string::npos ? from : text.find('\n', from + 1);
            if (to != std::string::npos) text.erase(from, to - from);
            break;
        }
        default: { // something else inside a value
            const std::size_t from = text.find('>', at);
            if (from != std::string::npos) text.insert(from + 1, pieces[below(pieces.size())]);
            break;
        }
        }
    }
    return text;
}

TEST(two_roads, sample_documents) {
    for (const char* folder : {"documents", "syntax", "bad"})
        for (const auto& [name, text] : support::documents(folder))
            expect_same_on_both_roads(text, name);
}

/// Every cut of a small document.
TEST(two_roads, cut_documents) {
    const std::string text = support::document("syntax/plain.hqf");
    for (std::size_t size = 0; size <= text.size(); ++size)
        expect_same_on_both_roads(text.substr(0, size), "cut at " + std::to_string(size));
}

/// Files come in blocks of 256 KB. Blanks in front of the content move the edge of the first one over every byte of it.
TEST(two_roads, block_edges_of_files) {
    constexpr std::size_t block = 256 * 1024;
    std::string text = support::document("syntax/plain.hqf");
    const std::size_t broken = text.find("</Hqf:Purpose>");
    const std::size_t content = text.find("<Hqf:Preamble>");
    ASSERT_NE(broken, std::string::npos);
    text.insert(broken, "&nope;");
    const support::folder place;
    const std::string path = place / "a.hqf";
    for (std::size_t shift = 0; shift < text.size() - content; ++shift) {
        const std::string padded =
            text.substr(0, content) + std::string(block - content - shift, ' ') + text.substr(content);
        support::make_file(path, padded);
        outcome from_file, from_memory;
        lmx::c_read_file file(path.c_str());
        lmx::c_read_memory memory(padded.data(), static_cast<unsigned int>(padded.size()));
        load(file, true, from_file);
        load(memory, true, from_memory);
        ASSERT_EQ(from_file.log, from_memory.log) << "edge at byte " << shift << " of the content";
        ASSERT_TRUE(hqf::equal(from_file.document, from_memory.document)) << "edge at byte " << shift;
    }
}

/// Every rule of the schema broken, every value spelled otherwise: with a handler that goes on. That each fault alone
/// has the same code on both roads is seen where the corpus is tested.
TEST(two_roads, corpus) {
    const std::string bytes = corpus::bytes();
    for (const corpus::test_case& test : corpus::cases(bytes))
        expect_same_on_both_roads(std::string(test.document), std::string(test.what), {true});
}

TEST(two_roads, mutated_documents) {
    std::mt19937 random(20241105);
    const int rounds = support::repetitions(4000);
    std::vector<std::string> seeds;
    for (const char* folder : {"syntax", "bad"})
        for (const auto& [name, text] : support::documents(folder))
            if (text.size() < 10000) seeds.push_back(text);
    // A part of each large document: the start, and then somewhere else on.
    for (const auto& [name, text] : support::documents("documents")) {
        seeds.push_back(text.substr(0, 12000));
        const std::size_t colour = text.find("<Hqf:Color ", text.size() / 2);
        const std::size_t preamble = text.find("</Hqf:Preamble>");
        if (colour != std::string::npos && preamble != std::string::npos)
            seeds.push_back(text.substr(0, preamble + 15) + text.substr(colour, 12000));
    }
    for (int round = 0; round < rounds; ++round) {
        const std::string text = mutate(seeds[random() % seeds.size()], random);
        expect_same_on_both_roads(text, "round " + std::to_string(round));
        if (HasFatalFailure()) {
            support::keep("two_roads_failure.hqf", text);
            return;
        }
    }
}

} // namespace
