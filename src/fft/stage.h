// The two ways to combine blocks, for any kernel that transforms r values: generated, direct or Rader's.
//
// A kernel has points(), its r; Transform(t), r complex values in place; TransformReal(x, stride), r real samples in
// place into half-complex form. Those that need memory may fail with a status; generated ones always return 0.
#pragma once

#include <cstddef>
#include <cstdint>

#include "fft/inline.h"
#include "frame/complex.h"
#include "frame/status.h"

namespace krnumer {

// The twiddles of a stage: rows k = 1 .. m-1 of r-1 values, j = 1 .. r-1.
struct Twiddles {
    const double* re;
    const double* im;

    Complex operator()(ptrdiff_t k, int32_t j, int32_t r) const {
        const ptrdiff_t i = (k - 1) * (r - 1) + (j - 1);
        return {re[i], im[i]};
    }
};

// Rows k and m - k of half-complex blocks hold the real and the imaginary parts of one column, for 0 < k < m/2. The r
// results are rows k + q m of the combined block, those of the upper half as their conjugates. `t` holds r values.
template <class Kernel>
KRNUMER_FFT_INLINE int32_t PairStep(const Kernel& kernel, Complex* t, double* data, Twiddles w, ptrdiff_t stride,
                                    int32_t m, int32_t k) {
    const int32_t r = kernel.points();
    const ptrdiff_t block = stride * m;
    double* a = data + k * stride;
    double* b = data + (m - k) * stride;
    t[0] = {a[0], b[0]};
    for (int32_t j = 1; j < r; ++j) t[j] = Complex{a[j * block], b[j * block]} * w(k, j, r);
    if (const int32_t status = kernel.Transform(t)) return status;
    for (int32_t q = 0; q < r; ++q) {
        const bool lower = 2 * q < r;
        a[q * block] = lower ? t[q].re : -t[q].im;
        b[(r - 1 - q) * block] = lower ? t[q].im : t[q].re;
    }
    return kOk;
}

// Row m/2 of half-complex blocks of even length is real.
template <class Kernel>
KRNUMER_FFT_INLINE int32_t NyquistStep(const Kernel& kernel, Complex* t, double* data, Twiddles w, ptrdiff_t stride,
                                       int32_t m) {
    const int32_t r = kernel.points();
    const ptrdiff_t block = stride * m;
    double* a = data + m / 2 * stride;
    t[0] = {a[0], 0.0};
    for (int32_t j = 1; j < r; ++j) t[j] = a[j * block] * w(m / 2, j, r);
    if (const int32_t status = kernel.Transform(t)) return status;
    for (int32_t q = 0; q < r / 2; ++q) {
        a[q * block] = t[q].re;
        a[(r - 1 - q) * block] = t[q].im;
    }
    if (r % 2 != 0) a[r / 2 * block] = t[r / 2].re;
    return kOk;
}

// Combines rows of r half-complex blocks of length m in place, from row k >= 1 to before row `end`, with their
// partners. `t` holds r values.
template <class Kernel>
KRNUMER_FFT_INLINE int32_t CombineRealRows(const Kernel& kernel, Complex* t, double* data, Twiddles w, ptrdiff_t stride,
                                           int32_t m, int32_t k, int32_t end) {
    for (; k < end && k <= (m - 1) / 2; ++k)
        if (const int32_t status = PairStep(kernel, t, data, w, stride, m, k)) return status;
    return k < end && k == m / 2 ? NyquistStep(kernel, t, data, w, stride, m) : kOk;
}

// Combines r half-complex blocks of length m in place. `t` holds r values.
template <class Kernel>
KRNUMER_FFT_INLINE int32_t CombineReal(const Kernel& kernel, Complex* t, double* data, Twiddles w, ptrdiff_t stride,
                                       int32_t m) {
    if (const int32_t status = kernel.TransformReal(data, stride * m)) return status;
    return CombineRealRows(kernel, t, data, w, stride, m, 1, m);
}

// Combines r complex blocks of length m in place. `t` holds r values.
template <class Kernel>
KRNUMER_FFT_INLINE int32_t CombineComplex(const Kernel& kernel, Complex* t, double* re, double* im, Twiddles w,
                                          ptrdiff_t stride, int32_t m) {
    const int32_t r = kernel.points();
    const ptrdiff_t block = stride * m;
    for (int32_t k = 0; k < m; ++k, re += stride, im += stride) {
        for (int32_t j = 0; j < r; ++j) {
            t[j] = {re[j * block], im[j * block]};
            if (k > 0 && j > 0) t[j] = t[j] * w(k, j, r);
        }
        if (const int32_t status = kernel.Transform(t)) return status;
        for (int32_t q = 0; q < r; ++q) {
            re[q * block] = t[q].re;
            im[q * block] = t[q].im;
        }
    }
    return kOk;
}

}  // namespace krnumer
