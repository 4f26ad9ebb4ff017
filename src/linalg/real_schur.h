// Eigenvalues of a real Hessenberg matrix by double-shift QR iteration (J. G. F. Francis, Computer J. 4, 265 and 332,
// 1961; R. S. Martin, G. Peters and J. H. Wilkinson, Numer. Math. 14, 219, 1970).
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The iteration ends when an eigenvalue has needed this many sweeps.
inline constexpr int32_t kDoubleShiftLimit = 40;

// A matrix in Hessenberg form between low and high, and in triangular form outside.
struct RealHessenberg {
    double* h;  // n by n
    std::ptrdiff_t n;
    std::ptrdiff_t low;
    std::ptrdiff_t high;
    double* columns;  // the columns of the transformation so far, as rows of n; null: values only
    double norm;      // sum of the magnitudes of the Hessenberg part
};

// w receives the eigenvalues where the iteration leaves them, of a conjugate pair first the one with positive imaginary
// part. Where the transformation is wanted, h becomes a quasi-triangular matrix, with what is left of the small
// elements below its blocks. -20062 when the iteration does not end; -20001.
int32_t ReduceToRealSchur(const RealHessenberg& problem, Complex* w);

}  // namespace krnumer
