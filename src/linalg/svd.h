// Singular value decomposition A = U diag(s) V^H by Householder bidiagonalisation and implicit QR iteration (G. H.
// Golub and C. Reinsch, Numer. Math. 14, 403, 1970), for row-major real and complex matrices.
#pragma once

#include <cstdint>

namespace krnumer {

// With k = min(m, n): s receives the k singular values in descending order. Thin form: U is m by k, V is n by k; full
// form: U is m by m, V is n by n. U may be A itself, which is not changed otherwise.
//
// -20003: m or n below 1; -20068: data that cannot be used; -20062: no convergence; -20001.
template <class T>
int32_t SvdCore(const T* a, int32_t m, int32_t n, T* u, double* s, T* v, bool full);

// The singular values alone; A is not changed. Fails as above.
template <class T>
int32_t SvdValuesCore(const T* a, int32_t m, int32_t n, double* s);

}  // namespace krnumer
