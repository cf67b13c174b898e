/// What the accessors of the model classes do beyond reading a member: objects that are made when someone asks for
/// them, options and group members that are chosen by it.
#pragma once

#include <atomic>
#include <memory>
#include <string>
#include <utility>

#include "hqf/frame/checks.h"
#include "hqf/frame/objects.h"

namespace hqf::frame {

/// Stands in for an object that isn't there, for callers that only look.
template<class object_type>
const object_type& empty_object() {
    static const object_type empty{};
    return empty;
}

template<class object_type>
const object_type& object_or_empty(const object_type* object) {
    return object != nullptr ? *object : empty_object<object_type>();
}

/// What a caller is given who has put a null pointer in an object's place: a reference it can hold, to an object of no
/// document.
template<class object_type>
object_type& object_or_spare(object_type* object) {
    static thread_local object_type spare;
    return object != nullptr ? *object : spare;
}

/// Gives `object` what a copy holds that was made before it: what is chosen now may have held the source.
template<class object_type>
object_type& swapped(object_type& object, object_type& copy) {
    object.swap(copy);
    return object;
}

/// Makes an object nil: an operation of the classes that can be.
template<class model_class>
using nil_setter = void (model_class::*)();

/// The object that a child held by pointer lacks.
template<class model_class>
std::unique_ptr<model_class> missing_object(const pointer_member& member, nil_setter<model_class> make_nil) {
    auto fresh = std::make_unique<model_class>();
    if (member.nil) (*fresh.*make_nil)();
    return fresh;
}

/// The object of a child held by pointer, made if it isn't there, and marked present.
template<class model_class>
model_class& made(child_pointer<model_class>& member, nil_setter<model_class> make_nil = nullptr) {
    if (member.object == nullptr) member.object = missing_object(member, make_nil).release();
    member.present = true;
    return *member.get();
}

/// The same object for a caller that only looks: made if it isn't there, so that its address never changes, but not
/// marked present. Two threads may look at one object at a time.
template<class model_class>
const model_class& made_to_look_at(const child_pointer<model_class>& member,
                                   nil_setter<model_class> make_nil = nullptr) {
    // The pointer is the one thing that looking may change.
    const std::atomic_ref<void*> object(const_cast<void*&>(member.object));
    void* held = object.load(std::memory_order_acquire);
    if (held == nullptr) {
        auto fresh = missing_object(member, make_nil);
        if (object.compare_exchange_strong(held, fresh.get(), std::memory_order_acq_rel)) held = fresh.release();
    }
    return *static_cast<const model_class*>(held);
}

/// The value of an option; an empty one while another is chosen.
template<class value_type>
std::conditional_t<std::is_arithmetic_v<value_type>, value_type, const value_type&>
option_value(const choice_slot& slot, int index) {
    if constexpr (std::is_same_v<value_type, double>)
        return slot.chosen == index ? slot.real : 0.0;
    else if constexpr (std::is_same_v<value_type, int>)
        return slot.chosen == index ? slot.integer : 0;
    else if constexpr (std::is_same_v<value_type, unsigned int>)
        return slot.chosen == index ? slot.natural : 0u;
    else
        return object_or_empty(slot.chosen == index ? static_cast<const value_type*>(slot.object) : nullptr);
}

/// Chooses an option, then checks the value against its rules, then stores it. The value comes as a copy: it may lie in
/// the option that is given up.
template<class value_type>
lmx::elmx_error store_option(const class_rows& rows, void* object, choice_slot& slot, int index, value_type value) {
    choose_option(rows, object, index);
    const lmx::elmx_error error = check_value(value, rows.rows[index].rules);
    if (error != lmx::err_no_error) return error;
    if constexpr (std::is_same_v<value_type, double>)
        slot.real = value;
    else if constexpr (std::is_same_v<value_type, int>)
        slot.integer = value;
    else if constexpr (std::is_same_v<value_type, unsigned int>)
        slot.natural = value;
    else
        *static_cast<value_type*>(slot.object) = std::move(value);
    return lmx::err_no_error;
}

/// Makes member `index` of a group the chosen one, with a default object, unless it is already; gives the object.
void* choose_member(const class_rows& rows, void* group, int index);

template<class object_type>
const object_type& member_object(const object_slot& slot, int index) {
    return object_or_empty(slot.chosen == index ? static_cast<const object_type*>(slot.object) : nullptr);
}

/// The types that a class's factory can make.
struct factory_rows {
    int count;
    const class_rows* const* types;
};

/// A new object of the type with this local name in the format's namespace, null for any other.
void* make_by_name(const factory_rows& types, int namespace_id, const std::string& type_name);

/// Copies the parts of a wildcard entry; `ns` and `name` may be null.
void copy_any(const lmx::c_any_info& entry, std::string* ns, std::string* name, std::string* value);

} // namespace hqf::frame
