// How windows meet samples: a complex sample has both its parts multiplied by the one real weight.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// x[i] *= weights[i]
template <class T>
void MultiplyByWeights(T* x, const double* weights, std::int32_t n) {
    for (std::int32_t i = 0; i < n; ++i) x[i] *= weights[i];
}

// A periodic window weighs x[i] and x[n-i] alike, for i from 1 up to the middle. x[0] and, where n is even, x[n/2]
// have no partner and are left to the caller.
template <class T, class Weight>
void MultiplyPeriodicPairs(T* x, std::int32_t n, Weight weight) {
    for (std::int32_t i = 1; i <= (n - 1) / 2; ++i) {
        const double w = weight(i);
        x[i] *= w;
        x[n - i] *= w;
    }
}

}  // namespace krnumer
