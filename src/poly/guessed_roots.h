// Roots of real polynomials from the caller's guesses. Coefficients c[0..n) run from the constant up.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// A real root by Newton's method from `guess`: the point of least |p| among those that at most `limit` steps reach. A
// step more than five times the last is refused and the last repeated.
double NewtonRoot(const double* c, const double* derivative, int32_t n, double guess, int32_t limit, double tol);

// A pair of roots as those of a quadratic factor, by Bairstow's method (L. Bairstow, Applied Aerodynamics, 1920): from
// two guesses, until both coefficients of the factor change by less than `tol` relative, or no longer by less than in
// the step before, when that step is taken back. `work` holds 2 n doubles. True where the pair is real.
bool BairstowPair(const double* c, int32_t n, const Complex guesses[2], int32_t limit, double tol, double* work,
                  Complex roots[2]);

// All guesses of both kinds: the roots of the real guesses, then the real roots of the pairs, then the complex ones.
// Polynomials of degree 2 and below leave the guesses of pairs as they are; an odd last one is its own partner, and
// counts once. `roots` holds both counts. kWarnEmptyPolynomial, kOutOfMemory.
int32_t RootsFromGuesses(const double* c, int32_t n, const double* real_guesses, int32_t real_count, int32_t real_limit,
                         double real_tol, const Complex* pair_guesses, int32_t pair_count, int32_t pair_limit,
                         double pair_tol, Complex* roots);

}  // namespace krnumer
