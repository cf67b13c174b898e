#pragma once

#include "hqf/errors/c_error.h"
#include "hqf/xml_in/byte_run.h"
#include "hqf/xml_in/c_unget_buffer.h"

#include <cstdint>
#include <memory>
#include <string>

namespace hqf {
struct block_run;
class window;
struct reader_access;
} // namespace hqf

namespace lmx {

class c_read;

/// Turns the bytes of a source into UTF-8 with every line end as one line feed, and counts lines.
///
/// It finds the encoding from the first bytes and from the name in the XML declaration: UTF-8, UTF-16 and UCS-2 in both
/// byte orders, ISO-8859-1 and US-ASCII (which are read alike). CR, LF, CR LF, U+0085 and U+2028 each give one line
/// feed and count one line. A byte sequence that is no UTF-8 reads as the end of input, without a report.
///
/// After a fatal report to the error object everything reads as ended. One thread at a time; owns neither the source
/// nor the error object, and must not outlive them.
class HQF_API c_get_as_utf8 {
public:
    /// Makes this object the current getter of `errors`. Reads nothing.
    c_get_as_utf8(c_read& input, c_error& errors);
    c_get_as_utf8(const c_get_as_utf8&) = delete;
    c_get_as_utf8& operator=(const c_get_as_utf8&) = delete;
    /// Gives `errors` its previous getter back.
    virtual ~c_get_as_utf8();

    /// The next UTF-8 byte, 0 to 255, or -1 at the end of input. Characters given back come first, the last one given
    /// back before the others; they are not counted again.
    int get() {
        if (errors_.is_fatal_errored()) return -1;
        if (!ungot_.empty()) return ungot_.get();
        // The short way for what most documents consist of: ASCII that is no control character.
        if (is_plain_next()) return last_character_ = static_cast<unsigned char>(run_->take());
        return get_folded();
    }
    /// Gives a character back, to be read again. At most three between two reads.
    void unget(int c) { ungot_.unget(c); }
    /// Back to the state before the first byte, source included. What has been reported stays reported.
    void rewind();

    /// Takes the encoding's name from the XML declaration, in any case of letters.
    ///
    /// \returns false after a fatal report: 6 for a name that is not read here, 15 for one that contradicts the bytes
    bool set_encoding(const char* name);

    /// Reports to the error object, with this source and the current line.
    void error(elmx_error_type type, elmx_error code, const char* text);
    void error(elmx_error_type type, elmx_error code, const std::string& text) { error(type, code, text.c_str()); }

    /// The source's name for messages; may be null.
    const char* get_source_id() const;
    /// The line of what will be read next, from 1.
    int get_line_num() const;
    c_error& get_error_handler() const { return errors_; }

protected:
    /// How many bytes of the source have been read so far.
    std::uint64_t bytes_read() const;

private:
    friend class hqf::window;
    friend struct hqf::reader_access;

    // UTF-16 with a declared encoding of "ISO-10646-UCS-2" knows no surrogates.
    enum encoding_state : int { undecided, single_byte, utf8, utf16_be, utf16_le, ucs2_be, ucs2_le };
    // The built-in sources are read through their byte_run; all others by one virtual call a byte. Found out at the
    // first read, since a source may be built after the reader that holds it.
    enum source_kind : int { unknown_source, memory_source, block_source, other_source };

    bool is_plain_next() const {
        return sequence_cursor_ == nullptr && state_ == utf8 && !run_->empty() &&
               static_cast<signed char>(*run_->cursor) >= ' ';
    }
    int get_folded();
    int next_byte() { return run_->empty() ? next_byte_slowly() : run_->take(); }
    int next_byte_slowly();
    void attach();

    int decode_next();
    int detect(int first);
    int detect_behind_mark(encoding_state state);
    int detect_without_mark(int first);
    int decode_utf16();
    int read_unit(int first);
    int refuse_encoding();
    bool refuse_declared_encoding();
    bool read_sequence(int lead);
    int start_sequence();
    int deliver_sequence();
    int encode(int code_point);

    c_read& input_;
    c_error& errors_;
    c_getter_error_binder binder_;
    encoding_state state_ = undecided;
    unsigned char last_character_ = 0;
    c_unget_buffer ungot_;
    char sequence_[8] = {};
    const char* sequence_cursor_ = nullptr;
    int line_ = 1;

    source_kind source_ = unknown_source;
    hqf::byte_run nothing_;
    hqf::byte_run* run_ = &nothing_;
    hqf::block_run* blocks_ = nullptr;
    std::uint64_t virtual_reads_ = 0;
    // The bytes lie in memory that outlives this object.
    bool is_source_lasting_ = false;
    std::unique_ptr<hqf::window> window_;
};

} // namespace lmx
