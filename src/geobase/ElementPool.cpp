#include "geobase/ElementPool.h"

#include <cstdlib>
#include <new>
#include <system_error>

#if defined(__SANITIZE_ADDRESS__)
#define PYR_ELEMENT_POOL 0
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define PYR_ELEMENT_POOL 0
#endif
#endif
#ifndef PYR_ELEMENT_POOL
#define PYR_ELEMENT_POOL 1
#endif

namespace pyr {

SlotAllocator::~SlotAllocator() {
    m_stopPreparing = true;
    FinishPreparing();
    for (void* block : m_blocks)
        std::free(block);
    for (void* block : m_prepared)
        std::free(block);
}

void SlotAllocator::Prepare(std::size_t bytes) {
    FinishPreparing();
    std::vector<void*> blocks;
    {
        std::lock_guard lock(m_mutex);
        const std::size_t have = static_cast<std::size_t>(m_end - m_next) + m_prepared.size() * kBlockBytes;
        if (bytes <= have) return;
        const std::size_t count = (bytes - have + kBlockBytes - 1) / kBlockBytes;
        for (std::size_t i = 0; i < count; ++i)
            blocks.push_back(AllocateHugePageBlock(kBlockBytes));
        // Taken from the back: the first block to fill is the last one.
        m_prepared.insert(m_prepared.begin(), blocks.rbegin(), blocks.rend());
    }
    m_stopPreparing = false;
    try {
        m_preparing =
            std::thread([this, blocks = std::move(blocks)]() mutable { PrepareBlocks(std::move(blocks)); });
    } catch (const std::system_error&) {
        // No second thread: the pages come as they are touched.
    }
}

void SlotAllocator::PrepareBlocks(std::vector<void*> blocks) {
    for (void* block : blocks) {
        if (m_stopPreparing) return;
        PopulateBlock(block, kBlockBytes);
    }
}

void SlotAllocator::FinishPreparing() {
    if (m_preparing.joinable()) m_preparing.join();
}

void* SlotAllocator::Allocate(std::size_t size) {
    if (size == 0 || size > kLargest) return ::operator new(size);
    const std::size_t slot = (size + kGrain - 1) / kGrain;
    std::lock_guard lock(m_mutex);
    if (FreeSlot* free = m_free[slot]) {
        m_free[slot] = free->next;
        return free;
    }
    const std::size_t bytes = slot * kGrain;
    if (static_cast<std::size_t>(m_end - m_next) < bytes) {
        void* block = nullptr;
        if (!m_prepared.empty()) {
            block = m_prepared.back();
            m_prepared.pop_back();
        } else {
            block = AllocateHugePageBlock(kBlockBytes);
        }
        // The few bytes left at the end of the previous block are given up.
        m_next = static_cast<char*>(block);
        m_end = m_next + kBlockBytes;
        m_blocks.push_back(block);
    }
    void* memory = m_next;
    m_next += bytes;
    return memory;
}

void SlotAllocator::Free(void* memory, std::size_t size) noexcept {
    if (!memory) return;
    if (size == 0 || size > kLargest) {
        ::operator delete(memory);
        return;
    }
    const std::size_t slot = (size + kGrain - 1) / kGrain;
    std::lock_guard lock(m_mutex);
    auto* free = static_cast<FreeSlot*>(memory);
    free->next = m_free[slot];
    m_free[slot] = free;
}

namespace {

SlotAllocator& Elements() {
    // Never destroyed: an element may be freed by a static object's destructor at exit.
    static SlotAllocator* slots = new SlotAllocator;
    return *slots;
}

} // namespace

void* ElementPool::Allocate(std::size_t size) {
    return PYR_ELEMENT_POOL ? Elements().Allocate(size) : ::operator new(size);
}

ElementPool::Preparation::Preparation(std::size_t bytes) {
    if (PYR_ELEMENT_POOL) Elements().Prepare(bytes);
}

ElementPool::Preparation::~Preparation() {
    if (PYR_ELEMENT_POOL) Elements().FinishPreparing();
}

void ElementPool::Free(void* memory, std::size_t size) noexcept {
    if (PYR_ELEMENT_POOL)
        Elements().Free(memory, size);
    else
        ::operator delete(memory);
}

} // namespace pyr
