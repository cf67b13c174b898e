#pragma once

#include "hqf/platform/api.h"

#include <cstddef>

namespace hqf {
class attribute_store;
}

namespace lmx {

class c_get_with_entities;

/// Where the name of a reference is read from.
class HQF_API c_entity_name_reader {
public:
    explicit c_entity_name_reader(bool is_stream_value = false)
        : is_stream(is_stream_value) {}
    c_entity_name_reader(const c_entity_name_reader&) = delete;
    c_entity_name_reader& operator=(const c_entity_name_reader&) = delete;

    virtual ~c_entity_name_reader();
    /// The next byte, 0 to 255, or -1 at the end.
    virtual int get() = 0;
    /// Gives a byte back.
    virtual void unget(int c) = 0;

    /// Whether the entity's value is to be pushed on the character stream, markup and all; otherwise it is expanded in
    /// place.
    bool is_stream;
};

/// Reads from the character stream.
class HQF_API c_entity_name_reader_for_c_get : public c_entity_name_reader {
public:
    c_entity_name_reader_for_c_get(c_get_with_entities& input, bool is_stream_value)
        : c_entity_name_reader(is_stream_value)
        , input_(input) {}
    int get() override;
    void unget(int c) override;

private:
    c_get_with_entities& input_;
};

/// Reads from the stored attributes of a start tag, from their cursor on, which it moves.
class HQF_API c_entity_name_reader_for_attribute_data : public c_entity_name_reader {
public:
    explicit c_entity_name_reader_for_attribute_data(hqf::attribute_store& attributes)
        : c_entity_name_reader(false)
        , attributes_(attributes) {}
    int get() override;
    void unget(int c) override;

private:
    hqf::attribute_store& attributes_;
};

/// Reads from an entity's value, from a cursor on, which it moves.
class HQF_API c_entity_name_reader_for_entity : public c_entity_name_reader {
public:
    c_entity_name_reader_for_entity(const char* start, const char*& cursor)
        : c_entity_name_reader(false)
        , start_(start)
        , cursor_(cursor) {}
    int get() override;
    void unget(int c) override;

private:
    const char* start_;
    const char*& cursor_;
};

/// Reads from a text that ends in NUL.
class HQF_API c_entity_name_reader_for_c_str : public c_entity_name_reader {
public:
    explicit c_entity_name_reader_for_c_str(const char* text)
        : c_entity_name_reader(false)
        , text_(text) {}
    int get() override;
    void unget(int c) override;

    /// How many bytes have been read.
    std::size_t index() const { return index_; }

private:
    const char* text_;
    std::size_t index_ = 0;
};

} // namespace lmx
