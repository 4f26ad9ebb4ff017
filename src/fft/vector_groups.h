// The vector butterflies by groups of radices, each group compiled on its own.
#pragma once

#include "fft/vector_kernels.h"

namespace krnumer {

const VectorButterflies* SmallVectorButterflies(int32_t radix);   // 2 to 11
const VectorButterflies* MediumVectorButterflies(int32_t radix);  // 13 to 19, 32
const VectorButterflies* LargeVectorButterflies(int32_t radix);   // 29, 31, 37 to 43

}  // namespace krnumer
