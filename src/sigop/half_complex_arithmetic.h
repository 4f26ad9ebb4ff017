// Products and quotients of spectra of real sequences, value by value, in half-complex form (fft/fft.h).
#pragma once

#include <cstdint>

namespace krnumer {

// a b, or, where both are one pointer, a conj(a): the spectrum of an autocorrelation. The output may be an input too.
void HalfComplexMultiply(const double* a, const double* b, double* out, int32_t n);

// a / b. The output may be an input too.
void HalfComplexDivide(const double* a, const double* b, double* out, int32_t n);

}  // namespace krnumer
