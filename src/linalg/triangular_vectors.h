// Eigenvectors of a triangular or quasi-triangular matrix by back substitution.
#pragma once

#include <cstdint>

#include "frame/complex.h"
#include "linalg/complex_schur.h"
#include "linalg/real_schur.h"

namespace krnumer {

// The eigenvectors take the place of the Schur form: the vector of eigenvalue j, multiplied by the transformation, that
// of row j. Of a real conjugate pair, rows j and j + 1 receive the real and the imaginary part. -20001.
int32_t SchurVectors(const RealHessenberg& schur, const Complex* w);
int32_t SchurVectors(const ComplexHessenberg& schur, const Complex* w);

}  // namespace krnumer
