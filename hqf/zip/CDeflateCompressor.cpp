// Stored and deflated data. The streams are raw: window bits -15 means no zlib header and no checksum of its own.

#include "hqf/zip/CDeflateCompressor.h"

#include "hqf/zip/CZipFileHeader.h"

#include <zlib.h>

#include <algorithm>
#include <cstring>

namespace ZipArchiveLib {
namespace {

constexpr int raw_window_bits = -15;
constexpr int memory_level = 8;
// The version whose stream structure this code knows. zlib compares the first digit and the structure's size.
constexpr char known_version[] = "1.2.3";

} // namespace

CDeflateCompressor::COptions::~COptions() = default;

std::unique_ptr<CZipCompressor::COptions> CDeflateCompressor::COptions::Clone() const {
    return std::make_unique<COptions>(*this);
}

CDeflateCompressor::CDeflateCompressor(CZipStorage* storage)
    : CBaseLibCompressor(storage)
    , stream_(std::make_unique<z_stream_s>()) {}

CDeflateCompressor::~CDeflateCompressor() {
    end_stream();
}

void CDeflateCompressor::UpdateOptions(const CZipCompressor::COptions* options) {
    if (const auto* own = dynamic_cast<const COptions*>(options)) options_ = *own;
}

void CDeflateCompressor::reset_stream() {
    end_stream();
    begin(options_);
    *stream_ = z_stream_s();
    stream_->zalloc = [](void* self, uInt count, uInt size) { return allocate(self, count, size); };
    stream_->zfree = [](void* self, void* block) { release(self, block); };
    // zlib hands this back as it got it: a pointer to the base, to which `allocate` casts.
    stream_->opaque = static_cast<CBaseLibCompressor*>(this);
}

void CDeflateCompressor::end_stream() noexcept {
    // The results tell of data that were left, which is no news after an exception.
    if (work_ == work::deflating) (void)::deflateEnd(stream_.get());
    if (work_ == work::inflating) (void)::inflateEnd(stream_.get());
    work_ = work::none;
    release_blocks();
}

void CDeflateCompressor::InitCompression(int level, CZipFileHeader* header, CZipCryptograph* cryptograph) {
    CZipCompressor::InitCompression(level, header, cryptograph);
    reset_stream();
    filled_ = 0;
    packed_ = 0;
    stored_ = header->GetMethod() == 0;
    if (stored_) return;
    const int code = ::deflateInit2_(stream_.get(), level, Z_DEFLATED, raw_window_bits, memory_level,
                                     Z_DEFAULT_STRATEGY, known_version, sizeof(z_stream_s));
    if (!IsCodeErrorOK(code)) throw_library_error(code);
    work_ = work::deflating;
}

void CDeflateCompressor::InitDecompression(CZipFileHeader* header, CZipCryptograph* cryptograph) {
    CZipCompressor::InitDecompression(header, cryptograph);
    reset_stream();
    stored_ = header->GetMethod() == 0;
    if (stored_) return;
    const int code = ::inflateInit2_(stream_.get(), raw_window_bits, known_version, sizeof(z_stream_s));
    if (!IsCodeErrorOK(code)) throw_library_error(code);
    work_ = work::inflating;
}

void CDeflateCompressor::store(const char* from, unsigned int size) {
    while (size > 0) {
        const std::uint32_t count = std::min(size, static_cast<std::uint32_t>(buffer_.GetSize()) - filled_);
        std::memcpy(buffer_.GetBuffer() + filled_, from, count);
        filled_ += count;
        packed_ += count;
        from += count;
        size -= count;
        if (filled_ == buffer_.GetSize()) {
            write_packed(filled_);
            filled_ = 0;
        }
    }
}

int CDeflateCompressor::deflate_step(int flush) {
    const auto room = static_cast<std::uint32_t>(buffer_.GetSize()) - filled_;
    stream_->next_out = reinterpret_cast<Bytef*>(buffer_.GetBuffer()) + filled_;
    stream_->avail_out = room;
    const int code = ::deflate(stream_.get(), flush);
    filled_ += room - stream_->avail_out;
    packed_ += room - stream_->avail_out;
    if (filled_ == buffer_.GetSize()) {
        write_packed(filled_);
        filled_ = 0;
    }
    return code;
}

void CDeflateCompressor::Compress(const void* buffer, unsigned int size) {
    note_input(buffer, size);
    if (stored_) {
        store(static_cast<const char*>(buffer), size);
        return;
    }
    stream_->next_in = const_cast<Bytef*>(static_cast<const Bytef*>(buffer));
    stream_->avail_in = size;
    while (stream_->avail_in > 0) {
        const int code = deflate_step(Z_NO_FLUSH);
        if (!IsCodeErrorOK(code)) throw_library_error(code);
    }
}

void CDeflateCompressor::FinishCompression(bool afterException) {
    if (!afterException) {
        if (!stored_) {
            stream_->avail_in = 0;
            int code = Z_OK;
            while (code == Z_OK)
                code = deflate_step(Z_FINISH);
            if (code != Z_STREAM_END) throw_library_error(code);
        }
        write_packed(filled_);
        note_sizes(packed_);
    }
    end_stream();
}

unsigned int CDeflateCompressor::Decompress(void* buffer, unsigned int size) {
    method_rules rules{};
    rules.stream_end = Z_STREAM_END;
    if (stored_) {
        rules.step = [](void*, piece& bytes) {
            unsigned const int count = std::min(bytes.in_left, bytes.out_left);
            std::memcpy(bytes.out, bytes.in, count);
            bytes = {bytes.in + count, bytes.in_left - count, bytes.out + count, bytes.out_left - count};
            return Z_OK;
        };
        rules.has_to_end = true;
        return deliver(rules, buffer, size);
    }
    rules.step = [](void* stream, piece& bytes) {
        auto* const inflating = static_cast<z_stream_s*>(stream);
        inflating->next_in = reinterpret_cast<Bytef*>(bytes.in);
        inflating->avail_in = bytes.in_left;
        inflating->next_out = reinterpret_cast<Bytef*>(bytes.out);
        inflating->avail_out = bytes.out_left;
        const int code = ::inflate(inflating, Z_SYNC_FLUSH);
        bytes = {reinterpret_cast<char*>(const_cast<Bytef*>(inflating->next_in)), inflating->avail_in,
                 reinterpret_cast<char*>(inflating->next_out), inflating->avail_out};
        return code;
    };
    rules.stream = stream_.get();
    rules.takes_dummy = true;
    rules.has_to_end = options_.check_last_block;
    return deliver(rules, buffer, size);
}

void CDeflateCompressor::FinishDecompression(bool /*afterException*/) {
    end_stream();
}

int CDeflateCompressor::ConvertInternalError(int code) const {
    if (code == Z_STREAM_END) return 500;
    if (code == Z_NEED_DICT) return 501;
    if (code <= Z_ERRNO && code >= Z_VERSION_ERROR) return 501 - code;
    return CZipCompressor::ConvertInternalError(code);
}

bool CDeflateCompressor::IsCodeErrorOK(int code) const {
    return code == Z_OK || code == Z_NEED_DICT;
}

} // namespace ZipArchiveLib
