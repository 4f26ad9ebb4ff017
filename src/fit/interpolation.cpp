#include "fit/interpolation.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

// The point whose abscissa is nearest, the first of equals.
int32_t Nearest(const double* x, int32_t n, double x0) {
    int32_t nearest = 0;
    for (int32_t i = 1; i < n; ++i)
        if (std::fabs(x0 - x[i]) < std::fabs(x0 - x[nearest])) nearest = i;
    return nearest;
}

// Adds the corrections of the columns of a tableau to the value of the nearest point, on the path that stays nearest to
// it. column(m, c, d) turns the differences of one column into those of the next, n - m of each.
template <class Column>
int32_t WalkTableau(const double* y, int32_t n, int32_t nearest, double offset, double* value, double* error,
                    Column column) {
    Scratch<double> differences(2 * Count(n));
    if (!differences) return kOutOfMemory;
    double* const c = differences.data();
    double* const d = c + n;
    for (int32_t i = 0; i < n; ++i) {
        c[i] = y[i];
        d[i] = y[i] + offset;
    }
    double sum = y[nearest];
    double correction = 0.0;
    int32_t below = nearest;  // differences c from this place on lie above the path, d before it below
    for (int32_t m = 1; m < n; ++m) {
        if (const int32_t status = column(m, c, d)) return status;
        correction = 2 * std::int64_t{below} < n - m ? c[below] : d[--below];
        sum += correction;
    }
    *value = sum;
    *error = correction;
    return kOk;
}

}  // namespace

int32_t InterpolatePolynomial(const double* x, const double* y, int32_t n, double x0, double* value, double* error) {
    if (n < 1) return kEmptyInput;
    return WalkTableau(y, n, Nearest(x, n, x0), 0.0, value, error, [=](int32_t m, double* c, double* d) {
        for (int32_t i = 0; i < n - m; ++i) {
            if (x[i] == x[i + m]) return kRepeatedAbscissa;
            const double h = x[i] - x[i + m];
            const double w = c[i + 1] - d[i];
            c[i] = (x[i] - x0) * w / h;
            d[i] = (x[i + m] - x0) * w / h;
        }
        return kOk;
    });
}

int32_t InterpolateRational(const double* x, const double* y, int32_t n, double x0, double* value, double* error) {
    if (n < 1) return kEmptyInput;
    if (const double* const point = std::find(x, x + n, x0); point != x + n) {
        *value = y[point - x];
        *error = 0.0;
        return kOk;
    }
    constexpr double kOffset = 1e-10;  // keeps the first quotients from 0/0
    return WalkTableau(y, n, Nearest(x, n, x0), kOffset, value, error, [=](int32_t m, double* c, double* d) {
        for (int32_t i = 0; i < n - m; ++i) {
            const double t = (x[i] - x0) * d[i] / (x[i + m] - x0);
            const double q = t - c[i + 1];
            if (q == 0.0) return kInterpolantPole;
            const double r = (c[i + 1] - d[i]) / q;
            d[i] = c[i + 1] * r;
            c[i] = t * r;
        }
        return kOk;
    });
}

int32_t SplineSecondDerivatives(const double* x, const double* y, int32_t n, double slope_first, double slope_last,
                                double* y2) {
    if (n < 1) return kEmptyInput;
    if (n == 1) {
        y2[0] = 0.0;
        return kOk;
    }
    Scratch<double> scratch(Count(n));
    if (!scratch) return kOutOfMemory;
    double* const u = scratch.data();
    const auto slope = [=](int32_t i) { return (y[i + 1] - y[i]) / (x[i + 1] - x[i]); };

    if (slope_first >= kNaturalEnd) {
        y2[0] = u[0] = 0.0;
    } else {
        y2[0] = -0.5;
        u[0] = (3.0 / (x[1] - x[0])) * (slope(0) - slope_first);
    }
    for (int32_t i = 1; i < n - 1; ++i) {
        if (x[i - 1] == x[i] || x[i] == x[i + 1] || x[i - 1] == x[i + 1]) return kRepeatedAbscissa;
        const double width = x[i + 1] - x[i - 1];
        const double s = (x[i] - x[i - 1]) / width;
        const double p = s * y2[i - 1] + 2.0;
        y2[i] = (s - 1.0) / p;
        u[i] = (6.0 * (slope(i) - slope(i - 1)) / width - s * u[i - 1]) / p;
    }
    double q = 0.0;
    double last = 0.0;
    if (!(slope_last >= kNaturalEnd)) {
        const double h = x[n - 1] - x[n - 2];
        q = 0.5;
        last = (3.0 / h) * (slope_last - (y[n - 1] - y[n - 2]) / h);
    }
    y2[n - 1] = (last - q * u[n - 2]) / (q * y2[n - 2] + 1.0);
    for (int32_t k = n - 2; k >= 0; --k) y2[k] = y2[k] * y2[k + 1] + u[k];
    return kOk;
}

int32_t EvaluateSpline(const double* x, const double* y, const double* y2, int32_t n, double x0, double* value) {
    if (n < 1) return kEmptyInput;
    const bool ascending = x[n - 1] > x[0];
    int32_t lo = 0;
    int32_t hi = n - 1;
    while (hi - lo > 1) {
        const int32_t middle = lo + (hi - lo) / 2;
        const bool behind = ascending ? x[middle] <= x0 : x[middle] >= x0;
        (behind ? lo : hi) = middle;
    }
    const double h = x[hi] - x[lo];
    if (h == 0.0) return kRepeatedAbscissa;
    const double a = (x[hi] - x0) / h;
    const double b = (x0 - x[lo]) / h;
    *value =
        a * y[lo] + b * y[hi] + ((a * a * a - a) * y2[lo] + (b * b * b - b) * y2[hi]) * (h * h) * 0.16666666666666666;
    return kOk;
}

}  // namespace krnumer
