// Between eigenvalues and polynomials.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The coefficients of (x - roots[0]) ... (x - roots[n-1]) in ascending powers; out has room for n + 1. Returns how many
// there are, or -20003 when n is negative.
int32_t PolyFromRoots(const Complex* roots, int32_t n, Complex* out);

// c[0 .. n] = the coefficients of det(x I - A) in ascending powers, c[n] = 1, by way of the eigenvalues. -20003: n
// below 1; -20068: data that cannot be used; -20062: no convergence; -20001.
int32_t CharacteristicPolynomial(const double* a, int32_t n, double* c);

// The companion matrix, n by n, that has the given eigenvalues if they are closed under conjugation: ones above the
// diagonal, the coefficients in the last row. What else they have of imaginary parts is lost. -20003: n below 1;
// -20001.
int32_t MatrixFromEigenvalues(const Complex* eigenvalues, int32_t n, double* m);

}  // namespace krnumer
