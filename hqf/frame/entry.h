/// The operations of global elements that need no reader or writer of the caller's: a document from a file or from
/// memory, and one to a file, a string or a stream.
#pragma once

#include <ostream>
#include <string>

#include "hqf/frame/rows.h"
#include "hqf/xml_in/c_read_string.h"
#include "hqf/xml_in/c_xml_reader.h"
#include "hqf/xml_in/c_xml_reader_file.h"
#include "hqf/xml_in/c_xml_reader_memory.h"
#include "hqf/xml_out/c_xml_writer.h"

namespace hqf::frame {

using write_call = lmx::elmx_error (*)(void* object, lmx::c_xml_writer& writer, const char* name);

/// Layout of every document that the library writes by itself.
inline constexpr char layout_tab[] = "\t";
inline constexpr char layout_newline[] = "\n";

/// Writes to a file that is truncated first and deleted after a failure. 1 if it can't be opened, 42 if the stream
/// failed in a write that was otherwise complete. What is thrown on the way deletes the file, too, and passes through.
lmx::elmx_error write_file(const char* file_name, void* object, const char* name, write_call write);
/// Assigns to `*out` when the code is 0. `text_size`, if there is one, holds what to expect, and then the size.
lmx::elmx_error write_string(std::string* out, void* object, const char* name, write_call write,
                             std::size_t* text_size);
/// The same as wide text.
lmx::elmx_error write_string(std::wstring* out, void* object, const char* name, write_call write,
                             std::size_t* text_size);
lmx::elmx_error write_stream(std::ostream& stream, void* object, const char* name, write_call write);

/// Reads up to the root's name and compares it. Returns 0, 16, or the reader's code, through the reader's handler.
lmx::elmx_error read_root(lmx::c_xml_reader& reader, const char* local_name);
/// Promises that the bytes that a reader reads lie in memory that outlives it.
void note_lasting_source(lmx::c_xml_reader& reader);
/// How many bytes of its source a reader has read.
std::size_t size_read(lmx::c_xml_reader& reader);

template<class model_class>
lmx::elmx_error call_marshal(void* object, lmx::c_xml_writer& writer, const char* name) {
    return static_cast<model_class*>(object)->marshal(writer, name);
}

template<class model_class>
lmx::elmx_error marshal_to_file(model_class& object, const char* name, const char* file_name) {
    return write_file(file_name, &object, name, call_marshal<model_class>);
}
template<class model_class>
lmx::elmx_error marshal_to_string(model_class& object, const char* name, std::string* out,
                                  std::size_t* text_size = nullptr) {
    return write_string(out, &object, name, call_marshal<model_class>, text_size);
}
template<class model_class>
lmx::elmx_error marshal_to_stream(model_class& object, const char* name, std::ostream& stream) {
    return write_stream(stream, &object, name, call_marshal<model_class>);
}

template<class model_class>
lmx::elmx_error unmarshal_document(model_class& object, lmx::c_xml_reader& reader, const char* local_name,
                                   std::size_t* text_size = nullptr) {
    reader.set_ns_map(namespace_map);
    const lmx::c_xml_reader_local scope(&reader);
    lmx::elmx_error error = read_root(reader, local_name);
    if (error == lmx::err_no_error) error = object.unmarshal(reader, reader.item_name);
    if (text_size != nullptr) *text_size = size_read(reader);
    return error;
}
template<class model_class>
lmx::elmx_error unmarshal_file(model_class& object, const char* file_name) {
    lmx::c_xml_reader_file reader(file_name);
    return reader.is_open() ? object.unmarshal(reader) : lmx::err_unable_to_open_file;
}
template<class model_class>
lmx::elmx_error unmarshal_memory(model_class& object, const char* data, unsigned int size) {
    lmx::c_xml_reader_memory reader(data, size);
    note_lasting_source(reader);
    return object.unmarshal(reader);
}
/// Through a source of its own, which has no limit of 4 GiB.
template<class model_class>
lmx::elmx_error unmarshal_text(model_class& object, const std::string& text) {
    lmx::c_read_string source(text);
    lmx::c_xml_reader reader(source);
    note_lasting_source(reader);
    return object.unmarshal(reader);
}

} // namespace hqf::frame
