// The regularised incomplete gamma functions P and Q = 1 - P.
#pragma once

namespace krnumer {

// P(a, x) = 1 / Gamma(a) times the integral of t^(a - 1) e^-t from 0 to x. NaN for a <= 0 and for x < 0, and where a is
// so large that the series would take more than ten million terms.
double IncompleteGamma(double a, double x);

// Q(a, x) = 1 - P(a, x).
double IncompleteGammaC(double a, double x);

}  // namespace krnumer
