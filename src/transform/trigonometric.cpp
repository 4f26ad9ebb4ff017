#include "transform/trigonometric.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "frame/numeric.h"
#include "frame/status.h"
#include "sigop/spectrum.h"

namespace krnumer {

namespace {

// exp(i pi k / (2n)) for k = 0 .. n/2, as products of coarse and fine turns.
void FillTurns(int32_t n, Complex* turns) {
    constexpr int32_t kFine = 32;
    const auto turn = [n](int32_t k) {
        const double angle = k * kPi / (2.0 * n);
        return Complex{std::cos(angle), std::sin(angle)};
    };
    const int32_t count = n / 2 + 1;
    const int32_t fine = std::min(count, kFine);
    for (int32_t k = 0; k < fine; ++k) turns[k] = turn(k);
    for (int32_t k = fine; k < count; k += kFine) {
        const Complex coarse = turn(k);
        const int32_t end = std::min(kFine, count - k);
        for (int32_t j = 0; j < end; ++j) turns[k + j] = coarse * turns[j];
    }
}

int32_t LengthOrNone(std::int64_t length) {
    return length <= std::numeric_limits<int32_t>::max() ? static_cast<int32_t>(length) : 0;
}

// Imaginary parts of the spectrum of the odd extension 0, x, 0, -reversed x, times `factor`.
int32_t OddExtension(const double* x, int32_t available, double* y, LinePlan& plan, double factor) {
    const int32_t n = plan.length();
    const int32_t length = 2 * (n + 1);
    double* const extended = plan.work();
    double* const spectrum = extended + length;
    extended[0] = extended[n + 1] = 0.0;
    CopyPadded(x, std::min(available, n), extended + 1, n);
    for (int32_t i = 1; i <= n; ++i) extended[length - i] = -extended[i];
    if (const int32_t status = Forward(plan.table(), extended, spectrum, length)) return status;
    for (int32_t k = 1; k <= n; ++k) y[k - 1] = factor * spectrum[length - k];
    return kOk;
}

}  // namespace

int32_t CosineTableLength(int32_t n) {
    return n % 2 == 0 ? n : LengthOrNone(2 * std::int64_t{n});
}
int32_t SineTableLength(int32_t n) {
    return LengthOrNone(2 * (std::int64_t{n} + 1));
}

LinePlan::LinePlan(const LineTransform& line, int32_t n, const qmfft_table* table)
    : transform_(line.transform),
      length_(n),
      table_(table),
      work_(4 * (Count(n) + 1)),
      turns_(line.turns ? Count(n / 2 + 1) : 0) {
    if (line.turns && turns_) FillTurns(n, turns_.data());
}

int32_t CosineTransform(const double* x, int32_t available, double* y, LinePlan& plan) {
    const int32_t n = plan.length();
    const int32_t present = std::min(available, n);
    const bool even = n % 2 == 0;
    const int32_t length = even ? n : 2 * n;
    double* const ordered = plan.work();
    double* const spectrum = ordered + length;
    if (even) {
        std::fill_n(ordered, n, 0.0);
        for (int32_t i = 0; i < present; ++i) ordered[i % 2 == 0 ? i / 2 : n - 1 - i / 2] = x[i];
    } else {
        CopyPadded(x, present, ordered, n);
        std::reverse_copy(ordered, ordered + n, ordered + n);
    }
    if (const int32_t status = Forward(plan.table(), ordered, spectrum, length)) return status;

    const double gain = (even ? 2.0 : 1.0) / std::sqrt(2.0 * n);
    for (int32_t k = 0; k < n; ++k) {
        const Complex line = HalfComplexValue(spectrum, length, k);
        const Complex turn = plan.Turn(k);
        y[k] = (line.re * turn.re + line.im * turn.im) * gain;
    }
    y[0] /= std::sqrt(2.0);
    return kOk;
}

// Of an even length the samples are the real part of the transform of x[k] times its turn, so that of the spectrum its
// Hermitian part is enough.
int32_t InverseCosineTransform(const double* x, int32_t, double* y, LinePlan& plan) {
    const int32_t n = plan.length();
    const bool even = n % 2 == 0;
    const int32_t length = even ? n : 2 * n;
    const double gain = std::sqrt(2.0 * n);
    double* const spectrum = plan.work();
    double* const samples = spectrum + length;
    if (even) {
        spectrum[0] = x[0] * std::sqrt(n);
        for (int32_t k = 1; k < n / 2; ++k) {
            const Complex turn = plan.Turn(k) * (0.5 * gain);
            spectrum[k] = x[k] * turn.re + x[n - k] * turn.im;
            spectrum[n - k] = x[k] * turn.im - x[n - k] * turn.re;
        }
        spectrum[n / 2] = x[n / 2] * plan.Turn(n / 2).re * gain;
    } else {
        spectrum[0] = 2.0 * x[0] * std::sqrt(n);
        for (int32_t k = 1; k < n; ++k) {
            const Complex turn = plan.Turn(k) * gain;
            spectrum[k] = x[k] * turn.re;
            spectrum[length - k] = x[k] * turn.im;
        }
        spectrum[n] = 0.0;
    }
    if (const int32_t status = Inverse(plan.table(), spectrum, samples, length)) return status;
    if (even) {
        for (int32_t i = 0; i < n; ++i) y[i] = samples[i % 2 == 0 ? i / 2 : n - 1 - i / 2];
    } else {
        std::copy_n(samples, n, y);
    }
    return kOk;
}

int32_t SineTransform(const double* x, int32_t available, double* y, LinePlan& plan) {
    return OddExtension(x, available, y, plan, -0.5);
}

int32_t InverseSineTransform(const double* x, int32_t available, double* y, LinePlan& plan) {
    if (const int32_t status = OddExtension(x, available, y, plan, -1.0)) return status;
    const int32_t n = plan.length();
    for (int32_t i = 0; i < n; ++i) y[i] /= n + 1.0;
    return kOk;
}

int32_t TransformRows(LinePlan& plan, const double* x, int32_t x_rows, int32_t x_columns, double* y, int32_t rows) {
    const std::size_t columns = Count(plan.length());
    const int32_t present = std::min(x_rows, rows);
    for (int32_t row = 0; row < present; ++row, x += x_columns, y += columns) {
        if (const int32_t status = plan.Run(x, x_columns, y)) return status;
    }
    std::fill_n(y, Count(rows - present) * columns, 0.0);
    return kOk;
}

// A cache line of columns at a time, in lines of their own.
int32_t TransformColumns(LinePlan& plan, const double* x, double* y, int32_t columns) {
    constexpr int32_t kTogether = 8;
    const std::size_t rows = Count(plan.length());
    Scratch<double> lines(kTogether * rows);
    if (!lines) return kOutOfMemory;
    for (int32_t first = 0; first < columns; first += kTogether) {
        const std::size_t together = Count(std::min(kTogether, columns - first));
        for (std::size_t row = 0; row < rows; ++row)
            for (std::size_t c = 0; c < together; ++c)
                lines[c * rows + row] = x[row * Count(columns) + Count(first) + c];
        for (std::size_t c = 0; c < together; ++c) {
            double* const line = lines.data() + c * rows;
            if (const int32_t status = plan.Run(line, plan.length(), line)) return status;
        }
        for (std::size_t row = 0; row < rows; ++row)
            for (std::size_t c = 0; c < together; ++c)
                y[row * Count(columns) + Count(first) + c] = lines[c * rows + row];
    }
    return kOk;
}

}  // namespace krnumer
