#pragma once

/// Methods 0 (stored) and 8 (deflate, RFC 1951) over zlib.

#include "hqf/zip/CBaseLibCompressor.h"

struct z_stream_s;

namespace ZipArchiveLib {

class HQF_API CDeflateCompressor : public CBaseLibCompressor {
public:
    class HQF_API COptions : public CBaseLibCompressor::COptions {
    public:
        ~COptions() override;
        std::unique_ptr<CZipCompressor::COptions> Clone() const override;

        /// Demands, once all bytes of an entry were delivered, that the stream ends there.
        bool check_last_block = true;
    };

    explicit CDeflateCompressor(CZipStorage* storage);
    ~CDeflateCompressor() override;

    bool CanProcess(std::uint16_t method) override { return method == 0 || method == 8; }
    void InitCompression(int level, CZipFileHeader* header, CZipCryptograph* cryptograph) override;
    void InitDecompression(CZipFileHeader* header, CZipCryptograph* cryptograph) override;
    void Compress(const void* buffer, unsigned int size) override;
    unsigned int Decompress(void* buffer, unsigned int size) override;
    void FinishCompression(bool afterException) override;
    void FinishDecompression(bool afterException) override;
    const COptions* GetOptions() const override { return &options_; }
    void UpdateOptions(const CZipCompressor::COptions* options) override;
    /// `Z_STREAM_END` (1) to `Z_VERSION_ERROR` (-6) give 500 to 507, 0 left out; any other 100.
    int ConvertInternalError(int code) const override;
    /// `Z_OK` and `Z_NEED_DICT`.
    bool IsCodeErrorOK(int code) const override;

private:
    enum class work { none, deflating, inflating };

    void reset_stream();
    void end_stream() noexcept;
    void store(const char* from, unsigned int size);
    int deflate_step(int flush);

    COptions options_;
    std::unique_ptr<z_stream_s> stream_;
    work work_ = work::none;
    bool stored_ = false;
    std::uint32_t filled_ = 0;
    std::uint64_t packed_ = 0;
};

} // namespace ZipArchiveLib
