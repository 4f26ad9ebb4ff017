#include "sweep/allocator.h"

#include <cerrno>
#include <cstddef>
#include <cstring>
#include <new>

// The run time's own functions, under the names that stay reachable when malloc and its kin are replaced.
#if defined(__SANITIZE_ADDRESS__)
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
    int64_t live;
    void* blocks[kMostBlocks];
};
thread_local State state;

bool Refuse() {
    if (!state.armed || ++state.allocations != state.refuse) return false;
    state.refused = true;
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
int64_t LiveAllocations() {
    return state.live;
}

}  // namespace sweep

extern "C" {

void* malloc(std::size_t bytes) {
    return sweep::Refuse() ? nullptr : sweep::Taken(UNDERLYING(malloc)(bytes));
}

void* calloc(std::size_t count, std::size_t bytes) {
    return sweep::Refuse() ? nullptr : sweep::Taken(UNDERLYING(calloc)(count, bytes));
}

void* realloc(void* block, std::size_t bytes) {
    if (sweep::Refuse()) return nullptr;
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
