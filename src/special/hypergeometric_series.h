// Hypergeometric series with an estimate of their error, which decides between methods.
#pragma once

#include <cstdint>

namespace krnumer {

inline constexpr int32_t kMostPasses = 200;

// Above this relative error a result is doubtful.
inline constexpr double kDoubtful = 1.8334264312505186e-11;

struct Estimate {
    double value;
    double error;
};

// 1F2(a; b, c; x).
Estimate OneF2(double a, double b, double c, double x);

// 3F0(a, b, c; ; x), asymptotic: up to its smallest term.
Estimate ThreeF0(double a, double b, double c, double x);

}  // namespace krnumer
