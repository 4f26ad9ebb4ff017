// Products of matrices and vectors, row-major. None of them conjugates.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// C = A B, m by n, through BLAS; k is the inner dimension. Sums of no terms (k = 0) are NaN, since nothing is known of
// them. -20003 when a size is negative.
template <class T>
int32_t MatMulCore(const T* a, const T* b, int32_t m, int32_t k, int32_t n, T* c);

// y = A x, each sum in the order of the columns; 0 where there is none. -20003 when a size is negative.
template <class T>
int32_t MatVecCore(const T* a, int32_t m, int32_t n, const T* x, T* y);

// Sum of x[i] y[i] in the order of i. -20003 when n is below 1.
template <class T>
int32_t DotCore(const T* x, const T* y, int32_t n, T* out);

// M[i][j] = x[i] y[j].
template <class T>
int32_t OuterCore(const T* x, int32_t m, const T* y, int32_t n, T* out);

// K[i p + k][j q + l] = A[i][j] B[k][l] for A of m by n and B of p by q.
template <class T>
int32_t KroneckerCore(const T* a, int32_t m, int32_t n, const T* b, int32_t p, int32_t q, T* out);

// Sum of the first min(m, n) diagonal elements.
template <class T>
int32_t TraceCore(const T* a, int32_t m, int32_t n, T* out);

}  // namespace krnumer
