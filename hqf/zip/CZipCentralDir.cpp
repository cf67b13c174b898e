// The directory of an archive, read and written.
//
// The end record (APPNOTE 4.3.16) is the one fixed point: it is searched from the end, and everything else is found
// from it. What stands before the archive shifts all offsets by the same count, which shows as the gap between where
// the directory should end and where the end record is. Not done: ZIP64, several volumes, digital signatures.

#include "hqf/zip/CZipCentralDir.h"

#include "hqf/zip/CZipException.h"
#include "hqf/zip/CZipStorage.h"
#include "hqf/zip/limits.h"
#include "hqf/zip/little_endian.h"

#include <algorithm>
#include <tuple>

namespace limits = hqf::zip_limits;

CZipCentralDir::~CZipCentralDir() = default;

void CZipCentralDir::Init(CZipStorage& storage, std::optional<std::uint32_t> name_code_page) {
    Close();
    storage_ = &storage;
    name_code_page_ = name_code_page;
}

void CZipCentralDir::Close() {
    open_ = nullptr;
    headers_.clear();
    end_ = end_record();
}

std::string CZipCentralDir::GetComment() const {
    return end_.comment.GetSize() == 0 ? std::string() : std::string(end_.comment.GetBuffer(), end_.comment.GetSize());
}

void CZipCentralDir::Read(bool exhaustive) {
    read_end_record();
    refuse_zip64();
    storage_->SetVolume(end_.this_disk);
    place_archive();
    end_.is_in_file = true;
    if (end_.size != 0) read_headers(exhaustive);
}

void CZipCentralDir::read_end_record() {
    const std::int64_t position = storage_->LocateSignature(end_signature, limits::end_record_depth);
    if (position < 0) storage_->ThrowError(CZipException::noEndRecord);
    end_.position = static_cast<std::uint32_t>(position);
    // No bytes before the archive are known yet, so that a position in the file is an offset in the archive.
    storage_->SetBytesBefore(0);
    storage_->Seek(end_.position + 4);
    char bytes[18];
    storage_->Read(bytes, sizeof bytes);
    hqf::field_reader next(bytes);
    std::uint16_t comment_length = 0;
    next(end_.this_disk);
    next(end_.directory_disk);
    next(end_.entries_on_disk);
    next(end_.entries);
    next(end_.size);
    next(end_.offset);
    next(comment_length);
    storage_->Read(end_.comment.Allocate(comment_length), comment_length);
}

void CZipCentralDir::refuse_zip64() {
    constexpr std::uint16_t all16 = 0xFFFF;
    constexpr std::uint32_t all32 = 0xFFFFFFFF;
    const bool is_marked = end_.this_disk == all16 || end_.directory_disk == all16 || end_.entries_on_disk == all16 ||
                           end_.entries == all16 || end_.size == all32 || end_.offset == all32;
    // 65,535 is also a true count of entries; only the locator makes the archive a ZIP64 one.
    if (is_marked && storage_->LocateSignatureBefore(end_.position, zip64_signature, end_.position) >= 0)
        storage_->ThrowError(CZipException::needsZip64);
}

void CZipCentralDir::place_archive() {
    const std::uint64_t directory_end = std::uint64_t{end_.offset} + end_.size;
    if (end_.position < directory_end) storage_->ThrowError(CZipException::badZipFile);
    if (storage_->GetBytesBefore() == 0 && end_.directory_disk == 0)
        storage_->SetBytesBefore(static_cast<std::uint32_t>(end_.position - directory_end));
    if ((end_.size == 0) != (end_.entries == 0)) storage_->ThrowError(CZipException::badZipFile);
}

void CZipCentralDir::read_headers(bool exhaustive) {
    storage_->Seek(end_.offset);
    headers_.clear();
    const auto read_one = [this](bool with_signature) {
        // No room is made for the count in advance: it costs 2 bytes to claim, and a header costs 46.
        auto header = std::make_unique<CZipFileHeader>();
        if (!header->Read(*this, with_signature)) storage_->ThrowError(CZipException::badZipFile);
        headers_.push_back(std::move(header));
    };
    for (unsigned int i = 0; i < end_.entries; ++i)
        read_one(true);
    // The end record follows, so there are always four bytes to look at.
    for (char next[4]; exhaustive; read_one(false)) {
        storage_->Read(next, sizeof next);
        if (hqf::read_little_endian<std::uint32_t>(next) != header_signature) break;
    }
    const auto place = [](const auto& header) { return std::tuple(header->disk_start_, header->local_offset_); };
    std::sort(headers_.begin(), headers_.end(), [&](const auto& a, const auto& b) { return place(a) < place(b); });
    if (std::adjacent_find(headers_.begin(), headers_.end(),
                           [&](const auto& a, const auto& b) { return place(a) == place(b); }) != headers_.end())
        storage_->ThrowError(CZipException::badZipFile);
}

void CZipCentralDir::OpenFile(unsigned int index) {
    headers_[index]->ReadLocal(*this);
    open_ = headers_[index].get();
}

void CZipCentralDir::CloseFile(bool afterException) {
    if (!afterException && open_ != nullptr && (open_->flags_ & CZipFileHeader::flag_descriptor) != 0 &&
        (consistency_flags_ & skipDescriptor) == 0)
        check_descriptor();
    open_ = nullptr;
}

void CZipCentralDir::check_descriptor() {
    const std::uint64_t behind_data = std::uint64_t{open_->local_offset_} + 30 + open_->local_name_length_ +
                                      open_->local_extra_.GetBytes().size() + open_->compressed_size_;
    if (behind_data > limits::last_position) storage_->ThrowError(CZipException::badZipFile);
    storage_->Seek(static_cast<std::uint32_t>(behind_data));
    char bytes[16];
    storage_->Read(bytes, 12);
    // The signature may be missing (APPNOTE 4.3.9.3).
    const char* fields = bytes;
    if (hqf::read_little_endian<std::uint32_t>(bytes) == 0x08074B50) {
        storage_->Read(bytes + 12, 4);
        fields = bytes + 4;
    }
    hqf::field_reader next(fields);
    std::uint32_t crc = 0, compressed = 0, uncompressed = 0;
    next(crc);
    next(compressed);
    next(uncompressed);
    if (crc != open_->crc32_ || compressed != open_->compressed_size_ || uncompressed != open_->uncompressed_size_)
        storage_->ThrowError(CZipException::badZipFile);
}

CZipFileHeader* CZipCentralDir::AddNewFile(const CZipFileHeader& header, int replaceIndex, int level) {
    if (replaceIndex != -1) return nullptr;
    auto added = std::make_unique<CZipFileHeader>(header);
    added->PrepareData(level, false);
    if (!added->FieldsFit()) storage_->ThrowError(CZipException::tooLongData);
    headers_.push_back(std::move(added));
    try {
        cut_off();
        storage_->SeekToEnd();
        headers_.back()->WriteLocal(*storage_);
    } catch (...) {
        headers_.pop_back();
        throw;
    }
    open_ = headers_.back().get();
    return open_;
}

void CZipCentralDir::cut_off() {
    if (!end_.is_in_file) return;
    storage_->SetLength(end_.offset);
    end_.is_in_file = false;
}

void CZipCentralDir::CloseNewFile(bool afterException) {
    if (afterException) {
        headers_.pop_back();
    } else if ((open_->flags_ & CZipFileHeader::flag_descriptor) != 0) {
        open_->WriteDataDescriptor(*storage_);
    } else {
        open_->UpdateLocal(*storage_);
    }
    open_ = nullptr;
}

void CZipCentralDir::Write() {
    if (end_.is_in_file) return;
    end_.entries = end_.entries_on_disk = static_cast<std::uint16_t>(headers_.size());
    end_.this_disk = end_.directory_disk = 0;
    storage_->SeekToEnd();
    end_.offset = storage_->GetPosition();
    end_.size = 0;
    for (const auto& header : headers_)
        end_.size += header->WriteCentral(*storage_);
    WriteCentralEnd();
    end_.is_in_file = true;
}

void CZipCentralDir::WriteCentralEnd() {
    hqf::field_writer out;
    out(end_signature)(end_.this_disk)(end_.directory_disk)(end_.entries_on_disk)(end_.entries);
    out(end_.size)(end_.offset)(static_cast<std::uint16_t>(end_.comment.GetSize()));
    out.bytes(end_.comment.GetBuffer(), end_.comment.GetSize());
    storage_->Write(out.get().data(), static_cast<std::uint32_t>(out.get().size()));
}

bool CZipCentralDir::is_size_credible(unsigned int index) const {
    const CZipFileHeader& header = *headers_[index];
    // Only packed bytes that there is room for before the directory say anything.
    const std::uint64_t data_begin = std::uint64_t{header.local_offset_} + 30;
    std::uint64_t packed = header.compressed_size_;
    if (end_.is_in_file) packed = std::min(packed, end_.offset - std::min<std::uint64_t>(end_.offset, data_begin));
    const std::uint64_t expansion = header.method_ == 8    ? limits::deflate_expansion
                                    : header.method_ == 12 ? limits::bzip2_expansion
                                                           : 1;
    return header.uncompressed_size_ <= packed * expansion;
}
