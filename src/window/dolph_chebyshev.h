// The window of least main-lobe width for a given side-lobe level; C. L. Dolph, Proc. IRE 34, 335 (1946).
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Multiplies x[0..n) by the window whose main lobe is `ratio` times as high as its side lobes, divided by its greatest
// weight. The periodic window is the symmetric one of length n + 1 without its last weight. A ratio below 1, or NaN,
// means 1; one whose square overflows makes all weights NaN. One sample stays as it is. The work grows as n^2.
template <class T>
std::int32_t DolphChebyshevWindow(T* x, std::int32_t n, double ratio, bool symmetric);

extern template std::int32_t DolphChebyshevWindow(double*, std::int32_t, double, bool);
extern template std::int32_t DolphChebyshevWindow(Complex*, std::int32_t, double, bool);

}  // namespace krnumer
