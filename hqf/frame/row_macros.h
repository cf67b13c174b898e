/// The macros that the emitted rows are written with. Each takes kind and offsets from the member itself, by the type
/// `own` of the class that the rows belong to. For the emitted tables alone, which answer the compiler's warning about
/// offsets into classes with virtual operations.
#pragma once

#include <cstddef>
#include <type_traits>

#include "hqf/frame/rows.h"

namespace hqf::frame {

/// What kind a member is, read off its storage type, so that a row can't lie about it.
template<class storage>
struct storage_traits;

template<class value_type>
constexpr kind kind_of_value = std::is_same_v<value_type, std::wstring>      ? kind::text
                               : std::is_same_v<value_type, enumerated>      ? kind::enumerated
                               : std::is_same_v<value_type, double>          ? kind::real
                               : std::is_same_v<value_type, int>             ? kind::integer
                               : std::is_same_v<value_type, unsigned int>    ? kind::natural
                               : std::is_same_v<value_type, unsigned char>   ? kind::octet
                               : std::is_same_v<value_type, bool>            ? kind::boolean
                               : std::is_same_v<value_type, lmx::c_datetime> ? kind::moment
                                                                             : kind::binary;
template<class model_class>
concept substitution_group = requires {
    typename model_class::is_substitution_group;
};

template<class value_type>
struct storage_traits<mandatory<value_type>> {
    static constexpr kind what = kind_of_value<value_type>;
    static constexpr unsigned int value = offsetof(value_member<value_type>, value);
    static constexpr unsigned int flag = offsetof(value_member<value_type>, set);
};
template<class value_type>
struct storage_traits<optional<value_type>> : storage_traits<mandatory<value_type>> {};
template<class model_class>
struct storage_traits<child<model_class>> {
    static constexpr kind what = substitution_group<model_class> ? kind::group : kind::child;
    static constexpr unsigned int value = offsetof(child<model_class>, object);
    static constexpr unsigned int flag = offsetof(child<model_class>, present);
};
template<class model_class>
struct storage_traits<child_pointer<model_class>> {
    static constexpr kind what = substitution_group<model_class> ? kind::group_pointer : kind::child_pointer;
    static constexpr unsigned int value = offsetof(pointer_member, object);
    static constexpr unsigned int flag = offsetof(pointer_member, present);
};
template<class item_type>
struct storage_traits<list<item_type>> {
    static constexpr kind what = std::is_same_v<item_type, std::wstring>      ? kind::text_list
                                 : std::is_same_v<item_type, lmx::c_datetime> ? kind::moment_list
                                 : std::is_same_v<item_type, lmx::c_any_info> ? kind::any_list
                                 : substitution_group<item_type>              ? kind::group_list
                                                                              : kind::child_list;
    static constexpr unsigned int value = 0;
    static constexpr unsigned int flag = 0;
};

template<class root_class, bool has_head>
inline constexpr group_calls calls_of = {
    [](const void* object) -> void* { return static_cast<const root_class*>(object)->clone(); },
    [](void* object) { delete static_cast<root_class*>(object); },
    [](const void* object) { return static_cast<const root_class*>(object)->getid(); },
    [](void* object, lmx::c_xml_writer& writer, const char* name) {
        return static_cast<root_class*>(object)->marshal(writer, name);
    },
    has_head
    ? +[](int namespace_id, const std::string& name) -> void* { return root_class::factory(namespace_id, name); }
    : nullptr,
    [](void* object, lmx::c_xml_reader& reader, const std::string& name) {
        return static_cast<root_class*>(object)->unmarshal(reader, name);
    },
    &root_class::id,
};

} // namespace hqf::frame

#define HQF_STORED(member) storage_traits<decltype(own::member)>
#define HQF_MEMBER_ROW(member, row_flags, element, attribute, rules, type)                                             \
    row {                                                                                                              \
        HQF_STORED(member)::what, row_flags, offsetof(own, member) + HQF_STORED(member)::value,                        \
            offsetof(own, member) + HQF_STORED(member)::flag, element, attribute, rules, type                          \
    }

#define HQF_ATTRIBUTE(name, row_flags, rules)                                                                          \
    HQF_MEMBER_ROW(name##_, row_flags, nullptr, &model::attribute_##name, rules, nullptr)
#define HQF_ELEMENT(name, row_flags, rules, type)                                                                      \
    HQF_MEMBER_ROW(name##_, row_flags, &model::element_##name, nullptr, rules, type)
#define HQF_GROUP(name, row_flags, type) HQF_MEMBER_ROW(name##_, row_flags, nullptr, nullptr, nullptr, type)
#define HQF_WILDCARD(name, row_flags) HQF_MEMBER_ROW(name##_, row_flags, nullptr, nullptr, nullptr, nullptr)
#define HQF_BODY(row_flags, rules) HQF_MEMBER_ROW(body_, row_flags, nullptr, nullptr, rules, nullptr)
#define HQF_OPTION(name, what, rules, type)                                                                            \
    row {                                                                                                              \
        what, 0, offsetof(own, slot_), offsetof(own, slot_), &model::element_##name, nullptr, rules, type              \
    }
