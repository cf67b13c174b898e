// The records of an extra field, to and from bytes.

#include "hqf/zip/CZipExtraField.h"

#include "hqf/zip/little_endian.h"

#include <algorithm>
#include <cstring>
#include <utility>

CZipExtraField::CZipExtraField(const CZipExtraField& other) {
    for (const auto& record : other.records_)
        Add(record->id, record->data.GetBuffer(), record->data.GetSize());
}

CZipExtraField& CZipExtraField::operator=(CZipExtraField other) noexcept {
    records_.swap(other.records_);
    return *this;
}

CZipExtraField::~CZipExtraField() = default;

bool CZipExtraField::Read(const char* bytes, std::size_t size) {
    records_.clear();
    while (size >= 4) {
        const std::size_t length = hqf::read_little_endian<std::uint16_t>(bytes + 2);
        if (length > size - 4) break;
        Add(hqf::read_little_endian<std::uint16_t>(bytes), bytes + 4, length);
        bytes += 4 + length;
        size -= 4 + length;
    }
    if (size != 0) records_.clear();
    return size == 0;
}

std::string CZipExtraField::GetBytes() const {
    hqf::field_writer out;
    for (const auto& record : records_)
        out(record->id)(static_cast<std::uint16_t>(record->data.GetSize()))
            .bytes(record->data.GetBuffer(), record->data.GetSize());
    return out.get();
}

CZipExtraData& CZipExtraField::Add(std::uint16_t id, const char* data, std::size_t size) {
    auto record = std::make_unique<CZipExtraData>();
    record->id = id;
    if (record->data.Allocate(size) != nullptr) std::memcpy(record->data.GetBuffer(), data, size);
    records_.push_back(std::move(record));
    return *records_.back();
}

void CZipExtraField::Remove(std::uint16_t id) {
    std::erase_if(records_, [id](const auto& record) { return record->id == id; });
}

const CZipExtraData* CZipExtraField::Find(std::uint16_t id) const {
    const auto found = std::find_if(records_.begin(), records_.end(), [id](const auto& r) { return r->id == id; });
    return found == records_.end() ? nullptr : found->get();
}
