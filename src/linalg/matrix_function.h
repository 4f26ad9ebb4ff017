// Functions of square row-major matrices.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// exp(A) in place by scaling, a diagonal Pade approximant and squaring (C. B. Moler and C. F. Van Loan, SIAM Rev. 20,
// 801, 1978). Its order is chosen for an error of 1e-8 of the unscaled norm and no more, so that is about what the
// result is good to. Data that are not finite give NaN. -20003, -20001.
template <class T>
int32_t ExpCore(T* a, int32_t n);

// The least order of the approximant whose error bound, relative to the norm b, is below tol.
int32_t PadeOrder(double tol, double b);

// log(A) in place, through eigenvectors. Where they are no help, those of a slightly perturbed A, and up to two
// corrections that invert ExpCore; +20006 where these do not converge. -20060 for an eigenvalue of 0, -20041 for
// dependent eigenvectors, -20003, -20068, -20062, -20001.
int32_t CxLnCore(Complex* a, int32_t n);

// The principal square root of A, in place, through the Schur form (A. Bjorck and S. Hammarling, Linear Algebra Appl.
// 52, 127, 1983). +20006 where the second smallest eigenvalue is near 0, when there may be no root. -20003, -20068,
// -20062, -20999, -20001.
int32_t CxSqrtCore(Complex* a, int32_t n);

// A^power by squaring; negative powers are those of the pseudo-inverse. -20003, -20001, and for negative powers -20068,
// -20062.
template <class T>
int32_t PowerCore(const T* a, int32_t n, int32_t power, T* out);

}  // namespace krnumer
