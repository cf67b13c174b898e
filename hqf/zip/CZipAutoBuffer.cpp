// The block of bytes that the archive classes share.

#include "hqf/zip/CZipAutoBuffer.h"

#include <cstring>
#include <utility>

CZipAutoBuffer::CZipAutoBuffer(const CZipAutoBuffer& other) {
    if (Allocate(other.size_) != nullptr) std::memcpy(bytes_.get(), other.bytes_.get(), size_);
}

CZipAutoBuffer::CZipAutoBuffer(CZipAutoBuffer&& other) noexcept
    : bytes_(std::move(other.bytes_))
    , size_(std::exchange(other.size_, 0)) {}

CZipAutoBuffer& CZipAutoBuffer::operator=(CZipAutoBuffer other) noexcept {
    bytes_.swap(other.bytes_);
    std::swap(size_, other.size_);
    return *this;
}

CZipAutoBuffer::~CZipAutoBuffer() = default;

char* CZipAutoBuffer::Allocate(std::size_t size, bool clear) {
    if (size != size_) {
        Release();
        // Not value-initialised: a large block costs pages only as it is filled.
        if (size != 0) bytes_.reset(new char[size]);
        size_ = size;
    }
    if (clear && size_ != 0) std::memset(bytes_.get(), 0, size_);
    return bytes_.get();
}

void CZipAutoBuffer::Release() noexcept {
    bytes_.reset();
    size_ = 0;
}
