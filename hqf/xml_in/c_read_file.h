#pragma once

#include "hqf/xml_in/block_run.h"
#include "hqf/xml_in/c_read.h"

#include <cstddef>
#include <cstdio>
#include <string>

namespace lmx {

/// Reads a file, 512 bytes at a time.
///
/// Owns the handle, unless told to leave it open. A failed open shows in `is_open`; `read` then gives -1.
class HQF_API c_read_file : public c_read {
public:
    /// Opens the file at a path in UTF-8. The path is the source id.
    explicit c_read_file(const char* path);
    /// Opens the file at a wide path, which the system gets as UTF-8. The source id holds each unit of the path encoded
    /// by itself, so that a surrogate pair shows as two three-byte sequences.
    explicit c_read_file(const wchar_t* path);
    /// Takes over an open handle, which may be null; the source id is empty.
    explicit c_read_file(FILE* file);
    c_read_file(const c_read_file&) = delete;
    c_read_file& operator=(const c_read_file&) = delete;
    /// Closes the handle unless it is to be left open.
    ~c_read_file() override;

    bool is_open() const override { return file_ != nullptr; }
    int read() override { return blocks_.run.empty() && !fill() ? -1 : blocks_.run.take(); }
    const char* get_source_id() override { return source_id_.c_str(); }
    /// Back to offset 0 of the file. Precondition: the file is open.
    void rewind() override;

    /// Whether the destructor leaves the handle open (true) or closes it (false, as at the start).
    void leave_file_open_on_delete(bool leave) { close_on_delete_ = !leave; }
    /// Closes the handle, if there is one. Bytes that were read ahead can still be read.
    void close();

private:
    friend class c_get_as_utf8;

    bool fill();
    static std::size_t supply(void* source, char* memory, std::size_t size, bool& is_last);

    std::string source_id_;
    FILE* file_ = nullptr;
    bool close_on_delete_ = true;
    // Read ahead only if the file was opened here: a caller's handle is never read beyond the 512 bytes that `read`
    // takes.
    hqf::block_run blocks_{supply, this};
    char buffer_[512];
};

} // namespace lmx
