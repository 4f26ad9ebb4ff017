#include "transform/spectrum.h"

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

double Scale(int32_t n) {
    return 1.0 / (static_cast<double>(n) * n);
}

// Spectrum of interleaved samples in two arrays.
int32_t Transform(const Complex* x, int32_t n, const qmfft_table* table, double* re, double* im) {
    const double* const parts = &x->re;
    return ComplexFFT(table, parts, parts + 1, re, im, 2, 1, n);
}

}  // namespace

int32_t PowerSpectrum(double* x, int32_t n, const qmfft_table* table) {
    if (n == 1) {
        x[0] *= x[0];
        return kOk;
    }
    Scratch<double> spectrum(Count(n));
    if (!spectrum) return kOutOfMemory;
    const double* const w = spectrum.data();
    if (const int32_t status = RealFFT(table, x, spectrum.data(), 1, 1, n)) return status;
    const double scale = Scale(n);
    x[0] = w[0] * w[0] * scale;
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) x[k] = x[n - k] = (w[k] * w[k] + w[n - k] * w[n - k]) * scale;
    if (n % 2 == 0) x[n / 2] = w[n / 2] * w[n / 2] * scale;
    return kOk;
}

int32_t PowerSpectrum(const Complex* x, int32_t n, const qmfft_table* table, double* power) {
    if (n == 1) {
        power[0] = x[0].re * x[0].re + x[0].im * x[0].im;
        return kOk;
    }
    Scratch<double> spectrum(2 * Count(n));
    if (!spectrum) return kOutOfMemory;
    double* const re = spectrum.data();
    double* const im = re + n;
    if (const int32_t status = Transform(x, n, table, re, im)) return status;
    const double scale = Scale(n);
    for (int32_t k = 0; k < n; ++k) power[k] = (re[k] * re[k] + im[k] * im[k]) * scale;
    return kOk;
}

// The two half-complex spectra stand in the real and the imaginary parts of the result until they are combined.
int32_t CrossSpectrum(const double* x, const double* y, int32_t n, const qmfft_table* table, Complex* cross) {
    if (n == 1) {
        cross[0] = {x[0] * y[0], 0.0};
        return kOk;
    }
    double* const parts = &cross->re;
    if (const int32_t status = RealFFT(table, x, parts, 1, 2, n)) return status;
    if (const int32_t status = RealFFT(table, y, parts + 1, 1, 2, n)) return status;
    const double scale = Scale(n);
    cross[0] = {cross[0].re * cross[0].im * scale, 0.0};
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        const Complex a{cross[k].re, cross[n - k].re};
        const Complex b{cross[k].im, cross[n - k].im};
        cross[k] = {(a.re * b.re + a.im * b.im) * scale, (a.re * b.im - a.im * b.re) * scale};
        cross[n - k] = Conjugate(cross[k]);
    }
    if (n % 2 == 0) cross[n / 2] = {cross[n / 2].re * cross[n / 2].im * scale, 0.0};
    return kOk;
}

int32_t CrossSpectrum(const Complex* x, const Complex* y, int32_t n, const qmfft_table* table, Complex* cross) {
    if (n == 1) {
        cross[0] = Conjugate(x[0]) * y[0];
        return kOk;
    }
    const std::size_t count = Count(n);
    Scratch<double> spectra(4 * count);
    if (!spectra) return kOutOfMemory;
    double* const x_re = spectra.data();
    double* const x_im = x_re + count;
    double* const y_re = x_im + count;
    double* const y_im = y_re + count;
    if (const int32_t status = Transform(x, n, table, x_re, x_im)) return status;
    if (const int32_t status = Transform(y, n, table, y_re, y_im)) return status;
    const double scale = Scale(n);
    for (std::size_t k = 0; k < count; ++k) cross[k] = Complex{x_re[k], -x_im[k]} * Complex{y_re[k], y_im[k]} * scale;
    return kOk;
}

}  // namespace krnumer
