// Linear equations and inverses of positive definite matrices.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// L L^H X = B by the packed factor, in place of B (n by nrhs). The diagonal of L is not tested. -20003 when a size is
// below 1.
template <class T>
int32_t CholeskySolvePacked(const T* packed, int32_t n, T* b, int32_t nrhs);

// A X = B, where A is read in its lower triangle or, by any triangle but kLower, in its upper one. X may be B. -20003;
// -20068 for bad data anywhere in A or B; -20071, -20001.
template <class T>
int32_t CholeskySolveFull(const T* a, int32_t n, int32_t triangle, const T* b, int32_t nrhs, T* x);

// The lower triangle of the inverse of L L^H takes the place of the packed factor. -20003, -20001.
template <class T>
int32_t CholeskyInversePacked(T* packed, int32_t n);

// The inverse, whole, takes the place of A, which is read in its lower triangle. -20003, -20071, -20001.
template <class T>
int32_t InvertByCholesky(T* a, int32_t n);

}  // namespace krnumer
