#include "hqf/xml_in/window.h"

#include "hqf/xml_in/block_run.h"
#include "hqf/xml_in/byte_scan.h"
#include "hqf/xml_in/c_get_as_utf8.h"
#include "hqf/xml_in/c_read_memory.h"

#include <algorithm>
#include <limits>

namespace hqf {
namespace {

// Bytes that stay between the edge and the end of the memory, so that wide loads near the edge are safe: 64 for them,
// and what a character that crosses the end of a proof may take.
constexpr std::ptrdiff_t margin = 64 + 4;
// At the end of a document fewer bytes than this aren't worth a window.
constexpr std::ptrdiff_t least_run = 256;
// Bytes proven at a time.
constexpr std::ptrdiff_t chunk = 16 * 1024;
// A source of blocks is read on when fewer bytes than this lie ahead, in blocks of the larger size. Values that don't
// fit are left to the general path.
constexpr std::ptrdiff_t fair_run = 64 * 1024;
constexpr std::size_t large_block = 256 * 1024;

} // namespace

// Finds where the source keeps its position; false for a source that is never read ahead.
bool window::find_run() {
    switch (owner_.source_) {
    case lmx::c_get_as_utf8::memory_source: {
        auto& memory = static_cast<lmx::c_read_memory&>(owner_.input_);
        run_ = &memory.run_;
        block_start_ = memory.start_;
        return true;
    }
    case lmx::c_get_as_utf8::block_source:
        blocks_ = owner_.blocks_;
        run_ = &blocks_->run;
        block_start_ = blocks_->start;
        return blocks_->may_read_ahead;
    default: return false;
    }
}

// Characters that were given back are taken from the bytes again, if they are the ones that stand there. A line end is
// not: it has been counted already. Nor is a byte above ASCII: it may be the end of a character.
bool window::settle_ungot() {
    lmx::c_unget_buffer& ungot = owner_.ungot_;
    if (ungot.empty()) {
        // The general path would drop the LF of a CR LF that it has read half of.
        if (owner_.last_character_ == '\r' && !run_->empty() && *run_->cursor == '\n') {
            ++run_->cursor;
            owner_.last_character_ = '\n';
        }
        return true;
    }
    if (run_->cursor - block_start_ < ungot.size()) return false;
    for (int i = 0; i < ungot.size(); ++i) {
        const int c = static_cast<unsigned char>(run_->cursor[-1 - i]);
        if (c != ungot.at(i) || c == '\n' || c == '\r' || c > 127) return false;
    }
    run_->cursor -= ungot.size();
    ungot.clear();
    owner_.last_character_ = 0;
    return true;
}

bool window::open() {
    if (is_open()) close();
    if (owner_.errors_.is_fatal_errored() || owner_.state_ != lmx::c_get_as_utf8::utf8 ||
        owner_.sequence_cursor_ != nullptr || !find_run() || run_->end == nullptr || !settle_ungot())
        return false;
    const bool is_all = blocks_ == nullptr || blocks_->is_at_end;
    if (is_all && run_->end - run_->cursor < least_run) return false;
    count_up_to(p);
    const std::uint64_t generation = blocks_ == nullptr ? 0 : blocks_->delivered;
    const bool is_edge_good = generation == edge_generation_ && edge_ >= run_->cursor && edge_ <= run_->end;
    const std::ptrdiff_t proven = is_edge_good ? edge_ - run_->cursor : 0;
    if (blocks_ != nullptr) {
        blocks_->read_ahead(fair_run, large_block);
        edge_generation_ = blocks_->delivered;
    }
    p = opened_at_ = counted_ = run_->cursor;
    before_opened_ = owner_.last_character_;
    end_ = run_->end;
    const bool may_have_more = blocks_ != nullptr && !blocks_->is_at_end;
    last_start_ = !may_have_more ? end_ : end_ - p > fair_run ? end_ - fair_run : p;
    edge_ = p + proven;
    owner_.run_ = &owner_.nothing_;
    return true;
}

void window::close() {
    if (blocks_ != nullptr || !owner_.is_source_lasting_) count_up_to(p);
    owner_.last_character_ = byte_before(p);
    run_->cursor = p;
    owner_.run_ = run_;
    last_start_ = nullptr;
}

bool window::prove_more() {
    if (end_ - edge_ <= margin) return false;
    // While what was read still lies in the cache.
    if (!owner_.is_source_lasting_) count_up_to(p);
    const char* const stop = edge_ + std::min(chunk, end_ - edge_ - margin);
    const char* const proven = find_not_plain(edge_, stop);
    if (proven == edge_) return false;
    edge_ = proven;
    return true;
}

bool window::prove(const char* at, std::size_t n) {
    while (static_cast<std::size_t>(edge_ - at) < n)
        if (!prove_more()) return false;
    return true;
}

// The last character that the general path would have delivered before a place.
unsigned char window::byte_before(const char* place) const {
    return place == opened_at_ ? before_opened_ : static_cast<unsigned char>(place[-1]);
}

void window::count_up_to(const char* place) {
    // What has been counted may be gone.
    if (place == counted_) return;
    const long long lines = owner_.line_ + count_line_ends(counted_, place, byte_before(counted_));
    owner_.line_ = static_cast<int>(std::min<long long>(lines, std::numeric_limits<int>::max()));
    counted_ = place;
}

int window::line() {
    count_up_to(p);
    return owner_.line_;
}

} // namespace hqf
