// The loop that unpacks, for all methods. No input keeps it going without progress: a step that neither takes nor gives
// a byte ends it.

#include "hqf/zip/CBaseLibCompressor.h"

#include "hqf/zip/CZipException.h"
#include "hqf/zip/CZipStorage.h"

#include <zlib.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>

namespace ZipArchiveLib {

CBaseLibCompressor::COptions::~COptions() = default;

std::unique_ptr<CZipCompressor::COptions> CBaseLibCompressor::COptions::Clone() const {
    return std::make_unique<COptions>(*this);
}

CBaseLibCompressor::~CBaseLibCompressor() {
    release_blocks();
}

void CBaseLibCompressor::begin(const COptions& options) {
    buffer_.Allocate(options.buffer_size != 0 ? options.buffer_size : hqf::zip_limits::compressor_buffer);
    release_blocks();
    detect_leaks_ = options.detect_leaks;
    end_of_stream_ = false;
    dummy_taken_ = false;
    in_ = buffer_.GetBuffer();
    in_left_ = 0;
}

void CBaseLibCompressor::throw_library_error(int code) const {
    storage_->ThrowError(ConvertInternalError(code));
}

void CBaseLibCompressor::write_packed(std::uint32_t size) {
    storage_->Write(buffer_.GetBuffer(), size, false);
}

bool CBaseLibCompressor::refill(bool takes_dummy) {
    in_ = buffer_.GetBuffer();
    if (compressed_left_ != 0) {
        const std::uint32_t size = std::min(compressed_left_, static_cast<std::uint32_t>(buffer_.GetSize()));
        storage_->Read(in_, size, false);
        compressed_left_ -= size;
        in_left_ = size;
        return true;
    }
    // One byte behind the end lets a decoder that looks ahead finish; a second one would let a cut stream go on.
    if (!takes_dummy || dummy_taken_) return false;
    dummy_taken_ = true;
    *in_ = 0;
    in_left_ = 1;
    return true;
}

int CBaseLibCompressor::step(const method_rules& rules, char*& out, unsigned int& out_left, bool& moved) {
    piece bytes{in_, in_left_, out, out_left};
    const int code = rules.step(rules.stream, bytes);
    unsigned const int delivered = out_left - bytes.out_left;
    moved = delivered != 0 || bytes.in_left != in_left_;
    crc32_ = static_cast<std::uint32_t>(::crc32(crc32_, reinterpret_cast<const Bytef*>(out), delivered));
    uncompressed_left_ -= delivered;
    in_ = bytes.in;
    in_left_ = bytes.in_left;
    out = bytes.out;
    out_left = bytes.out_left;
    end_of_stream_ = code == rules.stream_end;
    return code;
}

unsigned int CBaseLibCompressor::deliver(const method_rules& rules, void* buffer, unsigned int size) {
    if (end_of_stream_) return 0;
    char* out = static_cast<char*>(buffer);
    unsigned const int wanted = std::min(size, uncompressed_left_);
    unsigned int out_left = wanted;
    while (out_left > 0) {
        // Stored data that run out are a short entry, which the caller notices; a packed stream has to tell its end.
        if (in_left_ == 0 && !refill(rules.takes_dummy) && rules.stream == nullptr) return wanted - out_left;
        bool moved = false;
        const int code = step(rules, out, out_left, moved);
        if (end_of_stream_) return wanted - out_left;
        if (!IsCodeErrorOK(code)) throw_library_error(code);
        if (!moved) storage_->ThrowError(CZipException::badZipFile);
    }
    if (size != 0 && uncompressed_left_ == 0 && rules.has_to_end) require_end(rules);
    return wanted;
}

void CBaseLibCompressor::require_end(const method_rules& rules) {
    // Whether one more step reaches the end must not depend on where a piece of input ended: pieces follow as long as
    // they are taken.
    if (rules.stream == nullptr) {
        if (in_left_ != 0 || compressed_left_ != 0) storage_->ThrowError(CZipException::badZipFile);
        end_of_stream_ = true;
        return;
    }
    char nothing = 0;
    while (!end_of_stream_) {
        char* out = &nothing;
        unsigned int no_room = 0;
        bool moved = false;
        if (in_left_ == 0) refill(rules.takes_dummy);
        const int code = step(rules, out, no_room, moved);
        if (!end_of_stream_ && (!moved || !IsCodeErrorOK(code))) storage_->ThrowError(CZipException::badZipFile);
    }
}

void* CBaseLibCompressor::allocate(void* self, std::size_t count, std::size_t size) noexcept {
    if (size != 0 && count > SIZE_MAX / size) return nullptr;
    auto* const compressor = static_cast<CBaseLibCompressor*>(self);
    void* const block = std::malloc(count * size);
    if (block == nullptr || !compressor->detect_leaks_) return block;
    // Called from C, which no exception may pass.
    try {
        compressor->blocks_.push_back(block);
        return block;
    } catch (...) {
        std::free(block);
        return nullptr;
    }
}

void CBaseLibCompressor::release(void* self, void* block) noexcept {
    std::erase(static_cast<CBaseLibCompressor*>(self)->blocks_, block);
    std::free(block);
}

void CBaseLibCompressor::release_blocks() noexcept {
    for (void* const block : blocks_)
        std::free(block);
    blocks_.clear();
}

} // namespace ZipArchiveLib
