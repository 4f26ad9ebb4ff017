#include "sweep/allocator.h"

#include <cerrno>
#include <cstddef>
#include <cstring>
#include <new>

// The run time's own functions, under the names that stay reachable when malloc and its kin are replaced.
#if defined(KRNUMER_ASAN)
#define UNDERLYING(name) __interceptor_##name
#else
#define UNDERLYING(name) __libc_##name
#endif
extern "C" {
void* UNDERLYING(malloc)(std::size_t);
void* UNDERLYING(calloc)(std::size_t, std::size_t);
void* UNDERLYING(realloc)(void*, std::size_t);
void UNDERLYING(free)(void*);
}

namespace sweep {
namespace {

// Blocks taken while armed; few at a time, so a plain table does.
constexpr int kMostBlocks = 4096;

struct State {
    bool armed;
    bool refused;
    int32_t allocations;
    int32_t refuse;
    uint64_t limit;  // 0: none
    int64_t live;
    void* blocks[kMostBlocks];
};
thread_local State state;

bool Refuse(std::size_t bytes) {
    if (!state.armed) return false;
    const bool chosen = ++state.allocations == state.refuse;
    if (!chosen && (state.limit == 0 || bytes <= state.limit)) return false;
    state.refused = chosen;
    errno = ENOMEM;
    return true;
}

void* Taken(void* block) {
    if (!state.armed || block == nullptr) return block;
    for (void*& slot : state.blocks) {
        if (slot != nullptr) continue;
        slot = block;
        ++state.live;
        break;
    }
    return block;
}

void GivenBack(void* block) {
    if (state.live == 0 || block == nullptr) return;
    for (void*& slot : state.blocks) {
        if (slot != block) continue;
        slot = nullptr;
        --state.live;
        return;
    }
}

}  // namespace

ArmedAllocator::ArmedAllocator(int32_t refused) {
    state.refused = false;
    state.allocations = 0;
    state.refuse = refused;
    state.armed = true;
}
ArmedAllocator::~ArmedAllocator() {
    state.armed = false;
}
int32_t ArmedAllocator::allocations() {
    return state.allocations;
}
bool ArmedAllocator::refused() {
    return state.refused;
}
AllocationLimit::AllocationLimit(uint64_t bytes) {
    state.limit = bytes;
}
AllocationLimit::~AllocationLimit() {
    state.limit = 0;
}
int64_t LiveAllocations() {
    return state.live;
}

}  // namespace sweep

// Seen by the shared libraries of the process as well.
#pragma GCC visibility push(default)
extern "C" {

void* malloc(std::size_t bytes) {
    return sweep::Refuse(bytes) ? nullptr : sweep::Taken(UNDERLYING(malloc)(bytes));
}

void* calloc(std::size_t count, std::size_t bytes) {
    return sweep::Refuse(count * bytes) ? nullptr : sweep::Taken(UNDERLYING(calloc)(count, bytes));
}

void* realloc(void* block, std::size_t bytes) {
    if (sweep::Refuse(bytes)) return nullptr;
    void* const moved = UNDERLYING(realloc)(block, bytes);
    if (moved == nullptr) return nullptr;
    sweep::GivenBack(block);
    return sweep::Taken(moved);
}

void free(void* block) {
    sweep::GivenBack(block);
    UNDERLYING(free)(block);
}
}
#pragma GCC visibility pop
