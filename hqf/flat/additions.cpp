#include "hqf/flat/additions.h"

#include <algorithm>
#include <stdexcept>

namespace hqf::flat {

namespace {

struct any_entry {
    any_entry(const hqf_v2::Revision& revision, unsigned int index) {
        if (index >= revision.size_any()) throw std::out_of_range("index of a wildcard entry");
        revision.get_any(index, &ns, &name, &value);
    }

    std::string ns, name, value;
};

} // namespace

std::string any_namespace(const hqf_v2::Revision& revision, unsigned int index) {
    return any_entry(revision, index).ns;
}

std::string any_name(const hqf_v2::Revision& revision, unsigned int index) {
    return any_entry(revision, index).name;
}

std::string any_value(const hqf_v2::Revision& revision, unsigned int index) {
    return any_entry(revision, index).value;
}

unsigned int copy_bytes(const lmx::c_binary& from, unsigned char* buffer, unsigned int size) {
    const unsigned int count = std::min(size, from.size());
    if (count > 0) from.get(buffer, count);
    return count;
}

} // namespace hqf::flat
