// Narrowband filters at work.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Parts of a narrowband filter. The taps of the prototype stand `factor` samples apart; with a factor of 1 there is no
// interpolator.
struct NarrowbandParts {
    int32_t type;  // complements add the signal, delayed
    int32_t factor;
    const double* prototype;
    int32_t prototype_size;
    const double* interpolator;
    int32_t interpolator_size;

    // Whether a signal of n samples can be filtered at all: kEmptyInput, kBadSelector for a factor below 1, or
    // kOutOfMemory where no array holds what comes out.
    int32_t Check(int32_t n) const;

    // Length of the filtered signal; 64 bits hold it whatever the sizes.
    int64_t OutputSize(int32_t n) const;
};

// Full convolution: y holds OutputSize(n) samples. Fails as Check does.
int32_t FilterNarrowband(const NarrowbandParts& filter, const double* x, int32_t n, double* y);
int32_t FilterNarrowband(const NarrowbandParts& filter, const Complex* x, int32_t n, Complex* y);

}  // namespace krnumer
