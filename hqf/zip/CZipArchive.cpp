// An archive as a whole, and the reading of its entries.

#include "hqf/zip/CZipArchive.h"

#include "hqf/platform/file_access.h"
#include "hqf/zip/attributes.h"

#include <algorithm>
#include <limits>

CZipArchive::CZipArchive() = default;
CZipArchive::~CZipArchive() = default;

CZipCryptograph* CZipArchive::CreateCryptograph(int /*method*/) {
    return nullptr;
}

CZipCompressor* CZipArchive::CreateCompressor(std::uint16_t method) {
    if (compressor_ == nullptr || !compressor_->CanProcess(method)) {
        compressor_.reset();
        if (method == 0 || method == 8) compressor_ = std::make_unique<ZipArchiveLib::CDeflateCompressor>(&storage_);
        if (method == 12) compressor_ = std::make_unique<ZipArchiveLib::CBzip2Compressor>(&storage_);
    }
    const auto options = compressor_options_.find(method);
    if (compressor_ != nullptr && options != compressor_options_.end())
        compressor_->UpdateOptions(options->second.get());
    return compressor_.get();
}

void CZipArchive::SetCompressionOptions(std::uint16_t method, const CZipCompressor::COptions& options) {
    compressor_options_[method] = options.Clone();
}

// A setting that equals the system's default is no choice: each header's host then decides.
std::optional<std::uint32_t> CZipArchive::chosen_code_page() const {
    const std::uint32_t by_default = system_ == hqf::host_fat ? 1 : 0;
    return name_code_page_ == by_default ? std::nullopt : name_code_page_;
}

bool CZipArchive::Open(const std::wstring& path, int mode, std::uint32_t volumeSize) {
    if (!IsClosed()) return false;
    system_ = hqf::host_fat;
    try {
        if (!storage_.Open(path, mode, volumeSize)) return false;
        central_dir_.Init(storage_, chosen_code_page());
        if (mode == CZipStorage::openExisting || mode == CZipStorage::openReadOnly) central_dir_.Read(exhaustive_read_);
    } catch (...) {
        central_dir_.Close();
        storage_.Close(true);
        throw;
    }
    if (GetCount() != 0 && hqf::is_supported_host(central_dir_.GetHeader(0).GetHost()))
        system_ = central_dir_.GetHeader(0).GetHost();
    return true;
}

CZipFileHeader* CZipArchive::GetFileInfo(unsigned int index) {
    return index < GetCount() ? &central_dir_.GetHeader(index) : nullptr;
}

const CZipFileHeader* CZipArchive::GetFileInfo(unsigned int index) const {
    return index < GetCount() ? &central_dir_.GetHeader(index) : nullptr;
}

bool CZipArchive::is_size_credible(unsigned int index) const {
    return index < GetCount() && central_dir_.is_size_credible(index);
}

bool CZipArchive::OpenFile(unsigned int index) {
    if (IsClosed() || state_ != open_entry::none || index >= GetCount()) return false;
    central_dir_.OpenFile(index);
    CZipFileHeader& header = *central_dir_.GetOpenHeader();
    try {
        if (CreateCompressor(header.GetMethod()) == nullptr || compressor_ == nullptr) {
            central_dir_.CloseFile(true);
            return false;
        }
        if (header.IsEncrypted()) storage_.ThrowError(CZipException::badPassword);
        compressor_->InitDecompression(&header, nullptr);
    } catch (...) {
        central_dir_.CloseFile(true);
        throw;
    }
    state_ = open_entry::reading;
    return true;
}

unsigned int CZipArchive::ReadFile(void* buffer, unsigned int size) {
    if (state_ != open_entry::reading || buffer == nullptr || size == 0) return 0;
    return compressor_->Decompress(buffer, size);
}

int CZipArchive::CloseFile(const std::wstring& path, bool afterException) {
    if (state_ != open_entry::reading) return 0;
    const CZipFileHeader& header = *central_dir_.GetOpenHeader();
    const bool is_complete = compressor_->GetUncompressedLeft() == 0;
    const bool is_checked = (central_dir_.GetConsistencyFlags() & CZipCentralDir::skipContentCrc) == 0;
    const bool is_right = compressor_->GetCrc32() == header.GetCrc32();
    compressor_->FinishDecompression(afterException);
    state_ = open_entry::none;
    if (afterException || !is_complete || (is_checked && !is_right)) {
        central_dir_.CloseFile(true);
        if (!afterException && is_complete) storage_.ThrowError(CZipException::badCrc);
        return is_complete ? 1 : -1;
    }
    central_dir_.CloseFile(false);
    if (path.empty()) return 1;
    const bool is_set =
        hqf::set_file_time(path, header.GetTime()) && hqf::set_file_attributes(path, header.GetSystemAttr());
    return is_set ? 1 : -2;
}

void CZipArchive::stamp_file(std::int64_t newest) const {
    if (newest != std::numeric_limits<std::int64_t>::min()) (void)hqf::set_file_time(storage_.GetPath(), newest);
}

void CZipArchive::Close(int mode, bool updateTimeStamp) {
    const bool after_exception = mode != closeNormal;
    if (IsClosed()) {
        if (after_exception) storage_.Close(true);
        return;
    }
    if (state_ == open_entry::reading) CloseFile(std::wstring(), after_exception);
    if (state_ == open_entry::writing) CloseNewFile(after_exception);
    std::int64_t newest = std::numeric_limits<std::int64_t>::min();
    if (!after_exception) {
        central_dir_.Write();
        for (unsigned int i = 0; updateTimeStamp && i < GetCount(); ++i)
            newest = std::max(newest, GetFileInfo(i)->GetTime());
    }
    // The directory goes last, so that a close that fails and is tried again finds it as it was.
    storage_.Close(after_exception);
    central_dir_.Close();
    copy_buffer_.Release();
    stamp_file(newest);
}
