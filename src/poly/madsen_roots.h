// All roots of a complex polynomial without guesses (K. Madsen, BIT 13, 71, 1973): Newton steps, searched along while
// far from a root, and deflation.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The roots of c[0] + ... + c[n-1] z^(n-1) in the order in which they are found, those at 0 first; `count` of them, at
// most n - 1, as zeros in the place of the highest coefficients stand for nothing. `limit` is the number of times that
// the step towards a root may be turned in a row.
//
// kEmptyInput; kBadCoefficient for coefficients that are not finite and for constants; kNoConvergence, also where a
// root overflows; kOutOfMemory.
int32_t MadsenRoots(const Complex* c, int32_t n, int32_t limit, Complex* roots, int32_t* count);

}  // namespace krnumer
