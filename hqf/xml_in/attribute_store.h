#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// The attributes of a start tag, as they stand in the document.

namespace hqf {

/// One run of bytes: for each attribute its name, a NUL, the opening quote, the raw value, a NUL; behind the last one
/// another NUL. A cursor walks over it. It keeps its capacity from tag to tag.
///
/// A NUL inside a raw value splits it, so that what follows reads as another attribute; every access is held to the
/// bytes that are there.
class attribute_store {
public:
    attribute_store() { bytes_.reserve(150); }

    void clear() {
        bytes_.clear();
        cursor_ = 0;
    }
    void append(int c) { bytes_ += static_cast<char>(c); }
    void append(std::string_view text) { bytes_ += text; }
    std::size_t size() const { return bytes_.size(); }
    /// The text from `offset` to the NUL behind it. Precondition: the offset lies inside.
    const char* text_at(std::size_t offset) const { return bytes_.c_str() + offset; }

    /// Whether an attribute stands at the cursor.
    bool has_attribute() const { return peek() != 0; }
    /// The name, or any text, at the cursor; the cursor moves behind its NUL.
    std::string_view take_text();
    /// Moves over the quote in front of a value and gives it; 0 at the end.
    int take_quote() { return cursor_ < bytes_.size() ? static_cast<unsigned char>(bytes_[cursor_++]) : 0; }
    /// Moves behind the next NUL.
    void skip_text() { take_text(); }

    /// The byte at the cursor, which moves on; -1 at a NUL, where it stays.
    int get() { return peek() == 0 ? -1 : static_cast<unsigned char>(bytes_[cursor_++]); }
    void step_back() {
        if (cursor_ != 0) --cursor_;
    }
    void rewind() { cursor_ = 0; }

private:
    char peek() const { return cursor_ < bytes_.size() ? bytes_[cursor_] : '\0'; }

    std::string bytes_;
    std::size_t cursor_ = 0;
};

inline std::string_view attribute_store::take_text() {
    if (cursor_ >= bytes_.size()) return {};
    const std::string_view text(bytes_.c_str() + cursor_);
    cursor_ += text.size() + 1;
    if (cursor_ > bytes_.size()) cursor_ = bytes_.size();
    return text;
}

} // namespace hqf
