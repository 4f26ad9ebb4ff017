// Spectra of real sequences, value by value, in half-complex form (fft/fft.h).
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Value k of a spectrum of length n.
inline Complex HalfComplexValue(const double* x, int32_t n, int32_t k) {
    if (k == 0 || k == n - k) return {x[k], 0.0};
    return k < n - k ? Complex{x[k], x[n - k]} : Complex{x[n - k], -x[k]};
}

// a b, or, where both are one pointer, a conj(a): the spectrum of an autocorrelation. The output may be an input too.
void HalfComplexMultiply(const double* a, const double* b, double* out, int32_t n);

// a / b. The output may be an input too.
void HalfComplexDivide(const double* a, const double* b, double* out, int32_t n);

// a b / n, its real parts less and plus its imaginary parts: the Hartley transform of the product's sequence, whose
// half-complex transform is that sequence but for CopyUnfolded. The output may not be an input.
void HartleyMultiply(const double* a, const double* b, double* out, int32_t n);

// The first `count` values of a sequence of n.
void CopyUnfolded(const double* folded, int32_t n, double* x, int32_t count);

}  // namespace krnumer
