// Linear equations and inverses by the factors of LUFactor.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// -20017 when a pivot is no row of a matrix of order n, as with pivots from elsewhere.
int32_t CheckPivots(const int32_t* pivots, int32_t n);

// A x = b by the factors of A; x may be b. -20041 when U has a zero on its diagonal, -20003 when n is below 1.
template <class T>
int32_t LUSolve(const T* lu, const int32_t* pivots, const T* b, int32_t n, T* x);

// The inverse of A by its factors: the solutions of A x = e_j side by side. It may take the place of the factors. Where
// U has a zero on its diagonal, the solutions stay as far as they had come; that is no failure. -20001, -20003.
template <class T>
int32_t LUInverse(const T* lu, const int32_t* pivots, int32_t n, T* inverse);

// A x = b, the matrix being factored in a copy. -20041 when it is singular, -20001, -20003.
template <class T>
int32_t LUSolveDirect(const T* a, int32_t n, const T* b, T* x);

// The inverse takes the place of A. -20041 when it is singular, -20001, -20003.
template <class T>
int32_t InvertByLU(T* a, int32_t n);

}  // namespace krnumer
