#pragma once

#include "hqf/xml_in/block_run.h"
#include "hqf/xml_in/c_read.h"

#include <string>

/// Wide text as a source of UTF-8.

namespace hqf {

/// Reads the UTF-8 form of a wide text, a block at a time, so that it needn't exist as a whole. The text must stay
/// alive and unchanged as long as it is read.
class wide_source final : public lmx::c_read {
public:
    explicit wide_source(const std::wstring& text)
        : blocks(supply, this)
        , text_(text)
        , next_(text.data()) {}

    int read() override;
    void rewind() override;

    block_run blocks;

private:
    static std::size_t supply(void* source, char* memory, std::size_t size, bool& is_last);

    const std::wstring& text_;
    const wchar_t* next_;
};

} // namespace hqf
