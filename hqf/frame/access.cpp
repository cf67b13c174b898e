#include "hqf/frame/access.h"

namespace hqf::frame {

void* choose_member(const class_rows& rows, void* group, int index) {
    auto& slot = member_at<object_slot>(group, rows.slot);
    if (slot.chosen == index && slot.object != nullptr) return slot.object;
    void* made = rows.members[index].type->create();
    void* old = slot.object;
    slot.object = made;
    slot.chosen = index;
    if (old != nullptr) rows.calls->destroy(old);
    return made;
}

void* make_by_name(const factory_rows& types, int namespace_id, const std::string& type_name) {
    if (namespace_id != format_namespace_id) return nullptr;
    for (int i = 0; i < types.count; ++i)
        if (type_name == types.types[i]->name) return types.types[i]->create();
    return nullptr;
}

void copy_any(const lmx::c_any_info& entry, std::string* ns, std::string* name, std::string* value) {
    if (ns != nullptr) *ns = entry.get_namespace();
    if (name != nullptr) *name = entry.get_name();
    *value = entry.get_value();
}

} // namespace hqf::frame
