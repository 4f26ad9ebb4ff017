// Eigenvalues and eigenvectors of symmetric and Hermitian matrices by Householder tridiagonalisation and QL iteration
// (J. H. Wilkinson and C. Reinsch, Handbook for Automatic Computation II, 1971).
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// w: the eigenvalues in ascending order. With want_vectors 1 the columns of v (n by n) are the eigenvectors of unit
// length in the same order; v may be A, and null means A. With 0, v is not used. Only the lower triangle of A counts,
// and only the real parts of its diagonal.
//
// -20003: n below 1; -20061: want_vectors neither 0 nor 1; -20062: no convergence; -20001. The real core also looks at
// all data first (-20068); callers of the Hermitian one do so themselves.
int32_t SymEigenCore(const double* a, int32_t n, int32_t want_vectors, double* w, double* v);
int32_t SymEigenCore(double* a, int32_t n, int32_t want_vectors, double* w, double* v);
int32_t HermitianEigenCore(const Complex* a, int32_t n, int32_t want_vectors, double* w, Complex* v);
int32_t HermitianEigenCore(Complex* a, int32_t n, int32_t want_vectors, double* w, Complex* v);

}  // namespace krnumer
