// Smoothing by polynomials that are fitted to a moving frame (A. Savitzky, M. J. E. Golay, Anal. Chem. 36, 1627
// (1964)).
#pragma once

#include <cstdint>

namespace krnumer {

// Row k of `differentiators`, order + 1 rows of `frame` columns, applied to a frame gives the coefficient of t^k of the
// polynomial of that order that fits it best, t being counted in samples from the middle. Row i of `smoothing`, `frame`
// by `frame`, gives the polynomial at sample i. Squares of deviations count by the magnitudes of `weights`; null for
// equal weights. `differentiators` may be null.
int32_t SavitzkyGolayMatrices(int32_t order, int32_t frame, const double* weights, double* smoothing,
                              double* differentiators);

// y[i] is the polynomial of the frame around i; at both ends, that of the first or last full frame. y and x may not
// overlap.
int32_t SavitzkyGolayFilter(const double* x, int32_t n, int32_t order, int32_t frame, const double* weights, double* y);

}  // namespace krnumer
