// What the tests of entry points need besides test_matrices.h: arrays of the host, twins of exports, and the kinds of
// matrices that residuals are tried on.
#pragma once

#include <cstdint>
#include <cstring>
#include <functional>
#include <vector>

#include "linalg/test_matrices.h"
#include "support/host_arrays.h"

namespace krnumer {

template <class T>
using Matrix = DenseMatrix<T>;

template <class T>
HostMatrix<T> ToHost(const Matrix<T>& a) {
    return {a.rows, a.columns, a.elements};
}
template <class T>
Matrix<T> FromHost(const HostMatrix<T>& a) {
    return {a.rows(), a.columns(), a.values()};
}

template <class T>
Matrix<T> Identity(int32_t n) {
    return Generate<T>(n, n, [](int32_t i, int32_t j) { return FromReal<T>(i == j ? 1.0 : 0.0); });
}

template <class T>
Matrix<T> Transposed(const Matrix<T>& a) {
    return Generate<T>(a.columns, a.rows, [&a](int32_t i, int32_t j) { return a(j, i); });
}

// Well-conditioned and Hermitian: B^H B + n I.
template <class T>
Matrix<T> PositiveDefinite(int32_t n, uint64_t seed) {
    const Matrix<T> b = RandomMatrix<T>(n, n, seed), gram = Product(Adjoint(b), b);
    return Generate<T>(n, n, [&gram, n](int32_t i, int32_t j) {
        if (i == j) return FromReal<T>(RealPart(gram(i, i)) + n);
        return i > j ? gram(i, j) : Conjugate(gram(j, i));
    });
}

template <class T>
struct MatrixKind {
    const char* name;
    std::function<Matrix<T>(int32_t rows, int32_t columns)> make;
};

template <class T>
std::vector<MatrixKind<T>> MatrixKinds() {
    const auto scaled = [](double factor) {
        return [factor](int32_t m, int32_t n) {
            Matrix<T> a = RandomMatrix<T>(m, n, 11);
            for (T& element : a.elements) element = element * factor;
            return a;
        };
    };
    return {
        {"random", [](int32_t m, int32_t n) { return RandomMatrix<T>(m, n, 7); }},
        {"integer", [](int32_t m, int32_t n) { return IntegerMatrix<T>(m, n, 3); }},
        {"graded", [](int32_t m, int32_t n) { return GradedMatrix<T>(m, n, 5); }},
        {"of rank 2", [](int32_t m, int32_t n) { return RankDeficientMatrix<T>(m, n, 2, 1); }},
        {"Hilbert", HilbertMatrix<T>},
        {"Vandermonde", VandermondeMatrix<T>},
        {"with zero columns",
         [](int32_t m, int32_t n) {
             Matrix<T> a = RandomMatrix<T>(m, n, 9);
             for (int32_t i = 0; i < m; ++i)
                 for (int32_t j = 0; j < n; j += 3) a(i, j) = T{};
             return a;
         }},
        {"large", scaled(1e100)},
        {"small", scaled(1e-100)},
    };
}

// Pivots as LU_head delivers them: integers in the first half of an array of doubles.
inline HostArray<double> Pivots(const std::vector<int32_t>& rows) {
    std::vector<double> places(rows.size());
    if (!rows.empty()) std::memcpy(places.data(), rows.data(), rows.size() * sizeof(int32_t));
    return HostArray<double>(places);
}

using ElementTypes = testing::Types<double, Complex>;

// A scalar as the exports take it by pointer.
template <class T>
using Scalar = std::conditional_t<kIsComplex<T>, KrComplex, double>;

inline double Value(double x) {
    return x;
}
inline Complex Value(KrComplex x) {
    return {x.re, x.im};
}

// An element for literal tables: the imaginary part is dropped where there is none.
template <class T>
constexpr T Make(double re, [[maybe_unused]] double im) {
    if constexpr (kIsComplex<T>) {
        return {re, im};
    } else {
        return re;
    }
}

// The export that serves the element type.
template <class T, class Real, class Twin>
constexpr auto Pick([[maybe_unused]] Real* real, [[maybe_unused]] Twin* complex) {
    if constexpr (kIsComplex<T>) {
        return complex;
    } else {
        return real;
    }
}

}  // namespace krnumer
