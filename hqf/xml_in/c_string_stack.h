#pragma once

#include <cstddef>
#include <cstring>
#include <string>
#include <string_view>

namespace lmx {

/// The names of the elements that are being read, outermost first: one run of bytes, each name with a NUL behind it.
class c_string_stack {
public:
    /// Size in bytes, NULs included; not the number of names.
    std::size_t get_stack_size() const { return size_; }

    /// Marks a name that is readable up to the next multiple of 16 bytes.
    static constexpr struct padding {
    } padded{};

private:
    friend class c_string_stack_node;

    static constexpr std::size_t block = 16;

    void push(std::string_view name) {
        make_room(name.size());
        name.copy(&bytes_[size_], name.size());
        size_ += name.size() + 1;
        bytes_[size_ - 1] = '\0';
    }
    void push_padded(std::string_view name) {
        make_room(name.size());
        char* const to = &bytes_[size_];
        for (std::size_t done = 0; done < name.size(); done += block)
            std::memcpy(to + done, name.data() + done, block);
        to[name.size()] = '\0';
        size_ += name.size() + 1;
    }
    void make_room(std::size_t length) {
        const std::size_t size = size_ + length + block;
        if (bytes_.size() < size) grow(size);
    }
    [[gnu::noinline]] void grow(std::size_t size) { bytes_.resize(size < 256 ? 256 : 2 * size); }

    /// Room for names, used up to `size_`.
    std::string bytes_;
    std::size_t size_ = 0;
};

/// Keeps a name on the stack for a scope. Nodes end in reverse order of their start.
class c_string_stack_node {
public:
    c_string_stack_node(c_string_stack& stack, std::string_view name)
        : stack_(stack)
        , offset_(stack.size_) {
        stack.push(name);
    }
    c_string_stack_node(c_string_stack& stack, std::string_view name, c_string_stack::padding)
        : stack_(stack)
        , offset_(stack.size_) {
        stack.push_padded(name);
    }
    c_string_stack_node(const c_string_stack_node&) = delete;
    c_string_stack_node& operator=(const c_string_stack_node&) = delete;
    ~c_string_stack_node() { stack_.size_ = offset_; }

    /// The name. Valid until the next name is pushed.
    const char* get_str() const { return stack_.bytes_.data() + offset_; }
    bool operator==(const std::string& name) const { return std::string_view(get_str()) == name; }
    bool operator!=(const std::string& name) const { return !(*this == name); }

private:
    c_string_stack& stack_;
    const std::size_t offset_;
};

} // namespace lmx
