// Evaluation of the tables that the rational and Chebyshev approximations of the special functions are made of.
// All tables start with the coefficient of the highest order.
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/numeric.h"

namespace krnumer {

// Horner's rule on degree + 1 coefficients. NaN for a negative degree.
inline double PolyEval(double x, const double* table, int32_t degree) {
    if (degree < 0) return kQuietNaN;
    double sum = table[0];
    for (int32_t i = 1; i <= degree; ++i) sum = sum * x + table[i];
    return sum;
}

// The same where table[0] is 1 and known to be.
inline double PolyEvalMonic(double x, const double* table, int32_t degree) {
    if (degree < 1) return degree < 0 ? kQuietNaN : 1.0;
    double sum = x + table[1];
    for (int32_t i = 2; i <= degree; ++i) sum = sum * x + table[i];
    return sum;
}

// Clenshaw's recurrence for the sum of coefficients times Chebyshev polynomials in x / 2, x in -2 to 2. The constant
// term, the last entry, counts by half.
inline double ChebyshevSum(double x, const double* table, int32_t count) {
    double sum = table[0], before = 0.0, before_that = 0.0;
    for (int32_t i = 1; i < count; ++i) {
        before_that = before;
        before = sum;
        sum = x * before - before_that + table[i];
    }
    return 0.5 * (sum - before_that);
}

// The degree, or the count, of a whole table.
template <size_t n>
double PolyEval(double x, const double (&table)[n]) {
    return PolyEval(x, table, static_cast<int32_t>(n) - 1);
}

template <size_t n>
double PolyEvalMonic(double x, const double (&table)[n]) {
    return PolyEvalMonic(x, table, static_cast<int32_t>(n) - 1);
}

template <size_t n>
double ChebyshevSum(double x, const double (&table)[n]) {
    return ChebyshevSum(x, table, static_cast<int32_t>(n));
}

}  // namespace krnumer
