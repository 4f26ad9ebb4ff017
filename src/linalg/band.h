// Linear equations with band matrices.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// A X = B in place of B (n by nrhs). A of order n has kl diagonals below and ku above the main one; it is given by its
// diagonals, one in a row: band[ku + i - j][j] = A[i][j].
//
// -20003 when n or nrhs is below 1; -20008 when kl or ku is negative or kl + ku + 1 above n; -20041 when A is singular;
// -20001.
template <class T>
int32_t BandSolve(const T* band, int32_t n, int32_t kl, int32_t ku, T* b, int32_t nrhs);

}  // namespace krnumer
