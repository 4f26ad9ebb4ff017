// The one source of randomness: the generator of B. A. Wichmann and I. D. Hill (Algorithm AS 183, Appl. Statist. 31,
// 188, 1982), three small congruential generators whose fractions are added. Its state belongs to the caller.
#pragma once

#include <cmath>
#include <cstdint>

#include "frame/numeric.h"

namespace krnumer {

struct RandomState {
    int32_t s1, s2, s3;
};

// Starts the sequence of a positive seed; any other seed lets the present one go on.
inline void Seed(RandomState& state, int32_t seed) {
    constexpr int32_t kMultiplier = 8191;
    constexpr int32_t kMask = 0x3FFF;
    if (seed <= 0) return;
    state.s1 = seed;
    state.s2 = WrappingMultiply(seed, kMultiplier) & kMask;
    state.s3 = WrappingMultiply(state.s2, kMultiplier) & kMask;
}

// One step of the three generators; the sum of their fractions. A large seed overflows the first product, and the first
// word then stays negative: remainders have the sign of the dividend.
inline double RandomStep(RandomState& state) {
    state.s1 = WrappingMultiply(state.s1, 171) % 30269;
    state.s2 = WrappingMultiply(state.s2, 172) % 30307;
    state.s3 = WrappingMultiply(state.s3, 170) % 30323;
    return state.s1 * 3.3037100664045725e-05 + state.s2 * 3.2995677566238825e-05 + state.s3 * 3.297826732183491e-05;
}

// Uniform in 0 to 1 exclusive. The three moduli are prime, so no sum of fractions comes nearer to a whole number from
// below than 3e-14, and rounding never makes it 1.
inline double RandomUniform(RandomState& state) {
    const double sum = RandomStep(state);
    return sum - std::floor(sum);
}

// Whole, below 32768; negative only while the first word is.
inline int32_t RandomInt15(RandomState& state) {
    const double sum = RandomStep(state);
    return static_cast<int32_t>((sum - std::trunc(sum)) * 32768.0);
}

}  // namespace krnumer
