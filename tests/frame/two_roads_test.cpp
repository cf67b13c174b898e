// Whatever the bytes are, the road over the window and the general road give the same codes, items, lines and objects.
// The general road is taken by a source that the library knows nothing of.

#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>
#include <map>
#include <random>
#include <string>
#include <vector>

#include "hqf/hqf.h"
#include "hqf/xml_in/c_read.h"
#include "hqf/xml_in/c_read_memory.h"
#include "hqf/xml_in/c_xml_reader.h"
#include "tests/support/documents.h"

namespace {

/// Hands out one byte a call, through its virtual operation.
class one_byte_source : public lmx::c_read {
public:
    explicit one_byte_source(const std::string& text)
        : text_(text) {}
    int read() override { return at_ < text_.size() ? static_cast<unsigned char>(text_[at_++]) : -1; }
    void rewind() override { at_ = 0; }

private:
    const std::string& text_;
    std::size_t at_ = 0;
};

/// Writes every report down, with what a handler can see of the reader, and goes on if asked to.
class recording_reader : public lmx::c_xml_reader {
public:
    recording_reader(lmx::c_read& source, bool goes_on)
        : c_xml_reader(source)
        , goes_on_(goes_on) {}
    lmx::elmx_error user_handle_error(lmx::elmx_error code, const std::string& item, const char*, int) override {
        log += std::to_string(code) + ' ' + item + " line " + std::to_string(get_line_no()) + " depth " +
               std::to_string(get_element_name_stack().get_stack_size()) + ' ' + item_name + '\n';
        return goes_on_ ? lmx::err_no_error : code;
    }
    std::string log;

private:
    bool goes_on_;
};

struct outcome {
    hqf_v2::Hqf document;
    std::string log;
};

void load(lmx::c_read& source, bool goes_on, outcome& out) {
    recording_reader reader(source, goes_on);
    const lmx::elmx_error code = out.document.unmarshal(reader);
    out.log = reader.log + "code " + std::to_string(code) + " line " + std::to_string(reader.get_line_no());
}

void expect_same_on_both_roads(const std::string& text, const std::string& what,
                               std::initializer_list<bool> handlers = {false, true}) {
    for (const bool goes_on : handlers) {
        outcome fast;
        outcome general;
        lmx::c_read_memory memory(text.data(), static_cast<unsigned int>(text.size()));
        one_byte_source bytes(text);
        load(memory, goes_on, fast);
        load(bytes, goes_on, general);
        ASSERT_EQ(fast.log, general.log) << what << (goes_on ? ", with a handler that goes on" : "");
        ASSERT_TRUE(hqf::equal(fast.document, general.document)) << what << ": different objects\n" << fast.log;
    }
}

/// Pieces that meet the places where the two roads part.
const char* const pieces[] = {
    "<",
    ">",
    "/",
    "&",
    "&amp;",
    "&#65;",
    "&nope;",
    "\"",
    "'",
    " ",
    "\n",
    "\r",
    "\r\n",
    "\t",
    "\xC2\x85",
    "\xE2\x80\xA8",
    "\xC3\xA9",
    "\xF0\x9D\x84\x9E",
    "\xFF",
    "\x01",
    "<!-- c -->",
    "<![CDATA[x]]>",
    "<?p?>",
    "-",
    "1e5",
    "NaN",
    "INF",
    "-0.0",
    "1.5",
    " 2 ",
    "text",
    "</Hqf:Color>",
    "<Hqf:Color>",
    "<Hqf:L>1</Hqf:L>",
    "xsi:nil=\"true\"",
    " xsi:nil=\"1\"",
    " xmlns:Hqf=\"urn:x\"",
    " xmlns=\"http://hqf.example/v2\"",
    " Name=\"n\"",
    " Comments='c'",
    "/>",
    "<Hqf:Version>v</Hqf:Version>",
    "<x/>",
    "2024-05-01T09:00:00Z",
    "2024-05-01T09:00:00",
    "Hqf:",
    "<Hqf:Function>",
};

std::string mutate(std::string text, std::mt19937& random) {
    const auto below = [&](std::size_t n) { return n == 0 ? 0 : static_cast<std::size_t>(random()) % n; };
    for (std::size_t changes = 1 + below(3); changes != 0 && !text.empty(); --changes) {
        const std::size_t at = below(text.size());
        switch (below(7)) {
        case 0: text[at] = static_cast<char>(below(256)); break;
        case 1: text.erase(at, 1 + below(4)); break;
        case 2: text.insert(at, pieces[below(std::size(pieces))]); break;
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
            if (from != std::string::npos) text.insert(from + 1, pieces[below(std::size(pieces))]);
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
    const char* const path = "block_edges.hqf";
    for (std::size_t shift = 0; shift < text.size() - content; ++shift) {
        const std::string padded =
            text.substr(0, content) + std::string(block - content - shift, ' ') + text.substr(content);
        {
            std::ofstream file(path, std::ios::binary);
            file << padded;
        }
        outcome from_file, from_memory;
        lmx::c_read_file file(path);
        lmx::c_read_memory memory(padded.data(), static_cast<unsigned int>(padded.size()));
        load(file, true, from_file);
        load(memory, true, from_memory);
        ASSERT_EQ(from_file.log, from_memory.log) << "edge at byte " << shift << " of the content";
        ASSERT_TRUE(hqf::equal(from_file.document, from_memory.document)) << "edge at byte " << shift;
    }
    std::remove(path);
}

/// The document of every element and attribute, cut into documents of one colour, palette or record each.
std::vector<std::string> everything_in_parts() {
    const std::string text = support::document("documents/everything.hqf");
    const std::size_t head = text.find("</Hqf:Preamble>") + 15;
    std::vector<std::string> parts = {text.substr(0, head) + "\n</Hqf:Hqf>\n"};
    for (std::size_t from = text.find("\n\t<", head); from != std::string::npos;) {
        const std::size_t next = text.find("\n\t</", from);
        const std::size_t end = next == std::string::npos ? next : text.find('>', next) + 1;
        if (end == std::string::npos) break;
        parts.push_back(text.substr(0, head) + text.substr(from, end - from) + "\n</Hqf:Hqf>\n");
        from = text.find("\n\t<", end);
    }
    return parts;
}

struct place {
    std::string text;
    std::size_t begin;
    std::size_t end;
};

/// For each name in front of a value, its shortest document and where the value stands there.
std::map<std::string, place> values_by_name() {
    std::map<std::string, place> found;
    for (const std::string& text : everything_in_parts()) {
        const auto add = [&](const std::string& name, std::size_t begin, std::size_t end) {
            const auto old = found.find(name);
            if (old == found.end() || old->second.text.size() > text.size()) found[name] = {text, begin, end};
        };
        for (std::size_t at = text.find('<'); at != std::string::npos; at = text.find('<', at + 1)) {
            const std::size_t close = text.find('>', at);
            const std::string name = text.substr(at, text.find_first_of(" >", at) - at);
            const std::size_t value_end = text.find('<', close);
            if (value_end != std::string::npos && text.compare(value_end, name.size() + 1, "</" + name.substr(1)) == 0)
                add(name, close + 1, value_end);
            for (std::size_t quote = text.find("=\"", at); quote < close; quote = text.find("=\"", quote + 2)) {
                const std::size_t blank = text.rfind(' ', quote);
                add(name + text.substr(blank, quote - blank), quote + 2, text.find('"', quote + 2));
            }
        }
    }
    return found;
}

/// Every value of every element and attribute, spelled in ways that only the general road may read, or nobody.
TEST(two_roads, values_spelled_otherwise) {
    const auto places = values_by_name();
    ASSERT_GT(places.size(), 250u) << "the document no longer holds every name";
    for (const auto& [name, at] : places) {
        const std::string value = at.text.substr(at.begin, at.end - at.begin);
        const std::string spellings[] = {
            "",
            " " + value,
            value + " ",
            "\n" + value + "\r\n",
            "a  b",
            "a\tb",
            "\r",
            "+" + value,
            "0" + value,
            value + "0",
            value + "<!-- -->",
            "&#32;" + value,
            "&amp;" + value,
            "&lt",
            "1e400",
            "-1",
            "2147483648",
            "NaN",
            "x",
            "<![CDATA[" + value + "]]>",
            value + "\xC3\xA9",
            value + "\xC2\x85",
            "2024-02-30T25:00:00Z",
            "&apos;&quot;&gt;",
        };
        for (const std::string& spelling : spellings)
            expect_same_on_both_roads(at.text.substr(0, at.begin) + spelling + at.text.substr(at.end),
                                      name + " with the value '" + spelling + "'", {true});
    }
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
