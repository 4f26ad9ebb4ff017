// Windows that are sums of cosines, w[i] = a[0] - a[1] cos(2 pi i / n) + a[2] cos(4 pi i / n) - ..., after
// F. J. Harris, Proc. IEEE 66, 51 (1978) and A. H. Nuttall, IEEE Trans. ASSP 29, 84 (1981).
#pragma once

#include <cstdint>
#include <span>

#include "frame/complex.h"

namespace krnumer {

// The coefficients a[0], a[1], ... of a named window; none for a type that is not a sum of cosines.
std::span<const double> WinCosTerms(std::int32_t type);

// Multiplies x[0..n) by the window of the m coefficients a. A scaled window is divided by a[0], its mean, so that its
// coherent gain is 1. One sample stays as it is.
template <class T>
std::int32_t CosineSumWindow(T* x, std::int32_t n, const double* a, std::int32_t m, bool scaled);

// The same with the coefficients of a named window; -20061 for a type without any.
template <class T>
std::int32_t NamedCosineWindow(T* x, std::int32_t n, std::int32_t type, bool scaled);

extern template std::int32_t CosineSumWindow(double*, std::int32_t, const double*, std::int32_t, bool);
extern template std::int32_t CosineSumWindow(Complex*, std::int32_t, const double*, std::int32_t, bool);
extern template std::int32_t NamedCosineWindow(double*, std::int32_t, std::int32_t, bool);
extern template std::int32_t NamedCosineWindow(Complex*, std::int32_t, std::int32_t, bool);

}  // namespace krnumer
