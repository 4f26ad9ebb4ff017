#include "linalg/eigen_symmetric.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numeric>
#include <utility>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/householder.h"
#include "linalg/rotations.h"
#include "linalg/row_sums.h"
#include "linalg/transpose.h"
#include "linalg/tridiagonal.h"
#include "linalg/workspace.h"

namespace krnumer {

namespace {

// The reduction A = Gn-1 ... G1 P T P^H G1 ... Gn-1 to a real tridiagonal T. The vector of reflector G[i] stays in row
// i of A, left of the diagonal; the diagonal unitary P makes a complex T real.
template <class T>
struct Tridiagonal {
    T* a;
    std::ptrdiff_t n;
    double* diagonal;
    double* subdiagonal;  // [i] left of diagonal[i + 1]
    double* h;            // of the reflectors
    T* phase;             // P
    T* row;               // work space

    T* Row(std::ptrdiff_t i) const { return a + i * n; }
};

// p = A u for the Hermitian matrix of which the lower triangle is given. Each element is summed in the order of the
// columns: those up to the diagonal from its own row, the others as the rows below come by.
template <class T>
void MultiplyLower(const T* a, std::ptrdiff_t size, std::ptrdiff_t row_stride, const T* u, T* p) {
    constexpr int kGroup = 4;
    T sums[kGroup];
    std::ptrdiff_t j = 0;
    const auto finish = [&](std::ptrdiff_t rows) {
        for (std::ptrdiff_t r = 0; r < rows; ++r) {
            const T* row = a + (j + r) * row_stride;
            T sum = sums[r];
            for (std::ptrdiff_t k = j; k <= j + r; ++k) sum += row[k] * u[k];
            p[j + r] = sum;
            const T factor = u[j + r];
            for (std::ptrdiff_t k = 0; k < j + r; ++k) p[k] += Conjugate(row[k]) * factor;
        }
    };
    for (; j + kGroup <= size; j += kGroup) {
        RowSums<kGroup>(a + j * row_stride, row_stride, j, u, sums);
        finish(kGroup);
    }
    for (; j < size; ++j) {
        RowSums<1>(a + j * row_stride, row_stride, j, u, sums);
        finish(1);
    }
}

// G A G for the leading block of A, lower triangle only, with G = I + u u^H / h.
template <class T>
void ReflectBothSides(const T* u, double h, T* a, std::ptrdiff_t size, std::ptrdiff_t row_stride, T* q) {
    MultiplyLower(a, size, row_stride, u, q);
    double projection = 0.0;
    for (std::ptrdiff_t k = 0; k < size; ++k) {
        q[k] = q[k] / h;
        projection += RealPart(Conjugate(u[k]) * q[k]);
    }
    const double half = projection / (2.0 * h);
    for (std::ptrdiff_t k = 0; k < size; ++k) q[k] += u[k] * half;
    for (std::ptrdiff_t j = 0; j < size; ++j) {
        T* row = a + j * row_stride;
        const T uj = u[j], qj = q[j];
        for (std::ptrdiff_t k = 0; k <= j; ++k) row[k] += uj * Conjugate(q[k]) + qj * Conjugate(u[k]);
    }
}

template <class T>
void Tridiagonalise(const Tridiagonal<T>& t) {
    T phase = FromReal<T>(1.0);
    for (std::ptrdiff_t i = t.n - 1; i > 0; --i) {
        T* row = t.Row(i);
        t.diagonal[i] = RealPart(row[i]);
        t.phase[i] = phase;
        Reflector<T> reflector{row[0], 0.0};
        if (i > 1) reflector = MakeReflector(row + i - 1, i, -1);
        if (reflector.h != 0.0) {
            std::transform(row, row + i, row, [](T x) { return Conjugate(x); });
            ReflectBothSides(row, reflector.h, t.a, i, t.n, t.row);
        }
        t.h[i] = reflector.h;
        t.subdiagonal[i - 1] = RealImage(Conjugate(reflector.image), &phase);
    }
    t.diagonal[0] = RealPart(t.a[0]);
    t.phase[0] = phase;
}

// A = Gn-1 ... G1 P.
template <class T>
void Accumulate(const Tridiagonal<T>& t) {
    for (std::ptrdiff_t i = 0; i < t.n; ++i) {
        T* row = t.Row(i);
        if (i > 1 && t.h[i] != 0.0) ReflectColumns({row, 1}, t.h[i], Block<T>{t.a, i, i, t.n}, t.row);
        std::fill_n(row, i, T{});
        row[i] = t.phase[i];
        for (std::ptrdiff_t k = 0; k < i; ++k) t.Row(k)[i] = T{};
    }
}

void Normalise(VectorRows vectors, std::ptrdiff_t n) {
    for (std::ptrdiff_t i = 0; i < n; ++i) {
        double* x = vectors[i];
        double squares = 0.0;
        for (std::ptrdiff_t k = 0; k < vectors.length; ++k) squares += x[k] * x[k];
        if (!(squares > 0.0)) continue;
        const double norm = std::sqrt(squares);
        for (std::ptrdiff_t k = 0; k < vectors.length; ++k) x[k] /= norm;
    }
}

// Ascending, by selection. Null order: values only.
void SortAscending(double* w, std::ptrdiff_t n, std::ptrdiff_t* order) {
    for (std::ptrdiff_t i = 0; i < n; ++i) {
        const std::ptrdiff_t smallest = std::min_element(w + i, w + n) - w;
        std::swap(w[i], w[smallest]);
        if (order != nullptr) std::swap(order[i], order[smallest]);
    }
}

template <class T>
int32_t HermitianEigen(const T* a, int32_t order_of_a, int32_t want_vectors, double* w, T* v) {
    constexpr Negligible kNegligible = kIsComplex<T> ? Negligible::kAgainstLargest : Negligible::kInSum;

    if (order_of_a < 1) return kEmptyInput;
    if (want_vectors != 0 && want_vectors != 1) return kBadSelector;
    if constexpr (!kIsComplex<T>) {
        if (HasUnusable(a, Count(order_of_a) * Count(order_of_a))) return kNotFinite;
    }

    const std::ptrdiff_t n = order_of_a;
    const bool vectors = want_vectors == 1;
    Workspace<T> work((n + 2) * n, 5 * n);
    if (!work) return kOutOfMemory;
    T* square = work.Elements(n * n);  // without vectors the copy of A, with them the vectors as rows

    const Tridiagonal<T> tridiagonal{.a = vectors ? v : square,
                                     .n = n,
                                     .diagonal = w,
                                     .subdiagonal = work.Doubles(n),
                                     .h = work.Doubles(n),
                                     .phase = work.Elements(n),
                                     .row = work.Elements(n)};
    if (tridiagonal.a != a) std::copy_n(a, n * n, tridiagonal.a);
    if constexpr (kIsComplex<T>) {
        for (std::ptrdiff_t i = 0; i < n; ++i) tridiagonal.Row(i)[i].im = 0.0;
    }
    Tridiagonalise(tridiagonal);
    if (!vectors) {
        const int32_t status = DiagonaliseTridiagonal(n, w, tridiagonal.subdiagonal, {}, nullptr, kNegligible);
        if (status == kOk) SortAscending(w, n, nullptr);
        return status;
    }

    Accumulate(tridiagonal);
    TransposeCore<T>(v, order_of_a, order_of_a, square);
    const VectorRows rows(square, n);
    const int32_t status =
        DiagonaliseTridiagonal(n, w, tridiagonal.subdiagonal, rows, work.Doubles(2 * n), kNegligible);
    if (status != kOk) return status;
    Normalise(rows, n);
    std::ptrdiff_t* order = work.Indices(n);
    std::iota(order, order + n, 0);
    SortAscending(w, n, order);
    RowsToColumns(square, order, n, n, v);
    return kOk;
}

}  // namespace

int32_t SymEigenCore(const double* a, int32_t n, int32_t want_vectors, double* w, double* v) {
    return HermitianEigen(a, n, want_vectors, w, v);
}
int32_t SymEigenCore(double* a, int32_t n, int32_t want_vectors, double* w, double* v) {
    return HermitianEigen(a, n, want_vectors, w, v != nullptr ? v : a);
}

int32_t HermitianEigenCore(const Complex* a, int32_t n, int32_t want_vectors, double* w, Complex* v) {
    return HermitianEigen(a, n, want_vectors, w, v);
}
int32_t HermitianEigenCore(Complex* a, int32_t n, int32_t want_vectors, double* w, Complex* v) {
    return HermitianEigen(a, n, want_vectors, w, v != nullptr ? v : a);
}

}  // namespace krnumer
