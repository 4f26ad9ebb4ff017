// The instruction sets that the vector butterflies are compiled for: the baseline of the compiler, two doubles from
// SSSE3 on, four from AVX2, eight from AVX-512. To be included before Highway.
#pragma once

#define HWY_DISABLED_TARGETS (HWY_SSE4 | HWY_AVX3_DL | KRNUMER_SIZELESS_TARGETS)
#include "frame/vector_targets.h"
