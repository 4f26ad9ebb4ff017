#include "transform/zoom.h"

#include <algorithm>
#include <cmath>
#include <type_traits>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "sigop/spectrum.h"

namespace krnumer {

namespace {

// The short transform of one phase. `work` holds twice its length.
template <class T>
class PhaseSpectrum {
  public:
    PhaseSpectrum(T* work, int32_t length) : samples_(work), spectrum_(work + length), length_(length) {}

    // Transforms x[t stride], where they exist below `end`.
    int32_t Transform(const T* x, std::int64_t end, int32_t stride, const qmfft_table* table) {
        for (int32_t t = 0; t < length_; ++t) {
            const std::int64_t i = std::int64_t{t} * stride;
            samples_[t] = i < end ? x[i] : T{};
        }
        return Forward(table, samples_, spectrum_, length_);
    }

    Complex operator[](int32_t k) const {
        if constexpr (std::is_same_v<T, Complex>) {
            return spectrum_[k];
        } else {
            return HalfComplexValue(spectrum_, length_, k);
        }
    }

  private:
    T* samples_;
    T* spectrum_;
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
    Scratch<T> work(2 * Count(length));
    if (!work) return kOutOfMemory;
    PhaseSpectrum<T> spectrum(work.data(), length);
    const int32_t remainder = start % length;
    const int32_t first = remainder < 0 ? remainder + length : remainder;
    for (int32_t phase = 0; phase < phases && phase < present; ++phase) {
        if (const int32_t status = spectrum.Transform(x + phase, present - phase, phases, table)) return status;
        const double turn = -6.283185307179586 * phase / static_cast<double>(total);
        const double angle = static_cast<double>(start % total) * turn;
        Complex rotor{std::cos(angle), std::sin(angle)};
        const Complex step{std::cos(turn), std::sin(turn)};
        for (int32_t i = 0, k = first; i < count; ++i) {
            y[i] += spectrum[k] * rotor;
            rotor = rotor * step;
            if (++k == length) k = 0;
        }
    }
    return kOk;
}

template int32_t ZoomTransform(double*, int32_t, int32_t, int32_t, int32_t, int32_t, const qmfft_table*, Complex*);
template int32_t ZoomTransform(Complex*, int32_t, int32_t, int32_t, int32_t, int32_t, const qmfft_table*, Complex*);

}  // namespace krnumer
