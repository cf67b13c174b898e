#pragma once

// Archives made by hand, field by field, and the road on which one is loaded. For the tests of the archive layer.

#include "hqf/zip/CZipArchive.h"
#include "hqf/zip/little_endian.h"
#include "tests/support/files.h"

#include <bzlib.h>
#include <zlib.h>

#include <algorithm>
#include <string>
#include <vector>

namespace zip_test {

using support::bytes_of, support::make_file, support::wide;

/// A folder of its own for each test program.
inline const support::folder& folder() {
    static const support::folder made;
    return made;
}

inline std::uint32_t crc_of(const std::string& bytes) {
    return static_cast<std::uint32_t>(
        ::crc32(0, reinterpret_cast<const Bytef*>(bytes.data()), static_cast<uInt>(bytes.size())));
}

inline std::string deflated(const std::string& bytes) {
    uLongf size = compressBound(static_cast<uLong>(bytes.size()));
    std::string packed(size, '\0');
    compress(reinterpret_cast<Bytef*>(packed.data()), &size, reinterpret_cast<const Bytef*>(bytes.data()),
             static_cast<uLong>(bytes.size()));
    return packed.substr(2, size - 6); // without what zlib puts around a stream
}

inline std::string bzipped(const std::string& bytes) {
    std::string packed(bytes.size() + bytes.size() / 50 + 1000, '\0');
    auto size = static_cast<unsigned int>(packed.size());
    BZ2_bzBuffToBuffCompress(packed.data(), &size, const_cast<char*>(bytes.data()),
                             static_cast<unsigned int>(bytes.size()), 1, 0, 0);
    packed.resize(size);
    return packed;
}

/// One entry as both headers tell it; every field can be made to lie.
struct entry {
    entry(const std::string& content, std::uint16_t with_method)
        : method(with_method)
        , data(with_method == 8    ? deflated(content)
               : with_method == 12 ? bzipped(content)
                                   : content)
        , crc(crc_of(content))
        , packed_size(static_cast<std::uint32_t>(data.size()))
        , size(static_cast<std::uint32_t>(content.size())) {}

    std::string name = "a.hqf";
    std::uint16_t made_by = 46, flags = 0, method, time = 0x4800, date = 0x58A1; // 2024-05-01 09:00:00
    std::string data, behind_data, local_extra, extra, comment;
    std::uint32_t crc, packed_size, size, external = 0x81B40020;
    std::uint32_t shift = 0; ///< added to the offset that the directory tells
};

/// The bytes of an archive, and where its records begin.
struct archive {
    std::string bytes;
    std::size_t central = 0, end = 0;
};

inline archive build(const std::vector<entry>& entries, const std::string& comment = "", bool reversed = false) {
    archive made;
    std::vector<std::string> headers;
    const auto size16 = [](const std::string& text) { return static_cast<std::uint16_t>(text.size()); };
    for (const entry& e : entries) {
        const auto offset = static_cast<std::uint32_t>(made.bytes.size());
        hqf::field_writer fields, local, central;
        fields(std::uint16_t{20})(e.flags)(e.method)(e.time)(e.date);
        fields(e.crc)(e.packed_size)(e.size)(size16(e.name));
        local(0x04034B50U).bytes(fields.get().data(), fields.get().size())(size16(e.local_extra));
        made.bytes += local.get() + e.name + e.local_extra + e.data + e.behind_data;
        central(0x02014B50U)(e.made_by).bytes(fields.get().data(), fields.get().size());
        central(size16(e.extra))(size16(e.comment))(0U)(e.external)(offset + e.shift);
        headers.push_back(central.get() + e.name + e.extra + e.comment);
    }
    made.central = made.bytes.size();
    if (reversed) std::reverse(headers.begin(), headers.end());
    for (const std::string& header : headers)
        made.bytes += header;
    made.end = made.bytes.size();
    hqf::field_writer end;
    const auto count = static_cast<std::uint16_t>(entries.size());
    end(0x06054B50U)(0U)(count)(count)(static_cast<std::uint32_t>(made.end - made.central));
    end(static_cast<std::uint32_t>(made.central))(size16(comment));
    made.bytes += end.get() + comment;
    return made;
}

/// Beside the causes of `CZipException`: how a load ends without one.
enum : int { loaded = 0, no_entry = -1, refused = -2 };

struct outcome {
    int cause;
    std::string content;
};

/// Loads the first entry in the way a document is loaded.
inline outcome load(const std::filesystem::path& path, unsigned int piece = 0xFFFFFFFF) {
    CZipArchive zip;
    const auto require = [](bool holds) {
        if (!holds) throw CZipException(CZipException::generic);
    };
    try {
        require(zip.Open(wide(path), CZipStorage::openReadOnly));
        zip.OpenFile(0);
        const CZipFileHeader* const info = zip.GetFileInfo(0);
        if (info == nullptr) return {no_entry, ""};
        if (!zip.is_size_credible(0)) return {refused, ""};
        std::string content(info->GetUncompressedSize(), '\0');
        const auto size = static_cast<unsigned int>(content.size());
        for (unsigned int done = 0, count = 1; done < size && count != 0; done += count)
            require((count = zip.ReadFile(&content[done], std::min(piece, size - done))) != 0);
        char more;
        require(zip.ReadFile(&more, 1) == 0);
        require(zip.CloseFile() == 1);
        zip.Close();
        return {loaded, content};
    } catch (const CZipException& e) {
        zip.Close(CZipArchive::closeAfterException);
        zip.Close(CZipArchive::closeAfterException);
        return {e.GetCause(), ""};
    }
}

inline outcome load_bytes(const std::string& bytes, unsigned int piece = 0xFFFFFFFF) {
    const std::filesystem::path path = folder() / "made.zip";
    make_file(path, bytes);
    return load(path, piece);
}

/// The cause that an action throws, 0 for none.
template<class Action>
int cause_of(Action action) {
    try {
        action();
        return 0;
    } catch (const CZipException& e) {
        return e.GetCause();
    }
}

/// Text that packs neither very well nor very badly.
inline std::string sample_text(std::size_t size) {
    std::string text;
    for (unsigned int i = 1; text.size() < size; i = i * 1103515245U + 12345U)
        text += "<L>" + std::to_string(i % 9973) + "</L>\n";
    text.resize(size);
    return text;
}

} // namespace zip_test
