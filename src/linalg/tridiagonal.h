// Eigenvalues of a real symmetric tridiagonal matrix by implicit QL iteration (A. Dubrulle, R. S. Martin and J. H.
// Wilkinson, Numer. Math. 12, 377, 1968).
#pragma once

#include <cstddef>
#include <cstdint>

#include "linalg/rotations.h"

namespace krnumer {

// The iteration ends when a value has needed this many sweeps.
inline constexpr int32_t kQlIterationLimit = 30;

// When an off-diagonal element counts as zero.
enum class Negligible : uint8_t {
    kInSum,          // it vanishes when added to the magnitudes of its neighbours on the diagonal
    kAgainstLargest  // it is below epsilon times the largest |d[l]| + |e[l]| met so far
};

// d: the diagonal, which becomes the eigenvalues in no order. e: n elements, e[i] beside d[i] and d[i + 1], used up.
// The rows of `vectors` are taken along. work: 2 n doubles where there are vectors. -20062 when the iteration does not
// end.
int32_t DiagonaliseTridiagonal(std::ptrdiff_t n, double* d, double* e, VectorRows vectors, double* work,
                               Negligible negligible);

}  // namespace krnumer
