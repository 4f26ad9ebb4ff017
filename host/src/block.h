// Blocks of memory behind handles: where they lie, how they move, what they leave behind.
#pragma once

#include <cstddef>
#include <cstdint>

#include "krrt/krrt.h"

namespace krrt {

// Memory as it came from the system, at a 64-byte boundary. Not from malloc: a test that lets malloc fail in turn
// counts the allocations of krnumer, and those of its host would get in between.
struct Memory {
    std::byte* base = nullptr;
    std::size_t bytes = 0;

    static Memory Allocate(std::size_t bytes);
    void Free();
};

struct Block {
    KrBlock* start;     // first member: a handle is its address
    Memory memory;      // in which the block lies
    std::size_t bytes;  // of the block, dimension words included
    int32_t rank;       // 0 for blocks of bytes
    Memory abandoned;   // what the last move left behind, under watch

    std::byte* Start() const { return reinterpret_cast<std::byte*>(start); }
    std::size_t WordBytes() const { return static_cast<std::size_t>(rank) * sizeof(int32_t); }
};

inline Block* FromHandle(KrHandle handle) {
    return reinterpret_cast<Block*>(handle);
}

// Contents are not initialised. Null when the memory cannot be had.
Block* NewBlock(int32_t rank, std::size_t bytes);

// Keeps contents up to the lesser size. False, with the block as it was, when the memory cannot be had; a lesser size
// always can.
[[nodiscard]] bool ResizeBlock(Block& block, std::size_t bytes);

void FreeBlock(Block* block);

}  // namespace krrt
