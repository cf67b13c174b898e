// The window against the general path: whatever is read through it, bytes and line numbers must be those that one
// character at a time gives.

#include "support.h"

#include "hqf/xml_in/byte_scan.h"
#include "hqf/xml_in/reader_access.h"

#include <random>

namespace {

using namespace xml_in_test;
using namespace std::string_literals;
using hqf::reader_access;
using hqf::window;
using stream = reading<lmx::c_get_with_entities>;

TEST(window, gives_the_bytes_and_lines_of_the_general_path_from_files_and_from_memory) {
    std::minstd_rand random(20240501);
    const std::string parts[] = {"<",        "&",    "\"",           " ",        "\n",
                                 "\r",       "\r\n", "\t\v",         "text",     "\xE9z",
                                 "\xC3\xA9", "\x01", "\xE2\x80\xA8", "\xC2\x85", "<L>50.25</L>\n"};
    for (const std::size_t size : {900u, 900u, 901u, 901u, 20000u, 20001u, 2000000u, 200001u}) {
        const bool is_in_memory = size % 2 == 1;
        std::string text = "<a>";
        while (text.size() < size)
            text += random() % 99 == 0
                        ? std::string(random() % std::min<std::size_t>(size / 4, 20000), ".\n "[random() % 3])
                        : parts[random() % std::size(parts)];
        text += std::string(100, ' ');
        const temporary_file on_disk(text);
        lmx::c_read_file file(on_disk.path.c_str());
        lmx::c_read_string memory(text);
        stream fast(is_in_memory ? static_cast<lmx::c_read&>(memory) : file), general(text);
        // Then lines wait till someone asks, which half the steps do not.
        if (is_in_memory) reader_access::note_lasting_source(fast.in);
        std::size_t through_window = 0;
        for (int ends = 0; ends < 3 && !HasFailure();) {
            window* const w = random() % 4 == 0 ? nullptr : reader_access::begin_step(fast.in);
            if (w == nullptr) {
                const int c = general.in.get();
                ends = c == -1 ? ends + 1 : 0;
                ASSERT_EQ(fast.in.get(), c);
                if (c != -1 && random() % 3 == 0) fast.in.unget(c), general.in.unget(c);
            } else {
                const char* const from = w->p;
                if (random() % 3 == 0)
                    w->p = w->skip_space(w->p);
                else if (const char* const end = w->find(w->p, "<\" "[random() % 3]))
                    w->p = end;
                else if (w->room(w->p, 3))
                    ++w->p;
                // A step of the engine ends neither within a character nor within CR LF.
                while (w->p != from && ((*w->p & 0xC0) == 0x80 || w->p[-1] == '\r'))
                    --w->p;
                if (random() % 4 == 0) w->p = from;
                through_window += static_cast<std::size_t>(w->p - from);
                for (const char* at = from; at != w->p; ++at) {
                    if (*at == '\n' && at != from && at[-1] == '\r') continue;
                    ASSERT_EQ(general.in.get(), *at == '\r' ? '\n' : static_cast<unsigned char>(*at));
                }
            }
            if (random() % 2 == 0) continue;
            ASSERT_EQ(w != nullptr && random() % 2 == 0 ? w->line() : fast.in.get_line_num(),
                      general.in.get_line_num());
        }
        EXPECT_GT(through_window, size / 3) << "the comparison must be about something";
    }
}

TEST(window, proves_only_what_the_general_path_leaves_as_it_is) {
    int proven = 0;
    for (int lead = 0; lead < 256; ++lead)
        for (const char second : "\0\n\x7F\x80\x84\x85\x8F\x90\x9F\xA0\xA8\xBF\xC0\xFF"s)
            for (const char third : "A\x7F\x80\xA8\xBF\xC0"s)
                for (const char fourth : {'A', '\x80', '\xBF'}) {
                    // Each at another place of a wide load.
                    const std::string front = "<" + std::string(static_cast<std::size_t>(lead) % 40, 'a');
                    const std::string text =
                        front + static_cast<char>(lead) + second + third + fourth + std::string(80, '.');
                    const char* const stop = text.data() + front.size() + 8;
                    if (lead == '\r' || hqf::find_not_plain(text.data(), stop) < stop) continue;
                    ++proven;
                    stream general(text);
                    for (const char c : text)
                        ASSERT_EQ(general.in.get(), static_cast<unsigned char>(c)) << "lead " << lead;
                }
    EXPECT_GT(proven, 1000) << "the comparison must be about something";
}

TEST(window, opens_only_where_the_library_may_read_ahead) {
    const std::string text = "<a>&e;x</a>" + std::string(1000, ' ');
    const temporary_file on_disk(text);
    lmx::c_read_string memory(text);
    lmx::c_read_file file(on_disk.path.c_str()), callers_file(std::fopen(on_disk.path.c_str(), "rb"));
    callers_source callers(text);
    struct : lmx::c_read_string {
        using c_read_string::c_read_string;
        int read() override { return c_read_string::read(); }
    } derived(text);
    using in = lmx::c_get_with_entities&;
    const auto nothing = [](in) {};
    const std::tuple<lmx::c_read*, std::function<void(in)>, char, const char*> rows[] = {
        // what stands next in the window, or '!'
        {&memory, nothing, '>', "memory"},
        {&file, nothing, '>', "a file"},
        {&callers_file, nothing, '!', "a caller's handle"},
        {&callers, nothing, '!', "a caller's source"},
        {&derived, nothing, '!', "one that may override"},
        {&memory, [](in g) { g.unget('a'), g.unget('<'); }, '<', "given back, found again"},
        {&memory, [](in g) { g.unget('b'); }, '!', "but only what stands there"},
        {&memory, [](in g) { g.set_encoding("ISO-8859-1"); }, '!', "no UTF-8"},
        {&memory, [](in g) { g.error(lmx::error_fatal, lmx::err_not_well_formed, ""); }, '!', "ended by a report"},
        {&memory, [](in g) { g.set_input_entity_value("v"); }, '!', "an entity is being read"},
    };
    for (const auto& [source, prepare, next, why] : rows) {
        source->rewind();
        stream s(*source);
        EXPECT_EQ(reader_access::begin_step(s.in), nullptr) << "nothing is known before the first byte";
        s.in.get();
        EXPECT_EQ(reader_access::begin_step(s.in), nullptr) << "the detection has read a character ahead";
        s.in.get();
        prepare(s.in);
        window* const w = reader_access::begin_step(s.in);
        ASSERT_EQ(w == nullptr ? '!' : *w->p, next) << why;
        if (next != '>') continue;
        EXPECT_TRUE(w->room(w->p, text.size() - 2 - 68)) << why;
        EXPECT_FALSE(w->room(w->p, text.size() - 2 - 63)) << "64 bytes stay behind the edge, for wide loads: " << why;
    }
}

} // namespace
