// The decomposition of a matrix that has at least as many rows as columns.
#pragma once

#include <cstdint>

namespace krnumer {

// A (m by n, m >= n) becomes U, v (n by n) becomes V, and s receives the singular values in descending order. Null v:
// values only, and A is used up. -20062: no convergence; -20001.
template <class T>
int32_t DecomposeTall(T* a, int32_t m, int32_t n, double* s, T* v);

}  // namespace krnumer
