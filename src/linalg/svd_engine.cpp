#include "linalg/svd_engine.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <utility>

#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/householder.h"
#include "linalg/rotations.h"
#include "linalg/svd_bidiagonal.h"
#include "linalg/transpose.h"
#include "linalg/workspace.h"

namespace krnumer {

namespace {

// The reduction of a tall matrix to a bidiagonal one, A = P H1 ... Hn B Gn-1 ... G1 Q^H. The vectors of the reflectors
// H and G stay in the columns and rows of A; the diagonal unitary P and Q make a complex B real.
template <class T>
struct Reduction {
    T* a;
    std::ptrdiff_t m;
    std::ptrdiff_t n;
    double* diagonal;
    double* superdiagonal;  // [i] above diagonal[i]
    double* left_h;         // of H1 ... Hn
    double* right_h;        // of G1 ... Gn-1
    T* left_phase;          // P
    T* right_phase;         // Q
    T* sums;                // work space for a row
    T* scaled;              // and another

    T* At(std::ptrdiff_t i, std::ptrdiff_t j) const { return a + i * n + j; }
};

template <class T>
void Bidiagonalise(const Reduction<T>& r) {
    T phase = FromReal<T>(1.0);  // of P and Q alternately
    r.superdiagonal[0] = 0.0;
    for (std::ptrdiff_t i = 0; i < r.n; ++i) {
        const std::ptrdiff_t below = r.m - i;
        const std::ptrdiff_t rest = r.n - i - 1;
        T* column = r.At(i, i);
        T* row = column + 1;

        const Reflector<T> left = MakeReflector(column, below, r.n);
        r.left_h[i] = left.h;
        r.right_phase[i] = phase;
        r.diagonal[i] = RealImage(left.image, &phase);
        r.left_phase[i] = phase;
        if (rest == 0) break;

        // The first row alone tells the right reflector, so the other rows meet both at once.
        const Spaced<T> v{column, r.n}, v_below{column + r.n, r.n};
        const Block<T> others{row + r.n, below - 1, rest, r.n};
        if (left.h != 0.0) {
            FindReflection(v, left.h, {row, below, rest, r.n}, r.sums);
            AddProducts(v, r.sums, {row, 1, rest, r.n});
        }
        const Reflector<T> right = MakeReflector(row, rest, 1);
        if (right.h == 0.0) {
            if (left.h != 0.0) AddProducts(v_below, r.sums, others);
        } else {
            std::transform(row, row + rest, r.scaled, [&right](T x) { return x / right.h; });
            if (left.h != 0.0) {
                AddProductsAndReflectRows(v_below, r.sums, row, r.scaled, others);
            } else {
                ReflectRows(row, r.scaled, others);
            }
        }
        r.right_h[i] = right.h;
        r.superdiagonal[i + 1] = RealImage(Conjugate(right.image), &phase);
    }
}

// V = G1 ... Gn-1 Q.
template <class T>
void AccumulateRight(const Reduction<T>& r, T* v) {
    const std::ptrdiff_t n = r.n;
    std::fill_n(v, n * n, T{});
    v[n * n - 1] = r.right_phase[n - 1];
    for (std::ptrdiff_t i = n - 2; i >= 0; --i) {
        v[i * (n + 1)] = r.right_phase[i];
        if (r.right_h[i] == 0.0) continue;
        const std::ptrdiff_t rest = n - i - 1;
        T* reflector = r.At(i, i + 1);
        std::transform(reflector, reflector + rest, reflector, [](T x) { return Conjugate(x); });
        ReflectColumns({reflector, 1}, r.right_h[i], Block<T>{v + (i + 1) * (n + 1), rest, rest, n}, r.sums);
    }
}

// A = the first n columns of P H1 ... Hn.
template <class T>
void AccumulateLeft(const Reduction<T>& r) {
    for (std::ptrdiff_t i = r.n - 1; i >= 0; --i) {
        const std::ptrdiff_t below = r.m - i;
        const std::ptrdiff_t rest = r.n - i - 1;
        const double h = r.left_h[i];
        T* column = r.At(i, i);
        std::fill_n(column + 1, rest, T{});
        if (h != 0.0) {
            ReflectColumns({column, r.n}, h, Block<T>{column + 1, below, rest, r.n}, r.sums);
            const T factor = Conjugate(*column) * r.left_phase[i] / h;
            for (std::ptrdiff_t k = 0; k < below; ++k) column[k * r.n] = column[k * r.n] * factor;
        }
        *column += r.left_phase[i];  // without a reflector the column is zero
    }
}

// Exchange sort into descending order; equal values stay where they are. Null order: values only.
void SortDescending(double* w, std::ptrdiff_t n, std::ptrdiff_t* order) {
    for (std::ptrdiff_t i = 0; i < n; ++i) {
        for (std::ptrdiff_t j = i + 1; j < n; ++j) {
            if (!(w[i] < w[j])) continue;
            std::swap(w[i], w[j]);
            if (order != nullptr) std::swap(order[i], order[j]);
        }
    }
}

}  // namespace

template <class T>
int32_t DecomposeTall(T* a, int32_t rows, int32_t columns, double* s, T* v) {
    const std::ptrdiff_t m = rows, n = columns;
    const bool vectors = v != nullptr;
    Workspace<T> work(4 * n + (vectors ? (m + n) * n : 0), 3 * n + (vectors ? 5 * n : 0));
    if (!work) return kOutOfMemory;

    const Reduction<T> reduction{.a = a,
                                 .m = m,
                                 .n = n,
                                 .diagonal = s,
                                 .superdiagonal = work.Doubles(n),
                                 .left_h = work.Doubles(n),
                                 .right_h = work.Doubles(n),
                                 .left_phase = work.Elements(n),
                                 .right_phase = work.Elements(n),
                                 .sums = work.Elements(n),
                                 .scaled = work.Elements(n)};
    const Bidiagonal bidiagonal{n, s, reduction.superdiagonal};
    Bidiagonalise(reduction);
    if (!vectors) {
        const int32_t status = DiagonaliseBidiagonal(bidiagonal, {}, {}, nullptr);
        if (status == kOk) SortDescending(s, n, nullptr);
        return status;
    }

    AccumulateRight(reduction, v);
    AccumulateLeft(reduction);
    T* left = work.Elements(m * n);
    T* right = work.Elements(n * n);
    TransposeCore<T>(a, rows, columns, left);
    TransposeCore<T>(v, columns, columns, right);
    const int32_t status = DiagonaliseBidiagonal(bidiagonal, {left, m}, {right, n}, work.Doubles(4 * n));
    if (status != kOk) return status;

    std::ptrdiff_t* order = work.Indices(n);
    std::iota(order, order + n, 0);
    SortDescending(s, n, order);
    RowsToColumns(left, order, n, m, a);
    RowsToColumns(right, order, n, n, v);
    return kOk;
}

template int32_t DecomposeTall(double*, int32_t, int32_t, double*, double*);
template int32_t DecomposeTall(Complex*, int32_t, int32_t, double*, Complex*);

}  // namespace krnumer
