/// Load and write operations of the root class.

#include <fstream>
#include <sstream>

#include "hqf/document/SdkInformationStamper.h"
#include "hqf/document/XMLDocumentResult.h"
#include "hqf/frame/entry.h"
#include "hqf/model/Hqf.h"
#include "hqf/platform/paths.h"
#include "hqf/values/text.h"

namespace hqf_v2 {

namespace {

constexpr char root_name[] = "Hqf:Hqf";
constexpr wchar_t plain_suffix[] = L".hqf";
constexpr wchar_t archive_suffix[] = L".hqfz";

bool hasSuffix(const std::wstring& path, const std::wstring& suffix) {
    return path.size() >= suffix.size() && path.compare(path.size() - suffix.size(), suffix.size(), suffix) == 0;
}

lmx::elmx_error writeXmlFile(Hqf& document, const std::wstring& path) {
    const std::string file_name = hqf::path_to_utf8(path);
    std::ofstream stream(file_name, std::ios::out | std::ios::trunc);
    if (!stream.is_open()) return lmx::err_unable_to_open_file;
    lmx::elmx_error error;
    {
        lmx::c_xml_writer writer(stream, lmx::c_xml_writer::include_xml_decl, hqf::frame::layout_tab,
                                 hqf::frame::layout_newline);
        SdkInformationStamper().stampWrite(document);
        error = document.marshal(writer, root_name);
    }
    stream.close();
    if (error == lmx::err_no_error && stream.fail()) error = lmx::err_undefined_error;
    if (error != lmx::err_no_error) hqf::remove_file(path);
    return error;
}

} // namespace

lmx::elmx_error Hqf::loadFile(const std::wstring& path) {
    if (hasSuffix(path, archive_suffix)) return lmx::err_user_defined_error_1;
    lmx::c_xml_reader_file reader(path.c_str());
    return reader.is_open() ? unmarshal(reader) : lmx::err_unable_to_open_file;
}

lmx::elmx_error Hqf::loadString(const std::wstring& xml) {
    std::string text;
    lmx::convert(&text, xml);
    return unmarshal(text);
}

lmx::elmx_error Hqf::writeFile(const std::wstring& path) {
    if (hasSuffix(path, archive_suffix)) return lmx::err_user_defined_error_1;
    if (!hasSuffix(path, plain_suffix)) return lmx::err_user_defined_error_2;
    return writeXmlFile(*this, path);
}

XMLDocumentResult Hqf::writeString() {
    std::ostringstream stream;
    lmx::c_xml_writer writer(stream, lmx::c_xml_writer::include_xml_decl, hqf::frame::layout_tab,
                             hqf::frame::layout_newline);
    SdkInformationStamper().stampWrite(*this);
    const lmx::elmx_error error = marshal(writer, root_name);
    std::wstring text;
    if (error == lmx::err_no_error) lmx::convert(&text, std::move(stream).str());
    return XMLDocumentResult(std::move(text), error);
}

} // namespace hqf_v2
