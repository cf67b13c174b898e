/// Where the engine's text goes on its way to a writer's stream: one block of memory, emptied when it is full, before
/// anyone else can touch the stream, and at the end.
#pragma once

#include <cstddef>
#include <cstring>
#include <ostream>
#include <string>

#include "hqf/values/c_binary.h"
#include "hqf/values/c_datetime.h"
#include "hqf/values/number_text.h"
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

/// Gathers the output of one write. While it lives, the writer's stream may lag behind: flush() before anything that
/// may look at it, and at the end.
///
/// The place where the next text goes travels in the caller's hands, so that it stays in a register: begin() gives the
/// first, each operation takes a place and gives the one behind what it wrote, and flush() takes the last.
///
/// A writer that the application derived still gets each of its virtual calls, with the stream up to date.
class output {
public:
    /// Longest text that may be appended in whole 16-byte blocks.
    static constexpr std::size_t longest_tag = 80;
    /// What a step may append before it asks for room again: an indent, a start tag, a number, an end tag, a line end.
    /// The operations on tags, characters and numbers rely on it.
    static constexpr std::size_t step_room = 512;

    explicit output(lmx::c_xml_writer& writer);
    output(const output&) = delete;
    output& operator=(const output&) = delete;

    lmx::c_xml_writer& writer() { return writer_; }

    /// Where text may be written, with room for a step. After flush() too, when others may have used the stream.
    char* begin();
    /// Gives the stream all that was gathered.
    void flush(const char* at);
    /// A place with room for a step.
    char* room(char* at) { return has_room(at, step_room) ? at : emptied(at); }

    /// Indents to the writer's level.
    char* indent(char* at) {
        const auto level = static_cast<std::size_t>(writer_access::nest_level(writer_));
        return level <= most_levels_ ? put_padded(at, tabs_, level) : indent_slowly(at);
    }
    char* line_end(char* at) {
        if (!has_short_newline_) return line_end_slowly(at);
        *at = *newline_;
        return at + 1;
    }
    /// Appends `size` bytes of a constant that is readable up to the next multiple of 16.
    char* padded(char* at, const char* constant, std::size_t size) {
        return size <= longest_tag ? put_padded(at, constant, size) : room(text(at, constant, size));
    }
    /// Any text; room for a step isn't there behind it.
    char* text(char* at, const char* data, std::size_t size);

    /// Values in their XML form, as the wrappers of hqf/values/c_as_xml.h would put them on the stream. Texts and bytes
    /// give a place with room for a step.
    char* value(char* at, const std::wstring& text);
    char* value(char* at, double number) {
        return standard_numbers_ ? write_number(at, number) : number_through_stream(at, number);
    }
    char* value(char* at, int number) {
        return standard_numbers_ ? write_number(at, number) : number_through_stream(at, number);
    }
    char* value(char* at, unsigned int number) {
        return standard_numbers_ ? write_number(at, number) : number_through_stream(at, number);
    }
    char* value(char* at, bool truth) {
        std::memcpy(at, truth ? "true " : "false", 5);
        return at + (truth ? 4 : 5);
    }
    char* value(char* at, const lmx::c_datetime& moment);
    char* value(char* at, const lmx::c_binary& bytes);

private:
    static char* put_padded(char* at, const char* constant, std::size_t size) {
        std::memcpy(at, constant, 16);
        for (std::size_t done = 16; done < size; done += 16)
            std::memcpy(at + done, constant + done, 16);
        return at + size;
    }
    bool has_room(const char* at, std::size_t size) const { return static_cast<std::size_t>(end_ - at) >= size; }
    char* emptied(char* at);
    template<class number>
    char* number_through_stream(char* at, number value);
    char* indent_slowly(char* at);
    char* line_end_slowly(char* at);

    lmx::c_xml_writer& writer_;
    std::ostream& stream_;
    const char* const tab_;
    const char* const newline_;
    const std::size_t tab_length_;
    const std::size_t newline_length_;
    /// The writer is a c_xml_writer and nothing more: its layout needs no virtual call.
    const bool plain_;
    const bool has_short_newline_;
    /// The stream is in the state that a new one has, so numbers needn't go through it.
    const bool standard_numbers_;
    /// Levels that `tabs_` can indent to; below 0 there is none.
    const std::size_t most_levels_;
    /// The stream's own memory, where it is one of ours: then text is gathered in it and not copied at all.
    text_buffer* const memory_;
    /// What is gathered starts at begin_.
    char* begin_ = nullptr;
    char* end_ = nullptr;
    char tabs_[longest_tag];
    char block_[16 * 1024];
};

} // namespace hqf
