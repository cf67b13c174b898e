/// The list behind every repeating member: pointers to objects that it owns, each allocated alone, so that a child's
/// address stays the same while the list grows.
#pragma once

#include <cstring>
#include <new>
#include <type_traits>
#include <utility>

#include "hqf/frame/pool.h"

namespace hqf::frame {

/// An object of a class that doesn't come from the pools by itself, such as a text.
template<class value_type>
struct pooled_value : pooled {
    template<class... arguments>
    explicit pooled_value(const arguments&... values)
        : value(values...) {}

    value_type value;
};

/// A new object from the pools. destroy_object() deletes it.
template<class object_type, class... arguments>
object_type* make_object(const arguments&... values) {
    if constexpr (std::is_base_of_v<pooled, object_type>)
        return new object_type(values...);
    else
        return &(new pooled_value<object_type>(values...))->value;
}

template<class object_type>
void destroy_object(void* object) {
    if constexpr (std::is_base_of_v<pooled, object_type>)
        delete static_cast<object_type*>(object);
    else
        // The value is all that there is in it.
        delete reinterpret_cast<pooled_value<object_type>*>(object);
}

/// The pointers of a list, without their type: the engine appends to every list through this.
class list_base {
public:
    list_base() = default;
    list_base(const list_base&) = delete;
    list_base& operator=(const list_base&) = delete;

    unsigned int size() const { return size_; }
    void* item(unsigned int index) const { return items()[index]; }

    /// Makes room for one more pointer, so that the append that follows cannot fail.
    ///
    /// \throws std::bad_alloc; the list is as it was.
    void make_room() {
        if (size_ == capacity_) grow();
    }

    /// Takes over an object. make_room() came first.
    void append(void* object) { items()[size_++] = object; }

    /// Takes over an object in front of the one at `index`, or at the end for an index from the size up.
    void insert(unsigned int index, void* object) {
        append(object);
        for (unsigned int at = size_ - 1; at > index; --at)
            std::swap(items()[at], items()[at - 1]);
    }

    /// Gives up the last object, which the caller owns then.
    void* take_back() { return items()[--size_]; }

    /// Gives up the object at `index` and closes the gap.
    void* take(unsigned int index) {
        for (unsigned int at = index + 1; at < size_; ++at)
            std::swap(items()[at], items()[at - 1]);
        return take_back();
    }

    void swap(list_base& other) noexcept {
        std::swap(place_, other.place_);
        std::swap(size_, other.size_);
        std::swap(capacity_, other.capacity_);
    }

protected:
    ~list_base() {
        if (has_block()) pooled::operator delete(place_);
    }

private:
    /// Most lists have one item: its pointer lies in the list itself, a longer list's in a block.
    static constexpr unsigned int in_place = 1;
    static constexpr unsigned int least_block = 4;

    bool has_block() const { return capacity_ > in_place; }
    void** items() const { return has_block() ? static_cast<void**>(place_) : const_cast<void**>(&place_); }

    void grow() {
        const unsigned int capacity = has_block() ? capacity_ * 2 : least_block;
        if (capacity <= capacity_) throw std::bad_alloc();
        void* const block = pooled::operator new(sizeof(void*) * capacity);
        std::memcpy(block, items(), sizeof(void*) * size_);
        if (has_block()) pooled::operator delete(place_);
        place_ = block;
        capacity_ = capacity;
    }

    /// The block of pointers, or the one pointer.
    void* place_ = nullptr;
    unsigned int size_ = 0;
    unsigned int capacity_ = in_place;
};

template<class item_type>
class list : public list_base {
public:
    ~list() { clear(); }

    item_type& operator[](unsigned int index) const { return *static_cast<item_type*>(item(index)); }
    item_type& back() const { return (*this)[size() - 1]; }

    /// Appends an item built from the arguments.
    template<class... arguments>
    item_type& add(const arguments&... values) {
        make_room();
        auto* object = make_object<item_type>(values...);
        append(object);
        return *object;
    }

    /// Inserts before `index`, or appends for an index from the size up.
    template<class... arguments>
    void insert_new(unsigned int index, const arguments&... values) {
        make_room();
        insert(index, make_object<item_type>(values...));
    }

    /// The item at `index`; default items fill the list up to there first.
    item_type& at_or_add(unsigned int index) {
        while (size() <= index)
            add();
        return (*this)[index];
    }

    /// Replaces the item at `index`, or appends for an index from the size up.
    void replace(unsigned int index, const item_type& value) {
        if (index < size())
            (*this)[index] = value;
        else
            add(value);
    }

    void remove(unsigned int index) { destroy_object<item_type>(take(index)); }

    /// Destroys the items, from the last to the first.
    void clear() {
        while (size() != 0)
            destroy_object<item_type>(take_back());
    }
};

} // namespace hqf::frame
