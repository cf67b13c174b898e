#include "hqf/frame/entry.h"

#include <cstdio>

#include "hqf/xml_in/reader_access.h"
#include "hqf/xml_out/text_stream.h"

namespace hqf::frame {

namespace {

template<class text_type>
lmx::elmx_error gathered(text_type* out, void* object, const char* name, write_call write, std::size_t* text_size) {
    lmx::elmx_error error = lmx::err_no_error;
    gather(*out, text_size == nullptr ? 0 : *text_size, [&](std::ostream& stream) {
        error = write_stream(stream, object, name, write);
        return error == lmx::err_no_error;
    });
    if (error == lmx::err_no_error && text_size != nullptr) *text_size = out->size();
    return error;
}

} // namespace

lmx::elmx_error write_file(const char* file_name, void* object, const char* name, write_call write) {
    file_stream stream(file_name);
    if (!stream.is_open()) return lmx::err_unable_to_open_file;
    lmx::elmx_error error = lmx::err_no_error;
    try {
        error = write_stream(stream, object, name, write);
    } catch (...) {
        std::remove(file_name);
        throw;
    }
    if (!stream.close() && error == lmx::err_no_error) error = lmx::err_undefined_error;
    if (error != lmx::err_no_error) std::remove(file_name);
    return error;
}

lmx::elmx_error write_string(std::string* out, void* object, const char* name, write_call write,
                             std::size_t* text_size) {
    return gathered(out, object, name, write, text_size);
}

lmx::elmx_error write_string(std::wstring* out, void* object, const char* name, write_call write,
                             std::size_t* text_size) {
    return gathered(out, object, name, write, text_size);
}

lmx::elmx_error write_stream(std::ostream& stream, void* object, const char* name, write_call write) {
    lmx::c_xml_writer writer(stream, lmx::c_xml_writer::include_xml_decl, layout_tab, layout_newline);
    return write(object, writer, name);
}

void note_lasting_source(lmx::c_xml_reader& reader) {
    reader_access::note_lasting_source(reader);
}

std::size_t size_read(lmx::c_xml_reader& reader) {
    return static_cast<std::size_t>(reader_access::bytes_read(reader));
}

lmx::elmx_error read_root(lmx::c_xml_reader& reader, const char* local_name) {
    lmx::elmx_error error = lmx::err_no_error;
    reader.get_element_event(nullptr, &error, &reader.item_name);
    if (error != lmx::err_no_error) error = reader.handle_error(error, reader.item_name, "Hqf", __LINE__);
    if (error != lmx::err_no_error) return error;
    if (reader.get_element_ns_id() == format_namespace_id && reader.get_local_name() == local_name)
        return lmx::err_no_error;
    return reader.handle_error(lmx::err_element_not_found, reader.item_name, "Hqf", __LINE__);
}

} // namespace hqf::frame
