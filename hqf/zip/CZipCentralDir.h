#pragma once

/// The directory at the end of an archive: its headers, and the end record that leads to them.

#include "hqf/platform/api.h"
#include "hqf/zip/CZipAutoBuffer.h"
#include "hqf/zip/CZipFileHeader.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

class CZipStorage;

/// Owns the headers. They stand in the order of their entries in the file, not of the directory, and an index is a
/// place in that order.
class HQF_API CZipCentralDir {
public:
    static constexpr std::uint32_t header_signature = 0x02014B50;
    static constexpr std::uint32_t end_signature = 0x06054B50;
    static constexpr std::uint32_t zip64_signature = 0x07064B50;

    /// Each switches a check off.
    enum EConsistencyFlags : std::uint32_t {
        skipContentCrc = 0x01, ///< CRC-32 at the close of an entry
        skipMethod = 0x02,     ///< method of the local header
        skipSizes = 0x04,      ///< sizes and CRC-32 of the local header
        skipCrc = 0x08,        ///< the same
        skipFlags = 0x10,      ///< flags of the local header
        skipDescriptor = 0x100 ///< data descriptor at the close of an entry
    };

    CZipCentralDir() = default;
    CZipCentralDir(const CZipCentralDir&) = delete;
    CZipCentralDir& operator=(const CZipCentralDir&) = delete;
    virtual ~CZipCentralDir();

    /// Empties the directory and binds it to a storage, which must outlive its use.
    ///
    /// \param name_code_page of all names; none lets the host of each header decide.
    void Init(CZipStorage& storage, std::optional<std::uint32_t> name_code_page = std::nullopt);

    /// Finds the end record and reads all headers.
    ///
    /// \param exhaustive goes on past the count of the end record as long as headers follow.
    ///
    /// Causes: 118 no end record; 120 ZIP64; 103 several volumes; 101 for all that is short, malformed or
    /// contradictory, two entries at one offset included.
    void Read(bool exhaustive);

    /// Makes an entry the open one and reads its local header. Cause 101 when the headers disagree.
    void OpenFile(unsigned int index);

    /// Ends it; normally after the data have been read, so that a data descriptor behind them can be checked (cause
    /// 101), which the flags switch off at first.
    void CloseFile(bool afterException);

    /// Appends a copy of a header for a new entry, prepares it for its method, and writes its local header at the end
    /// of the file. A directory that was in the file is cut off before.
    ///
    /// \param replaceIndex must be -1: entries are not replaced.
    /// \returns the new header, or null for another index. Cause 110 when a field has 65,536 bytes or more. After an
    ///          exception the directory has no new header.
    CZipFileHeader* AddNewFile(const CZipFileHeader& header, int replaceIndex, int level);

    /// Completes the entry that `AddNewFile` began: patches its local header, or writes a descriptor. After an
    /// exception the entry leaves the directory.
    void CloseNewFile(bool afterException);

    /// Writes headers and end record behind the entries, unless they are in the file already.
    void Write();

    /// Writes the end record alone, at the storage's position.
    void WriteCentralEnd();

    /// Empties the directory.
    void Close();

    unsigned int GetCount() const { return static_cast<unsigned int>(headers_.size()); }
    /// Precondition: `index < GetCount()`.
    CZipFileHeader& GetHeader(unsigned int index) { return *headers_[index]; }
    const CZipFileHeader& GetHeader(unsigned int index) const { return *headers_[index]; }
    /// The entry being read or written, or null.
    CZipFileHeader* GetOpenHeader() { return open_; }
    CZipStorage& GetStorage() { return *storage_; }
    std::uint32_t GetConsistencyFlags() const { return consistency_flags_; }
    void SetConsistencyFlags(std::uint32_t flags) { consistency_flags_ = flags; }
    std::optional<std::uint32_t> GetNameCodePage() const { return name_code_page_; }
    /// The bytes of the archive comment.
    std::string GetComment() const;

    /// Whether an entry's size can be true: its packed bytes lie before the directory, and they can stand for that
    /// many. Ask before memory is taken for an entry from unknown hands. Precondition: `index < GetCount()`.
    bool is_size_credible(unsigned int index) const;

private:
    struct end_record {
        std::uint32_t position = 0;
        std::uint16_t this_disk = 0;
        std::uint16_t directory_disk = 0;
        std::uint16_t entries_on_disk = 0;
        std::uint16_t entries = 0;
        std::uint32_t size = 0;
        std::uint32_t offset = 0;
        bool is_in_file = false;
        CZipAutoBuffer comment;
    };

    void read_end_record();
    void refuse_zip64();
    void place_archive();
    void read_headers(bool exhaustive);
    void check_descriptor();
    void cut_off();

    CZipStorage* storage_ = nullptr;
    CZipFileHeader* open_ = nullptr;
    std::uint32_t consistency_flags_ = skipDescriptor;
    std::vector<std::unique_ptr<CZipFileHeader>> headers_;
    std::optional<std::uint32_t> name_code_page_;
    end_record end_;
};
