// The drivers: decimation in time over the factors of a table, depth first, so that a block is finished while it is
// close at hand.
#include <cstddef>

#include "fft/factor.h"
#include "fft/fft.h"
#include "fft/inline.h"
#include "fft/table.h"
#include "fft/vector_transform.h"
#include "frame/complex.h"
#include "frame/status.h"

namespace krnumer {
namespace {

int32_t RealFFTStep(int32_t n, const qmfft_table* table, int32_t i, const double* in, double* out, int32_t in_stride,
                    int32_t out_stride) {
    const int32_t r = table->factors[i];
    const int32_t m = n / r;
    if (i == table->factorCount - 2) {
        if (const int32_t status = RunRealLeaf(table, i + 1, in, out, in_stride, out_stride, r)) return status;
    } else {
        const ptrdiff_t block = ptrdiff_t{m} * out_stride;
        for (int32_t b = 0; b < r; ++b) {
            if (const int32_t status = RealFFTStep(m, table, i + 1, in + ptrdiff_t{b} * in_stride, out + b * block,
                                                   r * in_stride, out_stride)) {
                return status;
            }
        }
    }
    return RunRealStage(table, i, out, out_stride, m);
}

int32_t ComplexFFTStep(int32_t n, const qmfft_table* table, int32_t i, const double* in_re, const double* in_im,
                       double* out_re, double* out_im, int32_t in_stride, int32_t out_stride) {
    const int32_t r = table->factors[i];
    const int32_t m = n / r;
    if (i == table->factorCount - 2) {
        if (const int32_t status =
                RunComplexLeaf(table, i + 1, in_re, in_im, out_re, out_im, in_stride, out_stride, r)) {
            return status;
        }
    } else {
        const ptrdiff_t block = ptrdiff_t{m} * out_stride;
        for (int32_t b = 0; b < r; ++b) {
            const ptrdiff_t from = ptrdiff_t{b} * in_stride;
            const ptrdiff_t to = b * block;
            if (const int32_t status = ComplexFFTStep(m, table, i + 1, in_re + from, in_im + from, out_re + to,
                                                      out_im + to, r * in_stride, out_stride)) {
                return status;
            }
        }
    }
    return RunComplexStage(table, i, out_re, out_im, out_stride, m);
}

// Scales, and turns half-complex form into Hartley form, up to the order of the halves, or back. The halves do not
// overlap, which the compiler has to be told.
KRNUMER_FFT_INLINE void FoldHalvesAt(double* data, ptrdiff_t stride, int32_t n, double scale) {
    double* KRNUMER_FFT_RESTRICT lower = data + stride;
    double* KRNUMER_FFT_RESTRICT upper = data + (n - 1) * stride;
    for (ptrdiff_t k = 0; k < (n - 1) / 2; ++k) {
        const double a = lower[k * stride] * scale;
        const double b = upper[-k * stride] * scale;
        lower[k * stride] = a - b;
        upper[-k * stride] = a + b;
    }
    data[0] *= scale;
    if (n % 2 == 0) data[n / 2 * stride] *= scale;
}

void FoldHalves(double* data, int32_t stride, int32_t n, double scale) {
    if (stride == 1) {
        FoldHalvesAt(data, 1, n, scale);
    } else {
        FoldHalvesAt(data, stride, n, scale);
    }
}

// Exchanges every value k with value n - k; store(k, x) scales.
template <class Value, class Store>
void ReverseAndScale(int32_t n, const Value& value, const Store& store) {
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        const Complex lower = value(k);
        store(k, value(n - k));
        store(n - k, lower);
    }
    store(0, value(0));
    if (n % 2 == 0) store(n / 2, value(n / 2));
}

}  // namespace

int32_t ComplexFFT(const qmfft_table* table, const double* in_re, const double* in_im, double* out_re, double* out_im,
                   int32_t in_stride, int32_t out_stride, int32_t n) {
    if (n != table->length) return kLengthMismatch;
    if (n == 1) {
        *out_re = *in_re;
        *out_im = *in_im;
        return kOk;
    }
    if (table->complexPlan.sequences > 0 && in_im == in_re + 1 && in_stride == 2 && out_im == out_re + 1 &&
        out_stride == 2)
        return VectorComplexFFT(table, in_re, out_re);
    if (table->factorCount == 1)
        return RunComplexLeaf(table, 0, in_re, in_im, out_re, out_im, in_stride, out_stride, 1);
    return ComplexFFTStep(n, table, 0, in_re, in_im, out_re, out_im, in_stride, out_stride);
}

int32_t RealFFT(const qmfft_table* table, const double* in, double* out, int32_t in_stride, int32_t out_stride,
                int32_t n) {
    if (n != table->length) return kLengthMismatch;
    if (n == 1) {
        *out = *in;
        return kOk;
    }
    if (table->realPlan.sequences > 0 && in_stride == 1 && out_stride == 1) return VectorRealFFT(table, in, out);
    if (table->factorCount == 1) return RunRealLeaf(table, 0, in, out, in_stride, out_stride, 1);
    return RealFFTStep(n, table, 0, in, out, in_stride, out_stride);
}

// A forward transform of a spectrum gives n x[-j].
int32_t InverseComplexFFT(const qmfft_table* table, const double* in_re, const double* in_im, double* out_re,
                          double* out_im, int32_t in_stride, int32_t out_stride, int32_t n) {
    if (const int32_t status = ComplexFFT(table, in_re, in_im, out_re, out_im, in_stride, out_stride, n)) return status;
    const double scale = 1.0 / n;
    if (out_im == out_re + 1 && out_stride == 2) {
        auto* out = reinterpret_cast<Complex*>(out_re);
        ReverseAndScale(
            n, [=](int32_t k) { return out[k]; }, [=](int32_t k, Complex x) { out[k] = x * scale; });
        return kOk;
    }
    const auto value = [&](int32_t k) {
        const ptrdiff_t at = ptrdiff_t{k} * out_stride;
        return Complex{out_re[at], out_im[at]};
    };
    const auto store = [&](int32_t k, Complex x) {
        const ptrdiff_t at = ptrdiff_t{k} * out_stride;
        out_re[at] = x.re * scale;
        out_im[at] = x.im * scale;
    };
    ReverseAndScale(n, value, store);
    return kOk;
}

// The Hartley transform is its own inverse, and half-complex form is a fold away from it on either side.
// Source: R. N. Bracewell, The Hartley Transform, Oxford 1986.
int32_t InverseRealFFT(const qmfft_table* table, double* in, double* out, int32_t in_stride, int32_t out_stride,
                       int32_t n) {
    if (n != table->length) return kLengthMismatch;
    FoldHalves(in, in_stride, n, 1.0 / n);
    if (const int32_t status = RealFFT(table, in, out, in_stride, out_stride, n)) return status;
    FoldHalves(out, out_stride, n, 1.0);
    return kOk;
}

}  // namespace krnumer
