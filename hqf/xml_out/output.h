/// Where the engine's text goes on its way to a writer's stream: one block of memory, emptied when it is full, before
/// anyone else can touch the stream, and at the end.
#pragma once

#include <cstddef>
#include <cstring>
#include <ostream>
#include <string>

#include "hqf/values/c_binary.h"
#include "hqf/values/c_datetime.h"
#include "hqf/xml_out/c_xml_writer.h"
#include "hqf/xml_out/text_stream.h"

namespace hqf {

/// What the library's own code sees of a writer.
struct writer_access {
    static std::ostream& stream(lmx::c_xml_writer& writer) { return writer.stream_; }
    static const char* tab(const lmx::c_xml_writer& writer) { return writer.tab_; }
    static const char* newline(const lmx::c_xml_writer& writer) { return writer.newline_; }
    static int nest_level(const lmx::c_xml_writer& writer) { return writer.nest_level_; }
    static bool ns_attrs_written(const lmx::c_xml_writer& writer) { return writer.ns_attrs_written_; }
};

/// Gathers the output of one write. While it lives, the writer's stream may lag behind; flush() before anything that
/// may look at it. The destructor flushes, also on the way of an exception.
///
/// A writer that the application derived still gets each of its virtual calls, with the stream up to date.
class output {
public:
    /// Longest text that may be appended in whole 16-byte blocks.
    static constexpr std::size_t longest_tag = 80;
    /// A longer text goes straight to the stream.
    static constexpr std::size_t most_at_once = 8 * 1024;

    explicit output(lmx::c_xml_writer& writer);
    output(const output&) = delete;
    output& operator=(const output&) = delete;
    ~output() { flush(); }

    lmx::c_xml_writer& writer() { return writer_; }
    /// Gives the stream all that was gathered.
    void flush();

    /// Indents to the writer's level.
    void indent() {
        if (!plain_) return indent_through_writer();
        const std::size_t size = static_cast<std::size_t>(writer_access::nest_level(writer_)) * tab_length_;
        if (tab_length_ != 1 || size > longest_tag) return indent_slowly();
        reserve(size);
        std::memset(at_, *tab_, size);
        at_ += size;
    }
    void line_end() {
        if (!plain_) return line_end_through_writer();
        if (newline_length_ == 1) {
            reserve(1);
            *at_++ = *newline_;
        } else {
            text(newline_, newline_length_);
        }
    }

    /// Appends `size` bytes of a constant that is readable up to the next multiple of 16.
    void padded(const char* constant, std::size_t size) {
        if (size > longest_tag) return text(constant, size);
        reserve(longest_tag + 16);
        std::memcpy(at_, constant, 16);
        for (std::size_t done = 16; done < size; done += 16)
            std::memcpy(at_ + done, constant + done, 16);
        at_ += size;
    }
    void character(char c) {
        reserve(1);
        *at_++ = c;
    }
    void text(const char* data, std::size_t size);

    /// Values in their XML form, as the wrappers of hqf/values/c_as_xml.h would put them on the stream.
    void value(const std::wstring& text);
    void value(double number);
    void value(int number);
    void value(unsigned int number);
    void value(bool truth) { truth ? text("true", 4) : text("false", 5); }
    void value(const lmx::c_datetime& moment);
    void value(const lmx::c_binary& bytes);

private:
    void reserve(std::size_t size) {
        if (static_cast<std::size_t>(end_ - at_) < size) make_room();
    }
    void make_room();
    void take_room();
    template<class number, class stream_form>
    void put_number(number value, const stream_form& in_stream);
    void indent_slowly();
    void indent_through_writer();
    void line_end_through_writer();

    lmx::c_xml_writer& writer_;
    std::ostream& stream_;
    const char* const tab_;
    const char* const newline_;
    const std::size_t tab_length_;
    const std::size_t newline_length_;
    /// The writer is a c_xml_writer and nothing more: its layout needs no virtual call.
    const bool plain_;
    /// The stream is in the state that a new one has, so numbers needn't go through it.
    const bool standard_numbers_;
    /// The stream's own memory, where it is one of ours: then text is gathered in it and not copied at all.
    text_buffer* const memory_;
    /// What is gathered lies from begin_ to at_.
    char* begin_;
    char* at_;
    char* end_;
    char block_[16 * 1024];
};

} // namespace hqf
