#include "fit/smoothing_spline.h"

#include <cmath>

#include "fit/interpolation.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/band.h"

namespace krnumer {

namespace {

// Half-width of the normal equations, and the number of their diagonals.
constexpr int32_t kReach = 2;
constexpr int32_t kDiagonals = 2 * kReach + 1;

// Replaces y by the smoothed values; `changes` is the sum of the squared changes. h holds the n - 1 steps.
int32_t Smooth(const double* h, double* y, int32_t n, const double* w, const double* lambda, double p,
               double* changes) {
    const int32_t m = n - 2;
    const std::size_t rows = Count(m);
    // The second differences as a matrix of three bands, scaled by D; then the spread D, the gains, and the equations.
    Scratch<double> work(3 * rows + 2 * Count(n) + rows + kDiagonals * rows);
    if (!work) return kOutOfMemory;
    double* const q0 = work.data();
    double* const q1 = q0 + rows;
    double* const q2 = q1 + rows;
    double* const d = q2 + rows;
    double* const g = d + n;
    double* const u = g + n;
    double* const band = u + rows;

    const double spread = std::sqrt(6.0 * (1.0 - p));
    for (int32_t i = 0; i < n; ++i) {
        if (w != nullptr && w[i] == 0.0) return kZeroParameter;
        d[i] = w != nullptr ? spread / std::sqrt(std::fabs(w[i])) : spread;
    }
    for (int32_t i = 0; i < m; ++i) {
        q0[i] = d[i] / h[i];
        q1[i] = -(1.0 / h[i + 1] + 1.0 / h[i]) * d[i + 1];
        q2[i] = d[i + 2] / h[i + 1];
    }
    if (lambda != nullptr) {
        for (int32_t i = 0; i < n - 1; ++i)
            if (lambda[i] == 0.0) return kZeroParameter;
    }
    const auto step = [=](int32_t i) { return lambda != nullptr ? h[i] / std::fabs(lambda[i]) : h[i]; };

    // Q'Q + R, symmetric: diagonal kReach + k of column j holds row j + k.
    const auto element = [=](int32_t offset, int32_t j) -> double& {
        return band[Count(kReach + offset) * rows + Count(j)];
    };
    for (int32_t j = 0; j < m; ++j) {
        element(0, j) = q0[j] * q0[j] + q1[j] * q1[j] + q2[j] * q2[j] + 2.0 * p * (step(j) + step(j + 1));
        if (j + 1 < m) {
            const double first = q1[j] * q0[j + 1] + q2[j] * q1[j + 1] + p * step(j + 1);
            element(1, j) = element(-1, j + 1) = first;
        }
        if (j + 2 < m) element(2, j) = element(-2, j + 2) = q2[j] * q0[j + 2];
        u[j] = q0[j] * (y[j] / d[j]) + q1[j] * (y[j + 1] / d[j + 1]) + q2[j] * (y[j + 2] / d[j + 2]);
    }
    // Corners that lie outside the matrix are never used, but copied.
    for (int32_t k = 1; k <= kReach; ++k)
        for (int32_t j = 0; j < k && j < m; ++j) element(-k, j) = element(k, m - 1 - j) = 0.0;
    if (const int32_t status = BandSolve(band, m, kReach, kReach, u, 1)) return status;

    for (int32_t i = 0; i < n; ++i) g[i] = 0.0;
    for (int32_t i = 0; i < m; ++i) {
        g[i] += q0[i] * u[i];
        g[i + 1] += q1[i] * u[i];
        g[i + 2] += q2[i] * u[i];
    }
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        const double change = d[i] * g[i];
        y[i] -= change;
        sum += change * change;
    }
    *changes = sum;
    return kOk;
}

}  // namespace

int32_t SmoothingSpline(const double* x, double* y, int32_t n, const double* w, const double* lambda, double balance,
                        double* residue) {
    if (n < 2) return kFewerThanTwo;
    if (n == 2) {
        *residue = 0.0;
        return kOk;
    }
    Scratch<double> work(2 * Count(n));
    if (!work) return kOutOfMemory;
    double* const h = work.data();
    double* const curvature = h + n;
    for (int32_t i = 0; i < n - 1; ++i) h[i] = x[i + 1] - x[i];

    double p = balance;
    if (p != 1.0) {
        for (int32_t i = 0; i < n - 1; ++i)
            if (!(h[i] > 0.0)) return kRepeatedAbscissa;
        if (!(p >= 0.0 && p <= 1.0)) p = 8.0 / (8.0 + std::pow((x[n - 1] - x[0]) / n, 3.0));
    }
    double sum = 0.0;
    if (p != 1.0) {
        double changes;
        if (const int32_t status = Smooth(h, y, n, w, lambda, p, &changes)) return status;
        sum = p * changes;
    }

    constexpr double kNatural = 1e30;
    if (const int32_t status = SplineSecondDerivatives(x, y, n, kNatural, kNatural, curvature)) return status;
    for (int32_t i = 0; i < n - 1; ++i) {
        const double a = curvature[i];
        const double b = curvature[i + 1];
        const double term = (b * b + a * b + a * a) * h[i] * (1.0 - p) * 0.3333333333333333;
        sum += lambda != nullptr ? term * std::fabs(lambda[i]) : term;
    }
    *residue = sum;
    return kOk;
}

}  // namespace krnumer
