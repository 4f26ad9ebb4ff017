#include "linalg/svd_engine.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <utility>

#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/householder.h"
#include "linalg/rotations.h"
#include "linalg/svd_bidiagonal.h"

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
    T* row;                 // work space

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
        if (left.h != 0.0) ReflectColumns(column, r.n, left.h, row, below, rest, r.n, r.row);
        r.left_h[i] = left.h;
        r.right_phase[i] = phase;
        r.diagonal[i] = RealImage(left.image, &phase);
        r.left_phase[i] = phase;
        if (rest == 0) break;

        const Reflector<T> right = MakeReflector(row, rest, 1);
        if (right.h != 0.0) {
            for (std::ptrdiff_t k = 0; k < rest; ++k) r.row[k] = row[k] / right.h;
            ReflectRows(row, r.row, row + r.n, below - 1, rest, r.n);
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
        ReflectColumns(reflector, 1, r.right_h[i], v + (i + 1) * (n + 1), rest, rest, n, r.row);
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
            ReflectColumns(column, r.n, h, column + 1, below, rest, r.n, r.row);
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
int32_t DecomposeTall(T* a, std::ptrdiff_t m, std::ptrdiff_t n, double* s, T* v) {
    constexpr std::ptrdiff_t kParts = kIsComplex<T> ? 2 : 1;  // doubles per element

    const std::ptrdiff_t vectors = v != nullptr ? kParts * (m + n) * n + 5 * n : 0;
    Scratch<double> block(static_cast<std::size_t>((3 + 3 * kParts) * n + vectors));
    if (!block) return kOutOfMemory;
    double* next = block.data();
    const auto doubles = [&next](std::ptrdiff_t count) { return std::exchange(next, next + count); };
    const auto elements = [&](std::ptrdiff_t count) { return reinterpret_cast<T*>(doubles(kParts * count)); };

    const Reduction<T> reduction{a, m, n, s, doubles(n), doubles(n), doubles(n), elements(n), elements(n), elements(n)};
    const Bidiagonal bidiagonal{n, s, reduction.superdiagonal};
    Bidiagonalise(reduction);
    if (v == nullptr) {
        const int32_t status = DiagonaliseBidiagonal(bidiagonal, {}, {}, nullptr);
        if (status == kOk) SortDescending(s, n, nullptr);
        return status;
    }

    AccumulateRight(reduction, v);
    AccumulateLeft(reduction);
    T* left = elements(m * n);
    T* right = elements(n * n);
    ColumnsToRows(a, m, n, left);
    ColumnsToRows(v, n, n, right);
    double* rotations = doubles(4 * n);
    const int32_t status = DiagonaliseBidiagonal(bidiagonal, {left, m}, {right, n}, rotations);
    if (status != kOk) return status;

    auto* order = reinterpret_cast<std::ptrdiff_t*>(doubles(n));
    std::iota(order, order + n, 0);
    SortDescending(s, n, order);
    RowsToColumns(left, order, n, m, a);
    RowsToColumns(right, order, n, n, v);
    return kOk;
}

template int32_t DecomposeTall(double*, std::ptrdiff_t, std::ptrdiff_t, double*, double*);
template int32_t DecomposeTall(Complex*, std::ptrdiff_t, std::ptrdiff_t, double*, Complex*);

}  // namespace krnumer
