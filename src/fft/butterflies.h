// The butterflies by groups of radices, each group compiled on its own.
#pragma once

#include "fft/table.h"

namespace krnumer {

const Butterflies* SmallButterflies(int32_t radix);   // 2 to 11
const Butterflies* MediumButterflies(int32_t radix);  // 13 to 32
const Butterflies* LargeButterflies(int32_t radix);   // 37 to 43

}  // namespace krnumer
