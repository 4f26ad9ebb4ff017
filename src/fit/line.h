// Straight line by least squares in closed form.
#pragma once

#include <cstdint>

namespace krnumer {

// y = slope x + intercept through n points with the weights |w[i]|, or all alike where w is null. The fitted values go
// to `best_fit`, which may be y itself, and their mean square error to `mse`, where these are not null. Equal abscissas
// give infinities or NaN and no code, weights that are all 0 give NaN. kFewerThanTwo.
int32_t LinFitCore(const double* x, const double* y, int32_t n, const double* w, double* best_fit, double* slope,
                   double* intercept, double* mse);

}  // namespace krnumer
