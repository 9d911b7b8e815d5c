#include "geobase/ElementPool.h"

#include <cstdint>
#include <cstring>
#include <gtest/gtest.h>
#include <set>
#include <vector>

using namespace pyr;

TEST(SlotAllocator, SlotsAreAlignedApartAndReusedOnceFreed) {
    SlotAllocator slots;
    // Enough objects of the size of a sighting to fill more than one block.
    const std::size_t count = 2 * SlotAllocator::kBlockBytes / 144 + 10;
    std::vector<char*> taken;
    for (std::size_t i = 0; i < count; ++i) {
        auto* memory = static_cast<char*>(slots.Allocate(144));
        ASSERT_EQ(reinterpret_cast<std::uintptr_t>(memory) % 16, 0u);
        std::memset(memory, static_cast<int>(i & 0xFF), 144);
        taken.push_back(memory);
    }
    EXPECT_EQ(slots.BlockCount(), 3u);
    std::set<char*> distinct(taken.begin(), taken.end());
    EXPECT_EQ(distinct.size(), count);
    for (std::size_t i = 0; i < count; ++i) // no object overlaps the next one
        ASSERT_EQ(static_cast<unsigned char>(taken[i][143]), i & 0xFF);

    // A freed slot serves the next object of the same size class, not of another.
    slots.Free(taken[5], 144);
    EXPECT_NE(slots.Allocate(160), taken[5]);
    EXPECT_EQ(slots.Allocate(130), taken[5]); // 130 and 144 round to the same 16-byte class

    // Large objects and empty ones go to the ordinary allocator.
    void* large = slots.Allocate(4096);
    slots.Free(large, 4096);
    void* empty = slots.Allocate(0);
    slots.Free(empty, 0);
    slots.Free(nullptr, 144);
    EXPECT_EQ(slots.BlockCount(), 3u);
}

TEST(SlotAllocator, BlocksPreparedAheadServeTheNextObjectsAndNoneIsLost) {
    SlotAllocator slots;
    const std::size_t count = 3 * (SlotAllocator::kBlockBytes / 144); // three blocks, full
    slots.Prepare(count * 144);
    EXPECT_EQ(slots.BlockCount(), 0u); // taken ahead, in use only once needed
    std::vector<char*> taken;
    for (std::size_t i = 0; i < count; ++i) {
        auto* memory = static_cast<char*>(slots.Allocate(144));
        std::memset(memory, static_cast<int>(i & 0xFF), 144); // written while the pages are being provided
        taken.push_back(memory);
    }
    slots.FinishPreparing();
    EXPECT_EQ(slots.BlockCount(), 3u);
    for (std::size_t i = 0; i < count; ++i)
        ASSERT_EQ(static_cast<unsigned char>(taken[i][0]), i & 0xFF);
    // Asking again for what is already there takes nothing more.
    slots.Prepare(16);
    slots.FinishPreparing();
    slots.Allocate(144);
    EXPECT_EQ(slots.BlockCount(), 4u);
}
