// Memory of the run time for work arrays; std::free gives it back.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>

#if defined(__linux__)
#include <sys/mman.h>
#include <unistd.h>
#endif

namespace krnumer {

enum class MemoryFill { kUninitialised, kZeroed };

// Asks for huge pages under a large block, where the system has them: work memory lives for one call, and a fault at
// every 4 KiB of it can take longer than the work. What the run time holds in reserve needs no pages at all, so the
// block stays where the run time put it.
inline void AdviseHugePages([[maybe_unused]] void* block, [[maybe_unused]] std::size_t bytes) {
#if defined(__linux__)
    constexpr std::size_t kHugePage = std::size_t{1} << 21;
    if (bytes < kHugePage) return;
    const auto offset = reinterpret_cast<std::uintptr_t>(block) % static_cast<std::uintptr_t>(sysconf(_SC_PAGESIZE));
    madvise(static_cast<char*>(block) - offset, bytes + offset, MADV_HUGEPAGE);
#endif
}

// Null where there is none.
inline void* AllocateMemory(std::size_t bytes, MemoryFill fill = MemoryFill::kUninitialised) {
    if (bytes == 0) bytes = 1;
    void* const block = fill == MemoryFill::kZeroed ? std::calloc(bytes, 1) : std::malloc(bytes);
    if (block != nullptr) AdviseHugePages(block, bytes);
    return block;
}

}  // namespace krnumer
