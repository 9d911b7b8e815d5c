#pragma once

#include <cstddef>
#include <memory_resource>

// Memory for the large arrays of a whole job (a million results at once), taken in blocks of huge pages
// where the system offers them: first touched, a block of 2 MB costs one page fault instead of 512, and on
// a virtual machine each page fault costs microseconds.
namespace pyr {

inline constexpr std::size_t kHugePageBytes = std::size_t{2} << 20;

// A block of at least `bytes`, aligned on a huge page and rounded up to whole huge pages, which the system
// is asked to back with huge pages (a hint: without them the block still works). Freed with std::free.
void* AllocateHugePageBlock(std::size_t bytes);
// Has the system provide the pages of a block now, in one call rather than a fault at a time (a hint:
// where it cannot, the pages come as they are first touched).
void PopulateBlock(void* block, std::size_t bytes);

// That memory for the standard containers: requests of a huge page or more in blocks of their own, smaller
// ones from the ordinary allocator. Safe to share between threads.
std::pmr::memory_resource* LargeBlocks();

} // namespace pyr
