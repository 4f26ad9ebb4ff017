#include <algorithm>
#include <cmath>
#include <cstddef>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/balance.h"
#include "linalg/complex_schur.h"
#include "linalg/eigen_general.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/householder.h"
#include "linalg/triangular_vectors.h"

namespace krnumer {

namespace {

// The unitary reduction of a balanced block to Hessenberg form. The vectors of the reflectors stay below the diagonal
// until they have been accumulated.
struct Reduction {
    Complex* a;
    std::ptrdiff_t n;
    std::ptrdiff_t low;
    std::ptrdiff_t high;
    Complex* subdiagonal;  // [m] at (m, m - 1)
    double* h;             // of the reflectors
    Complex* vector;       // work space, as the next two
    Complex* scaled;
    Complex* sums;

    Complex* Column(std::ptrdiff_t m) const { return a + m * n + m - 1; }  // from row m down
};

void ReduceToHessenberg(const Reduction& r) {
    for (std::ptrdiff_t m = r.low + 1; m < r.high; ++m) {
        const std::ptrdiff_t size = r.high - m + 1;
        Complex* column = r.Column(m);
        const Reflector<Complex> reflector = MakeReflector(column, size, r.n);
        r.subdiagonal[m] = reflector.image;
        r.h[m] = reflector.h;
        if (reflector.h == 0.0) continue;
        ReflectColumns({column, r.n}, reflector.h, Block<Complex>{column + 1, size, r.n - m, r.n}, r.sums);
        for (std::ptrdiff_t k = 0; k < size; ++k) r.vector[k] = Conjugate(column[k * r.n]);
        for (std::ptrdiff_t k = 0; k < size; ++k) r.scaled[k] = r.vector[k] / reflector.h;
        ReflectRows(r.vector, r.scaled, Block<Complex>{r.a + m, r.high + 1, size, r.n});
    }
    if (r.low < r.high) r.subdiagonal[r.high] = *r.Column(r.high);
}

// The columns of the transformation, as rows.
void Accumulate(const Reduction& r, Complex* columns) {
    std::fill_n(columns, r.n * r.n, Complex{});
    for (std::ptrdiff_t i = 0; i < r.n; ++i) columns[i * (r.n + 1)] = {1.0, 0.0};
    for (std::ptrdiff_t m = r.high - 1; m > r.low; --m) {
        if (r.h[m] == 0.0) continue;
        const std::ptrdiff_t size = r.high - m + 1;
        for (std::ptrdiff_t k = 0; k < size; ++k) r.vector[k] = r.Column(m)[k * r.n];
        for (std::ptrdiff_t k = 0; k < size; ++k) r.scaled[k] = r.vector[k] / r.h[m];
        ReflectRows(r.vector, r.scaled, Block<Complex>{columns + m * (r.n + 1), size, size, r.n});
    }
}

// Puts the subdiagonal in its place and makes it real: its phases go into the rows and columns behind.
void MakeSubdiagonalReal(const Reduction& r, Complex* columns) {
    Complex phase{1.0, 0.0};
    for (std::ptrdiff_t m = r.low + 1; m <= r.high; ++m) {
        Complex* row = r.a + m * r.n;
        std::fill(row + r.low, row + m - 1, Complex{});
        row[m - 1] = {RealImage(r.subdiagonal[m], &phase), 0.0};
        for (std::ptrdiff_t j = m + 1; j < r.n; ++j) row[j] = Conjugate(phase) * row[j];
        for (std::ptrdiff_t i = 0; i < m; ++i) r.a[i * r.n + m] *= phase;
        if (columns != nullptr)
            for (std::ptrdiff_t i = 0; i < r.n; ++i) columns[m * r.n + i] *= phase;
    }
}

}  // namespace

int32_t CxEigenGeneralCore(const Complex* a, int32_t order, int32_t want_vectors, Complex* w, Complex* v) {
    if (order < 1) return kEmptyInput;
    if (want_vectors != 0 && want_vectors != 1) return kBadSelector;
    if (HasUnusable(a, Count(order) * Count(order))) return kNotFinite;

    const std::ptrdiff_t n = order;
    Scratch<Complex> h(Count(order) * (Count(order) + 4));
    Scratch<double> scale(2 * Count(order));
    if (!h || !scale) return kOutOfMemory;
    Complex* work = h.data() + n * n;

    std::copy_n(a, n * n, h.data());
    const Balance balance = BalanceMatrix(h.data(), n, scale.data());
    const Reduction reduction{h.data(),         n,        balance.low,  balance.high, work,
                              scale.data() + n, work + n, work + 2 * n, work + 3 * n};
    ReduceToHessenberg(reduction);
    Complex* columns = want_vectors == 1 ? v : nullptr;
    if (columns != nullptr) Accumulate(reduction, columns);
    MakeSubdiagonalReal(reduction, columns);

    double norm = 0.0;
    for (std::ptrdiff_t i = 0; i < n; ++i)
        for (std::ptrdiff_t j = std::max<std::ptrdiff_t>(i - 1, 0); j < n; ++j) norm += SumOfParts(h.data()[i * n + j]);
    const ComplexHessenberg problem{h.data(), n, balance.low, balance.high, columns, norm};
    if (const int32_t status = ReduceToComplexSchur(problem, w)) return status;
    if (columns == nullptr) return kOk;

    // Row by row from the end the Schur form gives way to the eigenvectors.
    if (const int32_t status = SchurVectors(problem, w)) return status;
    for (std::ptrdiff_t j = 0; j < n; ++j) {
        Complex* x = h.data() + j * n;
        Unbalance(balance, n, x);
        double squares = 0.0;
        for (std::ptrdiff_t i = 0; i < n; ++i) squares += SquaredModulus(x[i]);
        const double norm_of_x = squares > 0.0 ? std::sqrt(squares) : 1.0;
        for (std::ptrdiff_t i = 0; i < n; ++i) v[i * n + j] = x[i] / norm_of_x;
    }
    return kOk;
}

}  // namespace krnumer
