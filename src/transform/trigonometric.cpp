#include "transform/trigonometric.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "frame/complex.h"
#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {

namespace {

double Sample(const Line& x, int32_t i) {
    return i < x.available ? x.samples[static_cast<std::ptrdiff_t>(i) * x.stride] : 0.0;
}

double& Element(double* y, int32_t stride, int32_t k) {
    return y[static_cast<std::ptrdiff_t>(k) * stride];
}

// Element k of a spectrum of length n in half-complex form.
Complex Spectrum(const double* half_complex, int32_t n, int32_t k) {
    if (k == 0 || 2 * static_cast<std::int64_t>(k) == n) return {half_complex[k], 0.0};
    if (k < n - k) return {half_complex[k], half_complex[n - k]};
    return {half_complex[n - k], -half_complex[k]};
}

// The factor by which element k of a cosine transform of length n becomes one of a spectrum.
Complex Rotor(int32_t n, int32_t k) {
    const double angle = k * kPi / (2.0 * n);
    const double gain = std::sqrt(k > 0 ? 2.0 * n : n);
    return {std::cos(angle) * gain, std::sin(angle) * gain};
}

int32_t LengthOrNone(std::int64_t length) {
    return length <= std::numeric_limits<int32_t>::max() ? static_cast<int32_t>(length) : 0;
}

// Imaginary parts of the spectrum of the odd extension 0, x, 0, -reversed x, times `factor`.
int32_t OddExtension(Line x, double* y, int32_t out_stride, int32_t n, double* work, const qmfft_table* table,
                     double factor) {
    const int32_t length = 2 * (n + 1);
    double* const extended = work;
    double* const spectrum = work + length;
    extended[0] = extended[n + 1] = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        extended[1 + i] = Sample(x, i);
        extended[length - 1 - i] = -extended[1 + i];
    }
    if (const int32_t status = RealFFT(table, extended, spectrum, 1, 1, length)) return status;
    for (int32_t k = 1; k <= n; ++k) Element(y, out_stride, k - 1) = factor * spectrum[length - k];
    return kOk;
}

}  // namespace

int32_t CosineTableLength(int32_t n) {
    return n % 2 == 0 ? n : LengthOrNone(2 * std::int64_t{n});
}
int32_t SineTableLength(int32_t n) {
    return LengthOrNone(2 * (std::int64_t{n} + 1));
}

int32_t CosineTransform(Line x, double* y, int32_t out_stride, int32_t n, double* work, const qmfft_table* table) {
    const bool even = n % 2 == 0;
    const int32_t length = even ? n : 2 * n;
    double* const ordered = work;
    double* const spectrum = work + length;
    if (even) {
        for (int32_t i = 0; i < n / 2; ++i) {
            ordered[i] = Sample(x, 2 * i);
            ordered[n - 1 - i] = Sample(x, 2 * i + 1);
        }
    } else {
        for (int32_t i = 0; i < n; ++i) ordered[i] = ordered[length - 1 - i] = Sample(x, i);
    }
    if (const int32_t status = RealFFT(table, ordered, spectrum, 1, 1, length)) return status;

    const double root = std::sqrt(2.0 * n);
    const double gain = even ? 2.0 : 1.0;
    for (int32_t k = 0; k < n; ++k) {
        const double angle = k * kPi / (-2.0 * n);
        const Complex element = Spectrum(spectrum, length, k);
        Element(y, out_stride, k) =
            element.re * (gain * std::cos(angle) / root) - element.im * (gain * std::sin(angle) / root);
    }
    y[0] /= std::sqrt(2.0);
    return kOk;
}

int32_t InverseCosineTransform(Line x, double* y, int32_t out_stride, int32_t n, double* work,
                               const qmfft_table* table) {
    if (n % 2 == 0) {
        double* const re = work;
        double* const im = re + n;
        double* const out_re = im + n;
        double* const out_im = out_re + n;
        for (int32_t k = 0; k < n; ++k) {
            const Complex element = Sample(x, k) * Rotor(n, k);
            re[k] = element.re;
            im[k] = element.im;
        }
        if (const int32_t status = InverseComplexFFT(table, re, im, out_re, out_im, 1, 1, n)) return status;
        for (int32_t i = 0; i < n / 2; ++i) {
            Element(y, out_stride, 2 * i) = out_re[i];
            Element(y, out_stride, 2 * i + 1) = out_re[n - 1 - i];
        }
        return kOk;
    }
    const int32_t length = 2 * n;
    double* const spectrum = work;
    double* const samples = work + length;
    spectrum[0] = 2.0 * Sample(x, 0) * Rotor(n, 0).re;
    spectrum[n] = 0.0;
    for (int32_t k = 1; k < n; ++k) {
        spectrum[k] = Sample(x, k) * Rotor(n, k).re;
        spectrum[length - k] = Sample(x, k) * Rotor(n, n - k).re;
    }
    if (const int32_t status = InverseRealFFT(table, spectrum, samples, 1, 1, length)) return status;
    for (int32_t i = 0; i < n; ++i) Element(y, out_stride, i) = samples[i];
    return kOk;
}

int32_t SineTransform(Line x, double* y, int32_t out_stride, int32_t n, double* work, const qmfft_table* table) {
    return OddExtension(x, y, out_stride, n, work, table, -0.5);
}

int32_t InverseSineTransform(Line x, double* y, int32_t out_stride, int32_t n, double* work, const qmfft_table* table) {
    if (const int32_t status = OddExtension(x, y, out_stride, n, work, table, -1.0)) return status;
    for (int32_t i = 0; i < n; ++i) Element(y, out_stride, i) /= n + 1.0;
    return kOk;
}

int32_t TransformRows(LineFunction* transform, const double* x, double* y, int32_t rows, int32_t columns, double* work,
                      const qmfft_table* table) {
    for (int32_t row = 0; row < rows; ++row) {
        const std::size_t start = Count(row) * Count(columns);
        const Line line{x + start, columns, 1};
        if (const int32_t status = transform(line, y + start, 1, columns, work, table)) return status;
    }
    return kOk;
}

int32_t TransformColumns(LineFunction* transform, const double* x, double* y, int32_t rows, int32_t columns,
                         double* work, const qmfft_table* table) {
    for (int32_t column = 0; column < columns; ++column) {
        const Line line{x + column, rows, columns};
        if (const int32_t status = transform(line, y + column, columns, rows, work, table)) return status;
    }
    return kOk;
}

}  // namespace krnumer
