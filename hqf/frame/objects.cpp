#include "hqf/frame/objects.h"

#include <cmath>
#include <cstring>
#include <memory>

#include "hqf/frame/presence.h"

namespace hqf::frame {

namespace {

bool same(double a, double b) {
    return std::isnan(a) ? std::isnan(b) : a == b && std::signbit(a) == std::signbit(b);
}
bool same(const lmx::c_datetime& a, const lmx::c_datetime& b) {
    return a == b && a.get_is_utc() == b.get_is_utc() && a.get_total_offset_mins() == b.get_total_offset_mins();
}
bool same(const lmx::c_any_info& a, const lmx::c_any_info& b) {
    return a.get_namespace() == b.get_namespace() && a.get_name() == b.get_name() && a.get_value() == b.get_value();
}
template<class value_type>
bool same(const value_type& a, const value_type& b) {
    return a == b;
}

/// Calls `act` with a null pointer of the value type behind a kind; false for the kinds that hold objects.
template<class action>
bool with_value_type(kind what, action&& act) {
    switch (what) {
    case kind::text: act(static_cast<std::wstring*>(nullptr)); return true;
    case kind::enumerated: act(static_cast<enumerated*>(nullptr)); return true;
    case kind::real: act(static_cast<double*>(nullptr)); return true;
    case kind::integer: act(static_cast<int*>(nullptr)); return true;
    case kind::natural: act(static_cast<unsigned int*>(nullptr)); return true;
    case kind::octet: act(static_cast<unsigned char*>(nullptr)); return true;
    case kind::boolean: act(static_cast<bool*>(nullptr)); return true;
    case kind::moment: act(static_cast<lmx::c_datetime*>(nullptr)); return true;
    case kind::binary: act(static_cast<lmx::c_binary*>(nullptr)); return true;
    default: return false;
    }
}

/// Objects of a list or behind a pointer: how to make, copy and compare one without knowing its class.
void* clone_item(const row& r, const void* item) {
    switch (r.what) {
    case kind::text_list: return clone_object<std::wstring>(item);
    case kind::moment_list: return clone_object<lmx::c_datetime>(item);
    case kind::any_list: return clone_object<lmx::c_any_info>(item);
    default: return r.type->clone(item);
    }
}

bool equal_items(const row& r, const void* a, const void* b) {
    switch (r.what) {
    case kind::text_list: return *static_cast<const std::wstring*>(a) == *static_cast<const std::wstring*>(b);
    case kind::moment_list:
        return same(*static_cast<const lmx::c_datetime*>(a), *static_cast<const lmx::c_datetime*>(b));
    case kind::any_list: return same(*static_cast<const lmx::c_any_info*>(a), *static_cast<const lmx::c_any_info*>(b));
    default: return equal_members(*r.type, a, b);
    }
}

bool& flag_of(const row& r, void* object) {
    return member_at<bool>(object, r.flag);
}
bool flag_of(const row& r, const void* object) {
    return member_at<bool>(object, r.flag);
}

bool is_nil(const row& r, const pointer_member& member) {
    return member.object == nullptr ? member.nil : r.type->is_nil(member.object);
}

/// What stands for a mandatory child that isn't there: in a copy its mandatory members count as set, like all others.
void* copy_of_new(const class_rows& type) {
    const std::unique_ptr<void, void (*)(void*)> fresh(type.create(), type.destroy);
    return type.clone(fresh.get());
}

void copy_list(const row& r, void* to, const void* from) {
    auto& target = member_at<list_base>(to, r.value);
    const auto& source = member_at<list_base>(from, r.value);
    for (unsigned int i = 0; i < source.size(); ++i) {
        target.make_room();
        target.append(clone_item(r, source.item(i)));
    }
}

void copy_row(const row& r, void* to, const void* from) {
    if (r.is_list()) return copy_list(r, to, from);
    const bool is_value = with_value_type(r.what, [&]<class value_type>(value_type*) {
        member_at<value_type>(to, r.value) = member_at<value_type>(from, r.value);
    });
    if (r.is_pointer()) {
        const auto& source = member_at<pointer_member>(from, r.value);
        void* copy = nullptr;
        if (source.object != nullptr)
            copy = r.type->clone(source.object);
        else if (r.has(mandatory_row) && !source.nil)
            copy = copy_of_new(*r.type);
        // A new document has its stamp already.
        auto& target = member_at<pointer_member>(to, r.value);
        if (target.object != nullptr) r.type->destroy(target.object);
        target.object = copy;
        target.nil = source.nil;
    } else if (!is_value) {
        copy_members(*r.type, &member_at<char>(to, r.value), &member_at<char>(from, r.value));
    }
    flag_of(r, to) = r.has(mandatory_row) || flag_of(r, from);
}

void swap_row(const row& r, void* a, void* b) noexcept {
    if (r.is_list()) return member_at<list_base>(a, r.value).swap(member_at<list_base>(b, r.value));
    const bool is_value = with_value_type(r.what, [&]<class value_type>(value_type*) {
        using std::swap;
        swap(member_at<value_type>(a, r.value), member_at<value_type>(b, r.value));
    });
    if (r.is_pointer()) {
        auto& left = member_at<pointer_member>(a, r.value);
        auto& right = member_at<pointer_member>(b, r.value);
        std::swap(left.object, right.object);
        std::swap(left.nil, right.nil);
    } else if (!is_value)
        swap_members(*r.type, &member_at<char>(a, r.value), &member_at<char>(b, r.value));
    std::swap(flag_of(r, a), flag_of(r, b));
}

bool equal_rows(const row& r, const void* a, const void* b) {
    if (r.is_list()) {
        const auto& left = member_at<list_base>(a, r.value);
        const auto& right = member_at<list_base>(b, r.value);
        if (left.size() != right.size()) return false;
        for (unsigned int i = 0; i < left.size(); ++i)
            if (!equal_items(r, left.item(i), right.item(i))) return false;
        return true;
    }
    if (flag_of(r, a) != flag_of(r, b)) return false;
    // What is absent in both is the same, whatever the storage still holds.
    if (!flag_of(r, a)) return true;
    bool equal = true;
    const bool is_value = with_value_type(r.what, [&]<class value_type>(value_type*) {
        equal = same(member_at<value_type>(a, r.value), member_at<value_type>(b, r.value));
    });
    if (is_value) return equal;
    if (!r.is_pointer()) return equal_members(*r.type, &member_at<char>(a, r.value), &member_at<char>(b, r.value));
    const auto& left = member_at<pointer_member>(a, r.value);
    const auto& right = member_at<pointer_member>(b, r.value);
    if (is_nil(r, left) || is_nil(r, right)) return is_nil(r, left) == is_nil(r, right);
    if (left.object == nullptr || right.object == nullptr) return left.object == right.object;
    return equal_members(*r.type, left.object, right.object);
}

choice_slot& choice_of(const class_rows& rows, void* object) {
    return member_at<choice_slot>(object, rows.slot);
}
const choice_slot& choice_of(const class_rows& rows, const void* object) {
    return member_at<choice_slot>(object, rows.slot);
}

void copy_choice(const class_rows& rows, void* to, const void* from) {
    const choice_slot& source = choice_of(rows, from);
    if (source.chosen == rows.none()) return;
    const row& option = rows.rows[source.chosen];
    choice_slot& target = choice_of(rows, to);
    if (option.what == kind::text)
        target.object = clone_object<std::wstring>(source.object);
    else if (option.what == kind::child)
        target.object = option.type->clone(source.object);
    else
        std::memcpy(&target.real, &source.real, sizeof(target.real));
    target.chosen = source.chosen;
}

bool equal_choices(const class_rows& rows, const void* a, const void* b) {
    const choice_slot& left = choice_of(rows, a);
    const choice_slot& right = choice_of(rows, b);
    if (left.chosen != right.chosen) return false;
    if (left.chosen == rows.none()) return true;
    const row& option = rows.rows[left.chosen];
    switch (option.what) {
    case kind::text:
        return *static_cast<const std::wstring*>(left.object) == *static_cast<const std::wstring*>(right.object);
    case kind::real: return same(left.real, right.real);
    case kind::integer: return left.integer == right.integer;
    case kind::natural: return left.natural == right.natural;
    default: return equal_members(*option.type, left.object, right.object);
    }
}

void swap_slots(const class_rows& rows, void* a, void* b) noexcept {
    if (rows.shape == form::group) {
        auto& left = member_at<object_slot>(a, rows.slot);
        auto& right = member_at<object_slot>(b, rows.slot);
        std::swap(left.chosen, right.chosen);
        std::swap(left.object, right.object);
        return;
    }
    // The options share eight bytes, whichever is chosen.
    auto& left = choice_of(rows, a);
    auto& right = choice_of(rows, b);
    unsigned char bytes[sizeof(left.real)];
    std::memcpy(bytes, &left.real, sizeof(bytes));
    std::memcpy(&left.real, &right.real, sizeof(bytes));
    std::memcpy(&right.real, bytes, sizeof(bytes));
    std::swap(left.chosen, right.chosen);
}

bool equal_groups(const class_rows& rows, const void* a, const void* b) {
    const auto& left = member_at<object_slot>(a, rows.slot);
    const auto& right = member_at<object_slot>(b, rows.slot);
    if (left.chosen != right.chosen) return false;
    if (left.object == nullptr || right.object == nullptr) return left.object == right.object;
    const char* id = rows.calls->id(left.object);
    if (id != rows.calls->id(right.object)) return false;
    // The head of a group may hold an object of any member's class: its identity finds the rows.
    for (int i = 0; i < rows.member_count; ++i)
        if (*rows.members[i].type->id == id) return equal_members(*rows.members[i].type, left.object, right.object);
    return equal_members(*rows.members[left.chosen].type, left.object, right.object);
}

} // namespace

void copy_members(const class_rows& rows, void* to, const void* from) {
    if (rows.is_nil(from)) {
        member_at<bool>(to, rows.nil) = true;
        return;
    }
    for (unsigned int i = 0; i < rows.attribute_count; ++i)
        copy_row(rows.attributes[i], to, from);
    if (rows.shape == form::choice) return copy_choice(rows, to, from);
    if (rows.shape == form::group) {
        const auto& source = member_at<object_slot>(from, rows.slot);
        auto& target = member_at<object_slot>(to, rows.slot);
        if (source.object != nullptr) target.object = rows.calls->clone(source.object);
        target.chosen = source.chosen;
        return;
    }
    for (unsigned int i = 0; i < rows.row_count; ++i)
        copy_row(rows.rows[i], to, from);
}

void swap_members(const class_rows& rows, void* a, void* b) noexcept {
    if (rows.nil != 0) std::swap(member_at<bool>(a, rows.nil), member_at<bool>(b, rows.nil));
    for (unsigned int i = 0; i < rows.attribute_count; ++i)
        swap_row(rows.attributes[i], a, b);
    if (rows.slot != 0) {
        return swap_slots(rows, a, b);
    }
    for (unsigned int i = 0; i < rows.row_count; ++i)
        swap_row(rows.rows[i], a, b);
}

bool equal_members(const class_rows& rows, const void* a, const void* b) {
    if (rows.is_nil(a) || rows.is_nil(b)) return rows.is_nil(a) == rows.is_nil(b);
    for (unsigned int i = 0; i < rows.attribute_count; ++i)
        if (!equal_rows(rows.attributes[i], a, b)) return false;
    if (rows.shape == form::choice) return equal_choices(rows, a, b);
    if (rows.shape == form::group) return equal_groups(rows, a, b);
    for (unsigned int i = 0; i < rows.row_count; ++i)
        if (!equal_rows(rows.rows[i], a, b)) return false;
    return true;
}

bool is_occurs_ok(const class_rows& rows, const void* object) {
    return has_mandatory_members(rows, object);
}

void release_choice(const class_rows& rows, void* object) {
    choice_slot& slot = choice_of(rows, object);
    if (slot.chosen == rows.none()) return;
    const row& option = rows.rows[slot.chosen];
    slot.chosen = rows.none();
    if (option.what == kind::text)
        destroy_object<std::wstring>(slot.object);
    else if (option.what == kind::child)
        option.type->destroy(slot.object);
    slot.object = nullptr;
}

void choose_option(const class_rows& rows, void* object, int index) {
    if (choice_of(rows, object).chosen != index) choose_new_option(rows, object, index);
}

void choose_new_option(const class_rows& rows, void* object, int index) {
    choice_slot& slot = choice_of(rows, object);
    release_choice(rows, object);
    const row& option = rows.rows[index];
    if (option.what == kind::text)
        slot.object = create_object<std::wstring>();
    else if (option.what == kind::child)
        slot.object = option.type->create();
    slot.chosen = index;
}

} // namespace hqf::frame
