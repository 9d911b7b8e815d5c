#pragma once

#include "core/LargeBlocks.h"

#include <atomic>
#include <cstddef>
#include <mutex>
#include <thread>
#include <vector>

namespace pyr {

// Small objects carved out of large blocks of memory, mapped with huge pages where the system offers
// them, and kept on a free list per size once freed. Objects larger than kLargest come from the
// ordinary allocator. The blocks stay with the process. Safe to share between threads.
class SlotAllocator {
public:
    static constexpr std::size_t kBlockBytes = kHugePageBytes;
    static constexpr std::size_t kGrain = 16; // sizes are rounded up to this
    static constexpr std::size_t kLargest = 512;

    SlotAllocator() = default;
    ~SlotAllocator(); // gives the blocks back: every object taken from them must be gone
    SlotAllocator(const SlotAllocator&) = delete;
    SlotAllocator& operator=(const SlotAllocator&) = delete;

    void* Allocate(std::size_t size);
    void Free(void* memory, std::size_t size) noexcept;
    std::size_t BlockCount() const { return m_blocks.size(); }

    // About `bytes` of objects are coming (a file being read): the blocks that they need are taken now,
    // and a second thread has the system provide their pages while the objects are made, instead of a
    // page fault at a time in the middle of the reading. Only a head start: objects are taken as before,
    // and a page not yet provided is provided when first touched. Returns at once.
    void Prepare(std::size_t bytes);
    // Waits for the pages asked by Prepare.
    void FinishPreparing();

private:
    struct FreeSlot {
        FreeSlot* next;
    };
    void PrepareBlocks(std::vector<void*> blocks);

    std::mutex m_mutex;
    FreeSlot* m_free[kLargest / kGrain + 1] = {};
    char* m_next = nullptr; // the untouched rest of the current block
    char* m_end = nullptr;
    std::vector<void*> m_blocks;
    std::vector<void*> m_prepared; // blocks taken ahead, the next one last
    std::thread m_preparing;
    std::atomic<bool> m_stopPreparing{false};
};

// Where the elements of the GéoBases live. A big job holds a million small elements: taking them from
// large blocks spares the allocator's bookkeeping and, above all, a page fault every few dozen elements
// when a job is first read. Under AddressSanitizer the ordinary allocator is used, so that every misuse
// of an element is still caught.
class ElementPool {
public:
    static void* Allocate(std::size_t size);
    static void Free(void* memory, std::size_t size) noexcept;
    // SlotAllocator::Prepare for elements, then FinishPreparing when the object goes: around a reading.
    class Preparation {
    public:
        explicit Preparation(std::size_t bytes);
        ~Preparation();
        Preparation(const Preparation&) = delete;
        Preparation& operator=(const Preparation&) = delete;
    };
};

} // namespace pyr
