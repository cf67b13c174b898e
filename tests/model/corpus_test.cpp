// Every rule of the schema, broken by the smallest step, on both roads into the library: bytes in memory, and a
// caller's own source that gives one byte a call. Codes, items and written bytes are those that corpus.py derives from
// the rules.

#include <gtest/gtest.h>

#include <iostream>
#include <map>

#include "hqf/hqf.h"
#include "tests/model/corpus.h"
#include "tests/support/callers_source.h"

namespace {

/// Loads and, after a load without an error, writes. Gives what went against the case, or an empty text.
std::string fault(const corpus::test_case& test, lmx::c_xml_reader& reader) {
    hqf_v2::Hqf document;
    // The stamp of a new document isn't in the corpus.
    document.get_Preamble().get_Header().unset_ReadSDKInformation();
    const int code = document.unmarshal(reader);
    const std::string& item = reader.get_error_item_name();
    if (code != test.code || (test.item != corpus::anything && item != test.item))
        return "code " + std::to_string(code) + " '" + item + '\'';
    if (test.write == corpus::anything) return {};
    std::string text;
    const std::string write = std::to_string(document.marshal(&text));
    if (write != test.write) return "write " + write;
    if (test.written == corpus::anything) return {};
    return text == (test.written == corpus::the_document ? test.document : test.written) ? "" : "written:\n" + text;
}

TEST(corpus, every_case) {
    const std::string bytes = corpus::bytes();
    const std::vector<corpus::test_case> cases = corpus::cases(bytes);
    ASSERT_GT(cases.size(), 10000u) << "the corpus is cut";
    std::map<std::string, int> families;
    int faults = 0;
    for (const corpus::test_case& test : cases) {
        ++families[std::string(test.family)];
        lmx::c_xml_reader_memory memory(test.document.data(), static_cast<unsigned int>(test.document.size()));
        support::callers_source bytes_one_by_one{std::string(test.document)};
        lmx::c_xml_reader general(bytes_one_by_one);
        for (const auto& [road, found] : {std::pair("memory", fault(test, memory)), {"bytes", fault(test, general)}})
            if (!found.empty() && ++faults <= 40)
                ADD_FAILURE() << test.family << ", " << test.what << ", from " << road << ": expected code "
                              << test.code << " '" << test.item << "', write " << test.write << "; found " << found
                              << '\n'
                              << test.document;
    }
    EXPECT_EQ(faults, 0) << "only the first 40 are shown";
    for (const auto& [family, count] : families)
        std::cout << family << ": " << count << '\n';
}

} // namespace
