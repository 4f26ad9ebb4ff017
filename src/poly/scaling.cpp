#include "poly/scaling.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "stat/moments.h"
#include "stat/order.h"

namespace krnumer {

namespace {

template <class Function>
void Map(double* x, int32_t n, double* out, Function function) {
    double* const y = out != nullptr ? out : x;
    for (int32_t i = 0; i < n; ++i) y[i] = function(x[i]);
}

}  // namespace

int32_t ScaleToUnitRange(double* x, int32_t n, double* scale, double* offset, double* out) {
    double max, min;
    int32_t max_index, min_index;
    if (const int32_t status = MinMaxIgnoreNaN(x, n, &max, &max_index, &min, &min_index)) return status;
    if (std::isnan(max) && std::isnan(min)) {
        *scale = *offset = kQuietNaN;
        Map(x, n, out, [](double value) { return value; });
        return kOk;
    }
    *scale = (max - min) * 0.5;
    *offset = *scale + min;
    const double reciprocal = 1.0 / *scale;
    if (std::isfinite(reciprocal)) {
        Map(x, n, out, [=, middle = *offset](double value) { return (value - middle) * reciprocal; });
    } else {
        *scale = 1.0;
        *offset = max;
        Map(x, n, out, [=](double value) { return value - max; });
    }
    return kOk;
}

int32_t ScaleByMagnitude(double* x, int32_t n, double* scale, double* out) {
    if (n < 1) return kEmptyInput;
    double magnitude = 0.0;
    for (int32_t i = 0; i < n; ++i) magnitude = std::max(magnitude, std::fabs(x[i]));
    *scale = magnitude;
    const double factor = magnitude != 0.0 ? 1.0 / magnitude : 1.0;
    Map(x, n, out, [=](double value) { return factor * value; });
    return kOk;
}

int32_t Standardize(double* x, int32_t n, double* deviation, double* mean, double* out) {
    if (const int32_t status = Mean(x, n, mean)) return status;
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) sum += (x[i] - *mean) * (x[i] - *mean);
    *deviation = std::sqrt(sum / n);
    const double factor = 1.0 / *deviation;
    Map(x, n, out, [=, center = *mean](double value) { return (value - center) * factor; });
    return kOk;
}

int32_t MapLinearly(double* x, int32_t n, double slope, double intercept, double* out) {
    if (n < 1) return kEmptyInput;
    Map(x, n, out, [=](double value) { return slope * value + intercept; });
    return kOk;
}

}  // namespace krnumer
