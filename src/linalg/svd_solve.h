// Least squares and the pseudo-inverse by singular value decomposition.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The X of least norm among those that minimise |A X - B|, A m by n, B m by nrhs, X n by nrhs. Singular values up to
// max(m, n) s[0] times the factor `tol` count as 0; a tol that is not positive means eps. +20001, with X, when values
// were cut. kEmptyInput; kNotFinite for data that cannot be used; kNoConvergence; kOutOfMemory.
template <class T>
int32_t SvdSolve(const T* a, int32_t m, int32_t n, const T* b, int32_t nrhs, T* x, double tol);

// The pseudo-inverse of A, m by n, into `out`, n by m; null overwrites A. Here `tol` is absolute: singular values up to
// it count as 0, and one that is negative or NaN means max(m, n) s[0] eps. Fails as above.
template <class T>
int32_t PseudoInverseCore(T* a, int32_t m, int32_t n, double tol, T* out);

extern template int32_t SvdSolve(const double*, int32_t, int32_t, const double*, int32_t, double*, double);
extern template int32_t SvdSolve(const Complex*, int32_t, int32_t, const Complex*, int32_t, Complex*, double);
extern template int32_t PseudoInverseCore(double*, int32_t, int32_t, double, double*);
extern template int32_t PseudoInverseCore(Complex*, int32_t, int32_t, double, Complex*);

}  // namespace krnumer
