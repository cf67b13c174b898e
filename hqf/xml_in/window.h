#pragma once

#include "hqf/xml_in/byte_run.h"
#include "hqf/xml_in/byte_scan.h"

#include <cstddef>
#include <cstdint>

namespace lmx {
class c_get_as_utf8;
}

namespace hqf {

struct block_run;

/// A look at the bytes ahead that need nothing special, so that names and values can be found in them with wide steps.
///
/// The general path delivers one character at a time and is the truth. A window opens on a document in UTF-8 that lies
/// in memory, or in a file that this library opened, wherever the general path stands between two characters; reading
/// on through the general path closes it, and both go on from the same byte with the same line number.
///
/// A window reports nothing and decides nothing. Its looks ahead take a place and give the place behind what they
/// found, or null; a step moves the window's position when it has read all that it wanted, and one that has not leaves
/// it where it was, for the general path to read the same bytes. So the place travels in a register from look to look.
/// Only `begin_step` moves bytes in memory: places last until its next call.
class window {
public:
    explicit window(lmx::c_get_as_utf8& owner)
        : owner_(owner) {}
    window(const window&) = delete;
    window& operator=(const window&) = delete;

    /// The next byte, where the last step ended. May be moved forward within `edge()`; at least 64 bytes from any place
    /// up to there can be loaded.
    const char* p = nullptr;

    /// The window is open, and a fair run of bytes lies ahead.
    bool is_ready() const { return p < last_start_; }
    /// Sees to that if need be. False: take a general step.
    bool begin_step() { return is_ready() || open(); }
    bool is_open() const { return last_start_ != nullptr; }
    /// Hands position, line and last character back to the general path.
    void close();

    /// Up to here bytes are proven: UTF-8 that the general path would deliver unchanged, without U+0085 and U+2028,
    /// without control characters but 9 to 13. A CR may be there: as white space it is harmless, in a value it is not.
    const char* edge() const { return edge_; }
    /// Whether `n` bytes from `at` are proven; tries to prove more if not.
    bool room(const char* at, std::size_t n) { return static_cast<std::size_t>(edge_ - at) >= n || prove(at, n); }
    /// Over white space, as far as bytes can be proven.
    const char* skip_space(const char* at) {
        do {
            at = hqf::skip_space(at, edge_);
        } while (at == edge_ && prove_more());
        return at;
    }
    /// Where the first `stop` stands. Null if a '&' or a CR comes first, or bytes that can't be proven. Line feeds and
    /// tabs may come before.
    const char* find(const char* at, char stop) {
        do {
            at = find_text_end(at, edge_, stop);
        } while (at == edge_ && prove_more());
        return at != edge_ && *at == stop ? at : nullptr;
    }

    /// The line at `p`, or where the general path stands behind a closed window. Each byte is looked at once for that:
    /// while it is in the cache, or not before someone asks if the source outlives the reader.
    int line();

private:
    bool open();
    bool find_run();
    bool settle_ungot();
    bool prove(const char* at, std::size_t n);
    bool prove_more();
    unsigned char byte_before(const char* place) const;
    void count_up_to(const char* place);

    lmx::c_get_as_utf8& owner_;
    const char* end_ = nullptr;
    const char* edge_ = nullptr;
    const char* opened_at_ = nullptr;
    unsigned char before_opened_ = 0;
    const char* counted_ = nullptr;
    // Before this place a fair run lies ahead; null while the window is closed.
    const char* last_start_ = nullptr;
    // Where the source keeps its position, and where its block in memory starts.
    byte_run* run_ = nullptr;
    const char* block_start_ = nullptr;
    block_run* blocks_ = nullptr;
    // What the source had delivered when `edge_` was found: another figure means other bytes in the same memory.
    std::uint64_t edge_generation_ = 0;
};

} // namespace hqf
