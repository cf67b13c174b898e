#include "support.h"

#include "hqf/values/s_ns_map.h"
#include "hqf/xml_in/byte_scan.h"
#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml_reader_memory.h"
#include "hqf/xml_in/reader_access.h"

#include <gtest/gtest.h>

#include <random>

// The window against the general path: whatever is read through it, bytes and line numbers must be those that one
// character at a time gives.

namespace {

using namespace xml_in_test;
using namespace std::string_literals;
using hqf::reader_access;
using hqf::window;

struct delivered {
    int character;
    int line;
};

// What the general path gives. A sequence that is no UTF-8 reads as the end, so three ends in a row are taken for it.
std::vector<delivered> deliver(const std::string& bytes) {
    callers_source source(bytes);
    recorder errors;
    lmx::c_get_with_entities getter(source, errors);
    std::vector<delivered> out;
    for (int ends = 0; ends < 3;) {
        const int c = getter.get();
        ends = c == -1 ? ends + 1 : 0;
        out.push_back({c, getter.get_line_num()});
    }
    return out;
}

// Reads a document by a random mixture of general steps, characters given back, and steps of the window.
class mixed_reader {
public:
    mixed_reader(lmx::c_read& source, const std::vector<delivered>& truth, std::uint_fast32_t seed)
        : getter_(source, errors_)
        , truth_(truth)
        , random_(seed) {}

    // The number of bytes that came through the window.
    std::size_t read_all() {
        while (next_ < truth_.size() && !testing::Test::HasFailure()) {
            if (random_() % 4 == 0)
                general_step();
            else if (window* const w = reader_access::begin_step(getter_))
                window_step(*w);
            else
                general_step();
        }
        return through_window_;
    }

private:
    void general_step() {
        std::vector<int> got;
        for (std::size_t count = 1 + random_() % 3; count > 0 && next_ < truth_.size(); --count) {
            got.push_back(getter_.get());
            ASSERT_EQ(got.back(), truth_[next_].character) << "at " << next_;
            ASSERT_EQ(getter_.get_line_num(), truth_[next_].line) << "at " << next_;
            ++next_;
        }
        if (random_() % 2 == 0) return;
        // A character given back keeps the line as it is, whoever reads it again.
        const int line = getter_.get_line_num();
        const std::size_t count = random_() % (got.size() + 1);
        for (std::size_t i = 0; i < count; ++i)
            getter_.unget(truth_[--next_].character);
        if (window* const w = reader_access::begin_step(getter_)) {
            ASSERT_EQ(w->line(), line) << "at " << next_;
            return;
        }
        for (std::size_t i = 0; i < count; ++i, ++next_) {
            ASSERT_EQ(getter_.get(), truth_[next_].character);
            ASSERT_EQ(getter_.get_line_num(), line) << "at " << next_;
        }
    }

    void window_step(window& w) {
        const char* const mark = w.mark();
        std::string_view piece;
        switch (random_() % 4) {
        case 0: w.skip_space(); break;
        case 1: {
            const char stop = "<\"'x"[random_() % 4];
            if (w.text(stop, piece)) {
                ASSERT_EQ(*w.p, stop);
                ASSERT_EQ(piece.find_first_of("&\r"s + stop), std::string_view::npos);
            } else {
                ASSERT_EQ(w.p, mark) << "nothing has changed";
            }
            break;
        }
        case 2: {
            const std::size_t length = random_() % 3 == 0 ? random_() % 40000 : random_() % 20;
            if (w.room(length)) w.p += length;
            // The engine only stops at ASCII characters.
            while (w.p != mark && w.p != w.edge() && (static_cast<unsigned char>(*w.p) & 0xC0) == 0x80)
                --w.p;
            break;
        }
        default: break;
        }
        if (random_() % 3 == 0) {
            if (random_() % 2 == 0) (void)w.line();
            w.back(mark);
            return;
        }
        compare(mark, w);
    }

    void compare(const char* from, window& w) {
        through_window_ += static_cast<std::size_t>(w.p - from);
        if (w.p == from) return;
        for (const char* at = from; at != w.p; ++at) {
            // The second half of CR LF is delivered with the first.
            if (*at == '\n' && at != from && at[-1] == '\r') continue;
            const int expected = *at == '\r' ? '\n' : static_cast<unsigned char>(*at);
            ASSERT_EQ(expected, truth_[next_].character) << "at " << next_;
            ++next_;
        }
        ASSERT_EQ(random_() % 2 == 0 ? w.line() : getter_.get_line_num(), truth_[next_ - 1].line) << "at " << next_;
        if (w.p[-1] != '\r' || *w.p != '\n') return;
        // A step that ends within CR LF: the second half is nobody's, for the window and for the general path alike.
        if (random_() % 2 == 0 || !w.room(1)) {
            w.close();
        } else if (const char* const second_half = w.p; random_() % 2 == 0 || (w.begin_step() && w.p == second_half)) {
            ++w.p;
        }
        ASSERT_EQ(getter_.get_line_num(), truth_[next_ - 1].line) << "at " << next_;
    }

    recorder errors_;
    lmx::c_get_with_entities getter_;
    const std::vector<delivered>& truth_;
    std::minstd_rand random_;
    std::size_t next_ = 0;
    std::size_t through_window_ = 0;
};

std::string random_document(std::minstd_rand& random) {
    static const std::string parts[] = {
        "<",
        ">",
        "&",
        "\"",
        "'",
        "x",
        " ",
        "\n",
        "\r",
        "\r\n",
        "\t\t",
        "\v\f",
        "\xC3\xA9",
        "\xE2\x82\xAC",
        "\xF0\x9D\x84\x9E",
        "plain words of a value ",
        "\n\t\t<Hqf:L>50.25</Hqf:L>",
    };
    static const std::string oddities[] = {
        "\xC2\x85", "\xE2\x80\xA8", "\x01", "\x1F",     "\x7F",         "\0"s,
        "\x80",     "\xFF",         "\xC3", "\xE2\x82", "\xED\xA0\x80", "\xC0\x80",
    };
    std::string out = "<a>";
    const std::size_t count = random() % 400;
    const std::size_t odd_chance = random() % 3 == 0 ? 20 : 2000;
    for (std::size_t i = 0; i < count; ++i) {
        if (random() % odd_chance == 0)
            out += oddities[random() % std::size(oddities)];
        else
            out += parts[random() % std::size(parts)];
        if (random() % 200 == 0) out += std::string(random() % 90000, ".\n "[random() % 3]);
    }
    return out;
}

TEST(window, gives_the_bytes_and_lines_of_the_general_path) {
    std::minstd_rand random(20240501);
    std::size_t through_window = 0;
    for (unsigned round = 0; round < 300; ++round) {
        SCOPED_TRACE("round " + std::to_string(round));
        std::string document = random_document(random);
        // Some are longer than the blocks in which a file is read.
        if (round % 20 == 0)
            while (document.size() < 700000)
                document += random_document(random);
        const std::vector<delivered> truth = deliver(document);
        lmx::c_read_string memory(document);
        through_window += mixed_reader(memory, truth, random()).read_all();
        const temporary_file on_disk(document);
        lmx::c_read_file file(on_disk.path.c_str());
        through_window += mixed_reader(file, truth, random()).read_all();
        if (HasFailure()) return;
    }
    EXPECT_GT(through_window, 1000000u) << "the comparison must be about something";
}

// Whether a sequence is proven; then the general path must deliver it unchanged.
bool is_proven(const std::string& sequence) {
    const std::string text = "<aaa" + sequence + "zzzz" + std::string(80, '.');
    if (hqf::find_not_plain(text.data(), text.data() + 12) < text.data() + 12) return false;
    std::string general;
    for (const delivered& d : deliver(text))
        general += static_cast<char>(d.character);
    EXPECT_EQ(general.substr(0, text.size()), text);
    return true;
}

TEST(window, proves_only_what_the_general_path_leaves_as_it_is) {
    const std::string seconds = "\0\n\x7F\x80\x84\x85\x8F\x90\x9F\xA0\xA8\xBF\xC0\xFF"s;
    const std::string thirds = "A\x7F\x80\xA8\xBF\xC0";
    int proven = 0;
    for (int lead = 0; lead < 256; ++lead)
        for (const char second : seconds)
            for (const char third : thirds)
                for (const char fourth : {'A', '\x80', '\xBF'})
                    if (lead != '\r') proven += is_proven({static_cast<char>(lead), second, third, fourth}) ? 1 : 0;
    EXPECT_GT(proven, 1000) << "the comparison must be about something";
}

TEST(window, finds_the_first_doubtful_byte_wherever_it_stands) {
    const struct {
        std::string bytes;
        bool is_plain;
        const char* why;
    } rows[] = {
        {"\t\n\v\f\r", true, "the controls that are white space"},
        {"\x08", false, "the one below them"},
        {"\x0E", false, "the one above"},
        {"\x1F", false, "the last control"},
        {"\x7F", true, "DEL is no control here"},
        {"\0"s, false, "NUL"},
        {"\xC2\x84", true, "beside U+0085"},
        {"\xC2\x85", false, "U+0085"},
        {"\xE2\x80\xA7", true, "beside U+2028"},
        {"\xE2\x80\xA8", false, "U+2028"},
        {"\xED\x9F\xBF", true, "below the surrogates"},
        {"\xED\xA0\x80", false, "a surrogate"},
        {"\xF4\x8F\xBF\xBF", true, "the last character"},
        {"\xF4\x90\x80\x80", false, "above it"},
        {"\xE0\x9F\xBF", false, "overlong in three"},
        {"\xF0\x8F\xBF\xBF", false, "overlong in four"},
        {"\xC1\xBF", false, "overlong in two"},
        {"\xE2\x82.", false, "a byte short"},
        {"\xF0\x9D\x84.", false, "a byte short of four"},
    };
    for (const auto& row : rows)
        for (std::size_t before = 0; before < 40; ++before) {
            const std::string text = std::string(before, 'x') + row.bytes + std::string(100, 'y');
            const std::size_t stop = before + row.bytes.size() + 20;
            const std::size_t found =
                static_cast<std::size_t>(hqf::find_not_plain(text.data(), text.data() + stop) - text.data());
            EXPECT_EQ(found, row.is_plain ? stop : before) << row.why << " behind " << before;
        }
}

TEST(window, opens_only_where_the_library_may_read_ahead) {
    const std::string text = "<a>&e;x</a>" + std::string(1000, ' ');
    const temporary_file on_disk(text);
    lmx::c_read_string memory(text);
    lmx::c_read_file file(on_disk.path.c_str());
    lmx::c_read_file callers_file(std::fopen(on_disk.path.c_str(), "rb"));
    callers_source callers(text);
    class derived : public lmx::c_read_string {
    public:
        using c_read_string::c_read_string;
        int read() override { return c_read_string::read(); }
    } derived_memory(text);
    const struct {
        lmx::c_read* source;
        bool opens;
        const char* why;
    } rows[] = {
        {&memory, true, "memory"},
        {&file, true, "a file by path"},
        {&callers_file, false, "a caller's handle"},
        {&callers, false, "a caller's source"},
        {&derived_memory, false, "one that may override"},
    };
    for (const auto& row : rows) {
        recorder errors;
        lmx::c_get_with_entities getter(*row.source, errors);
        EXPECT_EQ(reader_access::begin_step(getter), nullptr) << "nothing is known before the first byte";
        getter.get();
        EXPECT_EQ(reader_access::begin_step(getter), nullptr) << "the detection has read a character ahead";
        getter.get();
        EXPECT_EQ(reader_access::begin_step(getter) != nullptr, row.opens) << row.why;
    }
    const auto opens_after = [&](auto prepare) {
        lmx::c_read_string source(text);
        recorder errors;
        lmx::c_get_with_entities getter(source, errors);
        getter.get();
        getter.get();
        prepare(getter);
        const window* const w = reader_access::begin_step(getter);
        return w == nullptr ? '!' : *w->p;
    };
    using getter_ref = lmx::c_get_with_entities&;
    EXPECT_EQ(opens_after([](getter_ref) {}), '>');
    {
        lmx::c_read_string source(text);
        recorder errors;
        lmx::c_get_with_entities getter(source, errors);
        for (int i = 0; i < 11; ++i)
            getter.get();
        window* const w = reader_access::begin_step(getter);
        ASSERT_NE(w, nullptr);
        EXPECT_TRUE(w->room(1000 - 68));
        EXPECT_FALSE(w->room(1000 - 63)) << "64 bytes stay behind the edge, for wide loads";
    }
    EXPECT_EQ(opens_after([](getter_ref g) { g.unget('a'); }), 'a') << "a character given back is found again";
    EXPECT_EQ(opens_after([](getter_ref g) { g.unget('a'), g.unget('<'); }), '<');
    EXPECT_EQ(opens_after([](getter_ref g) { g.unget('b'); }), '!') << "but only the one that stands there";
    EXPECT_EQ(opens_after([](getter_ref g) { g.set_encoding("ISO-8859-1"); }), '!') << "no UTF-8";
    EXPECT_EQ(opens_after([](getter_ref g) { g.error(lmx::error_fatal, lmx::err_not_well_formed, ""); }), '!');
    EXPECT_EQ(opens_after([](getter_ref g) {
                  const char* value = nullptr;
                  g.add_general_entity("e", "v");
                  g.get_general_entity("e", &value);
                  g.set_input_entity_value(value);
              }),
              '!')
        << "an entity is being read";
}

TEST(window, grows_over_a_long_value_of_a_file) {
    const std::string value(3000000, 'v');
    const temporary_file on_disk("<a>" + value + "</a>" + std::string(100, '\n'));
    lmx::c_read_file file(on_disk.path.c_str());
    recorder errors;
    lmx::c_get_with_entities getter(file, errors);
    for (int i = 0; i < 3; ++i)
        getter.get();
    window* const w = reader_access::begin_step(getter);
    ASSERT_NE(w, nullptr);
    std::string_view piece;
    int attempts = 1;
    while (!w->text('<', piece) && w->grow())
        ++attempts;
    EXPECT_EQ(piece, value);
    EXPECT_LT(attempts, 8) << "twice as much each time";
    EXPECT_EQ(getter.get(), '<');
    ASSERT_EQ(reader_access::begin_step(getter), w);
    EXPECT_FALSE(w->text('&', piece));
    EXPECT_FALSE(w->grow()) << "the file has no more";
    getter.rewind();
    for (int i = 0; i < 3; ++i)
        getter.get();
    window* const again = reader_access::begin_step(getter);
    ASSERT_NE(again, nullptr);
    EXPECT_TRUE(again->room(60000)) << "after going back it reads ahead again";
}

TEST(window, stays_away_where_the_usual_prefixes_mean_something_else) {
    const lmx::s_ns_map format[] = {{1000, "Hqf", "urn:f"}, {0, nullptr, nullptr}};
    const std::string text = "<Hqf:a xmlns:Hqf='urn:f' xmlns:xsi='http://www.w3.org/2001/XMLSchema-instance'>"
                             "<Hqf:b/><b xmlns:Hqf='urn:g'><c/></b><Hqf:d xmlns:xsi='urn:h'/><Hqf:e xmlns:x='urn:i'/>"
                             "<Hqf:f/></Hqf:a>" +
                             std::string(100, ' ');
    lmx::c_xml_reader_memory reader(text.data(), static_cast<unsigned int>(text.size()));
    reader.set_ns_map(format);
    std::string seen;
    lmx::elmx_error error = lmx::err_no_error;
    const auto next = [&] {
        reader.get_element_event(nullptr, &error, &reader.item_name);
        seen += reader.item_name + (reader_access::begin_step(reader) != nullptr ? "+" : "-");
        reader.skip_start_tag(nullptr);
    };
    lmx::c_xml_reader_local root(&reader);
    EXPECT_EQ(reader_access::begin_step(reader), nullptr) << "nothing declared yet";
    next();
    {
        lmx::c_xml_reader_local children(&reader);
        next();
        next();
        {
            lmx::c_xml_reader_local grandchildren(&reader);
            next();
            EXPECT_EQ(reader_access::begin_element(reader), nullptr) << "the outer scope's declaration holds";
        }
        seen += reader_access::begin_step(reader) != nullptr ? "+" : "-";
        seen += reader_access::begin_element(reader) != nullptr ? "+ " : "- ";
        reader.get_element_event(nullptr, &error, &reader.item_name);
        next();
        next();
        next();
    }
    EXPECT_EQ(seen, "Hqf:a+Hqf:b+b-c--+ Hqf:d-Hqf:e+Hqf:f+");
}

TEST(window, leaves_the_state_that_the_engine_sets) {
    const std::string text = "<a>" + std::string(100, ' ');
    lmx::c_xml_reader_memory reader(text.data(), static_cast<unsigned int>(text.size()));
    lmx::elmx_error error = lmx::err_no_error;
    EXPECT_FALSE(reader_access::is_past_prolog(reader));
    reader.get_element_event(nullptr, &error, &reader.item_name);
    EXPECT_TRUE(reader_access::is_past_prolog(reader));
    reader_access::set_name(reader, "Hqf:L", 3, 1000);
    EXPECT_EQ(reader.get_full_name() + reader.get_local_name() + std::to_string(reader.get_ns_id()), "Hqf:LL1000");
    EXPECT_TRUE(reader.get_has_ns_prefix());
    reader_access::set_name(reader, "size", 0, 0);
    EXPECT_EQ(reader.get_local_name(), "size");
    EXPECT_FALSE(reader.get_has_ns_prefix());
    reader_access::set_event(reader, 12);
    EXPECT_EQ(reader.get_current_event(), 12);
}

} // namespace
