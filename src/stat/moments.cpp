#include "stat/moments.h"

#include <algorithm>
#include <cmath>

#include "frame/status.h"

namespace krnumer {

namespace {

// Repeated multiplication. Once a product keeps its magnitude (1, infinity, 0 or the denormal that rounding holds)
// all later ones do, and only the sign is left to find: no order takes long.
double Power(double base, int32_t order) {
    double power = base;
    for (int32_t k = 1; k < order; ++k) {
        const double next = power * base;
        if (!std::islessgreater(std::fabs(next), std::fabs(power))) {
            return std::copysign(next, order % 2 == 0 ? 1.0 : base);
        }
        power = next;
    }
    return power;
}

}  // namespace

int32_t Mean(const double* x, int32_t n, double* mean) {
    if (n < 1) return kEmptyInput;
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) sum += x[i];
    *mean = sum / n;
    return kOk;
}

int32_t Moment(const double* x, int32_t n, int32_t order, double* moment) {
    if (n < 1) return kEmptyInput;
    if (order < 1) return kBadOrder;
    double mean = 0.0;
    Mean(x, n, &mean);
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) sum += Power(x[i] - mean, order);
    *moment = sum / n;
    return kOk;
}

int32_t MeanSquareError(const double* x, int32_t n, const double* y, int32_t m, double* mse) {
    if (n < 1 || m < 1) return kEmptyInput;
    const int32_t common = std::min(n, m);
    double sum = 0.0;
    for (int32_t i = 0; i < common; ++i) sum += SquaredDifference(x[i], y[i]);
    *mse = sum / common;
    return n == m ? kOk : kWarnSizesDiffer;
}

int32_t RootMeanSquare(const double* x, int32_t n, double* rms) {
    if (n < 1) return kEmptyInput;
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) sum += x[i] * x[i];
    *rms = std::sqrt(sum / n);
    return kOk;
}

}  // namespace krnumer
