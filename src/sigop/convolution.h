// Linear convolution, cross-correlation and deconvolution of sequences, by definition or through the spectrum.
//
// Convolution:  z[k] = sum of x[i] y[k-i].
// Correlation:  the convolution of x, reversed in time and conjugated, with y. Lag 0 stands at k = nx - 1.
// Both have nx + ny - 1 values, which may not overlap the inputs.
#pragma once

#include <cstdint>

#include "frame/complex.h"
#include "frame/numeric.h"

namespace krnumer {

// How a convolution is computed. The choice is the caller's, whatever the lengths.
enum ConvolutionAlgorithm : int32_t { kDirect = 0, kFrequencyDomain = 1 };

// What the values of a correlation are divided by: nothing, the number of their terms, or the longer length.
enum CorrelationNormalization : int32_t { kNotNormalized = 0, kUnbiased = 1, kBiased = 2 };

// Length of a full convolution; negative where no int32 is long enough.
constexpr int32_t FullLength(int32_t nx, int32_t ny) {
    return WrappingAdd(nx, ny - 1);
}

// kEmptyInput where a length is below 1. An algorithm that is none gives kBadSelector for complex data; for real data
// it is taken, and z stays unwritten.
int32_t ConvolveReal(const double* x, int32_t nx, const double* y, int32_t ny, int32_t algorithm, double* z);
int32_t ConvolveComplex(const Complex* x, int32_t nx, const Complex* y, int32_t ny, int32_t algorithm, Complex* z);

// The same, and kBadSelector for a normalization that is none, after the computation. Real data passed twice by one
// pointer are correlated through their power spectrum.
int32_t CorrelateReal(const double* x, int32_t nx, const double* y, int32_t ny, int32_t algorithm, double* z,
                      int32_t normalization);
int32_t CorrelateComplex(const Complex* x, int32_t nx, const Complex* y, int32_t ny, int32_t algorithm, Complex* z,
                         int32_t normalization);

inline constexpr int32_t kLongestDeconvolution = 8388608;

// Undoes a convolution with y: the first n - m + 1 values of x become those of the inverse transform of X[k] / Y[k],
// over the least power of two that holds n points. Zeros of Y are not looked for; they give infinities and NaNs.
// kTooLong, kEmptyInput, and kBadDimension where y is longer than x. Without a table for the transform x stays as it
// is: kOk.
int32_t Deconvolve(double* x, int32_t n, const double* y, int32_t m);

}  // namespace krnumer
