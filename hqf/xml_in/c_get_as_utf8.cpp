#include "hqf/xml_in/c_get_as_utf8.h"

#include "hqf/xml_in/c_read_file.h"
#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/wide_source.h"
#include "hqf/xml_in/window.h"

#include <limits>
#include <string_view>
#include <typeinfo>

// From bytes to lines of UTF-8: the source, line ends, and the encoding that the XML declaration names. How bytes
// become characters stands in decoding.cpp.

namespace lmx {

c_get_as_utf8::c_get_as_utf8(c_read& input, c_error& errors)
    : input_(input)
    , errors_(errors)
    , binder_(errors) {
    binder_.bind(this);
}

c_get_as_utf8::~c_get_as_utf8() = default;

void c_get_as_utf8::attach() {
    const std::type_info& type = typeid(input_);
    if (type == typeid(c_read_memory) || type == typeid(c_read_string)) {
        source_ = memory_source;
        run_ = &static_cast<c_read_memory&>(input_).run_;
    } else if (type == typeid(c_read_file) || type == typeid(hqf::wide_source)) {
        source_ = block_source;
        blocks_ = type == typeid(c_read_file) ? &static_cast<c_read_file&>(input_).blocks_
                                              : &static_cast<hqf::wide_source&>(input_).blocks;
        run_ = &blocks_->run;
    } else {
        source_ = other_source;
    }
}

int c_get_as_utf8::next_byte_slowly() {
    if (window_ != nullptr && window_->is_open()) {
        window_->close();
        return next_byte();
    }
    if (source_ == unknown_source) {
        attach();
        return next_byte();
    }
    const int c = input_.read();
    if (source_ == other_source && c != -1) ++virtual_reads_;
    return c;
}

std::uint64_t c_get_as_utf8::bytes_read() const {
    if (window_ != nullptr && window_->is_open()) window_->close();
    switch (source_) {
    case memory_source: {
        const auto& memory = static_cast<const c_read_memory&>(input_);
        return static_cast<std::uint64_t>(memory.run_.cursor - memory.start_);
    }
    case block_source: return blocks_->consumed();
    default: return virtual_reads_;
    }
}

int c_get_as_utf8::get_folded() {
    int c = decode_next();
    if (c == '\n' && last_character_ == '\r') c = decode_next();
    last_character_ = static_cast<unsigned char>(c);
    if (c != '\r' && c != '\n') return c;
    if (line_ != std::numeric_limits<int>::max()) ++line_;
    return '\n';
}

void c_get_as_utf8::rewind() {
    window_.reset();
    state_ = undecided;
    last_character_ = 0;
    ungot_.clear();
    sequence_[0] = 0;
    sequence_cursor_ = nullptr;
    line_ = 1;
    run_ = &nothing_;
    source_ = unknown_source;
    virtual_reads_ = 0;
    input_.rewind();
}

void c_get_as_utf8::error(elmx_error_type type, elmx_error code, const char* text) {
    errors_.error(type, code, input_.get_source_id(), get_line_num(), text);
}

const char* c_get_as_utf8::get_source_id() const {
    return input_.get_source_id();
}

int c_get_as_utf8::get_line_num() const {
    return window_ != nullptr ? window_->line() : line_;
}

namespace {

bool equals_in_any_case(std::string_view a, std::string_view b) {
    const auto upper = [](char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; };
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size(); ++i)
        if (upper(a[i]) != upper(b[i])) return false;
    return true;
}

} // namespace

bool c_get_as_utf8::refuse_declared_encoding() {
    error(error_fatal, err_mis_match_between_specified_char_encoding_and_read_bytes,
          "Mis-match between specfied encoding and byte format");
    return false;
}

bool c_get_as_utf8::set_encoding(const char* name) {
    if (equals_in_any_case(name, "ISO-10646-UCS-2")) {
        if (state_ != utf16_be && state_ != utf16_le) return refuse_declared_encoding();
        state_ = state_ == utf16_be ? ucs2_be : ucs2_le;
        return true;
    }
    if (equals_in_any_case(name, "ISO-8859-1") || equals_in_any_case(name, "US-ASCII")) {
        const bool fits = state_ == utf8;
        state_ = single_byte;
        return fits || refuse_declared_encoding();
    }
    if (equals_in_any_case(name, "UTF-8")) return state_ == utf8 || refuse_declared_encoding();
    if (equals_in_any_case(name, "UTF-16"))
        return state_ == utf16_be || state_ == utf16_le || refuse_declared_encoding();
    error(error_fatal, err_xml_character_encoding_not_supported, "Unknown character encoding specified");
    return false;
}

} // namespace lmx
