// Any bytes as an archive: listed, unpacked with and without the checks, appended to, and loaded as a document. Nothing
// but a CZipException comes out, and what passes all checks is what the archive said.

#include <cstdint>
#include <string>

#include <sys/mman.h>
#include <unistd.h>
#include <zlib.h>

#include "fuzz/require.h"
#include "hqf/document/archive.h"
#include "hqf/hqf.h"
#include "hqf/zip/CZipArchive.h"

namespace {

using fuzz::require;

/// A file in memory, since an archive is opened by its path.
class memory_file {
public:
    memory_file(const std::uint8_t* data, std::size_t size)
        : descriptor_(::memfd_create("archive", MFD_CLOEXEC)) {
        require(descriptor_ >= 0 && ::write(descriptor_, data, size) == static_cast<ssize_t>(size), "a file in memory");
    }
    memory_file(const memory_file&) = delete;
    memory_file& operator=(const memory_file&) = delete;
    ~memory_file() { ::close(descriptor_); }
    std::wstring path() const { return L"/proc/self/fd/" + std::to_wstring(descriptor_); }

private:
    int descriptor_;
};

template<class Action>
void may_throw(CZipArchive& zip, Action action) {
    try {
        action();
        zip.Close();
    } catch (const CZipException&) {
        zip.Close(CZipArchive::closeAfterException);
    }
}

void look_at(const CZipFileHeader& header) {
    (void)header.GetFileName();
    (void)header.GetComment();
    (void)header.GetTime();
    try {
        (void)header.IsDirectory();
    } catch (const CZipException&) {
        // A host whose attributes nobody knows.
    }
}

/// In pieces whose size changes, as a caller with a buffer of his own would.
void unpack(CZipArchive& zip, unsigned int index, bool checked) {
    if (!zip.is_size_credible(index) || !zip.OpenFile(index)) return;
    const CZipFileHeader& header = *zip.GetFileInfo(index);
    constexpr unsigned int most = 1 << 20;
    char piece[5000];
    unsigned int total = 0, count = 0;
    uLong crc = ::crc32(0, nullptr, 0);
    do {
        count = zip.ReadFile(piece, 1 + (total * 7 + index) % sizeof piece);
        crc = ::crc32(crc, reinterpret_cast<const Bytef*>(piece), count);
        total += count;
    } while (count != 0 && total < most);
    const int closed = zip.CloseFile();
    if (closed != 1) return;
    require(total == header.GetUncompressedSize(), "a whole entry has its size");
    require(!checked || crc == header.GetCrc32(), "a checked entry has its CRC-32");
}

void read(const std::wstring& path, bool checked) {
    CZipArchive zip;
    zip.SetExhaustiveRead(!checked);
    zip.SetConsistencyFlags(checked ? 0 : 0xFFFF);
    may_throw(zip, [&] {
        zip.Open(path, CZipStorage::openReadOnly);
        constexpr unsigned int most = 20;
        for (unsigned int i = 0; i < zip.GetCount() && i < most; ++i) {
            look_at(*zip.GetFileInfo(i));
            try {
                unpack(zip, i, checked);
            } catch (const CZipException&) {
                zip.CloseFile(std::wstring(), true);
            }
        }
    });
}

void append_entry(const std::wstring& path) {
    CZipArchive zip;
    may_throw(zip, [&] {
        zip.Open(path, CZipStorage::openExisting);
        CZipFileHeader header;
        header.SetFileName(L"new");
        if (!zip.OpenNewFile(header)) return;
        zip.WriteNewFile("content", 7);
        zip.CloseNewFile();
    });
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const memory_file file(data, size);
    read(file.path(), true);
    read(file.path(), false);
    try {
        hqf_v2::Hqf document;
        (void)hqf_v2::load_archive(document, file.path());
    } catch (const CZipException&) {
        // One that can't be opened.
    }
    append_entry(file.path());
    read(file.path(), true);
    return 0;
}
