// Mean square error of a fit.
#pragma once

#include <cmath>
#include <cstdint>

#include "frame/status.h"
#include "stat/moments.h"

namespace krnumer {

// Mean of the squared differences of fit and data, each weighted by |w[i]| where there are weights. It is divided by n
// even then, not by the sum of the weights. kEmptyInput where n < 1.
inline int32_t FitMeanSquareError(const double* y, const double* fit, const double* w, int32_t n, double* mse) {
    if (w == nullptr) return MeanSquareError(y, n, fit, n, mse);
    if (n < 1) return kEmptyInput;
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) sum += std::fabs(w[i]) * SquaredDifference(y[i], fit[i]);
    *mse = sum / n;
    return kOk;
}

}  // namespace krnumer
