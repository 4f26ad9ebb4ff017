// LU factorisation with partial pivoting of a square row-major matrix.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// A becomes U and, below the diagonal, L without its unit diagonal. pivots[k] is the row that was exchanged with row k
// at step k, in place: the exchanges one after the other, not a permutation. parity is 1 after an odd number of them.
//
// The pivot is the first largest element of its column from the diagonal down; complex ones compare by re^2 + im^2. NaN
// is never chosen. A column that offers nothing is left as it is, which gives +20003 in the end, the rest of the
// factorisation being done all the same. -20003 when n is below 1.
int32_t LUFactor(double* a, int32_t n, int32_t* pivots, int32_t* parity);
int32_t LUFactor(Complex* a, int32_t n, int32_t* pivots, int32_t* parity);

}  // namespace krnumer
