/// A user's program: makes a document from nothing, writes it to the file that it is told, and reads it again.

#include <cstdio>
#include <string>

#include <hqf/hqf.h>
#include <hqf/xml_in/c_xml_reader_file.h>

int failed(const char* step, int code) {
    std::printf("%s: code %d\n", step, code);
    return 1;
}

int main(int argc, char** argv) {
    if (argc != 2) return failed("no file name", argc);
    const std::wstring path(argv[1], argv[1] + std::char_traits<char>::length(argv[1])); // an ASCII path will do here

    hqf_v2::Hqf document;
    hqf_v2::Header& header = document.get_Preamble().get_Header();
    header.set_Creator(L"consumer");
    header.set_CreatorVersion(L"1");
    header.append_ChangeHistory("2025-01-31T12:00:00Z");
    if (int code = document.writeFile(path); code != lmx::err_min_max_occurs_error_on_marshaling)
        return failed("writing without a purpose", code);
    header.set_Purpose(L"test");

    document.append_Palette();
    document.back_Palette().set_PaletteName(L"greys");
    document.back_Palette().append_ChangeHistory("2025-01-31T12:00:00Z");
    if (int code = document.writeFile(path); code != 0) return failed("writing", code);

    hqf_v2::Hqf again;
    lmx::c_xml_reader_file reader(argv[1]);
    if (int code = again.unmarshal(reader); code != 0) return failed("reading", code);
    if (again.get_Palette(0).get_PaletteName() != L"greys") return failed("another name", 0);
    if (!hqf::equal(document, again)) return failed("another document", 0);
    return 0;
}
