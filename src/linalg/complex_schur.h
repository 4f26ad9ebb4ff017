// Eigenvalues of a complex Hessenberg matrix by single-shift QR iteration (J. G. F. Francis, Computer J. 4, 265, 1961),
// after the unitary form of the procedure comlr2 (G. Peters and J. H. Wilkinson, Numer. Math. 16, 181, 1970).
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The iteration ends when an eigenvalue has needed this many sweeps.
inline constexpr int32_t kSingleShiftLimit = 30;

// A matrix in Hessenberg form with a real subdiagonal between low and high, and in triangular form outside.
struct ComplexHessenberg {
    Complex* h;  // n by n
    std::ptrdiff_t n;
    std::ptrdiff_t low;
    std::ptrdiff_t high;
    Complex* columns;  // the columns of the transformation so far, as rows of n; null: values only
    double norm;       // sum of the magnitudes of the Hessenberg part
};

// w receives the eigenvalues where the iteration leaves them. Where the transformation is wanted, h becomes triangular,
// with what is left of the small elements below its diagonal. -20062 when the iteration does not end; -20001.
int32_t ReduceToComplexSchur(const ComplexHessenberg& problem, Complex* w);

}  // namespace krnumer
