// Data packed with bzip2.

#include "hqf/zip/CBzip2Compressor.h"

#include "hqf/zip/CZipException.h"
#include "hqf/zip/CZipStorage.h"

#include <bzlib.h>

// What a bzip2 built without stdio calls when it finds a fault in itself; one built with stdio ends the process
// instead.
extern "C" void bz_internal_error(int code);
extern "C" void bz_internal_error(int /*code*/) {
    throw CZipException(CZipException::bzip2Internal);
}

namespace ZipArchiveLib {

struct CBzip2Compressor::stream_box {
    bz_stream stream{};
};

CBzip2Compressor::COptions::~COptions() = default;

std::unique_ptr<CZipCompressor::COptions> CBzip2Compressor::COptions::Clone() const {
    return std::make_unique<COptions>(*this);
}

CBzip2Compressor::CBzip2Compressor(CZipStorage* storage)
    : CBaseLibCompressor(storage)
    , stream_(std::make_unique<stream_box>()) {}

CBzip2Compressor::~CBzip2Compressor() {
    end_stream();
}

void CBzip2Compressor::UpdateOptions(const CZipCompressor::COptions* options) {
    if (const auto* own = dynamic_cast<const COptions*>(options)) options_ = *own;
}

void CBzip2Compressor::end_stream() noexcept {
    if (is_active_) (void)::BZ2_bzDecompressEnd(&stream_->stream);
    is_active_ = false;
    release_blocks();
}

void CBzip2Compressor::InitCompression(int, CZipFileHeader*, CZipCryptograph*) {
    storage_->ThrowError(CZipException::generic);
}

void CBzip2Compressor::Compress(const void*, unsigned int) {
    storage_->ThrowError(CZipException::generic);
}

void CBzip2Compressor::FinishCompression(bool /*afterException*/) {
    end_stream();
}

void CBzip2Compressor::InitDecompression(CZipFileHeader* header, CZipCryptograph* cryptograph) {
    CZipCompressor::InitDecompression(header, cryptograph);
    end_stream();
    begin(options_);
    stream_->stream = bz_stream();
    stream_->stream.bzalloc = [](void* self, int count, int size) {
        return allocate(self, static_cast<std::size_t>(count), static_cast<std::size_t>(size));
    };
    stream_->stream.bzfree = [](void* self, void* block) { release(self, block); };
    stream_->stream.opaque = static_cast<CBaseLibCompressor*>(this);
    const int code = ::BZ2_bzDecompressInit(&stream_->stream, 0, 0);
    if (!IsCodeErrorOK(code)) throw_library_error(code);
    is_active_ = true;
}

unsigned int CBzip2Compressor::Decompress(void* buffer, unsigned int size) {
    method_rules rules{};
    rules.step = [](void* stream, piece& bytes) {
        auto* const unpacking = static_cast<bz_stream*>(stream);
        unpacking->next_in = bytes.in;
        unpacking->avail_in = bytes.in_left;
        unpacking->next_out = bytes.out;
        unpacking->avail_out = bytes.out_left;
        const int code = ::BZ2_bzDecompress(unpacking);
        bytes = {unpacking->next_in, unpacking->avail_in, unpacking->next_out, unpacking->avail_out};
        return code;
    };
    rules.stream = &stream_->stream;
    rules.stream_end = BZ_STREAM_END;
    rules.has_to_end = true;
    return deliver(rules, buffer, size);
}

void CBzip2Compressor::FinishDecompression(bool /*afterException*/) {
    end_stream();
}

int CBzip2Compressor::ConvertInternalError(int code) const {
    if (code <= BZ_SEQUENCE_ERROR && code >= BZ_CONFIG_ERROR) return CZipException::bzip2Error - 1 - code;
    return CZipCompressor::ConvertInternalError(code);
}

} // namespace ZipArchiveLib
