// Matrices to try decompositions on, and what is left over when a decomposition is multiplied out. Row-major, real and
// complex by one template.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <random>
#include <utility>
#include <vector>

#include "frame/complex.h"
#include "frame/numeric.h"
#include "linalg/element.h"

namespace krnumer {

template <class T>
struct DenseMatrix {
    DenseMatrix(int32_t m, int32_t n) : rows(m), columns(n), elements(Count(m) * Count(n), T{}) {}
    DenseMatrix(int32_t m, int32_t n, std::vector<T> row_after_row)
        : rows(m), columns(n), elements(std::move(row_after_row)) {}

    T& operator()(int32_t i, int32_t j) { return elements[Count(i) * Count(columns) + Count(j)]; }
    T operator()(int32_t i, int32_t j) const { return elements[Count(i) * Count(columns) + Count(j)]; }
    T* data() { return elements.data(); }
    const T* data() const { return elements.data(); }

    friend bool operator==(const DenseMatrix&, const DenseMatrix&) = default;

    int32_t rows;
    int32_t columns;
    std::vector<T> elements;
};

using RandomBits = std::mt19937_64;

inline double Uniform(RandomBits& bits) {
    return 2.0 * std::ldexp(static_cast<double>(bits() >> 11), -53) - 1.0;
}

template <class T>
T RandomElement(RandomBits& bits) {
    if constexpr (kIsComplex<T>) {
        const double re = Uniform(bits);
        return {re, Uniform(bits)};
    } else {
        return Uniform(bits);
    }
}

template <class T, class Element>
DenseMatrix<T> Generate(int32_t m, int32_t n, Element&& element) {
    DenseMatrix<T> a(m, n);
    for (int32_t i = 0; i < m; ++i)
        for (int32_t j = 0; j < n; ++j) a(i, j) = element(i, j);
    return a;
}

template <class T>
DenseMatrix<T> RandomMatrix(int32_t m, int32_t n, uint64_t seed) {
    RandomBits bits(seed);
    return Generate<T>(m, n, [&](int32_t, int32_t) { return RandomElement<T>(bits); });
}

template <class T>
DenseMatrix<T> RandomHermitian(int32_t n, uint64_t seed) {
    DenseMatrix<T> a = RandomMatrix<T>(n, n, seed);
    for (int32_t i = 0; i < n; ++i) {
        a(i, i) = FromReal<T>(RealPart(a(i, i)));
        for (int32_t j = 0; j < i; ++j) a(j, i) = Conjugate(a(i, j));
    }
    return a;
}

// Elements fall off by 10^-12 from the first row and column to the last.
template <class T>
DenseMatrix<T> GradedMatrix(int32_t m, int32_t n, uint64_t seed) {
    DenseMatrix<T> a = RandomMatrix<T>(m, n, seed);
    for (int32_t i = 0; i < m; ++i)
        for (int32_t j = 0; j < n; ++j) a(i, j) = a(i, j) * std::pow(10.0, -12.0 * (i + j) / (m + n));
    return a;
}

template <class T>
DenseMatrix<T> IntegerMatrix(int32_t m, int32_t n, uint64_t seed) {
    RandomBits bits(seed);
    const auto integer = [&bits] { return static_cast<double>(bits() % 19) - 9.0; };
    return Generate<T>(m, n, [&](int32_t, int32_t) {
        if constexpr (kIsComplex<T>) {
            const double re = integer();
            return Complex{re, integer()};
        } else {
            return integer();
        }
    });
}

template <class T>
DenseMatrix<T> HilbertMatrix(int32_t m, int32_t n) {
    return Generate<T>(m, n, [](int32_t i, int32_t j) { return FromReal<T>(1.0 / (i + j + 1)); });
}

// Row i holds the powers of i / m - 1/2 (times the imaginary unit to the power i, if complex).
template <class T>
DenseMatrix<T> VandermondeMatrix(int32_t m, int32_t n) {
    return Generate<T>(m, n, [m](int32_t i, int32_t j) {
        const double power = std::pow(static_cast<double>(i) / m - 0.5, j);
        if constexpr (kIsComplex<T>) {
            constexpr Complex kTurns[4] = {{1, 0}, {0, 1}, {-1, 0}, {0, -1}};
            return kTurns[(i * j) % 4] * power;
        } else {
            return power;
        }
    });
}

// ---- Matrices of eigenproblem collections, by their formulas ------------------------------------------------------

// Ill-conditioned eigenvalues in reciprocal pairs (W. L. Frank, J. SIAM 6, 378, 1958).
inline DenseMatrix<double> FrankMatrix(int32_t n) {
    return Generate<double>(n, n, [n](int32_t i, int32_t j) { return j + 1 < i ? 0.0 : n - std::max(i, j); });
}

// Tridiagonal with nearly equal pairs of eigenvalues.
inline DenseMatrix<double> WilkinsonMatrix(int32_t n) {
    return Generate<double>(n, n, [n](int32_t i, int32_t j) {
        if (i == j) return std::fabs((n - 1) / 2.0 - i);
        return std::abs(i - j) == 1 ? 1.0 : 0.0;
    });
}

// Toeplitz, with very sensitive complex eigenvalues (J. Grcar, 1989).
inline DenseMatrix<double> GrcarMatrix(int32_t n) {
    return Generate<double>(n, n, [](int32_t i, int32_t j) {
        if (i == j + 1) return -1.0;
        return j >= i && j <= i + 3 ? 1.0 : 0.0;
    });
}

// Tridiagonal with zero diagonal and eigenvalues n - 1, n - 3, ..., 1 - n (P. A. Clement, SIAM Review 1, 50, 1959).
inline DenseMatrix<double> ClementMatrix(int32_t n) {
    return Generate<double>(n, n, [n](int32_t i, int32_t j) {
        if (j == i + 1) return static_cast<double>(n - j);
        return i == j + 1 ? static_cast<double>(i) : 0.0;
    });
}

// Double, small, zero and nearly equal eigenvalues (J. B. Rosser et al., J. Res. Nat. Bur. Standards 47, 291, 1951).
inline DenseMatrix<double> RosserMatrix() {
    DenseMatrix<double> a(8, 8);
    a.elements = {611,  196, -192, 407, -8,  -52,  -49, 29,   196, 899,  113, -192, -71,  -43, -8,   -44,
                  -192, 113, 899,  196, 61,  49,   8,   52,   407, -192, 196, 611,  8,    44,  59,   -23,
                  -8,   -71, 61,   8,   411, -599, 208, 208,  -52, -43,  49,  44,   -599, 411, 208,  208,
                  -49,  -8,  8,    59,  208, 208,  99,  -911, 29,  -44,  52,  -23,  208,  208, -911, 99};
    return a;
}

template <class T>
DenseMatrix<T> Product(const DenseMatrix<T>& a, const DenseMatrix<T>& b) {
    DenseMatrix<T> c(a.rows, b.columns);
    for (int32_t i = 0; i < a.rows; ++i)
        for (int32_t k = 0; k < a.columns; ++k)
            for (int32_t j = 0; j < b.columns; ++j) c(i, j) += a(i, k) * b(k, j);
    return c;
}

template <class T>
DenseMatrix<T> Adjoint(const DenseMatrix<T>& a) {
    return Generate<T>(a.columns, a.rows, [&a](int32_t i, int32_t j) { return Conjugate(a(j, i)); });
}

template <class T>
DenseMatrix<T> RankDeficientMatrix(int32_t m, int32_t n, int32_t rank, uint64_t seed) {
    return Product(RandomMatrix<T>(m, rank, seed), RandomMatrix<T>(rank, n, seed + 1));
}

// Columns times the given reals.
template <class T>
DenseMatrix<T> ColumnsScaled(const DenseMatrix<T>& a, const std::vector<double>& factors) {
    return Generate<T>(a.rows, static_cast<int32_t>(factors.size()),
                       [&](int32_t i, int32_t j) { return a(i, j) * factors[Count(j)]; });
}

template <class T>
double FrobeniusNorm(const DenseMatrix<T>& a) {
    double largest = 0.0;
    for (const T& x : a.elements) largest = std::max(largest, SumOfParts(x));
    if (largest == 0.0) return 0.0;
    double sum = 0.0;
    for (const T& x : a.elements) sum += SquaredModulus(x / largest);
    return largest * std::sqrt(sum);
}

// Frobenius norm of the difference, NaN included.
template <class T>
double Distance(const DenseMatrix<T>& a, const DenseMatrix<T>& b) {
    if (a.rows != b.rows || a.columns != b.columns) return kInfinity;
    double sum = 0.0;
    for (std::size_t i = 0; i < a.elements.size(); ++i) sum += SquaredModulus(a.elements[i] - b.elements[i]);
    return std::sqrt(sum);
}

// How far the columns are from orthonormal.
template <class T>
double Unorthogonality(const DenseMatrix<T>& q) {
    const auto identity =
        Generate<T>(q.columns, q.columns, [](int32_t i, int32_t j) { return FromReal<T>(i == j ? 1.0 : 0.0); });
    return Distance(Product(Adjoint(q), q), identity);
}

// A Jordan block, hidden in a full matrix: L J L^-1 with the ones of a lower triangle, exact in small integers.
inline DenseMatrix<double> JordanMatrix(int32_t n, double eigenvalue) {
    const auto block = Generate<double>(
        n, n, [eigenvalue](int32_t i, int32_t j) { return i == j ? eigenvalue : (j == i + 1 ? 1.0 : 0.0); });
    const auto ones = Generate<double>(n, n, [](int32_t i, int32_t j) { return j <= i ? 1.0 : 0.0; });
    const auto inverse =
        Generate<double>(n, n, [](int32_t i, int32_t j) { return i == j ? 1.0 : (i == j + 1 ? -1.0 : 0.0); });
    return Product(ones, Product(block, inverse));
}

inline DenseMatrix<Complex> ToComplex(const DenseMatrix<double>& a) {
    return Generate<Complex>(a.rows, a.columns, [&a](int32_t i, int32_t j) { return Complex{a(i, j), 0.0}; });
}
inline DenseMatrix<Complex> ToComplex(const DenseMatrix<Complex>& a) {
    return a;
}

}  // namespace krnumer
