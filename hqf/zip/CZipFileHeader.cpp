// Names, attributes and times of an entry.

#include "hqf/zip/CZipFileHeader.h"

#include "hqf/platform/file_access.h"
#include "hqf/zip/attributes.h"
#include "hqf/zip/limits.h"

#include <algorithm>
#include <cstring>
#include <ctime>

namespace {

void assign(CZipAutoBuffer& buffer, const std::string& bytes) {
    if (buffer.Allocate(bytes.size()) != nullptr) std::memcpy(buffer.GetBuffer(), bytes.data(), bytes.size());
}

std::string_view view(const CZipAutoBuffer& buffer) {
    return buffer.GetSize() == 0 ? std::string_view() : std::string_view(buffer.GetBuffer(), buffer.GetSize());
}

} // namespace

CZipFileHeader::CZipFileHeader() = default;
CZipFileHeader::~CZipFileHeader() = default;

void CZipFileHeader::SetFileName(const std::wstring& name) {
    std::wstring slashed = name;
    std::replace(slashed.begin(), slashed.end(), L'\\', L'/');
    assign(name_, hqf::to_code_page(slashed, GetNameCodePage()));
}

std::wstring CZipFileHeader::GetFileName() const {
    std::wstring name = hqf::from_code_page(view(name_), GetNameCodePage());
    if (host_ == hqf::host_fat || host_ == hqf::host_ntfs) std::replace(name.begin(), name.end(), L'/', L'\\');
    return name;
}

std::string CZipFileHeader::GetStoredName() const {
    return std::string(view(name_));
}

void CZipFileHeader::SetComment(const std::wstring& comment) {
    assign(comment_, hqf::to_code_page(comment, comment_code_page_));
}

std::wstring CZipFileHeader::GetComment() const {
    return hqf::from_code_page(view(comment_), comment_code_page_);
}

std::uint32_t CZipFileHeader::GetNameCodePage() const {
    return name_code_page_.value_or(default_code_page());
}

void CZipFileHeader::SetNameCodePage(std::uint32_t code_page) {
    const std::wstring name = GetFileName();
    name_code_page_ = code_page;
    SetFileName(name);
}

void CZipFileHeader::SetHost(std::uint8_t host) {
    if (host == host_) return;
    const std::uint32_t external = hqf::to_external_attributes(host, GetSystemAttr());
    const std::wstring name = GetFileName();
    host_ = host;
    external_attributes_ = external;
    SetFileName(name);
}

void CZipFileHeader::SetSystemAttr(std::uint32_t attributes) {
    external_attributes_ = hqf::to_external_attributes(host_, attributes);
}

std::uint32_t CZipFileHeader::GetSystemAttr() const {
    return hqf::from_external_attributes(host_, external_attributes_);
}

bool CZipFileHeader::IsDirectory() const {
    return (GetSystemAttr() & hqf::attribute_folder) != 0;
}

void CZipFileHeader::SetTime(std::int64_t time) {
    std::tm local{};
    if (!hqf::to_local_time(time, local)) {
        // The first day that a header can hold.
        local = std::tm{};
        local.tm_mday = 1;
    }
    // The year has 7 bits from 1980 on.
    const int year = std::clamp(local.tm_year - 80, 0, 127);
    date_ = static_cast<std::uint16_t>(year << 9 | (local.tm_mon + 1) << 5 | local.tm_mday);
    time_ = static_cast<std::uint16_t>(local.tm_hour << 11 | local.tm_min << 5 | local.tm_sec / 2);
}

std::int64_t CZipFileHeader::GetTime() const {
    std::tm local{};
    local.tm_year = (date_ >> 9) + 80;
    local.tm_mon = ((date_ >> 5) & 15) - 1;
    local.tm_mday = date_ & 31;
    local.tm_hour = time_ >> 11;
    local.tm_min = (time_ >> 5) & 63;
    local.tm_sec = (time_ & 31) * 2;
    return hqf::from_local_time(local);
}

void CZipFileHeader::PrepareData(int level, bool spanned) {
    internal_attributes_ = 0;
    crc32_ = compressed_size_ = uncompressed_size_ = 0;
    local_compressed_size_ = local_uncompressed_size_ = 0;
    version_made_by_ = 46;
    flags_ = 0;
    if (method_ == 8) {
        // How hard deflate tried (APPNOTE 4.4.4, bits 1 and 2).
        if (level == 1) flags_ = 6;
        if (level == 2) flags_ = 4;
        if (level == 8 || level == 9) flags_ = 2;
    }
    if (spanned || encryption_method_ == 0) flags_ |= flag_descriptor;
    if (IsEncrypted()) flags_ |= flag_encrypted;
    version_needed_ = method_ == 12 ? 46 : IsDirectory() ? 10 : 20;
}

bool CZipFileHeader::FieldsFit() const {
    return name_to_write().size() <= hqf::zip_limits::longest_field &&
           comment_.GetSize() <= hqf::zip_limits::longest_field &&
           local_extra_.GetBytes().size() <= hqf::zip_limits::longest_field &&
           central_extra_to_write().GetBytes().size() <= hqf::zip_limits::longest_field;
}
