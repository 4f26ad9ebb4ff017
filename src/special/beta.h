// The beta function and its regularised incomplete form.
#pragma once

namespace krnumer {

// B(a, b) = Gamma(a) Gamma(b) / Gamma(a + b). NaN at every pole of the three.
double Beta(double a, double b);

// I_x(a, b) = 1 / B(a, b) times the integral of t^(a - 1) (1 - t)^(b - 1) from 0 to x. NaN unless a, b > 0 and x is in
// 0 to 1.
double IncompleteBeta(double a, double b, double x);

}  // namespace krnumer
