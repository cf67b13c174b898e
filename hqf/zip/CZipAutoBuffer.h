#pragma once

/// A block of bytes with its size.

#include "hqf/platform/api.h"

#include <cstddef>
#include <memory>

/// Owns a byte array. Copies are deep.
class HQF_API CZipAutoBuffer {
public:
    CZipAutoBuffer() = default;
    explicit CZipAutoBuffer(std::size_t size, bool clear = false) { Allocate(size, clear); }
    CZipAutoBuffer(const CZipAutoBuffer& other);
    CZipAutoBuffer(CZipAutoBuffer&& other) noexcept;
    CZipAutoBuffer& operator=(CZipAutoBuffer other) noexcept;
    virtual ~CZipAutoBuffer();

    /// Makes the block `size` bytes long: the present one if it has that size, otherwise a new one after the old one is
    /// freed. Size 0 leaves no block.
    ///
    /// \param clear sets all bytes to 0; without it they are whatever they are.
    /// \returns the block, which stays the buffer's; null for size 0. When memory runs out (`std::bad_alloc`), the
    ///          buffer is empty.
    char* Allocate(std::size_t size, bool clear = false);

    /// Frees the block.
    void Release() noexcept;

    char* GetBuffer() noexcept { return bytes_.get(); }
    const char* GetBuffer() const noexcept { return bytes_.get(); }
    std::size_t GetSize() const noexcept { return size_; }

private:
    std::unique_ptr<char[]> bytes_;
    std::size_t size_ = 0;
};
