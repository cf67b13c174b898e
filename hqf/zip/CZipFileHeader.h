#pragma once

/// What an archive says about one entry: the fields of its central and its local header (APPNOTE 4.3.7, 4.3.12).

#include "hqf/platform/api.h"
#include "hqf/zip/CZipAutoBuffer.h"
#include "hqf/zip/CZipExtraField.h"

#include <cstdint>
#include <optional>
#include <string>

class CZipCentralDir;
class CZipCompressor;
class CZipStorage;

/// A value: copies are deep. Headers that an archive hands out stay the archive's until it is closed.
class HQF_API CZipFileHeader {
public:
    CZipFileHeader();
    virtual ~CZipFileHeader();
    CZipFileHeader(const CZipFileHeader&) = default;
    CZipFileHeader& operator=(const CZipFileHeader&) = default;

    /// Stores the name in the header's code page, with each backslash turned into a forward slash.
    void SetFileName(const std::wstring& name);
    /// The stored name as text; on hosts 0 and 10 each forward slash becomes a backslash.
    std::wstring GetFileName() const;
    /// The stored bytes of the name.
    std::string GetStoredName() const;

    /// Stores DOS attribute bits in the way of the header's host: 0 keeps them with a Unix mode above them, 3 keeps the
    /// mode alone. A host without a conversion is cause 117, in both directions.
    void SetSystemAttr(std::uint32_t attributes);
    /// The DOS attribute bits.
    std::uint32_t GetSystemAttr() const;
    /// The folder bit of the attributes. Cause 117 as above.
    bool IsDirectory() const;

    /// Stores a time, in seconds since 1970-01-01 UTC, as MS-DOS local time: even seconds, years up to 2107. A year of
    /// 1980 or earlier gives the year field 0.
    void SetTime(std::int64_t time);
    /// The way back; the system decides about daylight saving.
    std::int64_t GetTime() const;
    bool HasTime() const { return time_ != 0 || date_ != 0; }

    std::uint32_t GetUncompressedSize() const { return uncompressed_size_; }
    std::uint32_t GetCompressedSize() const { return compressed_size_; }
    std::uint32_t GetLocalUncompressedSize() const { return local_uncompressed_size_; }
    std::uint32_t GetLocalCompressedSize() const { return local_compressed_size_; }
    std::uint32_t GetCrc32() const { return crc32_; }
    std::uint16_t GetMethod() const { return method_; }
    std::uint16_t GetFlags() const { return flags_; }
    std::uint16_t GetVersionNeeded() const { return version_needed_; }
    std::uint8_t GetVersionMadeBy() const { return version_made_by_; }
    std::uint8_t GetHost() const { return host_; }
    std::uint16_t GetDosTime() const { return time_; }
    std::uint16_t GetDosDate() const { return date_; }
    std::uint16_t GetDiskStart() const { return disk_start_; }
    std::uint16_t GetInternalAttr() const { return internal_attributes_; }
    std::uint32_t GetExternalAttr() const { return external_attributes_; }
    std::uint32_t GetOffset() const { return local_offset_; }
    /// 0xFF for none, 0 for the traditional method.
    std::uint8_t GetEncryptionMethod() const { return encryption_method_; }
    bool IsEncrypted() const { return encryption_method_ != no_encryption; }

    /// Changes the host and converts the attributes to it.
    void SetHost(std::uint8_t host);
    /// The code page of the name: 1 on host 0 and 0 on others, unless told otherwise. The name is stored anew.
    void SetNameCodePage(std::uint32_t code_page);
    std::uint32_t GetNameCodePage() const;
    /// Keeps the name in the extra field of the central header too, in its own code page; the name field then holds it
    /// in the default code page of the host.
    void SetNameInExtra(bool in_extra) { name_in_extra_ = in_extra; }
    void SetCommentCodePage(std::uint32_t code_page) { comment_code_page_ = code_page; }
    std::uint32_t GetCommentCodePage() const { return comment_code_page_; }
    void SetComment(const std::wstring& comment);
    std::wstring GetComment() const;

    CZipExtraField& GetLocalExtra() { return local_extra_; }
    CZipExtraField& GetCentralExtra() { return central_extra_; }
    const CZipExtraField& GetCentralExtra() const { return central_extra_; }

    /// Makes the header ready for a new entry: sizes, CRC and internal attributes 0, version 46, and flags and the
    /// version needed by method and level. `spanned` asks for a data descriptor.
    void PrepareData(int level, bool spanned);

    /// Reads a central header at the storage's position; without `readSignature` the signature is already behind.
    ///
    /// \returns false for a wrong signature, or an extra field that is malformed or too short for what it announces. A
    ///          short read is cause 101.
    bool Read(CZipCentralDir& centralDir, bool readSignature);

    /// Reads the local header and compares it with this one; the storage then stands at the data. Cause 101 when they
    /// disagree, less what the directory's consistency flags switch off.
    void ReadLocal(CZipCentralDir& centralDir);

    /// Writes the local header at the storage's position and notes its offset.
    void WriteLocal(CZipStorage& storage);

    /// Writes the central header. \returns its size in bytes. Cause 110 when a field has 65,536 bytes or more.
    std::uint32_t WriteCentral(CZipStorage& storage) const;

    /// Puts CRC-32 and sizes into the local header; the position stays.
    void UpdateLocal(CZipStorage& storage);

    /// Writes signature, CRC-32 and sizes behind the data.
    void WriteDataDescriptor(CZipStorage& storage) const;

    /// \returns false when name, comment or an extra field has 65,536 bytes or more.
    bool FieldsFit() const;

private:
    friend class CZipCentralDir;
    friend class CZipCompressor;
    friend class CZipArchive;

    static constexpr std::uint8_t no_encryption = 0xFF;
    static constexpr std::uint16_t flag_encrypted = 0x01;
    static constexpr std::uint16_t flag_descriptor = 0x08;

    std::uint32_t default_code_page() const { return host_ == 0 ? 1 : 0; }
    bool read_names();
    CZipExtraField central_extra_to_write() const;
    std::string name_to_write() const;

    std::uint8_t version_made_by_ = 46;
    std::uint8_t host_ = 0;
    std::uint16_t version_needed_ = 20;
    std::uint16_t flags_ = 0;
    std::uint16_t method_ = 8;
    std::uint16_t time_ = 0;
    std::uint16_t date_ = 0;
    std::uint32_t crc32_ = 0;
    std::uint32_t compressed_size_ = 0;
    std::uint32_t uncompressed_size_ = 0;
    std::uint16_t disk_start_ = 0;
    std::uint16_t internal_attributes_ = 0;
    std::uint32_t local_compressed_size_ = 0;
    std::uint32_t local_uncompressed_size_ = 0;
    std::uint32_t local_offset_ = 0;
    std::uint32_t external_attributes_ = 0;
    CZipExtraField local_extra_;
    CZipExtraField central_extra_;
    std::uint16_t local_name_length_ = 0;
    std::uint8_t encryption_method_ = no_encryption;
    bool name_in_extra_ = false;
    CZipAutoBuffer name_;
    std::optional<std::uint32_t> name_code_page_; // none: the default of the host
    std::uint32_t comment_code_page_ = 0;
    CZipAutoBuffer comment_;
};
