// Singular values of a real upper bidiagonal matrix by implicit QR iteration (G. H. Golub and C. Reinsch, Numer. Math.
// 14, 403, 1970).
#pragma once

#include <cstddef>
#include <cstdint>

#include "linalg/rotations.h"

namespace krnumer {

// The iteration ends when a value would need this many sweeps.
inline constexpr int32_t kSvdIterationLimit = 100;

struct Bidiagonal {
    std::ptrdiff_t n;
    double* diagonal;
    double* superdiagonal;  // [i] stands above diagonal[i]; [0] is 0
};

// The diagonal becomes the singular values, in no order; the rows of `left` and `right` are taken along. work: 4 n
// doubles for the rotations of one sweep, needed where there are vectors. -20062 when the iteration does not end, as
// with elements whose squares overflow.
int32_t DiagonaliseBidiagonal(const Bidiagonal& b, VectorRows left, VectorRows right, double* work);

}  // namespace krnumer
