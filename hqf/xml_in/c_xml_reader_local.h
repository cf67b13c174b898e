#pragma once

/// `c_xml_reader_local`, the scope of namespace declarations in a reader. It is declared in c_xml_reader_scope.h, and
/// its bodies stand with the reader's.
#include "hqf/xml_in/c_xml_reader.h"
