// Eigenvalues and eigenvectors of general matrices (B. T. Smith et al., Matrix Eigensystem Routines: EISPACK Guide,
// 1976): balancing, reduction to Hessenberg form, QR iteration and back substitution.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// w: the n eigenvalues where the iteration left them; of a conjugate pair first the one with positive imaginary part.
// With want_vectors 1 the columns of v (n by n) are the eigenvectors of unit length in the same order. A is not
// changed.
//
// The real core reduces by stabilised elimination and iterates with double shifts, the complex core is unitary
// throughout and iterates with single shifts.
//
// -20003: n below 1; -20061: want_vectors neither 0 nor 1; -20068: data that cannot be used; -20062: an eigenvalue
// needs more than 40 (complex: 30) sweeps; -20001.
int32_t EigenGeneralCore(const double* a, int32_t n, int32_t want_vectors, Complex* w, Complex* v);
int32_t CxEigenGeneralCore(const Complex* a, int32_t n, int32_t want_vectors, Complex* w, Complex* v);

}  // namespace krnumer
