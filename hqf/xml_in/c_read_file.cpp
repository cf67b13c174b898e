#include "hqf/xml_in/c_read_file.h"

#include "hqf/platform/paths.h"
#include "hqf/values/text.h"

#include <cstring>

namespace lmx {
namespace {

std::string encode_units_alone(const wchar_t* path) {
    std::string id;
    char encoded[8];
    for (; *path != 0; ++path)
        id += unicode_char_to_utf8(static_cast<int>(*path), encoded);
    return id;
}

} // namespace

c_read_file::c_read_file(const char* path)
    : source_id_(path)
    , file_(std::fopen(path, "rb"))
    , is_opened_here_(true) {}

c_read_file::c_read_file(const wchar_t* path)
    : source_id_(encode_units_alone(path))
    , is_opened_here_(true) {
    file_ = hqf::open_file(path, "rb");
}

c_read_file::c_read_file(FILE* file)
    : file_(file) {}

c_read_file::~c_read_file() {
    if (close_on_delete_) close();
}

void c_read_file::close() {
    if (file_ == nullptr) return;
    std::fclose(file_);
    file_ = nullptr;
}

bool c_read_file::fill() {
    if (file_ == nullptr) return false;
    const std::size_t count = std::fread(buffer_, 1, sizeof buffer_, file_);
    taken_from_file_ += count;
    block_start_ = buffer_;
    run_ = {buffer_, buffer_ + count};
    return count != 0;
}

void c_read_file::read_ahead(std::size_t wanted, std::size_t block_size) {
    const std::size_t unread = static_cast<std::size_t>(run_.end - run_.cursor);
    if (unread >= wanted || !may_have_more()) return;
    if (large_size_ < block_size) {
        auto larger = std::make_unique_for_overwrite<char[]>(block_size);
        if (unread != 0) std::memcpy(larger.get(), run_.cursor, unread);
        large_block_ = std::move(larger);
        large_size_ = block_size;
    } else if (unread != 0) {
        std::memmove(large_block_.get(), run_.cursor, unread);
    }
    const std::size_t count = std::fread(large_block_.get() + unread, 1, large_size_ - unread, file_);
    is_at_end_ = count < large_size_ - unread;
    taken_from_file_ += count;
    block_start_ = large_block_.get();
    run_ = {block_start_, block_start_ + unread + count};
}

void c_read_file::rewind() {
    std::fseek(file_, 0, SEEK_SET);
    run_ = {};
    block_start_ = buffer_;
    taken_from_file_ = 0;
    is_at_end_ = false;
}

} // namespace lmx
