// What all compressors do to the header of their entry.

#include "hqf/zip/CZipCompressor.h"

#include "hqf/zip/CZipException.h"
#include "hqf/zip/CZipFileHeader.h"
#include "hqf/zip/CZipStorage.h"
#include "hqf/zip/limits.h"

#include <zlib.h>

CZipCompressor::~CZipCompressor() = default;
CZipCompressor::COptions::~COptions() = default;

void CZipCompressor::InitCompression(int /*level*/, CZipFileHeader* header, CZipCryptograph* cryptograph) {
    header_ = header;
    cryptograph_ = cryptograph;
    input_size_ = 0;
}

void CZipCompressor::InitDecompression(CZipFileHeader* header, CZipCryptograph* cryptograph) {
    header_ = header;
    cryptograph_ = cryptograph;
    uncompressed_left_ = header->GetUncompressedSize();
    compressed_left_ = header->GetCompressedSize();
    crc32_ = 0;
}

int CZipCompressor::ConvertInternalError(int /*code*/) const {
    return CZipException::generic;
}

bool CZipCompressor::IsCodeErrorOK(int /*code*/) const {
    return false;
}

void CZipCompressor::note_input(const void* buffer, unsigned int size) {
    // crc32 of a null buffer is the start value, whatever went before.
    if (size == 0) return;
    input_size_ += size;
    if (input_size_ > hqf::zip_limits::largest_size) storage_->ThrowError(CZipException::needsZip64);
    header_->crc32_ = static_cast<std::uint32_t>(::crc32(header_->crc32_, static_cast<const Bytef*>(buffer), size));
}

void CZipCompressor::note_sizes(std::uint64_t packed) {
    packed += header_->compressed_size_;
    if (packed > hqf::zip_limits::largest_size) storage_->ThrowError(CZipException::needsZip64);
    header_->compressed_size_ = static_cast<std::uint32_t>(packed);
    header_->uncompressed_size_ = static_cast<std::uint32_t>(input_size_);
}
