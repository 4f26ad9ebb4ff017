// The samples that a stream keeps between its blocks.
#pragma once

#include <algorithm>
#include <cstdint>

namespace krnumer {

// Drops the oldest of the `old` samples kept and the n new ones, and keeps the rest, for which there has to be room.
template <class T>
void KeepSamples(T* history, int64_t old, int64_t dropped, const T* x, int64_t n) {
    const int64_t dropped_old = std::min(dropped, old);
    if (dropped_old > 0) std::copy(history + dropped_old, history + old, history);
    std::copy(x + (dropped - dropped_old), x + n, history + (old - dropped_old));
}

}  // namespace krnumer
