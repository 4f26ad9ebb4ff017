// Filters without feedback whose weighted error ripples equally: the exchange of Parks and McClellan.
#pragma once

#include <cstdint>

namespace krnumer {

// A band of frequencies and what is wanted there. Bands follow each other upward.
struct FirBand {
    double desired;
    double low, high;
    double weight;
};

// What a filter is to do: let bands through, form the derivative, or turn the phase by a right angle. The impulse
// response of the first is symmetric, that of the others antisymmetric.
enum FirClass : int32_t { kMultiband = 1, kDifferentiator, kHilbertTransformer };

constexpr bool IsFirClass(int64_t fir_class) {
    return fir_class >= kMultiband && fir_class <= kHilbertTransformer;
}

// h[0] ... h[taps-1] and the deviation that they reach where the weight is 1. `max_iterations` below 1 stands for 100.
int32_t EquirippleDesign(int32_t taps, double fs, const FirBand* bands, int32_t band_count, FirClass fir_class,
                         int32_t max_iterations, double* h, double* ripple);

}  // namespace krnumer
