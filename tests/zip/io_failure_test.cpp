// Every call to the system fails once. The functions below stand before those of the C library.

#include "archives.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <cstdarg>
#include <dlfcn.h>
#include <fcntl.h>
#include <sys/stat.h>

using namespace zip_test;

namespace {

enum class way { error, interrupt, part };
enum call { call_open, call_read, call_write, call_seek, call_sync, call_close, call_status, calls };

struct {
    int left = -1; // calls until the one that fails; -1: none fails
    way how = way::error;
    bool failed = false;
    call what = calls;
    unsigned kinds = 0; // of calls that failed, a bit each
    int open_files = 0;
} trap;

bool springs(call what) {
    if (trap.left < 0 || trap.left-- != 0) return false;
    trap.failed = true;
    trap.what = what;
    trap.kinds |= 1U << what;
    errno = trap.how == way::interrupt ? EINTR : EDQUOT;
    return true;
}

bool fails(call what) {
    return trap.how == way::error && springs(what);
}

template<class Function>
Function* next(const char* name) {
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

template<class Buffer>
ssize_t transfer(call what, const char* name, int descriptor, Buffer* buffer, size_t size) {
    const bool springs_now = springs(what);
    if (springs_now && trap.how != way::part) return -1;
    return next<ssize_t(int, Buffer*, size_t)>(name)(descriptor, buffer, springs_now ? (size + 1) / 2 : size);
}

} // namespace

extern "C" {
int open(const char* path, int flags, ...) {
    va_list arguments;
    va_start(arguments, flags);
    const int mode = va_arg(arguments, int);
    va_end(arguments);
    const int descriptor = fails(call_open) ? -1 : next<int(const char*, int, ...)>("open")(path, flags, mode);
    trap.open_files += descriptor >= 0 ? 1 : 0;
    return descriptor;
}
ssize_t read(int descriptor, void* buffer, size_t size) {
    return transfer(call_read, "read", descriptor, buffer, size);
}
ssize_t write(int descriptor, const void* buffer, size_t size) {
    return transfer(call_write, "write", descriptor, buffer, size);
}
off_t lseek(int descriptor, off_t offset, int origin) noexcept {
    return fails(call_seek) ? -1 : next<off_t(int, off_t, int)>("lseek")(descriptor, offset, origin);
}
int fsync(int descriptor) {
    return fails(call_sync) ? -1 : next<int(int)>("fsync")(descriptor);
}
int close(int descriptor) {
    const int result = next<int(int)>("close")(descriptor);
    trap.open_files -= result == 0 ? 1 : 0;
    return fails(call_close) ? -1 : result;
}
int stat(const char* path, struct stat* status) noexcept {
    return fails(call_status) ? -1 : next<int(const char*, struct stat*)>("stat")(path, status);
}
}

namespace {

/// Runs `action` with the k-th call failing, for every k until none is left to fail; each run must end as it may.
template<class Action, class Judge>
void fail_each_call(way how, int least, Action action, Judge may_end_with) {
    trap.kinds = 0;
    for (int k = 0;; ++k) {
        const int before = trap.open_files;
        trap.left = k;
        trap.how = how;
        trap.failed = false;
        const int cause = action();
        trap.left = -1;
        trap.how = way::error;
        EXPECT_EQ(trap.open_files, before) << "files left open, call " << k;
        EXPECT_TRUE(trap.failed ? may_end_with(cause) : cause == 0 && k >= least)
            << "call " << k << " of kind " << trap.what << " gives " << cause;
        if (!trap.failed) return;
    }
}

} // namespace

TEST(zip_io_failure, load_fails_with_the_error_of_any_call) {
    const auto path = folder() / "io.zip";
    for (const std::uint16_t method : std::initializer_list<std::uint16_t>{0, 8, 12}) {
        make_file(path, build({entry(sample_text(300000), method)}, "comment").bytes);
        const auto load_it = [&] { return load(path).cause; };
        // EDQUOT has the number 122 here, which as a cause means something else.
        fail_each_call(way::error, 15, load_it, [](int cause) { return cause == ENOSPC; });
        for (way how : {way::interrupt, way::part})
            fail_each_call(how, 5, load_it, [](int cause) { return cause == 0; });
    }
}

TEST(zip_io_failure, save_fails_or_is_whole) {
    const auto source = folder() / "io.hqf", path = folder() / "io-saved.zip";
    std::string noise = sample_text(200000);
    for (std::size_t i = 0; i < noise.size(); ++i)
        noise[i] = static_cast<char>(noise[i] * 31 + static_cast<int>(i * i >> 7));
    make_file(source, noise);
    const auto save = [&] {
        CZipArchive zip;
        const int cause = cause_of([&] {
            zip.Open(wide(path), CZipStorage::create);
            zip.SetCompressionMethod(8);
            if (!zip.AddNewFile(wide(source))) throw CZipException(CZipException::generic);
            zip.Close();
        });
        zip.Close(CZipArchive::closeAfterException);
        return cause;
    };
    const auto is_whole = [&] { return load(path).content == noise; };
    fail_each_call(way::error, 20, save, [&](int cause) {
        // Only the source may fail to close unheard: everything of it had been read.
        if (cause == 0) return trap.what == call_close && is_whole();
        return cause == 100 || (cause == ENOSPC && trap.what != call_status);
    });
    EXPECT_EQ(trap.kinds, (1U << calls) - 1) << "a save reads, writes, seeks, and waits for the disk";
    for (way how : {way::interrupt, way::part})
        fail_each_call(how, 5, save, [&](int cause) { return cause == 0 && is_whole(); });
}
