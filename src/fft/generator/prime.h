// Short transforms of prime size.
#pragma once

#include <span>

#include "fft/generator/program.h"

namespace krnumer::generator {

// Rader's reordering by powers of the least primitive root turns the transform into one matrix of cyclic structure
// along every prime power q of r - 1. It factors as M' diag(c) M: additions M, constants c, and the same additions
// transposed. M reduces each axis modulo its cyclotomic polynomials and evaluates what is left by nested short
// products of sizes 2 and 3.
// Sources: C. M. Rader, Proc. IEEE 56, 1968; S. Winograd, Math. Comp. 32, 1978; I. W. Selesnick and C. S. Burrus, IEEE
// Trans. Signal Processing 44(1), 1996.
Spectrum PrimeTransform(Program& program, std::span<const Term> x);

}  // namespace krnumer::generator
