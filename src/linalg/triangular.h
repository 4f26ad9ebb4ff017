// Linear equations and inverses of packed triangular matrices.
//
// A matrix counts as singular when an element of its diagonal is too small against the largest element g of the
// triangle: real |d| <= eps |g| throughout; complex |d|^2 <= eps |g|^2 in equations and |d|^2 <= eps^2 |g|^2 in
// inverses. The complex squares are not scaled.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// T X = B, X and B being n by nrhs; X may be B. Any triangle but kLower is the upper one. -20003 when a size is below
// 1; -20068 for bad data in T or B; -20041 when T is singular.
template <class T>
int32_t TriangularSolvePacked(const T* packed, int32_t n, const T* b, int32_t nrhs, int32_t triangle, T* x);

// The same with a triangle of a full matrix; -20001, too.
template <class T>
int32_t TriangularSolveFull(const T* a, int32_t n, int32_t triangle, const T* b, int32_t nrhs, T* x);

// The inverse, which is a triangle of the same kind; it may take the place of the matrix. -20061 when `triangle` is
// neither kLower nor kUpper, then -20003, -20041.
template <class T>
int32_t TriangularInversePacked(const T* packed, int32_t n, int32_t triangle, T* inverse);

// The inverse of a triangle of A takes the place of A, with zeros in the other triangle. The same failures, and -20001.
template <class T>
int32_t InvertTriangle(T* a, int32_t n, int32_t triangle);

}  // namespace krnumer
