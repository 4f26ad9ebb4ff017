#include "fft/half_complex.h"

#include <algorithm>
#include <cstddef>

namespace krnumer {

void ExpandHalfComplex(Complex* data, int32_t n, int32_t shift) {
    const int32_t half = (n - 1) / 2;
    data[0].im = 0.0;
    for (int32_t k = 1; k <= half; ++k) {
        const double re = data[k].re;
        const double im = data[n - k].re;
        data[k] = {re, im};
        data[n - k] = {re, -im};
    }
    if (n % 2 == 0) data[n / 2].im = 0.0;
    if (shift != 0) ShiftSpectrum(data, n);
}

void PackHalfComplex(const Complex* data, int32_t n, int32_t shift, double* out, int32_t stride) {
    const ptrdiff_t step = stride;
    const Complex* origin = shift != 0 ? data + n / 2 * step : data;
    out[0] = origin->re;
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        out[k] = origin[k * step].re;
        out[n - k] = origin[k * step].im;
    }
    if (n % 2 == 0) out[n / 2] = data[shift != 0 ? 0 : n / 2 * step].re;
}

void ShiftSpectrum(Complex* data, int32_t n) {
    std::rotate(data, data + (n - n / 2), data + n);
}

void CopyUnshifted(const Complex* shifted, int32_t n, Complex* out) {
    std::rotate_copy(shifted, shifted + n / 2, shifted + n, out);
}

}  // namespace krnumer
