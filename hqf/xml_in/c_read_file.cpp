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
    , file_(std::fopen(path, "rb")) {}

c_read_file::c_read_file(const wchar_t* path)
    : source_id_(encode_units_alone(path)) {
    file_ = hqf::open_file(path, "rb");
}

c_read_file::c_read_file(FILE* file)
    : file_(file) {
    blocks_.may_read_ahead = false;
}

c_read_file::~c_read_file() {
    if (close_on_delete_) close();
}

void c_read_file::close() {
    if (file_ == nullptr) return;
    std::fclose(file_);
    file_ = nullptr;
}

bool c_read_file::fill() {
    return blocks_.fill(buffer_, sizeof buffer_);
}

std::size_t c_read_file::supply(void* source, char* memory, std::size_t size, bool& is_last) {
    FILE* const file = static_cast<c_read_file*>(source)->file_;
    const std::size_t count = file == nullptr ? 0 : std::fread(memory, 1, size, file);
    is_last = count < size;
    return count;
}

void c_read_file::rewind() {
    std::fseek(file_, 0, SEEK_SET);
    blocks_.rewind();
}

} // namespace lmx
