#include "hqf/xml_in/reader_access.h"

namespace hqf {

void reader_access::look_prefixes_up(lmx::c_xml_reader& reader) {
    const lmx::c_xml_local& scope = *reader.current_scope_;
    reader.are_prefixes_plain_ = scope.find_namespace_id("Hqf") == 1000 && scope.find_namespace_id("xsi") == 5;
    reader.are_prefixes_changed_ = false;
}

// An entity value that is being read must be read to its end by the general path.
window* reader_access::open_window(lmx::c_get_with_entities& stream) {
    if (stream.get_entity_stack_depth() != 0) return nullptr;
    if (stream.window_ == nullptr) stream.window_ = std::make_unique<window>(stream);
    return stream.window_->begin_step() ? stream.window_.get() : nullptr;
}

} // namespace hqf
