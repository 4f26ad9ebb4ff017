// Cholesky factorisation A = L L^H of a packed lower triangle.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The lower triangle of A becomes L, in place. -20071: a diagonal element came out negative or 0 (of a complex matrix
// its real part counts), where the factorisation ends; or, in the real family only, the matrix is that close to losing
// its definiteness that an element of the diagonal of L is below sqrt(eps) times the largest element of L.
int32_t CholeskyPacked(double* packed, int32_t n);
int32_t CholeskyPacked(Complex* packed, int32_t n);

// The upper factor R of A = R^H R takes the place of A, whose lower triangle is read; zeros below the diagonal. -20003,
// -20071, -20001.
template <class T>
int32_t CholeskyUpper(T* a, int32_t n);

}  // namespace krnumer
