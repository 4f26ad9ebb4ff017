// Memory of the run time for work arrays; std::free gives it back.
#pragma once

#include <cstddef>
#include <cstdlib>
#include <cstring>

#if defined(__linux__)
#include <sys/mman.h>
#endif

namespace krnumer {

enum class MemoryFill { kUninitialised, kZeroed };

// Null where there is none. Large blocks lie on huge pages where the system has them: work memory lives for one call,
// and a fault at every 4 KiB of it can take longer than the work.
inline void* AllocateMemory(std::size_t bytes, MemoryFill fill = MemoryFill::kUninitialised) {
    if (bytes == 0) bytes = 1;
    const bool zeroed = fill == MemoryFill::kZeroed;
#if defined(__linux__)
    constexpr std::size_t kHugePage = std::size_t{1} << 21;
    if (bytes >= kHugePage) {
        const std::size_t whole_pages = (bytes + kHugePage - 1) / kHugePage * kHugePage;
        void* const block = std::aligned_alloc(kHugePage, whole_pages);
        if (block == nullptr) return nullptr;
        madvise(block, whole_pages, MADV_HUGEPAGE);
        return zeroed ? std::memset(block, 0, bytes) : block;
    }
#endif
    return zeroed ? std::calloc(bytes, 1) : std::malloc(bytes);
}

}  // namespace krnumer
