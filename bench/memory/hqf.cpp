#include "hqf/hqf.h"
#include "bench/memory/peers.h"

namespace hqf_bench {

bool load_hqf(const std::string& text, const std::function<void()>& while_loaded) {
    hqf_v2::Hqf document;
    if (document.unmarshal(text.data(), static_cast<unsigned int>(text.size())) != lmx::err_no_error) return false;
    while_loaded();
    return true;
}

} // namespace hqf_bench
