// What operations on spectra of real and of complex data have in common: the form that suits the element, half-complex
// for real sequences and full for complex ones.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <type_traits>

#include "fft/fft.h"
#include "frame/complex.h"
#include "frame/status.h"
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

// The first `count` values of the inverse transform of the product of two spectra of n values. `work` holds n values.
// b is scratch afterwards, and x may be a.
inline int32_t InverseOfProduct(const qmfft_table* table, const double* a, double* b, int32_t n, double* work,
                                double* x, int32_t count) {
    HartleyMultiply(a, b, work, n);
    if (const int32_t status = Forward(table, work, b, n)) return status;
    CopyUnfolded(b, n, x, count);
    return kOk;
}
inline int32_t InverseOfProduct(const qmfft_table* table, const Complex* a, Complex* b, int32_t n, Complex* work,
                                Complex* x, int32_t count) {
    const double scale = 1.0 / n;
    for (int32_t k = 0; k < n; ++k) work[k] = a[k] * b[k];
    if (const int32_t status = Forward(table, work, b, n)) return status;
    x[0] = b[0] * scale;
    for (int32_t k = 1; k < count; ++k) x[k] = b[n - k] * scale;
    return kOk;
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
