// New entries of an archive.

#include "hqf/zip/CZipArchive.h"

#include "hqf/platform/file_access.h"
#include "hqf/zip/attributes.h"
#include "hqf/zip/limits.h"

#include <ctime>

namespace limits = hqf::zip_limits;

namespace {

constexpr std::uint16_t bzip2 = 12;
constexpr std::uint64_t small_file = 5;

std::wstring entry_name(const std::wstring& path, bool full_path) {
    const CZipPathComponent parts(CZipPathComponent::StripSeparators(path));
    const std::wstring& folders = parts.GetDirectory();
    return full_path && !folders.empty() ? folders + L'\\' + parts.GetFileName() : parts.GetFileName();
}

} // namespace

bool CZipArchive::SetCompressionMethod(std::uint16_t method) {
    if (state_ == open_entry::writing || (method != 8 && method != bzip2)) return false;
    compression_method_ = method;
    return true;
}

bool CZipArchive::OpenNewFile(const CZipFileHeader& header, int level, const std::wstring& path, int replaceIndex) {
    if (IsClosed() || storage_.IsReadOnly() || state_ != open_entry::none || GetCount() >= limits::most_entries ||
        replaceIndex != -1)
        return false;
    CZipFileHeader entry = header;
    entry.SetHost(system_);
    entry.encryption_method_ = CZipFileHeader::no_encryption;
    entry.disk_start_ = 0;
    if (!path.empty()) {
        hqf::file_status status;
        if (!hqf::get_file_status(path, status)) return false;
        entry.SetSystemAttr(status.attributes);
        entry.SetTime(status.modified);
    }
    if (!entry.HasTime()) entry.SetTime(std::time(nullptr));
    const bool is_directory = entry.IsDirectory();
    if (const std::wstring name = entry.GetFileName();
        is_directory && (name.empty() || !hqf::is_path_separator(name.back())))
        entry.SetFileName(name + L'\\');
    if (level < -1 || level > 9) level = -1;
    entry.method_ = level == 0 || is_directory ? std::uint16_t{0} : compression_method_;
    if (entry.method_ == bzip2 || CreateCompressor(entry.method_) == nullptr || compressor_ == nullptr) return false;
    CZipFileHeader* const added = central_dir_.AddNewFile(entry, replaceIndex, level);
    state_ = open_entry::writing;
    try {
        compressor_->InitCompression(level, added, nullptr);
    } catch (...) {
        drop_new_entry();
        throw;
    }
    return true;
}

bool CZipArchive::WriteNewFile(const void* buffer, unsigned int size) {
    if (state_ != open_entry::writing || (buffer == nullptr && size != 0)) return false;
    if (size == 0) return true;
    try {
        compressor_->Compress(buffer, size);
    } catch (...) {
        // Part of the data is lost; an entry that could still be closed would claim to be whole.
        drop_new_entry();
        throw;
    }
    return true;
}

bool CZipArchive::CloseNewFile(bool afterException) {
    if (state_ != open_entry::writing) return false;
    if (afterException) {
        drop_new_entry();
        return true;
    }
    try {
        compressor_->FinishCompression(false);
        central_dir_.CloseNewFile(false);
    } catch (...) {
        drop_new_entry();
        throw;
    }
    state_ = open_entry::none;
    return true;
}

void CZipArchive::drop_new_entry() noexcept {
    compressor_->FinishCompression(true);
    central_dir_.CloseNewFile(true);
    state_ = open_entry::none;
}

bool CZipArchive::AddNewFile(const std::wstring& path, int level, bool fullPath, int smartFlags,
                             std::uint32_t bufferSize) {
    hqf::file_status status;
    if (!hqf::get_file_status(path, status)) return false;
    const bool is_folder = (status.attributes & hqf::attribute_folder) != 0;
    CZipFileHeader header;
    header.SetHost(system_);
    if (const std::optional<std::uint32_t> code_page = chosen_code_page()) header.SetNameCodePage(*code_page);
    header.SetSystemAttr(status.attributes);
    header.SetFileName(entry_name(path, fullPath) + (is_folder ? L"\\" : L""));
    header.SetTime(status.modified == -1 ? std::int64_t{std::time(nullptr)} : status.modified);
    if (is_folder) return OpenNewFile(header, 0) && CloseNewFile();
    if ((smartFlags & smartNotCompressSmall) != 0 && status.size < small_file) level = 0;

    CZipFile source;
    if (!source.Open(path, CZipFile::modeRead | CZipFile::shareDenyNone, false)) return false;
    if (bufferSize == 0) bufferSize = limits::copy_buffer;
    copy_buffer_.Allocate(bufferSize);
    if (!OpenNewFile(header, level)) return false;
    try {
        for (unsigned int count = bufferSize; count == bufferSize;) {
            count = source.Read(copy_buffer_.GetBuffer(), bufferSize);
            WriteNewFile(copy_buffer_.GetBuffer(), count);
        }
    } catch (...) {
        CloseNewFile(true);
        throw;
    }
    return CloseNewFile();
}
