#include "fit/least_squares.h"

#include <algorithm>
#include <cmath>

#include "fit/residual.h"
#include "fit/scaled_system.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/cholesky_solve.h"
#include "linalg/lu_solve.h"
#include "linalg/products.h"
#include "linalg/qr.h"
#include "linalg/svd.h"
#include "linalg/svd_solve.h"
#include "linalg/transpose.h"

namespace krnumer {

namespace {

constexpr double kOwnThreshold = -1.0;  // of the pseudo-inverse: max(m, n) s[0] eps

// C = A A'.
void MultiplyByTranspose(const double* a, int32_t rows, int32_t columns, double* c) {
    for (int32_t i = 0; i < rows; ++i) {
        for (int32_t j = 0; j <= i; ++j) {
            const double* const left = a + Count(i) * Count(columns);
            const double* const right = a + Count(j) * Count(columns);
            double sum = 0.0;
            for (int32_t l = 0; l < columns; ++l) sum += left[l] * right[l];
            c[Count(i) * Count(rows) + Count(j)] = c[Count(j) * Count(rows) + Count(i)] = sum;
        }
    }
}

// N = H'WH and g = H'Wy.
struct NormalEquations {
    int32_t Form(const double* h, int32_t m, int32_t k, const double* y, const double* w) {
        if (!matrix.Allocate(Count(k) * Count(k), matrix.kZeroed) || !right.Allocate(Count(k), right.kZeroed))
            return kOutOfMemory;
        for (int32_t i = 0; i < m; ++i) {
            const double* const row = h + Count(i) * Count(k);
            const double weight = w != nullptr ? std::fabs(w[i]) : 1.0;
            for (int32_t a = 0; a < k; ++a) {
                const double weighted = weight * row[a];
                double* const sums = matrix.data() + Count(a) * Count(k);
                for (int32_t b = 0; b <= a; ++b) sums[b] += weighted * row[b];
                right[Count(a)] += weighted * y[i];
            }
        }
        for (int32_t a = 0; a < k; ++a)
            for (int32_t b = 0; b < a; ++b)
                matrix[Count(b) * Count(k) + Count(a)] = matrix[Count(a) * Count(k) + Count(b)];
        return kOk;
    }

    Scratch<double> matrix;
    Scratch<double> right;
};

int32_t SolveNormalEquations(const double* h, int32_t m, int32_t k, const double* y, const double* w, double* coef,
                             double* covariance, int32_t method) {
    NormalEquations normal;
    if (const int32_t status = normal.Form(h, m, k, y, w)) return status;
    if (covariance != nullptr) {
        const int32_t status = PseudoInverseCore(normal.matrix.data(), k, k, kOwnThreshold, covariance);
        if (status != kOk) return status;
    }
    if (method == kLUMethod) return LUSolveDirect(normal.matrix.data(), k, normal.right.data(), coef);
    return CholeskySolveFull(normal.matrix.data(), k, 0, normal.right.data(), 1, coef);
}

int32_t SolveBySvd(ScaledSystem& system, int32_t m, int32_t k, double* coef, double* covariance, int32_t method) {
    const std::size_t columns = Count(k);
    Scratch<double> work(2 * columns + columns * columns);
    if (!work) return kOutOfMemory;
    double* const s = work.data();
    double* const projection = s + columns;
    double* const v = projection + columns;
    double* const u = system.h.data();
    if (const int32_t status = SvdCore(u, system.rows, k, u, s, v, false)) return status;
    const double threshold = method == kTruncatedSvdMethod ? m * s[0] * kEpsilon : 0.0;

    std::fill_n(projection, columns, 0.0);
    for (std::size_t i = 0; i < Count(system.rows); ++i)
        for (std::size_t j = 0; j < columns; ++j) projection[j] += u[i * columns + j] * system.y[i];
    std::fill_n(coef, columns, 0.0);
    for (std::size_t j = 0; j < columns; ++j) {
        const bool kept = s[j] > threshold;
        const double inverse = kept ? 1.0 / s[j] : 0.0;
        for (std::size_t i = 0; i < columns; ++i) {
            double& element = v[i * columns + j];
            if (kept) coef[i] += projection[j] / s[j] * element;
            element *= inverse;
        }
    }
    if (covariance != nullptr) MultiplyByTranspose(v, k, k, covariance);
    return kOk;
}

int32_t SolveByQR(ScaledSystem& system, int32_t k, double* coef, double* covariance) {
    const int32_t m = system.rows;
    const std::size_t columns = Count(k);
    Scratch<double> q(Count(m) * columns);
    Scratch<double> r(2 * columns * columns);
    if (!q || !r) return kOutOfMemory;
    if (const int32_t status = QRHouseholder(system.h.data(), m, k, kEconomyQR, q.data(), r.data())) return status;

    std::fill_n(coef, columns, 0.0);
    for (std::size_t i = 0; i < Count(m); ++i)
        for (std::size_t j = 0; j < columns; ++j) coef[j] += q[i * columns + j] * system.y[i];
    for (std::size_t i = columns; i-- > 0;) {
        const double* const row = r.data() + i * columns;
        if (row[i] == 0.0) return kSingular;
        for (std::size_t j = i + 1; j < columns; ++j) coef[i] -= row[j] * coef[j];
        coef[i] /= row[i];
    }
    if (covariance == nullptr) return kOk;

    double* const transposed = r.data() + columns * columns;
    if (const int32_t status = TransposeCore(r.data(), k, k, transposed)) return status;
    double* const product = q.data();  // no longer needed, and at least as large
    MultiplyByTranspose(transposed, k, k, product);
    return PseudoInverseCore(product, k, k, kOwnThreshold, covariance);
}

}  // namespace

int32_t GenLSFitCore(const double* h, int32_t m, int32_t k, const double* y, const double* w, double* coef,
                     double* best_fit, double* mse, double* covariance, int32_t method) {
    if (k < 1) return kBadOrder;
    if (m < k) return kUnderdetermined;
    if (method < kSvdMethod || method > kTruncatedSvdMethod) return kBadSelector;
    int32_t status;
    if (method == kLUMethod || method == kCholeskyMethod) {
        status = SolveNormalEquations(h, m, k, y, w, coef, covariance, method);
    } else {
        ScaledSystem system;
        if (system.Load(h, m, k, y, w)) return kOutOfMemory;
        status = method == kSvdMethod || method == kTruncatedSvdMethod
                     ? SolveBySvd(system, m, k, coef, covariance, method)
                     : SolveByQR(system, k, coef, covariance);
    }
    if (status != kOk || best_fit == nullptr || mse == nullptr) return status;
    if (const int32_t failure = MatVecCore(h, m, k, coef, best_fit)) return failure;
    return FitMeanSquareError(y, best_fit, w, m, mse);
}

int32_t GetNewCoefCore(const double* hessian, const double* gradient, int32_t k, double lambda, double* coef) {
    const std::size_t size = Count(k);
    Scratch<double> work(size * size + size);
    if (!work) return kOutOfMemory;
    double* const damped = work.data();
    double* const step = damped + size * size;
    std::copy_n(hessian, size * size, damped);
    for (std::size_t i = 0; i < size; ++i) {
        double& diagonal = damped[i * size + i];
        diagonal *= lambda + 1.0;
        if (!std::isfinite(diagonal)) return kNotFinite;
    }
    const int32_t status = SvdSolve(damped, k, k, gradient, 1, step, kOwnThreshold);
    if (status < 0) return status;
    for (std::size_t i = 0; i < size; ++i) coef[i] += step[i];
    return status;
}

}  // namespace krnumer
