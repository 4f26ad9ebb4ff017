// Spectra of real sequences in their two forms, n doubles of half-complex form and n complex values.
//
// A shifted spectrum has X[0] at index n/2 (rounded down); for even n the Nyquist term stands at index 0.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Half-complex values in the real parts of `data` become the full spectrum, in place.
void ExpandHalfComplex(Complex* data, int32_t n, int32_t shift);

// The half-complex form of a spectrum. One half is read, and of X[0] and the Nyquist term the real part.
// `stride` is the distance of the values in complex numbers.
void PackHalfComplex(const Complex* data, int32_t n, int32_t shift, double* out, int32_t stride = 1);

}  // namespace krnumer
