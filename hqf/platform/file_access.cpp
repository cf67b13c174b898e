// Files by descriptor, over POSIX.

#include "hqf/platform/file_access.h"

#include "hqf/platform/paths.h"

#include <cerrno>
#include <fcntl.h>
#include <limits>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

namespace hqf {
namespace {

// A write of the owner is what the bit stands for: it does not depend on who asks, so that an archive made by root
// records the same bits as one made by the file's owner.
bool is_read_only(const struct stat& status) {
    return (status.st_mode & S_IWUSR) == 0;
}

void ask_for_share(int descriptor, open_mode mode) {
    if (mode.share == sharing::deny_none) return;
    bool alone = mode.write || mode.share != sharing::deny_writers;
    const int kept = errno;
    (void)::flock(descriptor, (alone ? LOCK_EX : LOCK_SH) | LOCK_NB);
    errno = kept;
}

template<class Bytes, class Step>
std::int64_t repeat(Bytes* bytes, std::size_t size, Step step) {
    std::size_t done = 0;
    while (done < size) {
        const auto count = step(bytes + done, size - done);
        if (count < 0 && errno == EINTR) {
            errno = 0;
            continue;
        }
        if (count < 0) return -1;
        if (count == 0) break;
        done += static_cast<std::size_t>(count);
    }
    return static_cast<std::int64_t>(done);
}

} // namespace

int open_descriptor(const std::wstring& path, open_mode mode) {
    // A NUL would cut the path short for the system, and another file than the one named would open.
    if (path.find(L'\0') != std::wstring::npos) {
        errno = EINVAL;
        return -1;
    }
    int flags = O_CLOEXEC | O_NONBLOCK | (mode.write ? (mode.read ? O_RDWR : O_WRONLY) : O_RDONLY);
    if (mode.create) flags |= O_CREAT;
    if (mode.truncate && mode.write) flags |= O_TRUNC;
    const int descriptor = ::open(path_to_utf8(path).c_str(), flags, 0666);
    if (descriptor < 0) return -1;
    struct stat status;
    const int failed = ::fstat(descriptor, &status) != 0 ? errno : S_ISDIR(status.st_mode) ? EISDIR : 0;
    if (failed != 0) {
        ::close(descriptor);
        errno = failed;
        return -1;
    }
    ask_for_share(descriptor, mode);
    return descriptor;
}

std::int64_t read_descriptor(int descriptor, void* buffer, std::size_t size) {
    return repeat(static_cast<char*>(buffer), size,
                  [=](char* to, std::size_t count) { return ::read(descriptor, to, count); });
}

std::int64_t write_descriptor(int descriptor, const void* buffer, std::size_t size) {
    return repeat(static_cast<const char*>(buffer), size,
                  [=](const char* from, std::size_t count) { return ::write(descriptor, from, count); });
}

std::int64_t seek_descriptor(int descriptor, std::int64_t offset, int origin) {
    const std::int64_t position = ::lseek(descriptor, offset, origin);
    if (position > std::numeric_limits<std::int32_t>::max()) {
        errno = EOVERFLOW;
        return -1;
    }
    return position;
}

int commit_descriptor(int descriptor) {
    if (::fsync(descriptor) == 0 || errno == EINVAL || errno == ENOTSUP) return 0;
    return -1;
}

int set_descriptor_length(int descriptor, std::uint64_t length) {
    if (length > static_cast<std::uint64_t>(std::numeric_limits<off_t>::max())) {
        errno = EINVAL;
        return -1;
    }
    return ::ftruncate(descriptor, static_cast<off_t>(length));
}

int close_descriptor(int descriptor) {
    return ::close(descriptor);
}

bool get_file_status(const std::wstring& path, file_status& status) {
    struct stat found;
    if (path.find(L'\0') != std::wstring::npos || ::stat(path_to_utf8(path).c_str(), &found) != 0) return false;
    const bool is_folder = S_ISDIR(found.st_mode);
    status.attributes = is_folder ? attribute_folder : attribute_archive;
    if (is_read_only(found)) status.attributes |= attribute_read_only;
    status.modified = found.st_mtime;
    status.size = is_folder ? 0 : static_cast<std::uint64_t>(found.st_size);
    return true;
}

bool set_file_attributes(const std::wstring& path, std::uint32_t attributes) {
    const std::string name = path_to_utf8(path);
    struct stat found;
    if (::stat(name.c_str(), &found) != 0) return false;
    const bool read_only = (attributes & attribute_read_only) != 0;
    if (read_only == is_read_only(found)) return true;
    const mode_t writers = S_IWUSR | S_IWGRP | S_IWOTH;
    const mode_t rights = found.st_mode & 07777;
    return ::chmod(name.c_str(), read_only ? rights & ~writers : rights | S_IWUSR) == 0;
}

bool set_file_time(const std::wstring& path, std::int64_t modified) {
    const timespec times[2] = {{0, UTIME_OMIT}, {static_cast<std::time_t>(modified), 0}};
    return ::utimensat(AT_FDCWD, path_to_utf8(path).c_str(), times, 0) == 0;
}

bool to_local_time(std::int64_t time, std::tm& local) {
    const std::time_t seconds = static_cast<std::time_t>(time);
    return ::localtime_r(&seconds, &local) != nullptr;
}

std::int64_t from_local_time(std::tm local) {
    local.tm_isdst = -1;
    return std::mktime(&local);
}

} // namespace hqf
