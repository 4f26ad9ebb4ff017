// Shuffles.
#pragma once

#include <cstdint>
#include <numeric>
#include <utility>

#include "frame/status.h"
#include "gen/random.h"

namespace krnumer {

// Swaps every position of 0..n with one drawn from the whole range, which does not give all orders the same
// probability.
template <class Swap>
void SwapAtRandom(int32_t n, RandomState& state, Swap swap) {
    for (int32_t i = 0; i < n; ++i) swap(i, static_cast<int32_t>(RandomUniform(state) * n));
}

// Shuffles x[0..n) and tells in `indices` where each element came from.
template <class T>
int32_t Riffle(T* x, int32_t* indices, int32_t n, int32_t seed, RandomState& state) {
    if (n < 1) return kEmptyInput;
    Seed(state, seed);
    std::iota(indices, indices + n, 0);
    SwapAtRandom(n, state, [=](int32_t i, int32_t j) {
        std::swap(x[i], x[j]);
        std::swap(indices[i], indices[j]);
    });
    return kOk;
}

// Shuffles the numbers 0 to n - 1.
inline int32_t RiffleNumbers(int32_t* numbers, int32_t n, int32_t seed, RandomState& state) {
    if (n < 1) return kEmptyInput;
    Seed(state, seed);
    std::iota(numbers, numbers + n, 0);
    SwapAtRandom(n, state, [=](int32_t i, int32_t j) { std::swap(numbers[i], numbers[j]); });
    return kOk;
}

}  // namespace krnumer
