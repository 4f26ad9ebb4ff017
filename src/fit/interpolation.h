// Interpolation between the n points (x[i], y[i]) of a table.
#pragma once

#include <cstdint>

namespace krnumer {

// The polynomial through all points, at x0, by Neville's scheme (W. H. Press et al., Numerical Recipes, 1986, 3.1). x
// in any order. The error estimate is the last correction. kEmptyInput, kOutOfMemory; kRepeatedAbscissa even where x0
// is a point of the table.
int32_t InterpolatePolynomial(const double* x, const double* y, int32_t n, double x0, double* value, double* error);

// The diagonal rational function through all points, at x0 (R. Bulirsch and J. Stoer, Numer. Math. 6, 413, 1964). At a
// point of the table the value is its y and the estimate 0. kEmptyInput, kOutOfMemory, kInterpolantPole.
int32_t InterpolateRational(const double* x, const double* y, int32_t n, double x0, double* value, double* error);

// From this slope on the end of a spline is natural.
inline constexpr double kNaturalEnd = 9.9e29;

// Second derivatives of the cubic spline with the given slopes at its ends (Numerical Recipes, 3.3). x ascending or
// descending; a single point has none. kEmptyInput, kOutOfMemory, kRepeatedAbscissa for inner points.
int32_t SplineSecondDerivatives(const double* x, const double* y, int32_t n, double slope_first, double slope_last,
                                double* y2);

// The spline at x0; outside the table the end pieces go on. kEmptyInput, kRepeatedAbscissa.
int32_t EvaluateSpline(const double* x, const double* y, const double* y2, int32_t n, double x0, double* value);

}  // namespace krnumer
