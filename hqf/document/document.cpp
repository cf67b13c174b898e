/// Load and write operations of the root class.

#include <cwchar>

#include "hqf/document/SdkInformationStamper.h"
#include "hqf/document/XMLDocumentResult.h"
#include "hqf/document/archive.h"
#include "hqf/frame/entry.h"
#include "hqf/model/Hqf.h"
#include "hqf/platform/paths.h"
#include "hqf/xml_in/wide_source.h"

namespace hqf_v2 {

namespace {

constexpr char root_name[] = "Hqf:Hqf";
constexpr wchar_t plain_suffix[] = L".hqf";
constexpr wchar_t archive_suffix[] = L".hqfz";

bool hasSuffix(const std::wstring& path, const std::wstring& suffix) {
    return path.size() >= suffix.size() && path.compare(path.size() - suffix.size(), suffix.size(), suffix) == 0;
}

/// Stamps before the first element is written, but behind the opening of a file: one that can't be opened leaves no
/// stamp.
lmx::elmx_error marshal_stamped(void* object, lmx::c_xml_writer& writer, const char* name) {
    auto& document = *static_cast<Hqf*>(object);
    SdkInformationStamper().stampWrite(document);
    return document.marshal(writer, name);
}

lmx::elmx_error writeXmlFile(Hqf& document, const std::wstring& path) {
    return hqf::frame::write_file(hqf::path_to_utf8(path).c_str(), &document, root_name, marshal_stamped);
}

} // namespace

lmx::elmx_error Hqf::loadFile(const std::wstring& path) {
    if (hasSuffix(path, archive_suffix)) return load_archive(*this, path);
    lmx::c_xml_reader_file reader(path.c_str());
    return reader.is_open() ? unmarshal(reader) : lmx::err_unable_to_open_file;
}

lmx::elmx_error Hqf::loadString(const std::wstring& xml) {
    hqf::wide_source source(xml);
    lmx::c_xml_reader reader(source);
    return unmarshal(reader);
}

lmx::elmx_error Hqf::writeFile(const std::wstring& path) {
    if (hasSuffix(path, archive_suffix)) {
        // The archive is packed from the plain file, which lies beside it for that time.
        const std::wstring xml_path = path.substr(0, path.size() - std::wcslen(archive_suffix)) + plain_suffix;
        const lmx::elmx_error error = writeXmlFile(*this, xml_path);
        return error != lmx::err_no_error ? error : pack_archive(path, xml_path);
    }
    return hasSuffix(path, plain_suffix) ? writeXmlFile(*this, path) : lmx::err_user_defined_error_2;
}

XMLDocumentResult Hqf::writeString() {
    std::wstring text;
    const lmx::elmx_error error = hqf::frame::write_string(&text, this, root_name, marshal_stamped, &text_size_);
    return XMLDocumentResult(std::move(text), error);
}

} // namespace hqf_v2
