// What operations on spectra of real and of complex data have in common: the form that suits the element, half-complex
// for real sequences and full for complex ones.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <type_traits>

#include "fft/fft.h"
#include "frame/complex.h"
#include "sigop/half_complex_arithmetic.h"

namespace krnumer {

// Output must not overlap input.
inline int32_t Forward(const qmfft_table* table, const double* x, double* spectrum, int32_t n) {
    return RealFFT(table, x, spectrum, 1, 1, n);
}
inline int32_t Forward(const qmfft_table* table, const Complex* x, Complex* spectrum, int32_t n) {
    return ComplexFFT(table, &x->re, &x->im, &spectrum->re, &spectrum->im, 2, 2, n);
}

// The spectrum is scratch afterwards, and must not overlap the output.
inline int32_t Inverse(const qmfft_table* table, double* spectrum, double* x, int32_t n) {
    return InverseRealFFT(table, spectrum, x, 1, 1, n);
}
inline int32_t Inverse(const qmfft_table* table, Complex* spectrum, Complex* x, int32_t n) {
    return InverseComplexFFT(table, &spectrum->re, &spectrum->im, &x->re, &x->im, 2, 2, n);
}

inline void MultiplySpectra(const double* a, const double* b, double* out, int32_t n) {
    HalfComplexMultiply(a, b, out, n);
}
inline void MultiplySpectra(const Complex* a, const Complex* b, Complex* out, int32_t n) {
    for (int32_t k = 0; k < n; ++k) out[k] = a[k] * b[k];
}

// Fills up to n values with zeros.
template <class T>
void CopyPadded(const T* x, int32_t nx, T* padded, int32_t n) {
    std::fill(std::copy_n(x, nx, padded), padded + n, T{});
}

// Backwards, and conjugated where the values are complex.
template <class T>
void CopyReversed(const T* x, size_t n, T* reversed) {
    for (size_t i = 0; i < n; ++i) {
        if constexpr (std::is_same_v<T, Complex>) {
            reversed[i] = Conjugate(x[n - 1 - i]);
        } else {
            reversed[i] = x[n - 1 - i];
        }
    }
}

}  // namespace krnumer
