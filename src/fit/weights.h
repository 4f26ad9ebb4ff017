// Weights as callers of fits give them.
#pragma once

#include <algorithm>

#include "frame/entry.h"
#include "frame/scratch.h"

namespace krnumer {

// An empty array means no weights.
inline const double* OptionalWeights(const In<double>& w) {
    return w.size() > 0 ? w.data() : nullptr;
}

inline bool WeightsFit(const In<double>& w, int32_t n) {
    return w.size() == 0 || w.size() == n;
}

// Turns standard deviations into weights, 1 / sigma^2, in memory of `weights`. A sigma of 0 stands for the weight 1.
inline int32_t WeightsOfDeviations(const double* sigma, int32_t n, Scratch<double>* weights) {
    if (!weights->Allocate(Count(n))) return kOutOfMemory;
    std::transform(sigma, sigma + n, weights->data(),
                   [](double each) { return each != 0.0 ? 1.0 / (each * each) : 1.0; });
    return kOk;
}

}  // namespace krnumer
