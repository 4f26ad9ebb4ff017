#include "fft/half_complex.h"

#include <algorithm>

namespace krnumer {

// The lower half of the spectrum overtakes none of the values that it is made of, and the upper half mirrors it.
void ExpandHalfComplex(Complex* data, int32_t n, int32_t shift) {
    const double* half_complex = HalfComplexPart(data, n);
    const int32_t half = (n - 1) / 2;
    data[0] = {half_complex[0], 0.0};
    for (int32_t k = 1; k <= half; ++k) data[k] = {half_complex[k], half_complex[n - k]};
    if (n % 2 == 0) data[n / 2] = {half_complex[n / 2], 0.0};
    for (int32_t k = 1; k <= half; ++k) data[n - k] = {data[k].re, -data[k].im};
    if (shift != 0) ShiftSpectrum(data, n);
}

void PackHalfComplex(const Complex* data, int32_t n, int32_t shift, double* out) {
    const Complex* origin = shift != 0 ? data + n / 2 : data;
    out[0] = origin->re;
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        out[k] = origin[k].re;
        out[n - k] = origin[k].im;
    }
    if (n % 2 == 0) out[n / 2] = data[shift != 0 ? 0 : n / 2].re;
}

void ShiftSpectrum(Complex* data, int32_t n) {
    std::rotate(data, data + (n - n / 2), data + n);
}

void CopyUnshifted(const Complex* shifted, int32_t n, Complex* out) {
    std::rotate_copy(shifted, shifted + n / 2, shifted + n, out);
}

}  // namespace krnumer
