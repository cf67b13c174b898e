#pragma once

/// The file under an archive, as an interface.

#include "hqf/platform/api.h"

#include <cstdint>
#include <string>

/// A file that can be read, written and positioned. Failures are `CZipException` with the `errno` value and the path.
class HQF_API CZipAbstractFile {
public:
    /// Bits of the flags of `Open`. Without a sharing bit all others are denied.
    enum EOpenFlags : unsigned int {
        modeRead = 0x01,
        modeWrite = 0x02,
        modeReadWrite = modeRead | modeWrite,
        shareDenyWrite = 0x04,
        shareDenyRead = 0x08,
        shareDenyNone = 0x10,
        modeCreate = 0x20,
        modeNoTruncate = 0x40
    };

    /// Opens a file in binary mode. A writable file is emptied without `modeNoTruncate`, a read-only one never.
    ///
    /// \returns false when it cannot be opened and `throwOnError` is not set.
    virtual bool Open(const std::wstring& path, unsigned int flags, bool throwOnError) = 0;
    /// A closed file is left alone.
    virtual void Close() = 0;
    /// Returns when all that was written has reached the disk.
    virtual void Flush() = 0;
    virtual std::uint64_t GetPosition() const = 0;
    /// `origin` is SEEK_SET, SEEK_CUR or SEEK_END. \returns the new position.
    virtual std::uint64_t Seek(std::int64_t offset, int origin) = 0;
    virtual std::uint64_t GetLength() const = 0;
    virtual void SetLength(std::uint64_t length) = 0;
    virtual void SeekToBegin() = 0;
    virtual void SeekToEnd() = 0;
    virtual std::wstring GetFilePath() const = 0;
    /// \returns the bytes read; fewer than asked for only at the end of the file.
    virtual unsigned int Read(void* buffer, unsigned int size) = 0;
    /// Writes all bytes or throws.
    virtual void Write(const void* buffer, unsigned int size) = 0;
    virtual bool IsClosed() const = 0;
    virtual ~CZipAbstractFile();
};
