#include "transform/zoom.h"

#include <algorithm>
#include <cmath>
#include <type_traits>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

// The short transform of one phase. Complex data use all of the work of 4 length doubles, real data half of it.
template <class T>
class PhaseSpectrum {
  public:
    PhaseSpectrum(double* work, int32_t length) : work_(work), length_(length) {}

    // Transforms samples[t stride], where they exist below `end`.
    int32_t Transform(const T* samples, std::int64_t end, int32_t stride, const qmfft_table* table) {
        double* const re = work_;
        double* const im = re + length_;
        double* const out_re = im + length_;
        double* const out_im = out_re + length_;
        for (int32_t t = 0; t < length_; ++t) {
            const std::int64_t i = std::int64_t{t} * stride;
            if constexpr (std::is_same_v<T, Complex>) {
                const Complex sample = i < end ? samples[i] : Complex{};
                re[t] = sample.re;
                im[t] = sample.im;
            } else {
                re[t] = i < end ? samples[i] : 0.0;
            }
        }
        if constexpr (std::is_same_v<T, Complex>) {
            return ComplexFFT(table, re, im, out_re, out_im, 1, 1, length_);
        } else {
            return RealFFT(table, re, out_re, 1, 1, length_);
        }
    }

    Complex operator[](int32_t k) const {
        const double* const out = work_ + 2 * static_cast<std::ptrdiff_t>(length_);
        if constexpr (std::is_same_v<T, Complex>) {
            return {out[k], out[length_ + k]};
        } else {
            if (k == 0 || k == length_ - k) return {out[k], 0.0};
            return k < length_ - k ? Complex{out[k], out[length_ - k]} : Complex{out[length_ - k], -out[k]};
        }
    }

  private:
    double* work_;
    int32_t length_;
};

// Adds what lies behind the first total samples to them, read from position `from` on.
template <class T>
void Fold(T* x, int32_t n, std::int64_t total, int32_t from) {
    const T* next = x + from;
    for (std::int64_t left = n - total; left > 0; left -= total)
        for (std::int64_t i = 0; i < std::min(left, total); ++i) x[i] += *next++;
}

}  // namespace

template <class T>
int32_t ZoomTransform(T* x, int32_t n, int32_t phases, int32_t length, int32_t start, int32_t count,
                      const qmfft_table* table, Complex* y) {
    if (n < 1 || phases < 1 || length < 1 || table == nullptr) return kBadZoom;
    const std::int64_t total = std::int64_t{phases} * length;
    if (n > total) Fold(x, n, total, length);
    const std::int64_t present = std::min<std::int64_t>(n, total);

    std::fill_n(y, count, Complex{});
    Scratch<double> work(4 * Count(length));
    if (!work) return kOutOfMemory;
    PhaseSpectrum<T> spectrum(work.data(), length);
    const int32_t shift = start >= 0 ? start % length : static_cast<int32_t>(length - -std::int64_t{start} % length);
    for (int32_t phase = 0; phase < phases && phase < present; ++phase) {
        if (const int32_t status = spectrum.Transform(x + phase, present - phase, phases, table)) return status;
        const double turn = -6.283185307179586 * phase / static_cast<double>(total);
        const double angle = static_cast<double>(start % total) * turn;
        Complex rotor{std::cos(angle), std::sin(angle)};
        const Complex step{std::cos(turn), std::sin(turn)};
        for (int32_t i = 0; i < count; ++i) {
            y[i] += spectrum[static_cast<int32_t>((std::int64_t{i} + shift) % length)] * rotor;
            rotor = rotor * step;
        }
    }
    return kOk;
}

template int32_t ZoomTransform(double*, int32_t, int32_t, int32_t, int32_t, int32_t, const qmfft_table*, Complex*);
template int32_t ZoomTransform(Complex*, int32_t, int32_t, int32_t, int32_t, int32_t, const qmfft_table*, Complex*);

}  // namespace krnumer
