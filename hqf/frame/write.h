/// The writing half of the engine: an object of any model class as an element, driven by the class's rows.
#pragma once

#include "hqf/frame/rows.h"

namespace hqf::frame {

/// Writes an object as an element of the qualified name `name`.
///
/// \returns 0; 46 from the first incomplete element in document order, when its ancestors have begun; 45 for a group
/// whose object is missing; or what the writer's error handler made of a code
lmx::elmx_error write_element(const class_rows& rows, void* object, lmx::c_xml_writer& writer, const char* name);

/// The attributes, each behind a blank: the mandatory ones always, the optional ones when set.
void write_attributes(const class_rows& rows, const void* object, lmx::c_xml_writer& writer);

/// What stands between the tags: children, the chosen option, or the value.
lmx::elmx_error write_content(const class_rows& rows, void* object, lmx::c_xml_writer& writer);

/// Writes the chosen member of a group under its own element name.
lmx::elmx_error write_group(const class_rows& rows, void* object, lmx::c_xml_writer& writer);

} // namespace hqf::frame
