#include "hqf/xml_out/output.h"

#include <typeinfo>

#include "hqf/values/c_as_xml.h"
#include "hqf/values/datetime_text.h"
#include "hqf/values/number_text.h"
#include "hqf/values/xml_escape.h"

namespace hqf {

output::output(lmx::c_xml_writer& writer)
    : writer_(writer)
    , stream_(writer_access::stream(writer))
    , tab_(writer_access::tab(writer))
    , newline_(writer_access::newline(writer))
    , tab_length_(std::strlen(tab_))
    , newline_length_(std::strlen(newline_))
    , plain_(typeid(writer) == typeid(lmx::c_xml_writer))
    , standard_numbers_(has_default_format(stream_))
    , memory_(stream_.good() ? dynamic_cast<text_buffer*>(stream_.rdbuf()) : nullptr) {
    take_room();
}

/// Starts to gather behind what the stream holds.
void output::take_room() {
    begin_ = memory_ == nullptr ? block_ : memory_->room(most_at_once);
    end_ = memory_ == nullptr ? block_ + sizeof(block_) : memory_->room_end();
    at_ = begin_;
}

void output::flush() {
    if (at_ == begin_) return;
    const char* const end = at_;
    at_ = begin_;
    if (memory_ != nullptr)
        memory_->advance(end);
    else
        stream_.write(begin_, end - begin_);
    // Others may write before we do again, so room that is theirs as well is asked for anew.
    if (memory_ != nullptr) begin_ = at_ = end_ = nullptr;
}

void output::make_room() {
    flush();
    take_room();
}

void output::text(const char* data, std::size_t size) {
    if (size > most_at_once) {
        flush();
        stream_.write(data, static_cast<std::streamsize>(size));
        return;
    }
    reserve(size);
    std::memcpy(at_, data, size);
    at_ += size;
}

void output::indent_slowly() {
    for (int level = 0; level < writer_access::nest_level(writer_); ++level)
        text(tab_, tab_length_);
}

void output::indent_through_writer() {
    flush();
    writer_(true);
}

void output::line_end_through_writer() {
    flush();
    const char* newline = writer_.endl();
    text(newline, std::strlen(newline));
}

void output::value(const std::wstring& text) {
    const wchar_t* next = text.data();
    const wchar_t* const end = next + text.size();
    while (next != end) {
        reserve(escaped_size);
        at_ = write_xml_escaped(at_, end_, next, end);
    }
}

/// A number through the stream where a caller has changed how it writes numbers, else straight into the block.
template<class number, class stream_form>
void output::put_number(number value, const stream_form& in_stream) {
    if (!standard_numbers_) {
        flush();
        stream_ << in_stream;
        return;
    }
    reserve(number_text_size);
    at_ = write_number(at_, value);
}

void output::value(double number) {
    put_number(number, lmx::c_as_xml(number));
}
void output::value(int number) {
    put_number(number, number);
}
void output::value(unsigned int number) {
    put_number(number, number);
}

void output::value(const lmx::c_datetime& moment) {
    if (!standard_numbers_) {
        flush();
        stream_ << moment;
        return;
    }
    reserve(datetime_text_size);
    at_ = write_datetime(at_, moment);
    stream_.fill('0'); // as the insertion would leave it
}

void output::value(const lmx::c_binary& bytes) {
    flush();
    bytes.out_base64(stream_);
}

} // namespace hqf
