/// Load and write operations of the root class.

#include <cwchar>

#include "hqf/document/SdkInformationStamper.h"
#include "hqf/document/XMLDocumentResult.h"
#include "hqf/document/archive.h"
#include "hqf/frame/entry.h"
#include "hqf/model/Hqf.h"
#include "hqf/platform/paths.h"
#include "hqf/values/text.h"
#include "hqf/values/transcode.h"
#include "hqf/xml_out/text_stream.h"

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
    std::string text;
    lmx::convert(&text, xml);
    return unmarshal(text);
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
    hqf::text_stream stream;
    const lmx::elmx_error error = hqf::frame::write_stream(stream, this, root_name, marshal_stamped);
    std::wstring text;
    if (error == lmx::err_no_error) {
        std::string utf8;
        stream.move_to(utf8);
        hqf::assign_wide(text, utf8.data(), utf8.size());
    }
    return XMLDocumentResult(std::move(text), error);
}

} // namespace hqf_v2
