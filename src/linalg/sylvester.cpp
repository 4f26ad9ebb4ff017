#include "linalg/sylvester.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/lapack.h"
#include "linalg/schur.h"
#include "linalg/svd.h"
#include "linalg/transpose.h"

namespace krnumer {

namespace {

// Everything below is column-major.

template <class T>
constexpr lapack::Transposition kAdjoint = kIsComplex<T> ? lapack::kConjugateTranspose : lapack::kTranspose;

// out = op(A) op(B), m by n with k as the inner dimension.
template <class T>
void Multiply(lapack::Transposition op_a, lapack::Transposition op_b, int32_t m, int32_t n, int32_t k, const T* a,
              int32_t lda, const T* b, int32_t ldb, T* out) {
    lapack::Gemm(lapack::kColumnMajor, op_a, op_b, m, n, k, FromReal<T>(1.0), a, lda, b, ldb, T{}, out, m);
}

// op(M), M square.
template <class T>
struct Operand {
    const T* elements;
    int32_t order;
    bool transposed;

    T operator()(int32_t row, int32_t column) const {
        return transposed ? Conjugate(At(column, row)) : At(row, column);
    }
    T At(int32_t row, int32_t column) const { return elements[Count(column) * Count(order) + Count(row)]; }
    Operand Adjoint() const { return {elements, order, !transposed}; }
    char letter() const { return !transposed ? 'N' : kIsComplex<T> ? 'C' : 'T'; }
};

// op(A) X + sign X op(B) = C
template <class T>
struct Equation {
    Operand<T> a;
    Operand<T> b;
    int32_t sign;
};

// Solutions of least norm of a square system, b becoming x; singular values up to rcond times the largest count as 0.
// Without memory, b stays as it is. The matrix is column-major in the real case and row-major in the complex one.
int32_t LeastSquares(double* matrix, int32_t order, double rcond, double* b) {
    const int32_t levels = TruncateToInt32(std::log(order) / std::log(2.0)) + 1;
    Scratch<double> s(Count(order));
    Scratch<int32_t> iwork(Count(3 * levels + 11) * Count(order));
    Scratch<double> work;
    if (!s || !iwork) return kOutOfMemory;
    int32_t info = 0;
    int32_t rank = 0;
    const auto call = [&](double* space, int32_t size) {
        return lapack::Gelsd(order, order, 1, matrix, order, b, order, s.data(), rcond, rank, space, size,
                             iwork.data());
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, work, call)) return status;
    if (info < 0) return kLapackError;
    return info > 0 ? kNoConvergence : kOk;
}

int32_t LeastSquares(Complex* matrix, int32_t order, double rcond, Complex* b) {
    Scratch<Complex> v(Count(order) * Count(order));
    Scratch<Complex> projection(Count(order), Scratch<Complex>::kZeroed);
    Scratch<double> s(Count(order));
    if (!v || !projection || !s) return kOutOfMemory;
    if (const int32_t status = SvdCore(matrix, order, order, matrix, s.data(), v.data(), false)) return status;
    const double cut = rcond * s[0];
    int32_t rank = 0;
    while (rank < order && s[Count(rank)] > cut) ++rank;
    if (rank == 0) {
        std::fill_n(b, Count(order), Complex{});
        return kOk;
    }
    const Complex one{1.0, 0.0};
    lapack::Gemm(lapack::kRowMajor, lapack::kConjugateTranspose, lapack::kNoTranspose, rank, 1, order, one, matrix,
                 order, b, 1, {}, projection.data(), 1);
    for (size_t i = 0; i < Count(rank); ++i) projection[i] = projection[i] / s[i];
    lapack::Gemm(lapack::kRowMajor, lapack::kNoTranspose, lapack::kNoTranspose, order, 1, rank, one, v.data(), order,
                 projection.data(), 1, {}, b, 1);
    return kOk;
}

// Solves for `width` columns of X together, as if the others were 0: the Kronecker form of that part of the equation.
template <class T>
int32_t SolveColumns(const Equation<T>& equation, int32_t first, int32_t width, double rcond, T* columns) {
    const int32_t m = equation.a.order;
    const size_t order = Count(m) * Count(width);
    Scratch<T> matrix(order * order, Scratch<T>::kZeroed);
    if (!matrix) return kOutOfMemory;
    const auto at = [&](int32_t block_row, int32_t i, int32_t block_column, int32_t j) -> T& {
        const size_t row = Count(block_row) * Count(m) + Count(i);
        const size_t column = Count(block_column) * Count(m) + Count(j);
        return matrix[kIsComplex<T> ? row * order + column : column * order + row];
    };
    for (int32_t q = 0; q < width; ++q) {
        for (int32_t j = 0; j < m; ++j)
            for (int32_t i = 0; i < m; ++i) at(q, i, q, j) = equation.a(i, j);
        for (int32_t p = 0; p < width; ++p) {
            const T factor = equation.b(first + p, first + q) * static_cast<double>(equation.sign);
            for (int32_t i = 0; i < m; ++i) at(q, i, p, i) += factor;
        }
    }
    return LeastSquares(matrix.data(), m * width, rcond, columns);
}

// Takes the columns of X that are known already, those before `first` or those from `last` on, to the right-hand side.
template <class T>
void SubtractKnown(const Equation<T>& equation, int32_t first, int32_t last, T* c) {
    const int32_t m = equation.a.order;
    const int32_t n = equation.b.order;
    const bool backward = equation.b.transposed;
    const int32_t known = backward ? n - last : first;
    if (known == 0) return;
    const size_t start = backward ? Count(last) : 0;
    const T* factors = equation.b.elements + (backward ? Count(first) + start * Count(n) : Count(first) * Count(n));
    lapack::Gemm(lapack::kColumnMajor, lapack::kNoTranspose, backward ? kAdjoint<T> : lapack::kNoTranspose, m,
                 last - first, known, FromReal<T>(-equation.sign), c + start * Count(m), m, factors, n,
                 FromReal<T>(1.0), c + Count(first) * Count(m), m);
}

// Substitution through the columns of the (quasi-)triangular B, those of a 2 by 2 block together.
template <class T>
int32_t Substitute(const Equation<T>& equation, T* c) {
    const int32_t m = equation.a.order;
    const int32_t n = equation.b.order;
    const double rcond = (kIsComplex<T> ? 1.0 : 2.0) * m * kEpsilon;
    const auto in_block = [&](int32_t j) {  // columns j and j + 1
        return !kIsComplex<T> && Modulus(equation.b.At(j + 1, j)) >= n * kEpsilon;
    };
    for (int32_t done = 0; done < n;) {
        int32_t first = equation.b.transposed ? n - 1 - done : done;
        int32_t width = 1;
        if (n - done > 1 && in_block(equation.b.transposed ? first - 1 : first)) {
            width = 2;
            first -= equation.b.transposed;
        }
        SubtractKnown(equation, first, first + width, c);
        const int32_t status = SolveColumns(equation, first, width, rcond, c + Count(first) * Count(m));
        if (status != kOk) return status;
        done += width;
    }
    return kOk;
}

// For wide C the adjoint equation is solved: op(B)^H X^H + sign X^H op(A)^H = sign C^H.
template <class T>
int32_t SolveByColumns(const Equation<T>& equation, T* c) {
    const int32_t m = equation.a.order;
    const int32_t n = equation.b.order;
    if (n <= m) return Substitute(equation, c);
    if (const int32_t status = ConjTransposeInPlace(c, n, m)) return status;
    if (equation.sign < 0) std::transform(c, c + Count(m) * Count(n), c, [](T element) { return -element; });
    const Equation<T> adjoint{equation.b.Adjoint(), equation.a.Adjoint(), equation.sign};
    if (const int32_t status = Substitute(adjoint, c)) return status;
    return ConjTransposeInPlace(c, m, n);
}

// What the triangular solver cannot do: equations that are singular or nearly so. The Kronecker form takes the square
// of m n elements, which limits it.
template <class T>
int32_t SolveSingular(const Equation<T>& equation, T* c) {
    constexpr size_t kLargestKronecker = kIsComplex<T> ? 800 : 1600;
    const size_t unknowns = Count(equation.a.order) * Count(equation.b.order);
    if (unknowns <= kLargestKronecker) {
        const double rcond = static_cast<double>(unknowns) * kEpsilon;
        const int32_t status = SolveColumns(equation, 0, equation.b.order, rcond, c);
        if (status != kOutOfMemory) return status;
    }
    return SolveByColumns(equation, c);
}

bool IsFlag(int32_t selector) {
    return selector == 0 || selector == 1;
}

}  // namespace

template <class T>
int32_t SylvesterCore(const T* a, const T* b, T* c, int32_t m, int32_t n, const SylvesterOptions& options,
                      double* scale, int32_t* singular) {
    const auto [transpose_a, transpose_b, sign, form] = options;
    if (m < 1 || n < 1) return kEmptyInput;
    if (!IsFlag(transpose_a) || !IsFlag(transpose_b) || (sign != 1 && sign != -1) || !IsFlag(form)) return kBadSelector;
    const size_t left = Count(m) * Count(m);
    const size_t right = Count(n) * Count(n);
    const size_t unknowns = Count(m) * Count(n);
    if (HasUnusable(a, left) || HasUnusable(b, right) || HasUnusable(c, unknowns)) return kNotFinite;

    Scratch<T> columns(left + right + 2 * unknowns);
    if (!columns) return kOutOfMemory;
    T* const ta = columns.data();
    T* const tb = ta + left;
    T* const rhs = tb + right;  // kept for the fallback, since the triangular solver overwrites what it fails on
    T* const y = rhs + unknowns;
    if (const int32_t status = TransposeCore(a, m, m, ta)) return status;
    if (const int32_t status = TransposeCore(b, n, n, tb)) return status;
    if (const int32_t status = TransposeCore(c, m, n, rhs)) return status;

    const bool general = form == 0;
    Scratch<T> vectors;
    T* ua = nullptr;
    T* ub = nullptr;
    if (general) {
        Scratch<Complex> w(Count(std::max(m, n)));
        if (!w || !vectors.Allocate(left + right)) return kOutOfMemory;
        ua = vectors.data();
        ub = ua + left;
        if (const int32_t status = DecomposeColumns(ta, m, ua, w.data(), n)) return status;
        if (const int32_t status = DecomposeColumns(tb, n, ub, w.data(), n)) return status;
        Multiply(kAdjoint<T>, lapack::kNoTranspose, m, n, m, ua, m, rhs, m, y);
        Multiply(lapack::kNoTranspose, lapack::kNoTranspose, m, n, n, y, m, ub, n, rhs);
    }

    const Equation<T> equation{{ta, m, transpose_a == 1}, {tb, n, transpose_b == 1}, sign};
    std::copy_n(rhs, unknowns, y);
    double factor = 1.0;
    const int32_t info =
        lapack::Trsyl(equation.a.letter(), equation.b.letter(), sign, m, n, ta, m, tb, n, y, m, factor);
    if (info < 0) return kLapackError;
    if (info > 0) {
        if (const int32_t status = SolveSingular(equation, rhs)) return status;
        std::copy_n(rhs, unknowns, y);
        factor = 1.0;
    }

    if (general) {
        Multiply(lapack::kNoTranspose, lapack::kNoTranspose, m, n, m, ua, m, y, m, rhs);
        Multiply(lapack::kNoTranspose, kAdjoint<T>, m, n, n, rhs, m, ub, n, y);
    }
    *scale = factor;
    *singular = info > 0;
    return TransposeCore(y, n, m, c);
}

template int32_t SylvesterCore(const double*, const double*, double*, int32_t, int32_t, const SylvesterOptions&,
                               double*, int32_t*);
template int32_t SylvesterCore(const Complex*, const Complex*, Complex*, int32_t, int32_t, const SylvesterOptions&,
                               double*, int32_t*);

}  // namespace krnumer
