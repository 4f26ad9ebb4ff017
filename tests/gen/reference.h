// Signals made by others than ourselves, and how tests of signals compare with them.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <random>
#include <vector>

#include "support/numbers.h"

namespace krnumer {

// A signal of n samples for the arguments given, known at some of its indices. The order of the arguments is that of
// the function that makes the signal; a wave is followed by the phase that it leaves.
struct Reference {
    struct Sample {
        int32_t index;
        double value;
    };

    int32_t n;
    std::vector<double> arguments;
    std::vector<Sample> samples;
};

inline std::vector<double> Samples(int32_t n, double value = 0.0) {
    return std::vector<double>(static_cast<std::size_t>(n), value);
}

inline void ExpectSamples(const std::vector<double>& y, const Reference& reference, double tolerance) {
    for (const auto& [index, value] : reference.samples)
        EXPECT_THAT(y.at(static_cast<std::size_t>(index)), Near(value, 0.0, tolerance))
            << "sample " << index << " of " << reference.n << ", arguments "
            << ::testing::PrintToString(reference.arguments);
}

// The phase that a wave leaves, the last of the arguments; 0 and 360 are neighbours.
inline void ExpectEndPhase(double phase, const Reference& reference, double tolerance) {
    EXPECT_GE(phase, 0.0);
    EXPECT_LT(phase, 360.0);
    EXPECT_LE(std::fabs(std::remainder(phase - reference.arguments.back(), 360.0)), tolerance)
        << "phase " << phase << " after " << reference.n << " samples, arguments "
        << ::testing::PrintToString(reference.arguments);
}

// Blocks of every kind of length: the least, odd, even, prime, powers of two, hundreds.
inline const std::vector<int32_t> kLengths = {1, 2, 3, 4, 5, 8, 17, 30, 64, 97, 128, 255, 500, 997};

// The same numbers in every run and on every machine.
class Numbers {
  public:
    double Between(double low, double high) {
        return low + (high - low) * (static_cast<double>(engine_() >> 11) * 0x1p-53);
    }

  private:
    std::mt19937_64 engine_{20240501};
};

}  // namespace krnumer
