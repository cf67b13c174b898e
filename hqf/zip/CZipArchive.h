#pragma once

/// Archives in ZIP format (PKWARE APPNOTE): reading entries that are stored, deflated or packed with bzip2, and writing
/// stored or deflated ones. This header brings in all archive classes.
///
/// Left out: encryption, several volumes, ZIP64, archives in memory, replacing and removing entries, packing with
/// bzip2.

#include "hqf/platform/api.h"
#include "hqf/zip/CBzip2Compressor.h"
#include "hqf/zip/CDeflateCompressor.h"
#include "hqf/zip/CZipAutoBuffer.h"
#include "hqf/zip/CZipCentralDir.h"
#include "hqf/zip/CZipCompressor.h"
#include "hqf/zip/CZipException.h"
#include "hqf/zip/CZipFile.h"
#include "hqf/zip/CZipFileHeader.h"
#include "hqf/zip/CZipPathComponent.h"
#include "hqf/zip/CZipStorage.h"

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>

/// An archive file, from `Open` to `Close`; at most one entry is open at a time.
///
/// ```cpp
/// CZipArchive archive;
/// archive.Open(L"a.zip", CZipStorage::openReadOnly);
/// if (archive.OpenFile(0) && archive.is_size_credible(0)) {
///     CZipAutoBuffer bytes(archive.GetFileInfo(0)->GetUncompressedSize());
///     archive.ReadFile(bytes.GetBuffer(), static_cast<unsigned int>(bytes.GetSize()));
///     archive.CloseFile(); // 1, or CZipException 102
/// }
/// archive.Close();
/// ```
///
/// A misuse by the caller is a `false` result; all that goes wrong with a file or its content is a `CZipException`.
/// After one, `Close(CZipArchive::closeAfterException)` lets go of everything. One thread at a time; archives share
/// nothing. The destructor lets go as well, and writes nothing: without `Close`, a new archive has no directory.
class HQF_API CZipArchive {
public:
    enum ECloseMode : int { closeNormal = 0, closeAfterException = 1 };

    /// Bits of the smart flags of `AddNewFile`. Those that are about passwords (1, 2) and the efficiency check (8) have
    /// nothing to act on.
    enum ESmartFlags : int { smartNotCompressSmall = 4 };

    CZipArchive();
    virtual ~CZipArchive();
    /// Encryption is not built. \returns null.
    virtual CZipCryptograph* CreateCryptograph(int method);
    /// Makes sure that the archive's compressor can process a method: keeps the one it has, or makes another, and
    /// applies the options of the method. \returns the compressor, which stays the archive's; null for a method other
    /// than 0, 8 and 12.
    virtual CZipCompressor* CreateCompressor(std::uint16_t method);

    CZipArchive(const CZipArchive&) = delete;
    CZipArchive& operator=(const CZipArchive&) = delete;

    /// Opens or makes an archive.
    ///
    /// \param mode one of `CZipStorage::EMode`.
    /// \param volumeSize must be 0.
    /// \returns true; false if this object has an archive open, or for another mode or volume size.
    ///
    /// Causes: `errno` (a file of 2 GiB or more: EOVERFLOW), and those of `CZipCentralDir::Read`. After an exception
    /// the object is closed.
    bool Open(const std::wstring& path, int mode, std::uint32_t volumeSize = 0);

    bool IsClosed() const { return storage_.IsClosed(); }
    /// The entries; 0 when closed.
    unsigned int GetCount() const { return central_dir_.GetCount(); }

    /// What the archive says about an entry. Indexes follow the order of the entries in the file.
    ///
    /// \returns a pointer that stays the archive's; null for a bad index or a closed archive.
    CZipFileHeader* GetFileInfo(unsigned int index);
    const CZipFileHeader* GetFileInfo(unsigned int index) const;

    /// Whether the size that an entry claims can be true, by the number of packed bytes in the file and the most that
    /// its method can make of them. Ask before taking memory for an entry from unknown hands. False for a bad index.
    bool is_size_credible(unsigned int index) const;

    /// Opens an entry for reading.
    ///
    /// \returns false for a bad index, a closed archive, while an entry is open, and for a method that is not read.
    ///
    /// Causes: 101 local and central header disagree; 112 encrypted.
    bool OpenFile(unsigned int index);

    /// \returns the bytes delivered, fewer than asked for only where the entry ends; 0 when no entry is open for
    ///          reading, for a null buffer or size 0.
    ///
    /// Causes: 101 short archive, or a stream that goes on beyond the entry's size; 500 to 507 and 600 to 608 damaged
    /// data; 100 an unknown result of the library.
    unsigned int ReadFile(void* buffer, unsigned int size);

    /// Closes the entry being read, whatever the outcome.
    ///
    /// \param path of an unpacked file that gets the time and attributes of the entry; empty for none.
    /// \returns 1 when all was read and its CRC-32 holds (cause 102 if not); -1 when data were left unread; -2 when
    /// time
    ///          or attributes could not be set; 0 when no entry was open for reading.
    int CloseFile(const std::wstring& path = std::wstring(), bool afterException = false);

    /// The method of entries to come, 8 at first. \returns false, without a change, for all but 8 and 12 and while an
    /// entry is being written. Method 12 is only read: `OpenNewFile` refuses it.
    bool SetCompressionMethod(std::uint16_t method);

    /// Packs a file, or makes an entry for a folder.
    ///
    /// \param level -1 for the library's default, 0 to store, 1 to 9; any other counts as -1.
    /// \param fullPath names the entry by the path without its drive, otherwise by the file name alone.
    /// \param smartFlags with 4, a file below 5 bytes is stored.
    /// \param bufferSize bytes of the file read at a time; 0 counts as the default.
    /// \returns false when the file's attributes cannot be read, when it cannot be opened, and where `OpenNewFile`
    /// gives
    ///          false. Causes: as `WriteNewFile`.
    bool AddNewFile(const std::wstring& path, int level = -1, bool fullPath = false, int smartFlags = 7,
                    std::uint32_t bufferSize = hqf::zip_limits::copy_buffer);

    /// Begins an entry, named and timed by a header; one without a time gets the current one.
    ///
    /// \param path of a file or folder whose time and attributes the entry gets; empty for none.
    /// \param replaceIndex must be -1.
    /// \returns false when the archive is closed or read-only, an entry is open, it holds 65,535 entries, there is
    ///          nothing at `path`, or the method is 12.
    ///
    /// Causes: 110 name, comment or extra field of 65,536 bytes or more; `errno`.
    bool OpenNewFile(const CZipFileHeader& header, int level = -1, const std::wstring& path = std::wstring(),
                     int replaceIndex = -1);

    /// Takes data for the entry being written. \returns false when there is none.
    ///
    /// Causes: `errno` (EFBIG where the archive would reach 2 GiB); 120 above 4,294,967,294 bytes in one entry; 500 to
    /// 507. After an exception the entry is dropped.
    bool WriteNewFile(const void* buffer, unsigned int size);

    /// Ends the entry. After an exception the entry is dropped. \returns false when none was being written.
    bool CloseNewFile(bool afterException = false);

    /// Ends the archive: an open entry is closed, the directory written where one is due, the file flushed to disk and
    /// closed. After an exception nothing is written, and nothing thrown. A closed archive is left alone.
    ///
    /// \param updateTimeStamp gives the file the time of its newest entry, where the system allows.
    void Close(int mode = closeNormal, bool updateTimeStamp = false);

    /// Reads headers beyond the count of the end record, as long as there are any; off at first. Of effect at `Open`.
    void SetExhaustiveRead(bool exhaustive) { exhaustive_read_ = exhaustive; }
    /// `CZipCentralDir::EConsistencyFlags`.
    void SetConsistencyFlags(std::uint32_t flags) { central_dir_.SetConsistencyFlags(flags); }
    /// The code page of names, 1 at first; any other than the archive system's own wins over what a header says by its
    /// host. Of effect at `Open` and for new entries.
    void SetNameCodePage(std::uint32_t code_page) { name_code_page_ = code_page; }
    /// Options for a compression method.
    void SetCompressionOptions(std::uint16_t method, const CZipCompressor::COptions& options);

private:
    enum class open_entry { reading = -1, none = 0, writing = 1 };

    std::optional<std::uint32_t> chosen_code_page() const;
    void drop_new_entry() noexcept;
    void stamp_file(std::int64_t newest) const;

    CZipStorage storage_;
    CZipCentralDir central_dir_;
    std::unique_ptr<CZipCompressor> compressor_;
    std::map<std::uint16_t, std::unique_ptr<CZipCompressor::COptions>> compressor_options_;
    CZipAutoBuffer copy_buffer_;
    std::optional<std::uint32_t> name_code_page_;
    open_entry state_ = open_entry::none;
    std::uint16_t compression_method_ = 8;
    std::uint8_t system_ = 0;
    bool exhaustive_read_ = false;
};
