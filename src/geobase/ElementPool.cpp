#include "geobase/ElementPool.h"

#include <cstdlib>
#include <new>

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
    for (void* block : m_blocks)
        std::free(block);
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
        void* block = AllocateHugePageBlock(kBlockBytes);
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

void ElementPool::Free(void* memory, std::size_t size) noexcept {
    if (PYR_ELEMENT_POOL)
        Elements().Free(memory, size);
    else
        ::operator delete(memory);
}

} // namespace pyr
