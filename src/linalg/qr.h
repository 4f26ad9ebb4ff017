// QR decompositions A = Q R of a row-major m by n matrix. A size below 1 is -20003, want of memory -20001.
#pragma once

#include <cstdint>
#include <type_traits>

#include "frame/complex.h"

namespace krnumer {

// What is formed. With k = min(m, n):
enum QRFormat : int32_t {
    kFullQR = 0,     // Q is m by m, R is m by n
    kEconomyQR = 1,  // Q is m by k, R is k by n
    kROnly = 2,      // R is k by n
};

// Rows of R, and columns of Q where there is one.
int32_t QRRows(int32_t m, int32_t n, int32_t format);

// By Householder reflectors. R may be A itself; null Q is not formed. NaN flows through.
template <class T>
int32_t QRHouseholder(const T* a, int32_t m, int32_t n, int32_t format, std::type_identity_t<T>* q, T* r);

// With column pivoting: A P = Q R, where column j of A P is column pivots[j] of A.
template <class T>
int32_t QRPivoted(const T* a, int32_t m, int32_t n, int32_t format, int32_t* pivots, std::type_identity_t<T>* q, T* r);

// By Givens rotations (G. H. Golub and C. F. Van Loan, Matrix Computations, 5.2). Q is m by m, R is m by n and may be A
// itself; rank is the number of columns in which a pivot was found. Elements that are nothing but rounding errors
// against their column are dropped.
int32_t QRGivens(const double* a, int32_t m, int32_t n, double* q, double* r, int32_t* rank);

// The same by fast Givens rotations (ibid., 5.1 of the third edition), which scale the rows in the end only.
int32_t QRFastGivens(const double* a, int32_t m, int32_t n, double* q, double* r, int32_t* rank);

}  // namespace krnumer
