#pragma once

/// The bytes of an archive: a file with a write buffer, and positions that count from where the archive begins in it.

#include "hqf/platform/api.h"
#include "hqf/zip/CZipAutoBuffer.h"
#include "hqf/zip/CZipFile.h"
#include "hqf/zip/limits.h"

#include <cstdint>

/// One thread at a time. Owns its file and buffer; writes nothing by itself when destroyed.
class HQF_API CZipStorage {
public:
    enum EMode : int {
        openExisting = 0, ///< reads and writes an existing archive
        openReadOnly = 1, ///< reads an existing archive
        create = 2,       ///< makes the file, or empties it
        append = 4        ///< begins an archive behind the content of an existing file
    };

    CZipStorage() = default;
    CZipStorage(const CZipStorage&) = delete;
    CZipStorage& operator=(const CZipStorage&) = delete;
    virtual ~CZipStorage();

    /// Opens the file. After modes 0 and 1 the storage has no volume until `SetVolume` tells it.
    ///
    /// \param volumeSize must be 0: archives of several volumes are not built.
    /// \returns false for a mode or volume size that is none of these. A file that cannot be opened is a
    ///          `CZipException` with its `errno` value and path.
    bool Open(const std::wstring& path, int mode, std::uint32_t volumeSize = 0);

    /// Reads exactly `size` bytes; fewer are cause 101. With one volume, `atOnce` makes no difference.
    void Read(void* buffer, std::uint32_t size, bool atOnce = true);

    /// Writes through the buffer; with `atOnce`, all that is buffered and these bytes reach the file in this call.
    void Write(const void* buffer, std::uint32_t size, bool atOnce = false);

    /// Moves to an offset in the archive. One beyond the last position that a file can have is cause 101.
    void Seek(std::uint32_t offset);

    /// Moves behind the last byte of the file.
    void SeekToEnd();

    /// Hands the write buffer to the file.
    void Flush();

    /// Finds the last occurrence of four bytes within the last `maximumDepth` bytes of the file.
    ///
    /// \param signature as a number, its lowest byte first in the file.
    /// \returns the position of its first byte, or -1.
    std::int64_t LocateSignature(std::uint32_t signature, std::uint32_t maximumDepth);

    /// The same in the `maximumDepth` bytes before `end`.
    std::int64_t LocateSignatureBefore(std::uint64_t end, std::uint32_t signature, std::uint64_t maximumDepth);

    /// Normally: writes out the buffer, waits for the disk unless read-only, closes the file. After an exception:
    /// closes the file and forgets the buffer. A normal close that fails leaves the file to a close after an exception.
    void Close(bool afterException = false);

    /// The offset in the archive at which the next byte is written or read.
    std::uint32_t GetPosition() const;
    /// The length of the file, without what the buffer holds.
    std::uint32_t GetLength() const;
    /// Cuts the archive at an offset.
    void SetLength(std::uint32_t offset);

    /// The number of the volume in hand, from the end record. Only 0 is read; any other is cause 103.
    void SetVolume(std::uint16_t volume);
    std::uint16_t GetVolume() const { return volume_; }
    bool IsClosed() const { return volume_ == closed; }
    bool HasOpenFile() const { return file_ != nullptr; }
    bool IsReadOnly() const { return read_only_; }
    std::uint32_t GetBytesBefore() const { return bytes_before_; }
    void SetBytesBefore(std::uint32_t count) { bytes_before_ = count; }
    std::wstring GetPath() const { return disk_file_.GetFilePath(); }

    /// Throws a `CZipException` with the path of the archive.
    [[noreturn]] void ThrowError(int cause) const;

private:
    static constexpr std::uint16_t closed = 0xFFFF;

    CZipFile disk_file_;
    CZipAbstractFile* file_ = nullptr;
    CZipAutoBuffer write_buffer_;
    std::uint32_t buffered_ = 0;
    std::uint32_t bytes_before_ = 0;
    std::uint16_t volume_ = closed;
    bool read_only_ = false;
};
