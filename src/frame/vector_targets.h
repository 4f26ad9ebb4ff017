// The instruction sets that loops over vectors are compiled for. To be included before Highway.
#pragma once

// Vectors become members and elements, which takes a size that the compiler knows.
#define KRNUMER_SIZELESS_TARGETS (HWY_SVE | HWY_SVE_256 | HWY_SVE2 | HWY_SVE2_128 | HWY_RVV)

#ifndef HWY_DISABLED_TARGETS
#define HWY_DISABLED_TARGETS KRNUMER_SIZELESS_TARGETS
#endif
