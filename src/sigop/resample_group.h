// Eight outputs of a resampler at once.
#pragma once

#include <cstdint>

#include "frame/complex.h"
#include "sigop/resample.h"

namespace krnumer {

inline constexpr int32_t kGroup = 8;

// Outputs number `count` to count + 7 of a block stand at number * ratio + base, counted from sample `origin` before
// the n samples. `delta` is that of the kernel's phases.
struct ResampleGroup {
    const ResampleKernel& kernel;
    double delta;
    double ratio;
    double base;
    int32_t count;
    int32_t origin;
    int32_t n;
    int32_t most_taps;
};

// Every output as one at a time would give it, to the bit. False, with nothing written, where they cannot be computed
// together: where one reaches beyond the samples, or has more taps than most_taps or than there is room for.
bool ResampleTogether(const ResampleGroup& group, const double* samples, double* out);
bool ResampleTogether(const ResampleGroup& group, const Complex* samples, Complex* out);

}  // namespace krnumer
