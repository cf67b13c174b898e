#pragma once

/// What packs and unpacks the data of an entry.

#include "hqf/platform/api.h"

#include <cstdint>
#include <memory>

class CZipCryptograph; // encryption is not built; a pointer to it is always null
class CZipFileHeader;
class CZipStorage;

/// One entry at a time, between an `Init` and a `Finish` operation. The storage and the header must outlive it.
class HQF_API CZipCompressor {
public:
    /// What a compressor can be told beside its method.
    class HQF_API COptions {
    public:
        virtual ~COptions();
        virtual std::unique_ptr<COptions> Clone() const = 0;
    };

    explicit CZipCompressor(CZipStorage* storage)
        : storage_(storage) {}
    CZipCompressor(const CZipCompressor&) = delete;
    CZipCompressor& operator=(const CZipCompressor&) = delete;

    virtual bool CanProcess(std::uint16_t method) = 0;
    /// Begins an entry that is written; `level` is -1 for the library's default, 0, or 1 to 9.
    virtual void InitCompression(int level, CZipFileHeader* header, CZipCryptograph* cryptograph);
    /// Begins an entry that is read.
    virtual void InitDecompression(CZipFileHeader* header, CZipCryptograph* cryptograph);
    /// Takes data and writes what is packed so far to the storage.
    virtual void Compress(const void* buffer, unsigned int size) = 0;
    /// \returns the bytes delivered, fewer than asked for only where the entry ends.
    virtual unsigned int Decompress(void* buffer, unsigned int size) = 0;
    /// Writes the rest and tells the header the sizes; after an exception it only lets go of what it holds.
    virtual void FinishCompression(bool afterException) = 0;
    virtual void FinishDecompression(bool afterException) = 0;
    /// The options in force; they stay the compressor's.
    virtual const COptions* GetOptions() const = 0;
    /// Takes over a copy; options of another class, or null, change nothing.
    virtual void UpdateOptions(const COptions* options) = 0;
    virtual ~CZipCompressor();
    /// The cause for a result of the library.
    virtual int ConvertInternalError(int code) const;
    /// Whether the work can go on after that result.
    virtual bool IsCodeErrorOK(int code) const;

    /// Bytes that the entry being read has still to deliver.
    std::uint32_t GetUncompressedLeft() const { return uncompressed_left_; }
    /// Of all that was delivered.
    std::uint32_t GetCrc32() const { return crc32_; }

protected:
    /// Counts data to be packed: CRC-32 of the header, and their number. Cause 120 beyond what a header can tell.
    void note_input(const void* buffer, unsigned int size);
    /// Tells the header the sizes of the data that were written. Cause 120 as above.
    void note_sizes(std::uint64_t packed);

    CZipStorage* storage_;
    CZipFileHeader* header_ = nullptr;
    CZipCryptograph* cryptograph_ = nullptr;
    std::uint32_t uncompressed_left_ = 0;
    std::uint32_t compressed_left_ = 0;
    std::uint32_t crc32_ = 0;
    std::uint64_t input_size_ = 0;
};

namespace ZipArchiveLib {
using ::CZipCompressor;
}
