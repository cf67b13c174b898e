#include "hqf/xml_in/c_entity_name_reader.h"

#include "hqf/xml_in/attribute_store.h"
#include "hqf/xml_in/c_get_with_entities.h"

namespace lmx {

c_entity_name_reader::~c_entity_name_reader() = default;

int c_entity_name_reader_for_c_get::get() {
    return input_.get();
}

void c_entity_name_reader_for_c_get::unget(int c) {
    input_.unget(c);
}

int c_entity_name_reader_for_attribute_data::get() {
    return attributes_.get();
}

void c_entity_name_reader_for_attribute_data::unget(int c) {
    if (c != -1) attributes_.step_back();
}

int c_entity_name_reader_for_entity::get() {
    return *cursor_ == 0 ? -1 : static_cast<unsigned char>(*cursor_++);
}

void c_entity_name_reader_for_entity::unget(int c) {
    if (c != -1 && cursor_ != start_) --cursor_;
}

int c_entity_name_reader_for_c_str::get() {
    return text_[index_] == 0 ? -1 : static_cast<unsigned char>(text_[index_++]);
}

void c_entity_name_reader_for_c_str::unget(int c) {
    if (c != -1 && index_ != 0) --index_;
}

} // namespace lmx
