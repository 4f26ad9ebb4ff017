// Unwrapping of phases.
#pragma once

#include <cstdint>

namespace krnumer {

// Takes whole turns off, in place, so that no sample of a phase in radians lies more than pi from the corrected one
// before it; a step of exactly pi is taken down, one of -pi stays. kEmptyInput where n < 1.
int32_t UnwrapPhase(double* x, int32_t n);

}  // namespace krnumer
