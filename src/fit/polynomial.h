// Polynomials by least squares.
#pragma once

#include <cstdint>

namespace krnumer {

// The polynomial of the given order through n points with the weights |w[i]|, coef[0] the constant. The f powers in
// `fixed_powers` keep the coefficients in `fixed_values`; a power listed twice has its last value, one out of range is
// skipped. `method` is that of GenLSFitCore and is not looked at when nothing is left to solve for.
//
// kNegativeOrder where f or the order is negative, kUnderdetermined unless n > order - f, and what GenLSFitCore says.
int32_t PolyFitCore(const double* x, const double* y, const double* w, int32_t n, int32_t order, int32_t method,
                    const int32_t* fixed_powers, const double* fixed_values, int32_t f, double* best_fit, double* coef,
                    double* mse);

}  // namespace krnumer
