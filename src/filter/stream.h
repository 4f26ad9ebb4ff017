// A signal that is filtered in blocks, with what a filter remembers of it.
#pragma once

#include <algorithm>
#include <cstdint>

namespace krnumer {

// The samples of the current block and the state before it. Block and newest part of the state lie in one buffer, so
// that a delayed block is always one piece of memory.
template <class T>
class Stream {
  public:
    static constexpr int32_t kBlock = 64;

    // The state holds the last `memory` samples, the oldest first.
    Stream(T* state, int32_t memory) : state_(state), memory_(memory), near_(std::min(memory, kBlock)) {}

    // Room for the samples of the next block, of which there may be kBlock.
    T* Begin() {
        std::copy_n(state_ + memory_ - near_, near_, buffer_ + kBlock - near_);
        return buffer_ + kBlock;
    }

    // The samples of the block, `lag` of at most `memory` samples earlier.
    const T* Delayed(int32_t lag) const { return lag <= kBlock ? buffer_ + kBlock - lag : state_ + memory_ - lag; }

    // Takes the samples of the block into the state.
    void End(int32_t count) {
        const int32_t taken = std::min(count, memory_);
        std::copy(state_ + taken, state_ + memory_, state_);
        std::copy_n(buffer_ + kBlock + count - taken, taken, state_ + memory_ - taken);
    }

  private:
    T* state_;
    int32_t memory_;
    int32_t near_;
    T buffer_[2 * kBlock];
};

}  // namespace krnumer
