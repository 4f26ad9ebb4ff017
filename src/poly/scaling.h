// Scaling of samples to a range, to a deviation, or along a line. `out` null means in place; it may also be x itself.
// -20003 (kEmptyInput) where n < 1.
#pragma once

#include <cstdint>

namespace krnumer {

// To the range from -1 to 1: (x - offset) / scale with the middle of the extrema as offset and half their distance as
// scale, NaNs left out. Data without extent are shifted to 0, with scale 1. Where all are NaN, so are scale and
// offset, and the data stay.
int32_t ScaleToUnitRange(double* x, int32_t n, double* scale, double* offset, double* out);

// By the largest magnitude, NaNs left out. Where that is 0, the data stay.
int32_t ScaleByMagnitude(double* x, int32_t n, double* scale, double* out);

// To mean 0 and deviation 1; the deviation is that of the population, sqrt(sum (x - mean)^2 / n).
int32_t Standardize(double* x, int32_t n, double* deviation, double* mean, double* out);

// slope x + intercept.
int32_t MapLinearly(double* x, int32_t n, double slope, double intercept, double* out);

}  // namespace krnumer
