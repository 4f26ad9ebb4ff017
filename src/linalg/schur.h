// Schur decomposition A = Z T Z^H of a square row-major matrix by LAPACK, with its eigenvalues in an order of the
// caller's.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

enum EigenvalueOrder : int32_t {
    kNoOrder = 0,
    kRealAscending = 1,
    kRealDescending = 2,
    kModulusAscending = 3,
    kModulusDescending = 4,
};

inline bool IsEigenvalueOrder(int32_t order) {
    return order >= kNoOrder && order <= kModulusDescending;
}

// Z null: no vectors. T of a real matrix has 2 by 2 blocks for complex pairs, which stay together. Eigenvalues move
// with their blocks and are not computed anew. -20061, -20003, -20068; -20062 without convergence; -20999, -20001.
template <class T>
int32_t SchurCore(const T* a, int32_t n, int32_t order, T* z, T* t, Complex* w);

// The decomposition in place and column-major, in no order, without a look at the data. LAPACK's failures are told
// apart by `size`, the order of the matrix: up to it -20062, then -20073 and -20074. -20999, -20001.
int32_t DecomposeColumns(double* t, int32_t n, double* vectors, Complex* w, int32_t size);
int32_t DecomposeColumns(Complex* t, int32_t n, Complex* vectors, Complex* w, int32_t size);

}  // namespace krnumer
