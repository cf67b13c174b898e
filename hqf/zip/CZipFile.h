#pragma once

/// A file on disk.

#include "hqf/zip/CZipAbstractFile.h"

/// Works over a file descriptor, -1 for closed, and keeps the path. Owns the descriptor; not copyable.
///
/// Positions above 2,147,483,647 are refused: `Seek`, `GetPosition` and `GetLength` with EOVERFLOW, `Write` with EFBIG.
/// Sharing is advisory here and never makes an open fail.
class HQF_API CZipFile : public CZipAbstractFile {
public:
    CZipFile() = default;
    /// Opens the file, or throws.
    CZipFile(const std::wstring& path, unsigned int flags) { CZipFile::Open(path, flags, true); }
    CZipFile(const CZipFile&) = delete;
    CZipFile& operator=(const CZipFile&) = delete;

    /// An open file is closed first.
    bool Open(const std::wstring& path, unsigned int flags, bool throwOnError) override;
    void Close() override;
    void Flush() override;
    std::uint64_t GetPosition() const override;
    std::uint64_t Seek(std::int64_t offset, int origin) override;
    /// Seeks to the end and back.
    std::uint64_t GetLength() const override;
    void SetLength(std::uint64_t length) override;
    void SeekToBegin() override;
    void SeekToEnd() override;
    std::wstring GetFilePath() const override { return path_; }
    unsigned int Read(void* buffer, unsigned int size) override;
    void Write(const void* buffer, unsigned int size) override;
    bool IsClosed() const override { return descriptor_ == -1; }
    /// Closes the file; a failure has nobody to tell.
    ~CZipFile() override;

private:
    [[noreturn]] void throw_error(int error) const;
    std::uint64_t seek(std::int64_t offset, int origin) const;

    std::wstring path_;
    int descriptor_ = -1;
};
