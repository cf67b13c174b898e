#include "hqf/xml_in/wide_source.h"

#include "hqf/values/transcode.h"

namespace hqf {

int wide_source::read() {
    constexpr std::size_t block = 64 * 1024;
    if (blocks.run.empty()) blocks.read_ahead(1, block);
    return blocks.run.empty() ? -1 : blocks.run.take();
}

void wide_source::rewind() {
    blocks.rewind();
    next_ = text_.data();
}

std::size_t wide_source::supply(void* source, char* memory, std::size_t size, bool& is_last) {
    auto& own = *static_cast<wide_source*>(source);
    const wchar_t* const end = own.text_.data() + own.text_.size();
    const char* const filled = write_utf8(memory, memory + size, own.next_, end);
    is_last = own.next_ == end;
    return static_cast<std::size_t>(filled - memory);
}

} // namespace hqf
