#include "fit/polynomial.h"

#include <algorithm>

#include "fit/least_squares.h"
#include "fit/residual.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

constexpr int32_t kFree = -1;

int32_t FitAll(const double* x, const double* y, const double* w, int32_t n, int32_t k, int32_t method,
               double* best_fit, double* coef, double* mse) {
    Scratch<double> powers(Count(n) * Count(k));
    if (!powers) return kOutOfMemory;
    double* row = powers.data();
    for (int32_t i = 0; i < n; ++i, row += k) {
        row[0] = 1.0;
        for (int32_t p = 1; p < k; ++p) row[p] = row[p - 1] * x[i];
    }
    return GenLSFitCore(powers.data(), n, k, y, w, coef, best_fit, mse, nullptr, method);
}

// Solves for the `left` coefficients of k that the map leaves free, with the fixed ones taken off the data.
int32_t FitFree(const double* x, const double* y, const double* w, int32_t n, int32_t k, int32_t left, int32_t method,
                const int32_t* map, const double* fixed_values, double* coef) {
    Scratch<double> work(Count(n) * Count(left) + Count(n) + Count(left));
    if (!work) return kOutOfMemory;
    double* const powers = work.data();
    double* const rest = powers + Count(n) * Count(left);
    double* const solved = rest + n;
    double* next = powers;
    for (int32_t i = 0; i < n; ++i) {
        rest[i] = y[i];
        double power = 1.0;
        for (int32_t p = 0; p < k; ++p) {
            if (map[p] == kFree) {
                *next++ = power;
            } else {
                rest[i] -= power * fixed_values[map[p]];
            }
            power *= x[i];
        }
    }
    const int32_t status = GenLSFitCore(powers, n, left, rest, w, solved, nullptr, nullptr, nullptr, method);
    if (status < 0) return status;
    const double* free = solved;
    for (int32_t p = 0; p < k; ++p) coef[p] = map[p] == kFree ? *free++ : fixed_values[map[p]];
    return kOk;
}

}  // namespace

int32_t PolyFitCore(const double* x, const double* y, const double* w, int32_t n, int32_t order, int32_t method,
                    const int32_t* fixed_powers, const double* fixed_values, int32_t f, double* best_fit, double* coef,
                    double* mse) {
    if (f < 0 || order < 0) return kNegativeOrder;
    if (n <= order - f) return kUnderdetermined;
    const int32_t k = order + 1;
    if (f == 0) return FitAll(x, y, w, n, k, method, best_fit, coef, mse);

    Scratch<int32_t> map(Count(k));
    if (!map) return kOutOfMemory;
    std::fill_n(map.data(), k, kFree);
    int32_t fixed = 0;
    for (int32_t j = 0; j < f; ++j) {
        const int32_t p = fixed_powers[j];
        if (p < 0 || p > order) continue;
        fixed += map[Count(p)] == kFree;
        map[Count(p)] = j;
    }
    if (fixed == k) {
        for (int32_t p = 0; p < k; ++p) coef[p] = fixed_values[map[Count(p)]];
    } else {
        const int32_t status = FitFree(x, y, w, n, k, k - fixed, method, map.data(), fixed_values, coef);
        if (status < 0) return status;
    }
    for (int32_t i = 0; i < n; ++i) {
        double value = coef[order];
        for (int32_t p = order - 1; p >= 0; --p) value = value * x[i] + coef[p];
        best_fit[i] = value;
    }
    return FitMeanSquareError(y, best_fit, w, n, mse);
}

}  // namespace krnumer
