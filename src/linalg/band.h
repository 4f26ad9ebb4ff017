// Linear equations with a band matrix.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Solves A X = B, B of n by nrhs over itself. `ab` holds the kl + ku + 1 diagonals of A as rows of n elements, the
// highest first, each element in the column that it has in A. kEmptyInput where n or nrhs is below 1, kBadDimension
// where kl or ku is negative or kl + ku + 1 above n, kSingular, kOutOfMemory. NaN and infinities flow through.
template <class T>
int32_t BandSolve(const T* ab, int32_t n, int32_t kl, int32_t ku, T* b, int32_t nrhs);

extern template int32_t BandSolve(const double*, int32_t, int32_t, int32_t, double*, int32_t);
extern template int32_t BandSolve(const Complex*, int32_t, int32_t, int32_t, Complex*, int32_t);

}  // namespace krnumer
