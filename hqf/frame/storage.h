/// How a model class holds its members. Every generated class is a row of these; what a member is (mandatory, optional,
/// repeating, owned through a pointer) stands in its type, and the rows of the class repeat none of it.
///
/// Nothing here is for callers of the library: they meet the members through accessors.
#pragma once

#include <memory>
#include <string>
#include <utility>

#include "hqf/frame/list.h"

namespace hqf::frame {

struct class_rows;
struct literals;

/// Gives the friend of every model class that builds its rows (see hqf/frame/rows.h).
template<class model_class>
struct rows_of;

/// An enumerated text, held as the number of its literal. A text that is none, which an application's error handler may
/// let through, is held beside it.
class enumerated {
public:
    enumerated() = default;
    enumerated(const enumerated& other)
        : number_(other.number_)
        , free_text_(other.free_text_ == nullptr ? nullptr : std::make_unique<std::wstring>(*other.free_text_)) {}
    enumerated& operator=(enumerated other) noexcept {
        swap(*this, other);
        return *this;
    }
    friend void swap(enumerated& a, enumerated& b) noexcept {
        std::swap(a.number_, b.number_);
        a.free_text_.swap(b.free_text_);
    }
    friend bool operator==(const enumerated& a, const enumerated& b) {
        if (a.free_text_ == nullptr || b.free_text_ == nullptr)
            return a.number_ == b.number_ && a.free_text_ == b.free_text_;
        return *a.free_text_ == *b.free_text_;
    }

    /// From 1, in schema order; 0 for no literal.
    int number() const { return number_; }
    void set_number(int number) {
        number_ = number;
        free_text_ = nullptr;
    }
    const std::wstring& text(const literals& texts) const;
    void set_text(const std::wstring& text, const literals& texts);

private:
    int number_ = 0;
    std::unique_ptr<std::wstring> free_text_;
};

/// A simple value and whether it was set. The engine sees every single simple member as this.
template<class value_type>
struct value_member {
    value_type value{};
    bool set = false;
};

/// A mandatory value. A copy counts as set, whatever the source was.
template<class value_type>
struct mandatory : value_member<value_type> {
    static constexpr bool set_in_copies = true;
};

/// A value that may be absent; its copy is absent then, too. A member with a default holds it while unset.
template<class value_type>
struct optional : value_member<value_type> {
    static constexpr bool set_in_copies = false;
};

/// A complex child held by value.
template<class model_class>
struct child {
    model_class object;
    bool present = false;
};

/// A complex child on the heap without its type: what the engine sees.
struct pointer_member {
    pointer_member() = default;
    pointer_member(const pointer_member&) = delete;
    pointer_member& operator=(const pointer_member&) = delete;

    void* object = nullptr;
    bool present = false;
    /// Stands for the nil flag of an object that isn't there yet; the object that comes takes it over and is the truth
    /// from then on.
    bool nil = false;
};

/// A complex child on the heap, made when someone asks for it: the only way for a class to contain its own kind, and
/// cheaper than an object for every child that might have been there. A nil child needs no object either.
template<class model_class>
struct child_pointer : pointer_member {
    ~child_pointer() { delete get(); }
    model_class* get() const { return static_cast<model_class*>(object); }
};

/// The selector of a choice and the slot that its options share: numbers lie in it, text and objects behind a pointer.
/// The class that holds it knows the options and frees what the slot owns.
struct choice_slot {
    explicit choice_slot(int none)
        : chosen(none) {}
    choice_slot(const choice_slot&) = delete;
    choice_slot& operator=(const choice_slot&) = delete;

    int chosen;
    union {
        double real;
        int integer;
        unsigned int natural;
        void* object = nullptr;
    };
};

/// The selector of a substitution group and the object of the member chosen, without its type.
struct object_slot {
    explicit object_slot(int none)
        : chosen(none) {}
    object_slot(const object_slot&) = delete;
    object_slot& operator=(const object_slot&) = delete;

    int chosen;
    /// Points at the hierarchy's root class, which lies at the start of every object below it.
    void* object = nullptr;
};

template<class root_class>
struct group_slot : object_slot {
    using object_slot::object_slot;
    ~group_slot() { delete get(); }
    root_class* get() const { return static_cast<root_class*>(object); }

    /// Gives up what is held and takes over `made` as member `index`.
    void hold(int index, root_class* made) {
        root_class* old = get();
        object = made;
        chosen = index;
        if (old != made) delete old;
    }
};

} // namespace hqf::frame
