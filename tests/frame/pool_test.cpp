/// Objects from the pools: where they lie, whose memory they are, and that all of it comes back, whichever thread
/// frees.

#include <atomic>
#include <cstdint>
#include <new>
#include <set>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "hqf/hqf.h"
#include "tests/support/memory.h"

namespace {

using hqf_v2::ColorType, support::bytes_in_use, support::counts_memory;

/// Classes of an application: larger than any of ours, larger than any slot, and with an alignment of its own.
struct large : ColorType {
    char more[1000];
};
struct huge : ColorType {
    char more[10000];
};
struct alignas(64) aligned : ColorType {
    int more = 7;
};

template<class object_type>
void expect_own_places(std::size_t alignment) {
    std::set<std::uintptr_t> begins;
    std::vector<ColorType*> objects;
    for (int i = 0; i < 300; ++i) {
        objects.push_back(new object_type);
        objects.back()->set_ColorName(L"a name that no string keeps in itself");
        begins.insert(reinterpret_cast<std::uintptr_t>(objects.back()));
        // Freed places are used again.
        if (i % 3 == 2) {
            begins.erase(reinterpret_cast<std::uintptr_t>(objects[objects.size() - 2]));
            delete objects[objects.size() - 2];
            objects.erase(objects.end() - 2);
        }
    }
    EXPECT_EQ(begins.size(), objects.size());
    std::uintptr_t end = 0;
    for (const std::uintptr_t begin : begins) {
        EXPECT_EQ(begin % alignment, 0u);
        EXPECT_GE(begin, end) << "two objects overlap";
        end = begin + sizeof(object_type);
    }
    for (ColorType* object : objects) {
        EXPECT_EQ(object->get_ColorName(), L"a name that no string keeps in itself");
        delete object;
    }
}

TEST(pool, objects_of_all_sizes_have_places_of_their_own) {
    expect_own_places<ColorType>(alignof(ColorType));
    expect_own_places<large>(alignof(large));
    expect_own_places<huge>(alignof(huge));
    expect_own_places<aligned>(64);
}

TEST(pool, every_form_of_new) {
    delete new (std::nothrow) ColorType;
    alignas(ColorType) char place[sizeof(ColorType)];
    auto* const placed = new (place) ColorType;
    EXPECT_EQ(static_cast<void*>(placed), place);
    placed->~ColorType();
    auto* const row = new ColorType[3];
    row[2].set_ColorName(L"last");
    delete[] row;
}

void fill(ColorType& color, int count) {
    for (int i = 0; i < count; ++i) {
        color.append_ChangeHistory(lmx::c_datetime("2024-01-01T00:00:00Z"));
        color.append_ColorSpace();
        color.back_ColorSpace().get_ColorSpaceCIELab().set_L(i % 100);
    }
}

/// Objects that outlive the thread that made them, that go to a thread that waits for more, and that are freed while
/// their maker goes on making.
TEST(pool, threads_free_what_others_made) {
    const auto round = [] {
        std::vector<ColorType*> made(40);
        std::vector<std::thread> makers;
        for (std::size_t maker = 0; maker < 4; ++maker)
            makers.emplace_back([&made, maker] {
                for (std::size_t i = 0; i < 10; ++i)
                    fill(*(made[maker * 10 + i] = new ColorType), 20);
            });
        for (std::thread& maker : makers)
            maker.join();
        std::atomic<ColorType*> handed_over = nullptr;
        std::atomic<bool> is_over = false;
        std::thread consumer([&] {
            while (!is_over || handed_over != nullptr)
                delete handed_over.exchange(nullptr);
        });
        for (ColorType* color : made) {
            EXPECT_EQ(color->size_ColorSpace(), 20u);
            auto* const copy = new ColorType(*color);
            delete handed_over.exchange(copy);
            delete color;
        }
        is_over = true;
        consumer.join();
    };
    round();
    const std::int64_t before = bytes_in_use;
    for (int i = 0; i < 20; ++i)
        round();
    // What is kept: a small block for each size, for each thread that was there at a time.
    if (counts_memory()) {
        EXPECT_LT(bytes_in_use - before, 6 * 32 * 1024);
    }
}

TEST(pool, memory_comes_back_at_once) {
    ColorType* const kept = new ColorType;
    fill(*kept, 1);
    const std::int64_t before = bytes_in_use;
    auto* const color = new ColorType;
    fill(*color, 20000);
    if (counts_memory()) {
        EXPECT_GT(bytes_in_use - before, 20000 * 100);
    }
    delete color;
    if (counts_memory()) {
        EXPECT_LT(bytes_in_use - before, 32 * 1024);
    }
    delete kept;
}

} // namespace
