// A file over a descriptor; failures of the platform become exceptions here and nowhere else.

#include "hqf/zip/CZipFile.h"

#include "hqf/platform/file_access.h"
#include "hqf/zip/CZipException.h"
#include "hqf/zip/limits.h"

#include <cerrno>
#include <cstdio>
#include <utility>

namespace {

// From 100 on a number means a state of the archive, and 0 would mean success.
int cause_of(int error) {
    if (error == EDQUOT) return ENOSPC;
    return error > 0 && error < CZipException::generic ? error : EIO;
}

hqf::open_mode to_open_mode(unsigned int flags) {
    hqf::open_mode mode;
    mode.write = (flags & CZipFile::modeWrite) != 0;
    mode.read = (flags & CZipFile::modeRead) != 0 || !mode.write;
    mode.create = (flags & CZipFile::modeCreate) != 0;
    mode.truncate = (flags & CZipFile::modeNoTruncate) == 0;
    switch (flags & (CZipFile::shareDenyWrite | CZipFile::shareDenyRead | CZipFile::shareDenyNone)) {
    case CZipFile::shareDenyNone: mode.share = hqf::sharing::deny_none; break;
    case CZipFile::shareDenyWrite: mode.share = hqf::sharing::deny_writers; break;
    case CZipFile::shareDenyRead: mode.share = hqf::sharing::deny_readers; break;
    default: mode.share = hqf::sharing::deny_all; break;
    }
    return mode;
}

} // namespace

CZipAbstractFile::~CZipAbstractFile() = default;

CZipFile::~CZipFile() {
    if (descriptor_ != -1) (void)hqf::close_descriptor(descriptor_);
}

void CZipFile::throw_error(int error) const {
    throw CZipException(cause_of(error), path_);
}

bool CZipFile::Open(const std::wstring& path, unsigned int flags, bool throwOnError) {
    Close();
    path_ = path;
    descriptor_ = hqf::open_descriptor(path, to_open_mode(flags));
    if (descriptor_ == -1 && throwOnError) throw_error(errno);
    return descriptor_ != -1;
}

void CZipFile::Close() {
    if (descriptor_ == -1) return;
    if (hqf::close_descriptor(std::exchange(descriptor_, -1)) != 0) throw_error(errno);
}

void CZipFile::Flush() {
    if (hqf::commit_descriptor(descriptor_) != 0) throw_error(errno);
}

std::uint64_t CZipFile::seek(std::int64_t offset, int origin) const {
    const std::int64_t position = hqf::seek_descriptor(descriptor_, offset, origin);
    if (position < 0) throw_error(errno);
    return static_cast<std::uint64_t>(position);
}

std::uint64_t CZipFile::GetPosition() const {
    return seek(0, SEEK_CUR);
}

std::uint64_t CZipFile::Seek(std::int64_t offset, int origin) {
    return seek(offset, origin);
}

std::uint64_t CZipFile::GetLength() const {
    const std::uint64_t position = seek(0, SEEK_CUR);
    const std::uint64_t length = seek(0, SEEK_END);
    seek(static_cast<std::int64_t>(position), SEEK_SET);
    return length;
}

void CZipFile::SetLength(std::uint64_t length) {
    if (hqf::set_descriptor_length(descriptor_, length) != 0) throw_error(errno);
}

void CZipFile::SeekToBegin() {
    seek(0, SEEK_SET);
}

void CZipFile::SeekToEnd() {
    seek(0, SEEK_END);
}

unsigned int CZipFile::Read(void* buffer, unsigned int size) {
    errno = 0;
    const std::int64_t count = hqf::read_descriptor(descriptor_, buffer, size);
    if (count < 0) throw_error(errno);
    return static_cast<unsigned int>(count);
}

void CZipFile::Write(const void* buffer, unsigned int size) {
    const std::int64_t position = hqf::seek_descriptor(descriptor_, 0, SEEK_CUR);
    // What has no positions (a pipe) has no last one either.
    if (position < 0 && errno != ESPIPE) throw_error(errno);
    if (position >= 0 && static_cast<std::uint64_t>(position) + size > hqf::zip_limits::last_position)
        throw_error(EFBIG);
    errno = 0;
    if (hqf::write_descriptor(descriptor_, buffer, size) != static_cast<std::int64_t>(size)) throw_error(errno);
}
