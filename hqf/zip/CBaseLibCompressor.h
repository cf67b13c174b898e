#pragma once

/// What compressors over a library have in common: the working buffer, the loop that unpacks, the library's memory.

#include "hqf/platform/api.h"
#include "hqf/zip/CZipAutoBuffer.h"
#include "hqf/zip/CZipCompressor.h"
#include "hqf/zip/limits.h"

#include <cstddef>
#include <vector>

namespace ZipArchiveLib {

class HQF_API CBaseLibCompressor : public CZipCompressor {
public:
    class HQF_API COptions : public CZipCompressor::COptions {
    public:
        ~COptions() override;
        std::unique_ptr<CZipCompressor::COptions> Clone() const override;

        /// Bytes of the working buffer; 0 counts as the default.
        std::uint32_t buffer_size = hqf::zip_limits::compressor_buffer;
        /// Records the library's memory and frees what the library leaves behind.
        bool detect_leaks = true;
    };

    explicit CBaseLibCompressor(CZipStorage* storage)
        : CZipCompressor(storage) {}
    ~CBaseLibCompressor() override;

protected:
    /// What one call of the library may use, and has used when it returns.
    struct piece {
        char* in;
        unsigned int in_left;
        char* out;
        unsigned int out_left;
    };
    using step_function = int (*)(void* stream, piece& bytes);

    /// How a method unpacks.
    struct method_rules {
        step_function step;
        void* stream;
        int stream_end;   ///< the result that tells the end of the stream
        bool takes_dummy; ///< gets one more byte of input behind the last
        bool has_to_end;  ///< its stream must end where the entry ends
    };

    void begin(const COptions& options);
    unsigned int deliver(const method_rules& rules, void* buffer, unsigned int size);
    void write_packed(std::uint32_t size);
    [[noreturn]] void throw_library_error(int code) const;

    /// The memory functions of the library; `self` is this object.
    static void* allocate(void* self, std::size_t count, std::size_t size) noexcept;
    static void release(void* self, void* block) noexcept;
    void release_blocks() noexcept;

    CZipAutoBuffer buffer_;
    bool end_of_stream_ = false;

private:
    bool refill(bool takes_dummy);
    int step(const method_rules& rules, char*& out, unsigned int& out_left, bool& moved);
    void require_end(const method_rules& rules);

    char* in_ = nullptr;
    unsigned int in_left_ = 0;
    bool dummy_taken_ = false;
    bool detect_leaks_ = true;
    std::vector<void*> blocks_;
};

} // namespace ZipArchiveLib
