#pragma once

/// The extra field of a header: a row of records, each with an id and data (APPNOTE 4.5).

#include "hqf/platform/api.h"
#include "hqf/zip/CZipAutoBuffer.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

/// One record of an extra field.
struct CZipExtraData {
    std::uint16_t id = 0;
    CZipAutoBuffer data;
};

/// Owns its records. Copies are deep.
class HQF_API CZipExtraField {
public:
    /// Code pages of name and comment, and the name itself where it stands here.
    static constexpr std::uint16_t idNames = 0x5A4C;
    /// AES; known by number only.
    static constexpr std::uint16_t idAes = 0x9901;

    CZipExtraField() = default;
    CZipExtraField(const CZipExtraField& other);
    CZipExtraField(CZipExtraField&&) noexcept = default;
    CZipExtraField& operator=(CZipExtraField other) noexcept;
    ~CZipExtraField();

    /// Takes the records from a header's bytes.
    ///
    /// \returns false, with no record kept, unless the records fill the bytes exactly.
    bool Read(const char* bytes, std::size_t size);

    /// The bytes as a header holds them.
    std::string GetBytes() const;

    /// Adds a record at the end; of data above 65,535 bytes its length could not be told, and the header is refused
    /// when it is written.
    CZipExtraData& Add(std::uint16_t id, const char* data, std::size_t size);

    /// Takes all records with that id away.
    void Remove(std::uint16_t id);

    /// The first record with that id, or null; it stays the field's.
    const CZipExtraData* Find(std::uint16_t id) const;

    std::size_t GetCount() const { return records_.size(); }

private:
    std::vector<std::unique_ptr<CZipExtraData>> records_;
};
