// The bytes of an archive: buffered writes, exact reads, and the backward search for a signature.

#include "hqf/zip/CZipStorage.h"

#include "hqf/zip/CZipException.h"

#include <algorithm>
#include <cstdio>
#include <cstring>

namespace limits = hqf::zip_limits;

CZipStorage::~CZipStorage() = default;

void CZipStorage::ThrowError(int cause) const {
    throw CZipException(cause, GetPath());
}

bool CZipStorage::Open(const std::wstring& path, int mode, std::uint32_t volumeSize) {
    unsigned int flags = CZipFile::modeReadWrite | CZipFile::shareDenyWrite | CZipFile::modeNoTruncate;
    switch (mode) {
    case openExisting:
    case append: break;
    case openReadOnly: flags = CZipFile::modeRead | CZipFile::shareDenyWrite | CZipFile::modeNoTruncate; break;
    case create: flags = CZipFile::modeReadWrite | CZipFile::shareDenyWrite | CZipFile::modeCreate; break;
    default: return false;
    }
    if (volumeSize != 0) return false;
    write_buffer_.Allocate(limits::write_buffer);
    disk_file_.Open(path, flags, true);
    file_ = &disk_file_;
    read_only_ = mode == openReadOnly;
    buffered_ = 0;
    bytes_before_ = 0;
    volume_ = mode == create || mode == append ? 0 : closed;
    // The length is asked for before anything else, so that a file beyond the last position is refused here.
    file_->SeekToEnd();
    return true;
}

void CZipStorage::Read(void* buffer, std::uint32_t size, bool /*atOnce*/) {
    if (size == 0) return;
    Flush();
    if (file_->Read(buffer, size) != size) ThrowError(CZipException::badZipFile);
}

void CZipStorage::Write(const void* buffer, std::uint32_t size, bool atOnce) {
    const char* from = static_cast<const char*>(buffer);
    if (atOnce) {
        Flush();
        if (size != 0) file_->Write(from, size);
        return;
    }
    while (size > 0) {
        if (buffered_ == limits::write_buffer) Flush();
        const std::uint32_t count = std::min(size, limits::write_buffer - buffered_);
        std::memcpy(write_buffer_.GetBuffer() + buffered_, from, count);
        buffered_ += count;
        from += count;
        size -= count;
    }
}

void CZipStorage::Flush() {
    if (buffered_ == 0) return;
    file_->Write(write_buffer_.GetBuffer(), buffered_);
    buffered_ = 0;
}

void CZipStorage::Seek(std::uint32_t offset) {
    Flush();
    const std::uint64_t position = std::uint64_t{offset} + bytes_before_;
    if (position > limits::last_position) ThrowError(CZipException::badZipFile);
    file_->Seek(static_cast<std::int64_t>(position), SEEK_SET);
}

void CZipStorage::SeekToEnd() {
    Flush();
    file_->SeekToEnd();
}

std::uint32_t CZipStorage::GetPosition() const {
    return static_cast<std::uint32_t>(file_->GetPosition() + buffered_ - bytes_before_);
}

std::uint32_t CZipStorage::GetLength() const {
    return static_cast<std::uint32_t>(file_->GetLength());
}

void CZipStorage::SetLength(std::uint32_t offset) {
    Flush();
    file_->SetLength(std::uint64_t{offset} + bytes_before_);
}

void CZipStorage::SetVolume(std::uint16_t volume) {
    // A number other than 0 says that this is the last of several volumes.
    if (volume != 0) ThrowError(CZipException::noCallback);
    volume_ = volume;
}

std::int64_t CZipStorage::LocateSignature(std::uint32_t signature, std::uint32_t maximumDepth) {
    return LocateSignatureBefore(GetLength(), signature, maximumDepth);
}

std::int64_t CZipStorage::LocateSignatureBefore(std::uint64_t end, std::uint32_t signature,
                                                std::uint64_t maximumDepth) {
    CZipAutoBuffer memory(limits::search_buffer);
    char* const chunk = memory.GetBuffer();
    const std::uint64_t first = end - std::min(end, maximumDepth);
    const auto byte_of_signature = [signature](int i) { return static_cast<char>(signature >> (8 * i)); };
    // Bytes of the signature that are still to be met; a match runs on from one chunk into the one before it.
    int missing = 4;
    Flush();
    while (end > first) {
        const std::uint32_t size =
            static_cast<std::uint32_t>(std::min<std::uint64_t>(end - first, limits::search_buffer));
        end -= size;
        file_->Seek(static_cast<std::int64_t>(end), SEEK_SET);
        if (file_->Read(chunk, size) != size) ThrowError(CZipException::badZipFile);
        for (std::uint32_t i = size; i-- > 0;) {
            // The byte that ends a partial match may itself be the last byte of the signature.
            if (chunk[i] != byte_of_signature(missing - 1)) missing = 4;
            if (chunk[i] == byte_of_signature(missing - 1) && --missing == 0) return static_cast<std::int64_t>(end + i);
        }
    }
    return -1;
}

void CZipStorage::Close(bool afterException) {
    if (file_ != nullptr) {
        if (!afterException) {
            Flush();
            if (!read_only_) file_->Flush();
            file_->Close();
        } else {
            try {
                file_->Close();
            } catch (const CZipException&) {
                // The first failure is the one that is told.
            }
        }
    }
    file_ = nullptr;
    write_buffer_.Release();
    buffered_ = 0;
    bytes_before_ = 0;
    read_only_ = false;
    volume_ = closed;
}
