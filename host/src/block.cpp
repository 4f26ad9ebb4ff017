#include "block.h"

#include <algorithm>
#include <atomic>
#include <cstdlib>
#include <cstring>
#include <new>
#include <utility>

#if defined(_WIN32)
#include <malloc.h>
#endif

#include "settings.h"

#if defined(KRNUMER_ASAN)
#include <sanitizer/asan_interface.h>
#else
#define ASAN_POISON_MEMORY_REGION(address, size) ((void)(address), (void)(size))
#define ASAN_UNPOISON_MEMORY_REGION(address, size) ((void)(address), (void)(size))
#endif

namespace krrt {
namespace {

constexpr std::size_t kBoundary = 64;

// A block keeps its memory while this much of it, and what twice its size leaves free, goes unused.
constexpr std::size_t kSlack = 4096;

std::atomic<int64_t> live_blocks{0};
std::atomic<int64_t> stale_writes{0};

// Offset of the block in its memory that puts its elements at a 64-byte boundary, or at an odd multiple of 4.
std::size_t Offset(std::size_t word_bytes) {
    if (ThreadSettings().least_alignment) return (word_bytes + 4) % 8;
    return (kBoundary - word_bytes) % kBoundary;
}

bool ExceedsLimit(std::size_t bytes) {
    const uint64_t limit = ThreadSettings().block_limit;
    return limit != 0 && bytes > limit;
}

// Lets the address sanitizer see the memory as it is meant: the block, and no man's land around it.
void Fence(const Block& block) {
    ASAN_POISON_MEMORY_REGION(block.memory.base, block.memory.bytes);
    ASAN_UNPOISON_MEMORY_REGION(block.start, block.bytes);
}

void Unfence(const Memory& memory) {
    ASAN_UNPOISON_MEMORY_REGION(memory.base, memory.bytes);
}

void Place(Block& block, Memory memory, std::size_t offset, std::size_t bytes) {
    block.memory = memory;
    block.start = reinterpret_cast<KrBlock*>(memory.base + offset);
    block.bytes = bytes;
    Fence(block);
}

void Abandon(Block& block, Memory memory) {
    Unfence(memory);
    std::memset(memory.base, KRRT_STALE_BYTE, memory.bytes);
    ASAN_POISON_MEMORY_REGION(memory.base, memory.bytes);
    block.abandoned = memory;
}

void FreeAbandoned(Block& block) {
    const Memory memory = std::exchange(block.abandoned, Memory{});
    if (memory.base == nullptr) return;
    Unfence(memory);
    const bool untouched = std::all_of(memory.base, memory.base + memory.bytes,
                                       [](std::byte byte) { return byte == std::byte{KRRT_STALE_BYTE}; });
    if (!untouched) ++stale_writes;
    Memory(memory).Free();
}

}  // namespace

Memory Memory::Allocate(std::size_t bytes) {
    if (bytes > PTRDIFF_MAX) return {};
    bytes = std::max<std::size_t>(bytes, 1);
    void* base = nullptr;
#if defined(_WIN32)
    base = _aligned_malloc(bytes, kBoundary);
#else
    if (posix_memalign(&base, kBoundary, bytes) != 0) base = nullptr;
#endif
    return base != nullptr ? Memory{static_cast<std::byte*>(base), bytes} : Memory{};
}

void Memory::Free() {
#if defined(_WIN32)
    _aligned_free(base);
#else
    std::free(base);
#endif
    *this = {};
}

Block* NewBlock(int32_t rank, std::size_t bytes) {
    if (ExceedsLimit(bytes)) return nullptr;
    Memory header = Memory::Allocate(sizeof(Block));
    if (header.base == nullptr) return nullptr;
    Block* block = new (header.base) Block{.start = nullptr, .memory = {}, .bytes = 0, .rank = rank, .abandoned = {}};
    const std::size_t offset = Offset(block->WordBytes());
    const Memory memory = Memory::Allocate(offset + bytes);
    if (memory.base == nullptr) {
        header.Free();
        return nullptr;
    }
    Place(*block, memory, offset, bytes);
    if (ThreadSettings().moving_blocks) std::memset(block->start, KRRT_FRESH_BYTE, bytes);
    ++live_blocks;
    return block;
}

bool ResizeBlock(Block& block, std::size_t bytes) {
    const bool moving = ThreadSettings().moving_blocks;
    const std::size_t offset = Offset(block.WordBytes());
    const std::size_t held = block.memory.bytes - static_cast<std::size_t>(block.Start() - block.memory.base);
    const bool well_placed = block.Start() == block.memory.base + offset;
    if (!moving && well_placed && bytes <= held && held <= 2 * bytes + kSlack) {
        block.bytes = bytes;
        Fence(block);
        return true;
    }

    const bool refused = bytes > block.bytes && ExceedsLimit(bytes);
    const Memory memory = refused ? Memory{} : Memory::Allocate(offset + bytes);
    if (memory.base == nullptr) {
        if (bytes > block.bytes) return false;
        block.bytes = bytes;
        Fence(block);
        return true;
    }

    const std::size_t kept = std::min(bytes, block.bytes);
    std::memcpy(memory.base + offset, block.start, kept);
    if (moving) std::memset(memory.base + offset + kept, KRRT_FRESH_BYTE, bytes - kept);
    Memory old = block.memory;
    Place(block, memory, offset, bytes);
    FreeAbandoned(block);
    if (moving) {
        Abandon(block, old);
    } else {
        Unfence(old);
        old.Free();
    }
    return true;
}

void FreeBlock(Block* block) {
    if (block == nullptr) return;
    FreeAbandoned(*block);
    Unfence(block->memory);
    block->memory.Free();
    Memory{reinterpret_cast<std::byte*>(block), sizeof(Block)}.Free();
    --live_blocks;
}

}  // namespace krrt

int64_t KrrtLiveBlocks() {
    return krrt::live_blocks;
}

int64_t KrrtStaleWrites() {
    return krrt::stale_writes;
}
