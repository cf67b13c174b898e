#include "hqf/document/archive.h"

#include "hqf/frame/entry.h"
#include "hqf/model/Hqf.h"
#include "hqf/platform/pages.h"
#include "hqf/platform/paths.h"
#include "hqf/xml_in/c_xml_reader_memory.h"
#include "hqf/zip/CZipArchive.h"

namespace hqf_v2 {

namespace {

constexpr lmx::elmx_error archive_failed = lmx::err_user_defined_error_1;
/// Cause of a step that gave false or too little.
constexpr int generic_cause = 100;

void require(bool holds) {
    if (!holds) throw CZipException(generic_cause);
}

} // namespace

lmx::elmx_error load_archive(Hqf& document, const std::wstring& path) {
    CZipArchive archive;
    archive.Open(path, CZipStorage::openReadOnly);
    archive.OpenFile(0);
    // Also the answer for an entry that lies about its size: no memory is taken for a claim that can't be true.
    if (!archive.is_size_credible(0)) return archive_failed;
    try {
        const unsigned int size = archive.GetFileInfo(0)->GetUncompressedSize();
        CZipAutoBuffer xml(size);
        hqf::expect_filling(xml.GetBuffer(), size);
        char one_more = 0;
        require(archive.ReadFile(xml.GetBuffer(), size) == size);
        require(archive.ReadFile(&one_more, 1) == 0);
        require(archive.CloseFile() == 1);
        archive.Close();
        lmx::c_xml_reader_memory reader(xml.GetBuffer(), size);
        hqf::frame::note_lasting_source(reader);
        return document.unmarshal(reader);
    } catch (...) {
        archive.Close(CZipArchive::closeAfterException);
        return archive_failed;
    }
}

lmx::elmx_error pack_archive(const std::wstring& archive_path, const std::wstring& xml_path) {
    CZipArchive archive;
    archive.Open(archive_path, CZipStorage::create);
    try {
        archive.SetCompressionMethod(8);
        require(archive.AddNewFile(xml_path));
        archive.Close();
    } catch (...) {
        archive.Close(CZipArchive::closeAfterException);
        return archive_failed;
    }
    hqf::remove_file(xml_path);
    return lmx::err_no_error;
}

} // namespace hqf_v2
