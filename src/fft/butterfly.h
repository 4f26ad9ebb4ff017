// The four families of one radix on plain doubles at any stride: what runs where vectors do not reach.
#pragma once

#include "fft/inline.h"
#include "fft/stage.h"
#include "fft/table.h"
#include "frame/complex.h"

namespace krnumer {

KRNUMER_FFT_INLINE Complex AddI(Complex a, Complex b) {
    return {a.re - b.im, a.im + b.re};
}
KRNUMER_FFT_INLINE Complex SubtractI(Complex a, Complex b) {
    return {a.re + b.im, a.im - b.re};
}
KRNUMER_FFT_INLINE Complex Rotate(Complex a, double re, double im) {
    return a * Complex{re, im};
}

#include "fft/dft-inl.h"

// The generated butterfly as the kernel of a stage.
template <int r>
struct GeneratedKernel {
    static constexpr int32_t points() { return r; }

    static KRNUMER_FFT_NOINLINE int32_t Transform(Complex* t) {
        ComplexDft<r, Complex>([&](int j) KRNUMER_FFT_INLINE_LAMBDA { return t[j]; },
                               [&](int k, Complex value) KRNUMER_FFT_INLINE_LAMBDA { t[k] = value; });
        return kOk;
    }

    static int32_t TransformReal(double* x, ptrdiff_t stride) {
        TransformReal(x, x, stride, stride);
        return kOk;
    }

    static KRNUMER_FFT_NOINLINE void TransformReal(const double* in, double* out, ptrdiff_t in_stride,
                                                   ptrdiff_t out_stride) {
        RealDft<r, double>([&](int j) KRNUMER_FFT_INLINE_LAMBDA { return in[j * in_stride]; },
                           [&](int q, double value) KRNUMER_FFT_INLINE_LAMBDA { out[q * out_stride] = value; });
    }
};

template <int r>
void LeafOfReal(const double* in, double* out, int32_t in_stride, int32_t out_stride, int32_t how_many) {
    const ptrdiff_t step = ptrdiff_t{in_stride} * how_many;
    for (int32_t i = 0; i < how_many; ++i, in += in_stride, out += ptrdiff_t{r} * out_stride)
        GeneratedKernel<r>::TransformReal(in, out, step, out_stride);
}

template <int r>
void StageOfReal(double* data, const double* twiddle_re, const double* twiddle_im, int32_t stride, int32_t m) {
    Complex t[r];
    CombineReal(GeneratedKernel<r>(), t, data, {twiddle_re, twiddle_im}, stride, m);
}

template <int r>
void LeafOfComplex(const double* in_re, const double* in_im, double* out_re, double* out_im, int32_t in_stride,
                   int32_t out_stride, int32_t how_many) {
    const ptrdiff_t step = ptrdiff_t{in_stride} * how_many;
    Complex t[r];
    for (int32_t i = 0; i < how_many; ++i, in_re += in_stride, in_im += in_stride) {
        for (int j = 0; j < r; ++j) t[j] = {in_re[j * step], in_im[j * step]};
        GeneratedKernel<r>::Transform(t);
        for (int k = 0; k < r; ++k, out_re += out_stride, out_im += out_stride) {
            *out_re = t[k].re;
            *out_im = t[k].im;
        }
    }
}

template <int r>
void StageOfComplex(double* re, double* im, const double* twiddle_re, const double* twiddle_im, int32_t stride,
                    int32_t m) {
    Complex t[r];
    CombineComplex(GeneratedKernel<r>(), t, re, im, {twiddle_re, twiddle_im}, stride, m);
}

template <int r>
void RowsOfReal(double* data, const double* twiddle_re, const double* twiddle_im, int32_t m, int32_t k, int32_t end) {
    Complex t[r];
    CombineRealRows(GeneratedKernel<r>(), t, data, {twiddle_re, twiddle_im}, 1, m, k, end);
}

template <int r>
inline constexpr Butterflies kButterflies{LeafOfReal<r>, StageOfReal<r>, LeafOfComplex<r>, StageOfComplex<r>,
                                          RowsOfReal<r>};

}  // namespace krnumer
