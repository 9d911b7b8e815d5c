#include "core/LargeBlocks.h"

#include <cerrno>
#include <cstdlib>
#include <new>
#include <sys/mman.h>

namespace pyr {

void* AllocateHugePageBlock(std::size_t bytes) {
    const std::size_t rounded = (bytes + kHugePageBytes - 1) / kHugePageBytes * kHugePageBytes;
    void* block = std::aligned_alloc(kHugePageBytes, rounded);
    if (!block) throw std::bad_alloc();
#ifdef MADV_HUGEPAGE
    madvise(block, rounded, MADV_HUGEPAGE);
#endif
    return block;
}

void PopulateBlock(void* block, std::size_t bytes) {
#ifdef MADV_POPULATE_WRITE
    const int saved = errno;
    madvise(block, bytes, MADV_POPULATE_WRITE);
    errno = saved;
#else
    (void)block;
    (void)bytes;
#endif
}

namespace {

class HugePageResource final : public std::pmr::memory_resource {
    void* do_allocate(std::size_t bytes, std::size_t alignment) override {
        if (bytes >= kHugePageBytes && alignment <= kHugePageBytes) return AllocateHugePageBlock(bytes);
        return ::operator new(bytes, std::align_val_t(alignment));
    }
    void do_deallocate(void* memory, std::size_t bytes, std::size_t alignment) override {
        if (bytes >= kHugePageBytes && alignment <= kHugePageBytes)
            std::free(memory);
        else
            ::operator delete(memory, bytes, std::align_val_t(alignment));
    }
    bool do_is_equal(const std::pmr::memory_resource& other) const noexcept override {
        return this == &other;
    }
};

} // namespace

std::pmr::memory_resource* LargeBlocks() {
    // Without state: a container of a static object may still give its memory back after it at exit.
    static HugePageResource resource;
    return &resource;
}

} // namespace pyr
