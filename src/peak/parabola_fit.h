// Least-squares parabolas in neighbouring windows of a signal.
#pragma once

#include <cstdint>

namespace krnumer {

// a0 + a1 x + a2 x^2, x = 0 in the middle of its window.
struct Parabola {
    double a0, a1, a2;
};

// Weights of windows of `width` samples, 3 rows of `width`: their products with a window are a0, a1 and a2. Fails as
// the pseudo-inverse does.
int32_t DesignParabolaWeights(int32_t width, double* weights);

struct ParabolaFits {
    static constexpr int32_t kMost = 64;

    Parabola operator[](int32_t k) const { return {a0[k], a1[k], a2[k]}; }
    bool IsRising(int32_t k) const { return (rising >> k & 1) != 0; }

    double a0[kMost], a1[kMost], a2[kMost];
    uint64_t rising;  // bit k: window k rises in its middle; where it is level there, it does if it is bent upward
};

// Fits `count` windows, kMost at the most, that start at x, x + 1 and so on. Every sum runs in the order of the
// samples.
void FitParabolas(const double* weights, int32_t width, const double* x, int32_t count, ParabolaFits* fits);

}  // namespace krnumer
