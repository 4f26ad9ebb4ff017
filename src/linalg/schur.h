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

}  // namespace krnumer
