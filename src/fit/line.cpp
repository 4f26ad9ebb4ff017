#include "fit/line.h"

#include <algorithm>
#include <cmath>

#include "fit/residual.h"
#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {

namespace {

// Weights are taken in units of the largest, so that their magnitude does not matter.
void WeightedLine(const double* x, const double* y, int32_t n, const double* w, double* slope, double* intercept) {
    double largest = -1.0;
    for (int32_t i = 0; i < n; ++i) largest = std::max(largest, std::fabs(w[i]));
    if (largest == 0.0) {
        *slope = *intercept = kQuietNaN;
        return;
    }
    double s = 0.0;
    double sx = 0.0;
    double sy = 0.0;
    double sxy = 0.0;
    double sxx = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        const double v = std::fabs(w[i]) / largest;
        s += v;
        sx += v * x[i];
        sy += v * y[i];
        sxy += v * x[i] * y[i];
        sxx += v * (x[i] * x[i]);
    }
    *slope = (sy * sx - sxy * s) / (sx * sx - sxx * s);
    *intercept = (sy - *slope * sx) / s;
}

void PlainLine(const double* x, const double* y, int32_t n, double* slope, double* intercept) {
    double sx = 0.0;
    double sy = 0.0;
    double sxy = 0.0;
    double sxx = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        sx += x[i];
        sy += y[i];
        sxy += x[i] * y[i];
        sxx += x[i] * x[i];
    }
    const double divisor = sx * sx - sxx * n;
    *slope = (sy * sx - sxy * n) / divisor;
    *intercept = (sxy * sx - sy * sxx) / divisor;
}

}  // namespace

int32_t LinFitCore(const double* x, const double* y, int32_t n, const double* w, double* best_fit, double* slope,
                   double* intercept, double* mse) {
    if (n < 2) return kFewerThanTwo;
    if (w != nullptr) {
        WeightedLine(x, y, n, w, slope, intercept);
    } else {
        PlainLine(x, y, n, slope, intercept);
    }
    if (best_fit == nullptr && mse == nullptr) return kOk;

    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        const double value = *slope * x[i] + *intercept;
        const double squared = SquaredDifference(y[i], value);
        sum += w != nullptr ? std::fabs(w[i]) * squared : squared;
        if (best_fit != nullptr) best_fit[i] = value;
    }
    if (mse != nullptr) *mse = sum / n;
    return kOk;
}

}  // namespace krnumer
