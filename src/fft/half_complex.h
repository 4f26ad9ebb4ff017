// Spectra in their forms: half-complex or full, with X[0] first or in the middle.
//
// A shifted spectrum of n values has X[0] at index n/2 (rounded down); for even n the Nyquist term stands at index 0.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Where ExpandHalfComplex expects the half-complex values: they are the last n of the 2n doubles.
inline double* HalfComplexPart(Complex* data, int32_t n) {
    return &data->re + n;
}

// Half-complex values become the full spectrum, in place.
void ExpandHalfComplex(Complex* data, int32_t n, int32_t shift);

// The half-complex form of a spectrum. One half is read, and of X[0] and of the Nyquist term the real part.
void PackHalfComplex(const Complex* data, int32_t n, int32_t shift, double* out);

// Shifts a spectrum in place.
void ShiftSpectrum(Complex* data, int32_t n);

// Copies a shifted spectrum with X[0] first.
void CopyUnshifted(const Complex* shifted, int32_t n, Complex* out);

}  // namespace krnumer
