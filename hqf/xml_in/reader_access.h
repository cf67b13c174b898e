#pragma once

#include "hqf/xml_in/c_xml_reader.h"
#include "hqf/xml_in/window.h"

#include <string_view>

namespace hqf {

/// What the engine may do with a reader and nobody else: look ahead, and leave the state that the general path would
/// have left.
struct reader_access {
    /// The window, ready for a step, or null: take a general step. Null too where "Hqf" doesn't mean namespace 1000 or
    /// "xsi" namespace 5.
    static window* begin_step(lmx::c_xml_reader& reader) {
        if (reader.are_prefixes_changed_) look_prefixes_up(reader);
        return reader.are_prefixes_plain_ ? begin_step(reader.getter_) : nullptr;
    }
    /// The same where the next thing to read is a tag: drops the declarations of the current scope first, as
    /// `get_element_event` does.
    static window* begin_element(lmx::c_xml_reader& reader) {
        reader.current_scope_->clear();
        return begin_step(reader);
    }
    /// The window on a stream, or null.
    static window* begin_step(lmx::c_get_with_entities& stream) {
        window* const open = stream.window_.get();
        if (open != nullptr && open->is_open()) return open->begin_step() ? open : nullptr;
        return open_window(stream);
    }

    /// Elements of the model that are open in this reader; the engine counts them.
    static unsigned int& model_depth(lmx::c_xml_reader& reader) { return reader.model_depth_; }
    static fast_trace& trace(lmx::c_xml_reader& reader) { return reader.trace_; }
    /// Before an event of the general path.
    static void note_general_step(lmx::c_xml_reader& reader) { ++reader.general_steps_; }
    /// How many events of the general path the engine has asked for.
    static unsigned int general_steps(const lmx::c_xml_reader& reader) { return reader.general_steps_; }
    /// Whether the input is used up, be it by a fatal report.
    static bool is_at_end(lmx::c_xml_reader& reader) {
        const int c = reader.getter_.get();
        if (c != -1) reader.getter_.unget(c);
        return c == -1;
    }
    /// Promises that the bytes lie in memory that outlives the stream: lines are not counted before someone asks.
    static void note_lasting_source(lmx::c_get_as_utf8& stream) { stream.is_source_lasting_ = true; }
    static void note_lasting_source(lmx::c_xml_reader& reader) { note_lasting_source(reader.getter_); }
    static std::uint64_t bytes_read(const lmx::c_xml_reader& reader) { return reader.getter_.bytes_read(); }
    /// Sets the name read last, known to have this namespace number.
    ///
    /// \param prefix_length bytes in front of the colon; 0 for a name without one
    static void set_name(lmx::c_xml_reader& reader, std::string_view full_name, std::size_t prefix_length, int ns_id) {
        lmx::c_cracked_name& name = reader.cracked_name_;
        name.full_name_ = full_name;
        name.has_prefix_ = prefix_length != 0;
        name.ns_id_ = ns_id;
        name.prefix_ = full_name.substr(0, prefix_length);
        name.local_name_ = full_name.substr(prefix_length == 0 ? 0 : prefix_length + 1);
    }
    /// Takes a name apart in the current scope.
    static void crack_name(lmx::c_xml_reader& reader, const std::string& name) {
        reader.cracked_name_.set(reader.current_scope_, name);
    }
    /// The mode in which a value has been read; text between elements is read in it too.
    static void set_ws_mode(lmx::c_xml_reader& reader, lmx::elmx_whitespace mode) { reader.getter_.set_ws_mode(mode); }
    /// Empties the stores of the current start tag, for a tag that was read without them.
    static void forget_attributes(lmx::c_xml_reader& reader) {
        reader.attributes_.clear();
        reader.declarations_.clear();
    }

private:
    static void look_prefixes_up(lmx::c_xml_reader& reader);
    static window* open_window(lmx::c_get_with_entities& stream);
};

} // namespace hqf
