/// Where model objects lie: a document is a few hundred thousand of them in some fifty sizes, made and destroyed
/// together, which a general allocator answers with as many searches and merges.
///
/// An object comes from a block of slots of its size and goes back to it; a block without objects is freed at once, but
/// for a size's first, small one. There is no arena for a document: objects move between documents and threads, and
/// each may be deleted alone.
///
/// Threads: a thread takes slots from blocks of its own and needs no lock. A slot freed by another thread waits in a
/// list until the owner asks for a new block, or is freed at once where the owner has ended.
///
/// The CMake option HQF_POOLS=OFF hands every object to the global operators: for tools that watch single allocations.
#pragma once

#include <cstddef>
#include <new>

#include "hqf/platform/api.h"

namespace hqf::frame {

/// The base of every model class: its objects come from the pools. Objects of derived classes too, up to 4 KB.
class HQF_API pooled {
public:
    /// \throws std::bad_alloc
    static void* operator new(std::size_t size);
    static void* operator new(std::size_t size, const std::nothrow_t&) noexcept;
    static void operator delete(void* object) noexcept;
    static void operator delete(void* object, const std::nothrow_t&) noexcept { operator delete(object); }

    // Into the caller's place, and with an alignment beyond the usual: nothing for a pool.
    static void* operator new(std::size_t, void* place) noexcept { return place; }
    static void operator delete(void*, void*) noexcept {}
    static void* operator new(std::size_t size, std::align_val_t alignment) { return ::operator new(size, alignment); }
    static void operator delete(void* object, std::align_val_t alignment) noexcept {
        ::operator delete(object, alignment);
    }
};

} // namespace hqf::frame
