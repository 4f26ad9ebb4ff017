// Generalised Schur decomposition of a pencil of square row-major matrices by LAPACK.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// What a decomposition delivers; any may be null. S, P, Q, Z and the vectors are n by n. Real vectors stand in LAPACK's
// packed form, a complex pair of them as its real and imaginary part in two columns; vectors have its scaling too.
template <class T>
struct QZOutputs {
    T* s = nullptr;
    T* p = nullptr;
    T* q = nullptr;
    T* z = nullptr;
    T* right = nullptr;
    T* left = nullptr;
};

// A = Q S Z^H, B = Q P Z^H with the eigenvalues alpha[i] / beta[i]. Without `transposed_q` Q is delivered as LAPACK has
// it, which read by rows is the transpose. mode 0 delivers S, P, Q and Z of the Hessenberg-triangular stage before the
// iteration, any other those after it; mode 1 also sorts by `order`. A pair that is 0/0 ends the sorting: +20005.
//
// -20061, -20003, -20068; -20062 without convergence; -20073 when pairs cannot be exchanged; -20999, -20001.
template <class T>
int32_t QZCore(const T* a, const T* b, int32_t n, bool transposed_q, int32_t mode, int32_t order,
               const QZOutputs<T>& out, Complex* alpha, T* beta);

// Makes complex eigenvectors out of real ones in packed form, for eigenvalues whose imaginary parts tell the pairs.
void ExpandVectors(const double* packed, int32_t n, const Complex* values, Complex* vectors);

}  // namespace krnumer
