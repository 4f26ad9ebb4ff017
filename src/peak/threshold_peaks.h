// Peaks as runs of samples above a threshold.
#pragma once

#include <cstdint>

namespace krnumer {

// No fewer than the peaks of this width that n samples can hold.
inline int32_t MostThresholdPeaks(int32_t n, int32_t width) {
    return n / width + 1;
}

// First samples of all runs of `width` or more samples at or above the threshold. `indices` has room for
// MostThresholdPeaks. kEmptyInput: n < 1; kBadWidth: width outside 1 to n - 1.
int32_t FindThresholdPeaks(const double* x, int32_t n, double threshold, int32_t width, int32_t* indices,
                           int32_t* count);

}  // namespace krnumer
