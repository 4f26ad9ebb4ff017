// The values that occur most often.
#pragma once

#include <cstdint>

#include "frame/scratch.h"

namespace krnumer {

// The modes of n samples in ascending order: of their exact values (equal to a relative 2^-52) where intervals < 1, or
// else the centers of the fullest of so many bins between the extrema. `modes` holds at least `count` values; there is
// none, and `modes` is null, where nothing occurs twice. Data without spread have the one mode that they all are, a
// single sample has none. kEmptyInput where n < 1, kOutOfMemory, and what EqualWidthHistogram says.
int32_t Mode(const double* x, int32_t n, int32_t intervals, Scratch<double>* modes, int32_t* count);

}  // namespace krnumer
