// Cubic smoothing spline (C. H. Reinsch, Numer. Math. 10, 177, 1967; balance and weights after C. de Boor, A Practical
// Guide to Splines, 1978, chapter XIV).
#pragma once

#include <cstdint>

namespace krnumer {

// Replaces y by the values at x of the f that minimises
//
//     p sum of w[i] (y[i] - f(x[i]))^2 + (1 - p) integral of lambda f''^2
//
// with weights 1 where `w` is null, and lambda constant on each of the n - 1 intervals, 1 where `lambda` is null; both
// count by their magnitude. `balance` is p, from 0 (a weighted regression line) to 1 (y itself); any other value asks
// for 8 / (8 + s^3) with s the range of x over n. The residue is p times the sum of the squared changes, without the
// weights, plus the second term of the functional.
//
// kFewerThanTwo; kRepeatedAbscissa where x does not ascend; kZeroParameter for a weight of 0; kBadDimension for 3 to 6
// points, which are too few for the band solver; kSingular; kOutOfMemory. Two points, and p = 1, are not smoothed and
// not looked at so closely.
int32_t SmoothingSpline(const double* x, double* y, int32_t n, const double* w, const double* lambda, double balance,
                        double* residue);

}  // namespace krnumer
