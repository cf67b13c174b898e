#include "hqf/xml_in/c_get_with_entities.h"

#include "hqf/xml_in/limits.h"

namespace lmx {

c_get_with_entities::~c_get_with_entities() = default;

int c_get_with_entities::get_from_entity() {
    while (!frames_.empty() && frames_.back().ungot.empty() && *frames_.back().cursor == 0) {
        frames_.pop_back();
        values_.pop();
    }
    if (frames_.empty()) {
        replaced_values_.clear();
        return c_get_as_utf8::get();
    }
    entity_frame& innermost = frames_.back();
    if (!innermost.ungot.empty()) return innermost.ungot.get();
    return static_cast<unsigned char>(*innermost.cursor++);
}

// A parameter entity can hold a declaration that defines it anew. The value that is just being read must outlive that,
// so its frame goes on with a copy.
void c_get_with_entities::keep_value_in_use(const entity_table& table, const char* name) {
    refused_lengths_.clear();
    if (frames_.empty()) return;
    const char* value = nullptr;
    if (!table.find(name, &value)) return;
    const std::size_t place = values_.find(value);
    if (place == hqf::open_values::none) return;
    replaced_values_.emplace_back(c_rep_ops<const char*>::copy(value));
    const char* const kept = replaced_values_.back().get();
    frames_[place].cursor = kept + (frames_[place].cursor - value);
    values_.replace(place, kept);
}

void c_get_with_entities::add_general_entity(const char* name, const char* value) {
    keep_value_in_use(general_entities_, name);
    general_entities_.add(name, value);
}

void c_get_with_entities::add_parameter_entity(const char* name, const char* value) {
    keep_value_in_use(parameter_entities_, name);
    parameter_entities_.add(name, value);
}

bool c_get_with_entities::get_general_entity(const char* name, const char** value) const {
    return general_entities_.find(name, value);
}

bool c_get_with_entities::get_parameter_entity(const char* name, const char** value) const {
    return parameter_entities_.find(name, value);
}

bool c_get_with_entities::pay_for_expansion(const char* value) {
    const std::uint64_t most = hqf::limits::entity_allowance + hqf::limits::entity_growth * bytes_read();
    expanded_bytes_ += hqf::limits::entity_reference_cost;
    // Beyond the limit a reference costs its sender a few bytes, and must not make us go over a long text.
    expanded_bytes_ += expanded_bytes_ > most ? refused_length(value) : std::strlen(value);
    return expanded_bytes_ <= most;
}

std::size_t c_get_with_entities::refused_length(const char* value) {
    const auto [known, is_new] = refused_lengths_.try_emplace(value, 0);
    if (is_new) known->second = std::strlen(value);
    return known->second;
}

bool c_get_with_entities::set_input_entity_value(const char* value) {
    if (values_.holds(value)) {
        error(error_fatal, err_badly_formed_dtd, std::string("Recursive entity definition for: ") + value);
        return false;
    }
    if (!pay_for_expansion(value)) {
        error(error_fatal, err_badly_formed_dtd, "Entities expand to too much text");
        return false;
    }
    if (frames_.size() == frames_.capacity()) frames_.reserve(2 * frames_.size() + 2);
    values_.push(value);
    frames_.push_back({value, {}});
    return true;
}

void c_get_with_entities::rewind() {
    general_entities_.clear();
    parameter_entities_.clear();
    frames_.clear();
    values_.clear();
    replaced_values_.clear();
    refused_lengths_.clear();
    expanded_bytes_ = 0;
    c_get_as_utf8::rewind();
}

} // namespace lmx
