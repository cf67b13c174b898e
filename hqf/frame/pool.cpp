#include "hqf/frame/pool.h"

#include <algorithm>
#include <atomic>
#include <mutex>

namespace hqf::frame {

namespace {

struct thread_pools;

struct block;

struct slot {
    /// Stands before each object: the block that it goes back to, null for one that lies in none.
    block* home;
    /// While the slot is free; else the object begins here.
    slot* next;

    void* object() { return &next; }
    static slot* of(void* object) { return reinterpret_cast<slot*>(static_cast<block**>(object) - 1); }
};

/// Slots of one size. All but `owner` is touched by the owner alone, or under the lock once the owner has ended.
struct block {
    thread_pools* const owner;
    const unsigned int granules; // of a slot
    unsigned int live = 0;
    bool has_room = true;
    slot* free = nullptr;
    char* unused; // slots that were never handed out
    char* const end;
    // Neighbours among the pool's blocks with room.
    block* next = nullptr;
    block* previous = nullptr;
};

constexpr std::size_t granule = 16;
constexpr std::size_t largest_object = 4096;
constexpr std::size_t sizes = (largest_object + sizeof(block*) + granule - 1) / granule + 1;
/// A small document should cost little, a large one few blocks: a block is half of what there is before it, so that no
/// more than a third lies idle behind the last object.
constexpr std::size_t first_block_size = 1024, largest_block_size = 65536, share = 2;
constexpr std::size_t least_slots = 4;

constexpr std::size_t granules_of(std::size_t object_size) {
    return (object_size + sizeof(block*) + granule - 1) / granule;
}

/// Slots of one size: the blocks that have room, and what all blocks take.
struct pool {
    block* with_room = nullptr;
    std::size_t size = 0;
};

/// The pools of a thread. Never freed: a thread that ends leaves them, with what lives in them, to the next that
/// starts.
struct thread_pools {
    pool by_granules[sizes];
    /// Slots that other threads gave back.
    std::atomic<slot*> returned = nullptr;
    /// The owner has ended: whoever holds the lock may act in its place.
    std::atomic<bool> left = false;
    thread_pools* next_left = nullptr;

    slot* take(std::size_t granules);
    void give_back(slot* freed);
    void collect();
    void give_back_from_elsewhere(slot* freed);
};

constinit std::mutex lock;
/// Pools without a thread, guarded by the lock.
constinit thread_pools* left_pools = nullptr;

// The library is loaded with the program or has room for these few bytes in the space kept for late comers; the usual
// model costs a call for each object.
[[gnu::tls_model("initial-exec")]] constinit thread_local thread_pools* own_pools = nullptr;
[[gnu::tls_model("initial-exec")]] constinit thread_local bool thread_ends = false;

void append(pool& to, block& added) {
    added.has_room = true;
    added.previous = nullptr;
    added.next = to.with_room;
    if (added.next != nullptr) added.next->previous = &added;
    to.with_room = &added;
}

void remove(pool& from, block& removed) {
    removed.has_room = false;
    (removed.previous != nullptr ? removed.previous->next : from.with_room) = removed.next;
    if (removed.next != nullptr) removed.next->previous = removed.previous;
}

slot* take_from(block& room) {
    slot* taken = room.free;
    if (taken != nullptr) {
        room.free = taken->next;
    } else if (room.unused != room.end) {
        taken = reinterpret_cast<slot*>(room.unused);
        taken->home = &room;
        room.unused += room.granules * granule;
    } else {
        return nullptr;
    }
    ++room.live;
    return taken;
}

void add_block(thread_pools* owner, pool& to, std::size_t granules) {
    // Behind the head, objects lie on 16 bytes, so slots begin 8 bytes before.
    constexpr std::size_t head = (sizeof(block) + granule - 1) / granule * granule + granule - sizeof(block*);
    const std::size_t wanted = std::clamp(to.size / share, first_block_size, largest_block_size);
    const std::size_t slots = std::max(least_slots, (wanted - head) / (granules * granule));
    const std::size_t size = head + slots * granules * granule;
    char* const place = static_cast<char*>(::operator new(size));
    append(to, *new (place) block{.owner = owner,
                                  .granules = static_cast<unsigned int>(granules),
                                  .unused = place + head,
                                  .end = place + size});
    to.size += size;
}

/// A slot where the first block with room has none.
slot* thread_pools::take(std::size_t granules) {
    pool& from = by_granules[granules];
    collect();
    for (;;) {
        if (from.with_room == nullptr) add_block(this, from, granules);
        if (slot* const taken = take_from(*from.with_room)) return taken;
        remove(from, *from.with_room);
    }
}

void thread_pools::give_back(slot* freed) {
    block& home = *freed->home;
    pool& to = by_granules[home.granules];
    freed->next = home.free;
    home.free = freed;
    if (!home.has_room) append(to, home);
    if (--home.live != 0) return;
    char* const place = reinterpret_cast<char*>(&home);
    const auto size = static_cast<std::size_t>(home.end - place);
    if (to.size == size && home.unused <= place + 2 * first_block_size) return;
    to.size -= size;
    remove(to, home);
    ::operator delete(&home);
}

void thread_pools::collect() {
    for (slot* freed = returned.exchange(nullptr); freed != nullptr;) {
        slot* const next = freed->next;
        give_back(freed);
        freed = next;
    }
}

void thread_pools::give_back_from_elsewhere(slot* freed) {
    freed->next = returned.load();
    while (!returned.compare_exchange_weak(freed->next, freed)) {
    }
    // Either the owner collects this slot when it ends, or it has ended by now and is seen to.
    if (!left.load()) return;
    const std::lock_guard guard(lock);
    if (left.load()) collect();
}

/// Leaves the thread's pools to others when it ends.
struct departure {
    ~departure() {
        thread_ends = true;
        if (own_pools == nullptr) return;
        const std::lock_guard guard(lock);
        own_pools->left.store(true);
        own_pools->collect();
        own_pools->next_left = left_pools;
        left_pools = own_pools;
        own_pools = nullptr;
    }
};

/// The pools of this thread, null where there can be none any more.
thread_pools* pools_of_this_thread() {
    if (own_pools != nullptr || thread_ends) return own_pools;
    const std::lock_guard guard(lock);
    if (left_pools == nullptr) {
        own_pools = new thread_pools;
    } else {
        own_pools = left_pools;
        left_pools = own_pools->next_left;
        own_pools->left.store(false);
    }
    static thread_local departure at_the_end;
    static_cast<void>(at_the_end);
    return own_pools;
}

[[gnu::noinline]] void* take_slowly(thread_pools& from, std::size_t granules) {
    return from.take(granules)->object();
}

/// The first object of a thread, and objects too large for a slot.
[[gnu::noinline]] void* allocate_slowly(std::size_t size) {
    thread_pools* const pools = pools_of_this_thread();
    if (pools != nullptr && size <= largest_object) return take_slowly(*pools, granules_of(size));
    slot* const alone = static_cast<slot*>(::operator new(size + granule));
    // As in a block, the object lies on 16 bytes, with the word about its home before it.
    void* const object = reinterpret_cast<char*>(alone) + granule;
    slot::of(object)->home = nullptr;
    return object;
}

} // namespace

void* pooled::operator new(std::size_t size) {
    if constexpr (!HQF_POOLS) return ::operator new(size);
    // Nothing but the slow ways needs registers kept.
    if (own_pools == nullptr || size > largest_object) return allocate_slowly(size);
    const std::size_t granules = granules_of(size);
    block* const room = own_pools->by_granules[granules].with_room;
    slot* const taken = room == nullptr ? nullptr : take_from(*room);
    return taken != nullptr ? taken->object() : take_slowly(*own_pools, granules);
}

void* pooled::operator new(std::size_t size, const std::nothrow_t&) noexcept {
    try {
        return operator new(size);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

void pooled::operator delete(void* object) noexcept {
    if constexpr (!HQF_POOLS) return ::operator delete(object);
    if (object == nullptr) return;
    slot* const freed = slot::of(object);
    if (freed->home == nullptr) return ::operator delete(static_cast<char*>(object) - granule);
    thread_pools* const owner = freed->home->owner;
    if (owner == own_pools)
        owner->give_back(freed);
    else
        owner->give_back_from_elsewhere(freed);
}

} // namespace hqf::frame
