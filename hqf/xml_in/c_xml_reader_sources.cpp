#include "hqf/xml_in/c_xml_reader_file.h"
#include "hqf/xml_in/c_xml_reader_memory.h"

// The readers that own their source; what they add is only the order in which things are built.

namespace lmx {

c_xml_reader_file::~c_xml_reader_file() = default;
c_xml_reader_memory::~c_xml_reader_memory() = default;

} // namespace lmx
