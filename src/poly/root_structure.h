// The multiplicities of the roots of a polynomial, from a chain of approximate greatest common divisors (Z. Zeng, Math.
// Comp. 74, 869, 2005). Coefficients run from the highest down, the highest is 1.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The distinct roots of f, of the given degree (at least 1), and their multiplicities, with room for `degree` each.
// Divisors are seen where singular values are below 100 tol and what they leave is below tol; each level of the chain
// is judged by the quality that the last one reached. The multiplicities need not sum to the degree where a level
// fails.
//
// kNoConvergence, kNotFinite for data that cannot be used, kOutOfMemory.
template <class T>
int32_t RootStructure(const T* f, int32_t degree, double tol, Complex* roots, int32_t* multiplicities, int32_t* count);

// All roots of f as eigenvalues of its companion matrix. Fails as above.
template <class T>
int32_t CompanionRoots(const T* f, int32_t degree, Complex* roots);

// Divides by the highest coefficient; false where it is 0.
template <class T>
bool MakeMonic(T* f, int32_t degree);

// The weight of an equation by its right-hand side: 1 over what is above 1.
template <class T>
double RowWeight(T right);

}  // namespace krnumer
