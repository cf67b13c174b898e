// What stands between a hostile document and the stack, and what keeps a load fast.

#include <gtest/gtest.h>

#include <pthread.h>

#include <functional>
#include <memory>
#include <string>

#include "hqf/hqf.h"
#include "hqf/xml_in/limits.h"
#include "hqf/xml_in/reader_access.h"
#include "tests/support/documents.h"
#include "tests/support/patterns.h"

namespace {

#if defined(__has_feature)
#if __has_feature(address_sanitizer)
#define HQF_LARGE_FRAMES
#endif
#endif
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__) || defined(HQF_LARGE_FRAMES)
constexpr std::size_t stack_factor = 8;
#else
constexpr std::size_t stack_factor = 1;
#endif

/// Runs something in a thread of its own with so much stack; an overflow ends the program.
void on_stack_of(std::size_t bytes, const std::function<void()>& action) {
    pthread_attr_t attributes;
    pthread_attr_init(&attributes);
    pthread_attr_setstacksize(&attributes, bytes * stack_factor);
    pthread_t thread;
    const auto run = [](void* argument) -> void* {
        (*static_cast<const std::function<void()>*>(argument))();
        return nullptr;
    };
    ASSERT_EQ(pthread_create(&thread, &attributes, run, const_cast<std::function<void()>*>(&action)), 0);
    pthread_join(thread, nullptr);
    pthread_attr_destroy(&attributes);
}

/// A document whose one colour has so many parents in one another, in the spelling of our writer or in another.
std::string nested_parents(unsigned int count, bool plain) {
    return support::patterned_document({.in_colour = support::nested(plain ? "" : " ")}, count);
}

/// Hqf, Color and the innermost form stand beside the parents, each of which is two elements.
constexpr unsigned int most_parents = (hqf::limits::model_depth - 3) / 2;

TEST(limits, model_depth) {
    const struct {
        unsigned int parents;
        int code;
    } rows[] = {{most_parents, 0}, {most_parents + 1, 5}, {10000, 5}};
    for (const bool plain : {true, false})
        for (const auto& row : rows) {
            const std::string text = nested_parents(row.parents, plain);
            hqf_v2::Hqf document;
            EXPECT_EQ(document.unmarshal(text), row.code)
                << row.parents << (plain ? " parents" : " parents, spelled otherwise");
        }
}

TEST(limits, objects_at_the_limit_need_little_stack) {
    auto document = std::make_unique<hqf_v2::Hqf>();
    ASSERT_EQ(document->unmarshal(nested_parents(most_parents, true)), 0);
    on_stack_of(1 << 20, [&] {
        auto copy = std::make_unique<hqf_v2::Hqf>(*document);
        EXPECT_TRUE(hqf::equal(*copy, *document));
        *copy = *document;
        std::string text;
        EXPECT_EQ(copy->marshal(&text), 0);
        copy.reset();
        document.reset();
    });
}

TEST(limits, foreign_and_skipped_elements) {
    const std::string nested = "{<x>}{</x>}", record = support::document("documents/quality-control.hqf");
    const std::size_t sample = record.find("<Hqf:PhysicalSample>") + 20, end = record.find("</Hqf:Physical", sample);
    using hqf::limits::capture_depth, hqf::limits::skip_depth;
    static_assert(capture_depth == skip_depth);
    for (const auto& [depth, captures, skips] :
         {std::tuple{skip_depth, 0, 0}, {skip_depth + 1, 29, 10}, {1000000u, 29, 10}}) {
        const std::string kept = support::patterned_document({.header = support::element("Revision", nested)}, depth);
        EXPECT_EQ(hqf_v2::Hqf().unmarshal(kept), captures) << depth;
        // In the place of a mandatory group any element is passed over, but then there is no sample to write.
        hqf_v2::Hqf passing;
        EXPECT_EQ(passing.unmarshal(record.substr(0, sample) + support::expanded(nested, depth) + record.substr(end)),
                  skips)
            << depth;
        std::string out;
        EXPECT_EQ(passing.marshal(&out), 46) << depth;
    }
}

/// In the spelling of our own writer nearly everything is read in the window.
TEST(limits, general_steps_are_few) {
    for (const char* name : {"rendition-chart", "test-color-samples", "light-sources", "color-bars", "recipes",
                             "quality-control", "embedded-profiles"}) {
        const std::string text = support::document(std::string("documents/") + name + ".hqf");
        lmx::c_read_string source(text);
        lmx::c_xml_reader reader(source);
        hqf_v2::Hqf document;
        ASSERT_EQ(document.unmarshal(reader), 0) << name;
        EXPECT_LE(hqf::reader_access::general_steps(reader), 16u) << name;
        EXPECT_GE(hqf::reader_access::general_steps(reader), 1u) << "the end of the document is always general";
    }
}

} // namespace
