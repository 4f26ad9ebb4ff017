#include "transform/spectrum.h"

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "sigop/spectrum.h"

namespace krnumer {

namespace {

double Scale(int32_t n) {
    return 1.0 / (static_cast<double>(n) * n);
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
    if (const int32_t status = Forward(table, x, spectrum.data(), n)) return status;
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
    Scratch<Complex> spectrum(Count(n));
    if (!spectrum) return kOutOfMemory;
    if (const int32_t status = Forward(table, x, spectrum.data(), n)) return status;
    const double scale = Scale(n);
    for (int32_t k = 0; k < n; ++k) {
        const Complex line = spectrum[Count(k)];
        power[k] = (line.re * line.re + line.im * line.im) * scale;
    }
    return kOk;
}

int32_t CrossSpectrum(const double* x, const double* y, int32_t n, const qmfft_table* table, Complex* cross) {
    if (n == 1) {
        cross[0] = {x[0] * y[0], 0.0};
        return kOk;
    }
    Scratch<double> spectra(2 * Count(n));
    if (!spectra) return kOutOfMemory;
    double* const v = spectra.data();
    double* const w = v + n;
    if (const int32_t status = Forward(table, x, v, n)) return status;
    if (const int32_t status = Forward(table, y, w, n)) return status;
    const double scale = Scale(n);
    cross[0] = {v[0] * w[0] * scale, 0.0};
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        cross[k] = Conjugate({v[k], v[n - k]}) * Complex{w[k], w[n - k]} * scale;
        cross[n - k] = Conjugate(cross[k]);
    }
    if (n % 2 == 0) cross[n / 2] = {v[n / 2] * w[n / 2] * scale, 0.0};
    return kOk;
}

int32_t CrossSpectrum(const Complex* x, const Complex* y, int32_t n, const qmfft_table* table, Complex* cross) {
    if (n == 1) {
        cross[0] = Conjugate(x[0]) * y[0];
        return kOk;
    }
    Scratch<Complex> spectra(2 * Count(n));
    if (!spectra) return kOutOfMemory;
    Complex* const v = spectra.data();
    Complex* const w = v + n;
    if (const int32_t status = Forward(table, x, v, n)) return status;
    if (const int32_t status = Forward(table, y, w, n)) return status;
    const double scale = Scale(n);
    for (int32_t k = 0; k < n; ++k) cross[k] = Conjugate(v[k]) * w[k] * scale;
    return kOk;
}

}  // namespace krnumer
