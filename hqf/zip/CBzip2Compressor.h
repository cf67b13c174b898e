#pragma once

/// Method 12 over bzip2, for reading.

#include "hqf/zip/CBaseLibCompressor.h"

namespace ZipArchiveLib {

class HQF_API CBzip2Compressor : public CBaseLibCompressor {
public:
    class HQF_API COptions : public CBaseLibCompressor::COptions {
    public:
        ~COptions() override;
        std::unique_ptr<CZipCompressor::COptions> Clone() const override;
    };

    explicit CBzip2Compressor(CZipStorage* storage);
    ~CBzip2Compressor() override;

    bool CanProcess(std::uint16_t method) override { return method == 12; }
    /// Compressing with bzip2 is not built: cause 100.
    void InitCompression(int level, CZipFileHeader* header, CZipCryptograph* cryptograph) override;
    void InitDecompression(CZipFileHeader* header, CZipCryptograph* cryptograph) override;
    /// Cause 100, as `InitCompression`.
    void Compress(const void* buffer, unsigned int size) override;
    unsigned int Decompress(void* buffer, unsigned int size) override;
    void FinishCompression(bool afterException) override;
    void FinishDecompression(bool afterException) override;
    const COptions* GetOptions() const override { return &options_; }
    void UpdateOptions(const CZipCompressor::COptions* options) override;
    /// `BZ_SEQUENCE_ERROR` (-1) to `BZ_CONFIG_ERROR` (-9) give 600 to 608; any other 100.
    int ConvertInternalError(int code) const override;
    /// `BZ_OK` (0) to `BZ_FINISH_OK` (3).
    bool IsCodeErrorOK(int code) const override { return code >= 0 && code <= 3; }

private:
    // bzip2 gives its stream structure no tag that could be declared here.
    struct stream_box;

    void end_stream() noexcept;

    COptions options_;
    std::unique_ptr<stream_box> stream_;
    bool is_active_ = false;
};

} // namespace ZipArchiveLib
