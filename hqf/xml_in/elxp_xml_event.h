#pragma once

namespace lmx {

/// What the tokeniser and the reader have met. From 12 on the numbers are those of the event tables.
enum elxp_xml_event : int {
    EXE_EOF = 0,                        ///< the input ended where an element, text or end tag could stand
    EXE_OTHER = 1,                      ///< a name that is in no event table
    EXE_FATAL = 2,                      ///< an error; the tokeniser itself never gives it
    EXE_ERROR = 3,                      ///< an error
    EXE_START_TAG_END = 4,              ///< the `>` of a start tag
    EXE_CHARS = 5,                      ///< character data
    EXE_ELEMENT_END = 6,                ///< an end tag, or the `/>` of an empty element
    EXE_NAME = 7,                       ///< the name of an element or attribute, not yet looked up
    EXE_XSI_TYPE = 8,                   ///< the attribute `xsi:type`
    EXE_XSI_NIL = 9,                    ///< the attribute `xsi:nil`
    EXE_XSI_SCHEMA_LOCATION = 10,       ///< the attribute `xsi:schemaLocation`
    EXE_XSI_NO_NS_SCHEMA_LOCATION = 11, ///< the attribute `xsi:noNamespaceSchemaLocation`
    EXE_FIRST_TOKEN = 12,               ///< the first number that event tables use
};

} // namespace lmx
