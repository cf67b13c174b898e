#pragma once

#include "hqf/xml_in/c_get_as_utf8.h"
#include "hqf/xml_in/c_repository.h"
#include "hqf/xml_in/open_values.h"

#include <memory>
#include <unordered_map>
#include <vector>

namespace lmx {

/// A character stream into which entity values can be pushed: while one is being read, its bytes come as if they stood
/// in the document. They count no lines and their line ends are not folded, since both was done when they were defined.
///
/// It owns the tables of entities; the values on its stack are those of the tables.
class HQF_API c_get_with_entities : public c_get_as_utf8 {
public:
    c_get_with_entities(c_read& input, c_error& errors)
        : c_get_as_utf8(input, errors) {}
    ~c_get_with_entities() override;

    /// The next byte of the innermost entity value, or of the document when none is left; -1 at the end of input. A
    /// value that has been begun is read to its end even after a fatal report.
    int get() { return frames_.empty() ? c_get_as_utf8::get() : get_from_entity(); }
    /// Gives a character back to where reading stands: to the innermost value, or to the document. At most three.
    void unget(int c) {
        if (frames_.empty())
            c_get_as_utf8::unget(c);
        else
            frames_.back().ungot.unget(c);
    }

    /// Defines an entity, or defines it anew. Name and value are copied.
    void add_general_entity(const char* name, const char* value);
    void add_parameter_entity(const char* name, const char* value);
    /// Looks a definition up. The value belongs to the table and lasts until the name is defined anew.
    bool get_general_entity(const char* name, const char** value) const;
    bool get_parameter_entity(const char* name, const char** value) const;

    /// Starts reading a value in place of the document.
    ///
    /// \param value a pointer that one of the tables gave; the pointer is the entity's identity
    /// \returns false after fatal report 9: the entity is being read already, or entities grow or nest beyond
    /// `hqf::limits`
    bool set_input_entity_value(const char* value);
    /// How many values are being read, one inside the other. A value counts until the read behind its last byte.
    unsigned int get_entity_stack_depth() const { return static_cast<unsigned int>(frames_.size()); }

    /// Forgets all entities and goes back to the start of the document.
    void rewind();

protected:
    /// Counts one more use of a value. False when entities have grown beyond their limit.
    bool pay_for_expansion(const char* value);

private:
    friend class c_xml;

    struct entity_frame {
        const char* cursor;
        c_unget_buffer ungot;
    };
    using entity_table = c_repository<const char*>;

    int get_from_entity();
    void keep_value_in_use(const entity_table& table, const char* name);
    std::size_t refused_length(const char* value);

    std::vector<entity_frame> frames_;
    hqf::open_values values_; // of the frames
    entity_table general_entities_;
    entity_table parameter_entities_;
    std::vector<std::unique_ptr<const char[]>> replaced_values_;
    std::uint64_t expanded_bytes_ = 0;
    // Of values that were refused since an entity was defined.
    std::unordered_map<const char*, std::size_t> refused_lengths_;
};

} // namespace lmx
