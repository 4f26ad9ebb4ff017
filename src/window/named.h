// Windows chosen by their number: scaled to unit gain, and in symmetric form. `parameter` is the beta, ratio or sigma
// of the Kaiser, Dolph-Chebyshev and Gaussian windows.
#pragma once

#include <cstdint>

#include "frame/complex.h"
#include "window/constants.h"

namespace krnumer {

// Multiplies x[0..n) by the periodic window divided by its coherent gain, and gives the window's constants: those of
// the table for sums of cosines, which are divided by a[0]; measured ones for all others. A negative n (-20004) and a
// lack of memory before the first step (-20001) leave the constants as they came; every other failure makes them NaN.
template <class T>
std::int32_t ScaledWindow(T* x, std::int32_t n, std::int32_t type, double parameter, WindowConstants& constants);

// Multiplies x[0..n) by the symmetric window: the periodic one of length n - 1 with its first weight repeated at the
// end. One sample stays as it is, whatever the type.
template <class T>
std::int32_t SymmetricWindow(T* x, std::int32_t n, std::int32_t type, double parameter);

extern template std::int32_t ScaledWindow(double*, std::int32_t, std::int32_t, double, WindowConstants&);
extern template std::int32_t ScaledWindow(Complex*, std::int32_t, std::int32_t, double, WindowConstants&);
extern template std::int32_t SymmetricWindow(double*, std::int32_t, std::int32_t, double);
extern template std::int32_t SymmetricWindow(Complex*, std::int32_t, std::int32_t, double);

}  // namespace krnumer
