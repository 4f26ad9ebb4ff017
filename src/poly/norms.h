// Unit vectors in the p-norm, and polar and rectangular form of pairs of arrays.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Divides x by its p-norm (|x[0]|^p + ...)^(1/p); `out` null means in place. p may be infinite, for the largest
// magnitude, or minus that, for the smallest. Where the norm is 0, the vector stays.
//
// kEmptyInput: n < 1; kNotFinite: p is NaN; kZeroParameter: p is 0.
template <class T>
int32_t UnitVectorCore(T* x, int32_t n, double p, double* norm, T* out);

// (r, theta) to (r cos theta, r sin theta). Where an output is null, it takes the place of its input. kEmptyInput.
int32_t PolarToRect(double* r, double* theta, int32_t n, double* x, double* y);

// (x, y) to (sqrt(x^2 + y^2), atan2(y, x)); the origin has angle 0 whatever the signs of its zeros. kEmptyInput.
int32_t RectToPolar(double* x, double* y, int32_t n, double* r, double* theta);

}  // namespace krnumer
