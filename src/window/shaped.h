// Windows whose weights follow from the position alone and need no table: triangle, cosine taper, exponential, force,
// Kaiser, Gaussian.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The periodic triangle 1 - |2i/n - 1|. x[0] is set to 0, so the only sample of a length of 1 too.
template <class T>
std::int32_t TriangleWindow(T* x, std::int32_t n);

// Tapers both ends over n fraction / 2 samples each by half a cycle of a raised cosine; the ends themselves are set to
// 0 (J. W. Tukey, 1967). Symmetric about (n-1)/2. A fraction of 1 or more is the periodic Hann window, one without any
// taper leaves the samples.
template <class T>
std::int32_t CosineTaper(T* x, std::int32_t n, double fraction);

// Decays, or grows, from 1 at the first sample to final_value at the last.
template <class T>
std::int32_t ExponentialWindow(T* x, std::int32_t n, double final_value);

// Keeps the first `duty` percent of the samples and sets the others to 0.
template <class T>
std::int32_t ForceWindow(T* x, std::int32_t n, double duty);

// The periodic window of J. F. Kaiser, I0(beta sqrt(1 - u^2)) / I0(beta) with u from 1 at x[0] to 0 in the middle, over
// I0 summed as Kaiser did: see the source.
template <class T>
std::int32_t KaiserWindow(T* x, std::int32_t n, double beta);

// A bell of standard deviation sigma n samples (periodic: sigma (n + 1)). A sigma that is not positive means 0.2. One
// sample stays as it is.
template <class T>
std::int32_t GaussianWindow(T* x, std::int32_t n, double sigma, bool symmetric);

extern template std::int32_t TriangleWindow(double*, std::int32_t);
extern template std::int32_t TriangleWindow(Complex*, std::int32_t);
extern template std::int32_t CosineTaper(double*, std::int32_t, double);
extern template std::int32_t CosineTaper(Complex*, std::int32_t, double);
extern template std::int32_t ExponentialWindow(double*, std::int32_t, double);
extern template std::int32_t ExponentialWindow(Complex*, std::int32_t, double);
extern template std::int32_t ForceWindow(double*, std::int32_t, double);
extern template std::int32_t ForceWindow(Complex*, std::int32_t, double);
extern template std::int32_t KaiserWindow(double*, std::int32_t, double);
extern template std::int32_t KaiserWindow(Complex*, std::int32_t, double);
extern template std::int32_t GaussianWindow(double*, std::int32_t, double, bool);
extern template std::int32_t GaussianWindow(Complex*, std::int32_t, double, bool);

}  // namespace krnumer
