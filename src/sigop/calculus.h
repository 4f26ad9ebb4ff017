// Derivative and integral of samples in place, with the samples that stand before the first and after the last given by
// the caller.
#pragma once

#include <cstdint>

namespace krnumer {

// Central differences, y[i] = (x[i+1] - x[i-1]) / (2 dt). kBadSamplingInterval unless dt > 0, before kEmptyInput where
// n < 1.
int32_t Differentiate(double* x, int32_t n, double initial, double final, double dt);

// Running sum of Simpson's rule, y[i] = y[i-1] + (x[i-1] + 4 x[i] + x[i+1]) dt / 6. kEmptyInput where n < 1, before
// kBadSamplingInterval where dt <= 0; a dt of NaN gives NaN.
int32_t Integrate(double* x, int32_t n, double initial, double final, double dt);

}  // namespace krnumer
