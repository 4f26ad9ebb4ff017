// Windows whose weights are generated into a temporary before they meet the samples. All are periodic: w[0] = 0,
// w[i] = w[n-i], and the peak of an even length is w[n/2] = 1. One sample stays as it is.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Y. H. Ha and J. A. Pearce, IEEE Trans. ASSP 37, 298 (1989).
template <class T>
std::int32_t BartlettHanningWindow(T* x, std::int32_t n);

// The convolution of a half-cycle cosine with itself; F. J. Harris, Proc. IEEE 66, 51 (1978).
template <class T>
std::int32_t BohmanWindow(T* x, std::int32_t n);

// Piecewise cubic, the convolution of a triangle with itself; E. Parzen, Technometrics 3, 167 (1961).
template <class T>
std::int32_t ParzenWindow(T* x, std::int32_t n);

// A parabola; P. D. Welch, IEEE Trans. Audio Electroacoust. 15, 70 (1967).
template <class T>
std::int32_t WelchWindow(T* x, std::int32_t n);

extern template std::int32_t BartlettHanningWindow(double*, std::int32_t);
extern template std::int32_t BartlettHanningWindow(Complex*, std::int32_t);
extern template std::int32_t BohmanWindow(double*, std::int32_t);
extern template std::int32_t BohmanWindow(Complex*, std::int32_t);
extern template std::int32_t ParzenWindow(double*, std::int32_t);
extern template std::int32_t ParzenWindow(Complex*, std::int32_t);
extern template std::int32_t WelchWindow(double*, std::int32_t);
extern template std::int32_t WelchWindow(Complex*, std::int32_t);

}  // namespace krnumer
