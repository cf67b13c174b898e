#include "hqf/xml_out/output.h"

#include <typeinfo>

#include "hqf/values/c_as_xml.h"
#include "hqf/values/datetime_text.h"
#include "hqf/values/xml_escape.h"

namespace hqf {

namespace {

/// A longer text goes straight to the stream.
constexpr std::size_t most_at_once = 8 * 1024;

lmx::c_as_xml<double> in_stream_form(const double& value) {
    return lmx::c_as_xml(value);
}
template<class integer>
integer in_stream_form(integer value) {
    return value;
}

} // namespace

output::output(lmx::c_xml_writer& writer)
    : writer_(writer)
    , stream_(writer_access::stream(writer))
    , tab_(writer_access::tab(writer))
    , newline_(writer_access::newline(writer))
    , tab_length_(std::strlen(tab_))
    , newline_length_(std::strlen(newline_))
    , plain_(typeid(writer) == typeid(lmx::c_xml_writer))
    , has_short_newline_(plain_ && newline_length_ == 1)
    , standard_numbers_(has_default_format(stream_))
    , most_levels_(plain_ && tab_length_ == 1 ? longest_tag : 0)
    , memory_(stream_.good() ? dynamic_cast<text_buffer*>(stream_.rdbuf()) : nullptr) {
    std::memset(tabs_, *tab_, longest_tag);
}

char* output::begin() {
    begin_ = memory_ == nullptr ? block_ : memory_->room(most_at_once);
    end_ = memory_ == nullptr ? block_ + sizeof(block_) : memory_->room_end();
    return begin_;
}

void output::flush(const char* at) {
    if (at == begin_) return;
    if (memory_ != nullptr)
        memory_->advance(at);
    else
        stream_.write(begin_, at - begin_);
}

char* output::emptied(char* at) {
    flush(at);
    return begin();
}

char* output::text(char* at, const char* data, std::size_t size) {
    if (size > most_at_once) {
        flush(at);
        stream_.write(data, static_cast<std::streamsize>(size));
        return begin();
    }
    if (!has_room(at, size)) at = emptied(at);
    std::memcpy(at, data, size);
    return at + size;
}

char* output::indent_slowly(char* at) {
    if (!plain_) {
        flush(at);
        writer_(true);
        return begin();
    }
    for (int level = 0; level < writer_access::nest_level(writer_); ++level)
        at = text(at, tab_, tab_length_);
    return room(at);
}

char* output::line_end_slowly(char* at) {
    if (plain_) return room(text(at, newline_, newline_length_));
    flush(at);
    const char* newline = writer_.endl();
    return room(text(begin(), newline, std::strlen(newline)));
}

char* output::value(char* at, const std::wstring& text) {
    const wchar_t* next = text.data();
    const wchar_t* const end = next + text.size();
    while (next != end) {
        if (!has_room(at, escaped_size)) at = emptied(at);
        at = write_xml_escaped(at, end_, next, end);
    }
    return room(at);
}

/// For a stream that a caller has told to write numbers in another way.
template<class number>
char* output::number_through_stream(char* at, number value) {
    flush(at);
    stream_ << in_stream_form(value);
    return begin();
}
template char* output::number_through_stream(char* at, double value);
template char* output::number_through_stream(char* at, int value);
template char* output::number_through_stream(char* at, unsigned int value);

char* output::value(char* at, const lmx::c_datetime& moment) {
    if (standard_numbers_) {
        at = write_datetime(at, moment);
        stream_.fill('0'); // as the insertion would leave it
        return at;
    }
    flush(at);
    stream_ << moment;
    return begin();
}

char* output::value(char* at, const lmx::c_binary& bytes) {
    flush(at);
    bytes.out_base64(stream_);
    return begin();
}

} // namespace hqf
