#include <algorithm>
#include <cmath>
#include <cstddef>
#include <utility>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/balance.h"
#include "linalg/eigen_general.h"
#include "linalg/finite.h"
#include "linalg/real_schur.h"
#include "linalg/row_sums.h"
#include "linalg/triangular_vectors.h"

namespace krnumer {

namespace {

// The largest magnitude in column m - 1 from row m to `high`, the first of equals; m where all are zero.
std::ptrdiff_t FindPivot(const double* a, std::ptrdiff_t n, std::ptrdiff_t m, std::ptrdiff_t high) {
    std::ptrdiff_t pivot = m;
    for (std::ptrdiff_t i = m + 1; i <= high; ++i)
        if (std::fabs(a[i * n + m - 1]) > std::fabs(a[pivot * n + m - 1])) pivot = i;
    return pivot;
}

// Reduces the balanced block to Hessenberg form by eliminations. The multipliers stay below the subdiagonal;
// exchanged[m] is the row that changed places with row m. multipliers: work space for n.
void Eliminate(double* a, std::ptrdiff_t n, const Balance& balance, int32_t* exchanged, double* multipliers) {
    for (std::ptrdiff_t m = balance.low + 1; m < balance.high; ++m) {
        const std::ptrdiff_t pivot = FindPivot(a, n, m, balance.high);
        exchanged[m] = static_cast<int32_t>(pivot);
        if (pivot != m) {
            std::swap_ranges(a + pivot * n + m - 1, a + (pivot + 1) * n, a + m * n + m - 1);
            for (std::ptrdiff_t i = 0; i <= balance.high; ++i) std::swap(a[i * n + pivot], a[i * n + m]);
        }
        const double x = a[m * n + m - 1];
        if (x == 0.0) continue;

        const double* source = a + m * n;
        for (std::ptrdiff_t i = m + 1; i <= balance.high; ++i) {
            double* row = a + i * n;
            const double factor = row[m - 1] /= x;
            multipliers[i] = factor;
            if (factor == 0.0) continue;
            for (std::ptrdiff_t j = m; j < n; ++j) row[j] -= factor * source[j];
        }
        // The inverse from the right: column m takes the sums of the columns behind it.
        ForEachRowSum(a + m + 1, n, balance.high + 1, balance.high - m, multipliers + m + 1,
                      [=](std::ptrdiff_t i, double sum) { a[i * n + m] += sum; });
    }
}

// The transformation that the eliminations amount to, its columns as rows; takes the multipliers out of the matrix.
void AccumulateEliminations(double* a, std::ptrdiff_t n, const Balance& balance, const int32_t* exchanged,
                            double* columns) {
    std::fill_n(columns, n * n, 0.0);
    for (std::ptrdiff_t i = 0; i < n; ++i) columns[i * (n + 1)] = 1.0;
    for (std::ptrdiff_t m = balance.high - 1; m > balance.low; --m) {
        double* column = columns + m * n;
        for (std::ptrdiff_t i = m + 1; i <= balance.high; ++i) column[i] = a[i * n + m - 1];
        const std::ptrdiff_t pivot = exchanged[m];
        if (pivot == m) continue;
        for (std::ptrdiff_t j = m; j <= balance.high; ++j) {
            columns[j * n + m] = columns[j * n + pivot];
            columns[j * n + pivot] = 0.0;
        }
        column[pivot] = 1.0;
    }
}

double HessenbergNorm(const double* h, std::ptrdiff_t n) {
    double norm = 0.0;
    for (std::ptrdiff_t i = 0; i < n; ++i)
        for (std::ptrdiff_t j = std::max<std::ptrdiff_t>(i - 1, 0); j < n; ++j) norm += std::fabs(h[i * n + j]);
    return norm;
}

double SumOfSquares(const double* x, std::ptrdiff_t n) {
    double sum = 0.0;
    for (std::ptrdiff_t i = 0; i < n; ++i) sum += x[i] * x[i];
    return sum;
}

// Column j of v, of unit length, from its real and imaginary part; with a conjugate pair column j + 1, too.
void StoreVector(const double* re, const double* im, std::ptrdiff_t n, std::ptrdiff_t j, Complex* v) {
    const double norm = std::sqrt(SumOfSquares(re, n) + (im != nullptr ? SumOfSquares(im, n) : 0.0));
    const double divisor = norm > 0.0 ? norm : 1.0;
    for (std::ptrdiff_t i = 0; i < n; ++i) {
        Complex* element = v + i * n + j;
        element[0] = {re[i] / divisor, im != nullptr ? im[i] / divisor : 0.0};
        if (im != nullptr) element[1] = Conjugate(element[0]);
    }
}

}  // namespace

int32_t EigenGeneralCore(const double* a, int32_t order, int32_t want_vectors, Complex* w, Complex* v) {
    if (order < 1) return kEmptyInput;
    if (want_vectors != 0 && want_vectors != 1) return kBadSelector;
    if (HasUnusable(a, Count(order) * Count(order))) return kNotFinite;

    const std::ptrdiff_t n = order;
    Scratch<double> h(Count(order) * (Count(order) + 2));
    Scratch<int32_t> exchanged(Count(order));
    if (!h || !exchanged) return kOutOfMemory;
    double* scale = h.data() + n * n;

    std::copy_n(a, n * n, h.data());
    const Balance balance = BalanceMatrix(h.data(), n, scale);
    Eliminate(h.data(), n, balance, exchanged.data(), scale + n);
    double* columns = nullptr;
    if (want_vectors == 1) {
        columns = reinterpret_cast<double*>(v);  // the first half of v, until the vectors themselves are there
        AccumulateEliminations(h.data(), n, balance, exchanged.data(), columns);
    }
    const double norm = HessenbergNorm(h.data(), n);
    const RealHessenberg problem{h.data(), n, balance.low, balance.high, columns, norm};
    if (const int32_t status = ReduceToRealSchur(problem, w)) return status;
    if (want_vectors == 0) return kOk;

    // Row by row from the end the Schur form gives way to the eigenvectors.
    if (const int32_t status = SchurVectors(problem, w)) return status;
    for (std::ptrdiff_t j = 0; j < n; ++j) {
        double* re = h.data() + j * n;
        Unbalance(balance, n, re);
        if (w[j].im == 0.0) {
            StoreVector(re, nullptr, n, j, v);
        } else {
            Unbalance(balance, n, re + n);
            StoreVector(re, re + n, n, j, v);
            ++j;
        }
    }
    return kOk;
}

}  // namespace krnumer
