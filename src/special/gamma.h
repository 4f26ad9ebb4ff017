// The gamma function, its logarithm and its logarithmic derivative, and factorials.
#pragma once

#include <cstdint>

namespace krnumer {

inline constexpr double kEulerGamma = 0.5772156649015329;

// Gamma(x); NaN at 0 and at the negative integers.
double Gamma(double x);

// Stirling's approximation of Gamma(x) with five terms of its correction, for x > 0. Meant for x from 33 on.
double Stirling(double x);

// ln Gamma(x) for x >= 0; NaN for negative x.
double LnGamma(double x);

// 1 / Gamma(x), which is 0 at the poles of Gamma.
double ReciprocalGamma(double x);

// n! and ln n!; NaN for negative n.
double Factorial(int32_t n);
double LnFactorial(int32_t n);

// psi(x), the derivative of ln Gamma; +infinity at 0 and at the negative integers.
double Digamma(double x);

}  // namespace krnumer
