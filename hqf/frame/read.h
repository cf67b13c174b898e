/// The reading half of the engine: an element into an object of any model class, driven by the class's rows.
///
/// Two roads lead through a document. The general one asks the reader for one event after the other; it finds every
/// error, and it is the truth. Where a window lies over the input (hqf/xml_in/window.h), whole steps are taken in it
/// first: a step either reads exactly what the general road would read without a report, or takes nothing.
#pragma once

#include "hqf/frame/rows.h"

namespace hqf::frame {

/// Reads the element whose start tag has been read up to its name.
///
/// \returns 0, or the first code that the reader's error handler didn't turn into 0. What was read before it is kept.
lmx::elmx_error read_element(const class_rows& rows, void* object, lmx::c_xml_reader& reader, const std::string& name);

/// Reads the value of the attribute just named if it is one of the class's; true when it was.
bool read_attribute(const class_rows& rows, void* object, lmx::c_xml_reader& reader, const std::string& attribute,
                    lmx::elmx_error* error);

/// Code 25 when a mandatory attribute is not set.
lmx::elmx_error check_attributes(const class_rows& rows, void* object, lmx::c_xml_reader& reader);

/// Reads the children, from the reader's current event to the first one that the class doesn't take. False with a code
/// in `*error` when that failed. `*name` is the current element's name, before and after; null for the reader's own.
bool read_body(const class_rows& rows, void* object, lmx::c_xml_reader& reader, std::string* name,
               lmx::elmx_error* error);

/// Reads the value of a class with simple content; without a body it is the empty text.
bool read_simple_body(const class_rows& rows, void* object, lmx::c_xml_reader& reader, std::string* name,
                      lmx::elmx_error* error, bool has_body);

/// Whether the current element is a member of the group; if so, its event stays, otherwise the old one is put back.
bool is_member(const class_rows& rows, lmx::c_xml_reader& reader);

/// Reads one member into a group's object, or passes over an element that is none. False with a code in `*error` when
/// that failed.
bool read_group(const class_rows& rows, void* object, lmx::c_xml_reader& reader, std::string* name,
                lmx::elmx_error* error);

} // namespace hqf::frame
