// Evaluation of the tables that the rational and Chebyshev approximations of the special functions are made of.
// All tables start with the coefficient of the highest order.
#pragma once

#include <cstddef>
#include <cstdint>
#include <utility>

#include "frame/numeric.h"
#include "frame/pair.h"

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

// Clenshaw's recurrence for twice the sum of coefficients times Chebyshev polynomials in x / 2, x in -2 to 2. The
// constant term, the last, counts by half. Every step waits for the one before; written out, without the counting of a
// loop, they leave the processor more room for what does not wait.
template <class V, class Coefficient, size_t... i>
V Clenshaw(V x, Coefficient coefficient, std::index_sequence<i...>) {
    V sum = coefficient(0), before = {}, before_that = {};
    ((before_that = before, before = sum, sum = x * before - before_that + coefficient(i + 1)), ...);
    return sum - before_that;
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
    const auto coefficient = [&](size_t i) { return table[i]; };
    return 0.5 * Clenshaw(x, coefficient, std::make_index_sequence<n - 1>());
}

// The sums of two tables side by side, in the time of one.
template <size_t n>
Pair ChebyshevSums(double x, const double (&first)[n], const double (&second)[n]) {
    const auto coefficients = [&](size_t i) { return Pair{first[i], second[i]}; };
    return Pair{0.5, 0.5} * Clenshaw(Pair{x, x}, coefficients, std::make_index_sequence<n - 1>());
}

}  // namespace krnumer
