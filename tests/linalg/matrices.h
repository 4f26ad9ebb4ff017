// Matrices for the tests of linear algebra: of many kinds, in both element types, with plain operations to check
// results by.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <functional>
#include <random>
#include <string>
#include <vector>

#include "frame/numeric.h"
#include "linalg/element.h"
#include "support/host_arrays.h"

namespace krnumer {

template <class T>
struct Matrix {
    int32_t rows = 0, columns = 0;
    std::vector<T> elements;

    Matrix() = default;
    Matrix(int32_t m, int32_t n) : rows(m), columns(n), elements(Count(m) * Count(n)) {}
    Matrix(int32_t m, int32_t n, std::vector<T> row_after_row) : rows(m), columns(n), elements(row_after_row) {}
    explicit Matrix(const HostMatrix<T>& host) : Matrix(host.rows(), host.columns(), host.values()) {}

    T& operator()(int32_t i, int32_t j) { return elements[Count(i) * Count(columns) + Count(j)]; }
    const T& operator()(int32_t i, int32_t j) const { return elements[Count(i) * Count(columns) + Count(j)]; }

    HostMatrix<T> ToHost() const { return HostMatrix<T>(rows, columns, elements); }
    friend bool operator==(const Matrix&, const Matrix&) = default;
};

template <class T>
Matrix<T> Identity(int32_t n) {
    Matrix<T> result(n, n);
    for (int32_t i = 0; i < n; ++i) result(i, i) = FromReal<T>(1.0);
    return result;
}

template <class T>
Matrix<T> ColumnOf(const std::vector<T>& elements) {
    return {static_cast<int32_t>(elements.size()), 1, elements};
}

template <class T>
Matrix<T> Transposed(const Matrix<T>& a) {
    Matrix<T> result(a.columns, a.rows);
    for (int32_t i = 0; i < a.rows; ++i)
        for (int32_t j = 0; j < a.columns; ++j) result(j, i) = a(i, j);
    return result;
}

template <class T>
Matrix<T> Adjoint(const Matrix<T>& a) {
    Matrix<T> result = Transposed(a);
    for (T& element : result.elements) element = Conjugate(element);
    return result;
}

template <class T>
Matrix<T> operator*(const Matrix<T>& a, const Matrix<T>& b) {
    Matrix<T> result(a.rows, b.columns);
    for (int32_t i = 0; i < a.rows; ++i)
        for (int32_t k = 0; k < a.columns; ++k)
            for (int32_t j = 0; j < b.columns; ++j) result(i, j) += a(i, k) * b(k, j);
    return result;
}

template <class T>
Matrix<T> operator-(const Matrix<T>& a, const Matrix<T>& b) {
    Matrix<T> result = a;
    for (size_t i = 0; i < result.elements.size(); ++i) result.elements[i] -= b.elements[i];
    return result;
}

// Frobenius norm, scaled so that neither large nor small elements lose themselves in their squares. A NaN stays one.
template <class T>
double Norm(const Matrix<T>& a) {
    double largest = 0.0;
    for (const T& element : a.elements) {
        const double size = SumOfParts(element);
        if (!(size <= largest)) largest = size;
    }
    if (largest == 0.0 || !std::isfinite(largest)) return largest;
    double sum = 0.0;
    for (const T& element : a.elements) sum += SquaredModulus(element * (1.0 / largest));
    return largest * std::sqrt(sum);
}

template <class T>
double OrthogonalityError(const Matrix<T>& q) {
    return Norm(Adjoint(q) * q - Identity<T>(q.columns));
}

// Uniform over (-1, 1), in both parts.
template <class T>
T RandomElement(std::mt19937_64& random) {
    const auto number = [&random] { return static_cast<double>(random() >> 11) * 0x1p-52 - 1.0; };
    if constexpr (kIsComplex<T>) {
        const double re = number();
        return {re, number()};
    } else {
        return number();
    }
}

template <class T>
Matrix<T> RandomMatrix(int32_t rows, int32_t columns, uint64_t seed) {
    std::mt19937_64 random(seed);
    Matrix<T> result(rows, columns);
    for (T& element : result.elements) element = RandomElement<T>(random);
    return result;
}

// Well-conditioned and Hermitian: B* B + n I.
template <class T>
Matrix<T> PositiveDefinite(int32_t n, uint64_t seed) {
    const Matrix<T> b = RandomMatrix<T>(n, n, seed);
    Matrix<T> result = Adjoint(b) * b;
    for (int32_t i = 0; i < n; ++i) {
        for (int32_t j = 0; j < i; ++j) result(j, i) = Conjugate(result(i, j));
        result(i, i) = FromReal<T>(RealPart(result(i, i)) + n);
    }
    return result;
}

// Small integers, so that sums of products are exact.
template <class T>
Matrix<T> IntegerMatrix(int32_t rows, int32_t columns, uint64_t seed) {
    std::mt19937_64 random(seed);
    Matrix<T> result = RandomMatrix<T>(rows, columns, seed);
    const auto rounded = [](double x) { return std::nearbyint(9.0 * x); };
    for (T& element : result.elements) {
        if constexpr (kIsComplex<T>) {
            element = {rounded(element.re), rounded(element.im)};
        } else {
            element = rounded(element);
        }
    }
    return result;
}

template <class T>
struct MatrixKind {
    const char* name;
    std::function<Matrix<T>(int32_t rows, int32_t columns)> make;
};

// The kinds of matrices that residuals are tried on.
template <class T>
std::vector<MatrixKind<T>> MatrixKinds() {
    const auto by_place = [](auto element) {
        return [element](int32_t m, int32_t n) {
            Matrix<T> result(m, n);
            for (int32_t i = 0; i < m; ++i)
                for (int32_t j = 0; j < n; ++j) result(i, j) = element(i, j);
            return result;
        };
    };
    const auto scaled = [](double factor) {
        return [factor](int32_t m, int32_t n) {
            Matrix<T> result = RandomMatrix<T>(m, n, 11);
            for (T& element : result.elements) element = element * factor;
            return result;
        };
    };
    return {
        {"random", [](int32_t m, int32_t n) { return RandomMatrix<T>(m, n, 7); }},
        {"integer", [](int32_t m, int32_t n) { return IntegerMatrix<T>(m, n, 3); }},
        {"graded",
         [](int32_t m, int32_t n) {
             Matrix<T> result = RandomMatrix<T>(m, n, 5);
             for (int32_t i = 0; i < m; ++i)
                 for (int32_t j = 0; j < n; ++j)
                     result(i, j) = result(i, j) * std::pow(10.0, -12.0 * (i + j) / (m + n));
             return result;
         }},
        {"of rank 2", [](int32_t m, int32_t n) { return RandomMatrix<T>(m, 2, 1) * RandomMatrix<T>(2, n, 2); }},
        {"Hilbert", by_place([](int32_t i, int32_t j) { return FromReal<T>(1.0 / (i + j + 1)); })},
        {"Vandermonde", by_place([](int32_t i, int32_t j) { return FromReal<T>(std::pow(0.1 * (i % 20) - 1.0, j)); })},
        {"identity", by_place([](int32_t i, int32_t j) { return FromReal<T>(i == j ? 1.0 : 0.0); })},
        {"with zero columns",
         [](int32_t m, int32_t n) {
             Matrix<T> result = RandomMatrix<T>(m, n, 9);
             for (int32_t i = 0; i < m; ++i)
                 for (int32_t j = 0; j < n; j += 3) result(i, j) = T{};
             return result;
         }},
        {"large", scaled(1e100)},
        {"small", scaled(1e-100)},
    };
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
