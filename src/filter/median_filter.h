// Sliding median.
#pragma once

#include <cstdint>

namespace krnumer {

// Replaces every sample by the median of the window from `left` samples before it to `right` samples behind it, the
// signal being 0 outside. Of an even number of samples it is the mean of the two in the middle. A negative `right`
// takes the value of `left`. NaN sorts below all numbers.
int32_t MedianFilter(double* x, int32_t n, int32_t left, int32_t right);

}  // namespace krnumer
