// The two headers and the descriptor of an entry, as bytes.
//
// What is often misread: the local header may hold zeros, or different extra records, where the central one tells; the
// sizes in a local header count for nothing when its flag bit 3 is set; and name and extra field of the local header
// have lengths of their own, so that only its own fields tell where the data begin.

#include "hqf/platform/file_access.h"
#include "hqf/zip/CZipCentralDir.h"
#include "hqf/zip/CZipException.h"
#include "hqf/zip/CZipFileHeader.h"
#include "hqf/zip/CZipStorage.h"
#include "hqf/zip/limits.h"
#include "hqf/zip/little_endian.h"

#include <cstring>

namespace {

constexpr std::uint32_t local_signature = 0x04034B50;
constexpr std::uint32_t descriptor_signature = 0x08074B50;
constexpr std::uint32_t local_size = 30;
constexpr std::uint32_t central_size = 46;
constexpr std::uint32_t crc_in_local = 14;

void read_field(CZipStorage& storage, CZipAutoBuffer& field, std::uint16_t length) {
    storage.Read(field.Allocate(length), length);
}

bool read_extra(CZipStorage& storage, CZipExtraField& extra, std::uint16_t length) {
    CZipAutoBuffer bytes;
    read_field(storage, bytes, length);
    return extra.Read(bytes.GetBuffer(), length);
}

void write_bytes(CZipStorage& storage, const std::string& bytes, bool at_once = false) {
    storage.Write(bytes.data(), static_cast<std::uint32_t>(bytes.size()), at_once);
}

std::uint16_t length_of(std::size_t size) {
    return static_cast<std::uint16_t>(size);
}

// The record of code pages and names: version, flags, and what the flags announce.
enum names_flags : unsigned { names_code_page = 1, names_text = 2, names_comment_code_page = 4 };

} // namespace

bool CZipFileHeader::Read(CZipCentralDir& centralDir, bool readSignature) {
    CZipStorage& storage = centralDir.GetStorage();
    char bytes[central_size];
    const std::uint32_t skipped = readSignature ? 0 : 4;
    storage.Read(bytes + skipped, central_size - skipped);
    if (readSignature && hqf::read_little_endian<std::uint32_t>(bytes) != CZipCentralDir::header_signature)
        return false;
    hqf::field_reader next(bytes + 4);
    std::uint16_t name_length = 0, extra_length = 0, comment_length = 0;
    next(version_made_by_);
    next(host_);
    next(version_needed_);
    next(flags_);
    next(method_);
    next(time_);
    next(date_);
    next(crc32_);
    next(compressed_size_);
    next(uncompressed_size_);
    next(name_length);
    next(extra_length);
    next(comment_length);
    next(disk_start_);
    next(internal_attributes_);
    next(external_attributes_);
    next(local_offset_);
    encryption_method_ = (flags_ & flag_encrypted) != 0 ? std::uint8_t{0} : no_encryption;
    name_code_page_ = centralDir.GetNameCodePage();
    comment_code_page_ = 0;
    name_in_extra_ = false;
    read_field(storage, name_, name_length);
    const bool well_formed = read_extra(storage, central_extra_, extra_length);
    read_field(storage, comment_, comment_length);
    return well_formed && read_names();
}

bool CZipFileHeader::read_names() {
    const CZipExtraData* const record = central_extra_.Find(CZipExtraField::idNames);
    if (record == nullptr) return true;
    const char* at = record->data.GetBuffer();
    std::size_t left = record->data.GetSize();
    // A later version may be laid out in another way, and says nothing to this one.
    if (left >= 1 && static_cast<unsigned char>(at[0]) >= 2) return true;
    if (left < 2) return false;
    const unsigned flags = static_cast<unsigned char>(at[1]);
    at += 2;
    left -= 2;
    const std::size_t behind_name = (flags & names_comment_code_page) != 0 ? 4 : 0;
    if ((flags & names_code_page) != 0) {
        if (left < 4 + behind_name) return false;
        name_code_page_ = hqf::read_little_endian<std::uint32_t>(at);
        at += 4;
        left -= 4;
        if ((flags & names_text) != 0) {
            const std::size_t length = left - behind_name;
            if (name_.Allocate(length) != nullptr) std::memcpy(name_.GetBuffer(), at, length);
            name_in_extra_ = true;
            at += length;
            left -= length;
        }
    }
    if (left < behind_name) return false;
    if (behind_name != 0) comment_code_page_ = hqf::read_little_endian<std::uint32_t>(at);
    return true;
}

void CZipFileHeader::ReadLocal(CZipCentralDir& centralDir) {
    CZipStorage& storage = centralDir.GetStorage();
    const auto require = [&storage](bool holds) {
        if (!holds) storage.ThrowError(CZipException::badZipFile);
    };
    const auto is_checked = [&centralDir](std::uint32_t off) { return (centralDir.GetConsistencyFlags() & off) == 0; };
    char bytes[local_size];
    storage.Seek(local_offset_);
    storage.Read(bytes, local_size);
    hqf::field_reader next(bytes);
    std::uint32_t signature = 0, crc = 0;
    std::uint16_t version = 0, flags = 0, method = 0, time = 0, date = 0, extra_length = 0;
    next(signature);
    next(version);
    next(flags);
    next(method);
    next(time);
    next(date);
    next(crc);
    next(local_compressed_size_);
    next(local_uncompressed_size_);
    next(local_name_length_);
    next(extra_length);
    require(signature == local_signature);
    require(!is_checked(CZipCentralDir::skipFlags) || ((flags ^ flags_) & 0x0F) == 0);
    require(!is_checked(CZipCentralDir::skipMethod) || method == method_);
    if (is_checked(CZipCentralDir::skipSizes | CZipCentralDir::skipCrc) && (flags & flag_descriptor) == 0) {
        require(crc == crc32_);
        require(local_uncompressed_size_ == uncompressed_size_);
        require(local_compressed_size_ == compressed_size_ || local_compressed_size_ == 0);
    }
    CZipAutoBuffer name;
    read_field(storage, name, local_name_length_);
    require(read_extra(storage, local_extra_, extra_length));
}

std::string CZipFileHeader::name_to_write() const {
    if (!name_in_extra_) return GetStoredName();
    const std::string stored = GetStoredName();
    return hqf::to_code_page(hqf::from_code_page(stored, GetNameCodePage()), default_code_page());
}

CZipExtraField CZipFileHeader::central_extra_to_write() const {
    CZipExtraField extra = central_extra_;
    extra.Remove(CZipExtraField::idNames);
    const bool tells_code_page = name_in_extra_ || GetNameCodePage() != default_code_page();
    const bool tells_comment = comment_code_page_ != 0;
    if (!tells_code_page && !tells_comment) return extra;
    hqf::field_writer record;
    record(std::uint8_t{1})(static_cast<std::uint8_t>((tells_code_page ? names_code_page : 0U) |
                                                      (name_in_extra_ ? names_text : 0U) |
                                                      (tells_comment ? names_comment_code_page : 0U)));
    if (tells_code_page) record(GetNameCodePage());
    if (name_in_extra_) record.bytes(name_.GetBuffer(), name_.GetSize());
    if (tells_comment) record(comment_code_page_);
    extra.Add(CZipExtraField::idNames, record.get().data(), record.get().size());
    return extra;
}

void CZipFileHeader::WriteLocal(CZipStorage& storage) {
    local_offset_ = storage.GetPosition();
    const std::string name = name_to_write();
    const std::string extra = local_extra_.GetBytes();
    local_name_length_ = length_of(name.size());
    hqf::field_writer out;
    out(local_signature)(version_needed_)(flags_)(method_)(time_)(date_);
    out(crc32_)(compressed_size_)(uncompressed_size_)(local_name_length_)(length_of(extra.size()));
    out.bytes(name.data(), name.size()).bytes(extra.data(), extra.size());
    write_bytes(storage, out.get());
}

std::uint32_t CZipFileHeader::WriteCentral(CZipStorage& storage) const {
    if (!FieldsFit()) storage.ThrowError(CZipException::tooLongData);
    const std::string name = name_to_write();
    const std::string extra = central_extra_to_write().GetBytes();
    hqf::field_writer out;
    out(CZipCentralDir::header_signature)(version_made_by_)(host_)(version_needed_)(flags_)(method_)(time_)(date_);
    out(crc32_)(compressed_size_)(uncompressed_size_);
    out(length_of(name.size()))(length_of(extra.size()))(length_of(comment_.GetSize()));
    out(disk_start_)(internal_attributes_)(external_attributes_)(local_offset_);
    out.bytes(name.data(), name.size()).bytes(extra.data(), extra.size());
    out.bytes(comment_.GetBuffer(), comment_.GetSize());
    write_bytes(storage, out.get());
    return static_cast<std::uint32_t>(out.get().size());
}

void CZipFileHeader::UpdateLocal(CZipStorage& storage) {
    storage.Flush();
    const std::uint32_t position = storage.GetPosition();
    hqf::field_writer out;
    out(crc32_)(compressed_size_)(uncompressed_size_);
    storage.Seek(local_offset_ + crc_in_local);
    write_bytes(storage, out.get(), true);
    storage.Seek(position);
    local_compressed_size_ = compressed_size_;
    local_uncompressed_size_ = uncompressed_size_;
}

void CZipFileHeader::WriteDataDescriptor(CZipStorage& storage) const {
    hqf::field_writer out;
    out(descriptor_signature)(crc32_)(compressed_size_)(uncompressed_size_);
    write_bytes(storage, out.get());
}
