#include "window/dolph_chebyshev.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>

#include "fft/fft.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

double InverseCosh(double t) {
    return std::log(t + std::sqrt(t * t - 1.0));
}

// Samples the spectrum, a Chebyshev polynomial of degree m - 1 stretched so that its main lobe rises to `ratio`, and
// transforms it back. m is at least 2.
std::int32_t GenerateDolphChebyshev(double* w, std::ptrdiff_t m, double ratio) {
    const double degree = static_cast<double>(m - 1);
    const double stretch = std::cosh(InverseCosh(ratio) / degree);
    const std::ptrdiff_t half = (m - 1) / 2;

    // The weights lie at d = j - (m - 1) / 2 from the middle, between samples where m is even: there every other term of
    // a transform of twice the length is theirs.
    const std::ptrdiff_t doubled = m % 2 == 0 ? 1 : 2;
    const std::ptrdiff_t length = 2 * m / doubled;
    if (length > std::numeric_limits<std::int32_t>::max()) return kOutOfMemory;
    const HeldTable table(static_cast<std::int32_t>(length));
    Scratch<double> spectrum(static_cast<std::size_t>(length), Scratch<double>::kZeroed);
    Scratch<double> sums(static_cast<std::size_t>(length));
    if (!table || !spectrum || !sums) return kOutOfMemory;

    const double phi = kPi / static_cast<double>(m);
    const double twice_cos_phi = 2.0 * std::cos(phi);
    double cosine = std::cos(phi), next = std::cos(2.0 * phi);
    double* const samples = spectrum.data();
    samples[0] = ratio;
    for (std::ptrdiff_t k = 1; k <= half; ++k) {
        const double t = stretch * cosine;
        samples[k] = std::fabs(t) > 1.0 ? std::cosh(InverseCosh(t) * degree) : std::cos(std::acos(t) * degree);
        samples[length - k] = samples[k];
        const double after = twice_cos_phi * next - cosine;
        cosine = next;
        next = after;
    }

    const auto n = static_cast<std::int32_t>(length);
    if (const std::int32_t status = RealFFT(table.get(), samples, sums.data(), 1, 1, n)) return status;
    for (std::ptrdiff_t j = 0; j <= half; ++j)
        w[j] = w[m - 1 - j] = sums[static_cast<std::size_t>((m - 1 - 2 * j) / doubled)] / static_cast<double>(m);
    return kOk;
}

}  // namespace

template <class T>
std::int32_t DolphChebyshevWindow(T* x, std::int32_t n, double ratio, bool symmetric) {
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    if (!(ratio >= 1.0)) ratio = 1.0;

    const std::ptrdiff_t m = symmetric ? std::ptrdiff_t{n} : std::ptrdiff_t{n} + 1;
    Scratch<double> weights(static_cast<std::size_t>(m));
    if (!weights) return kOutOfMemory;
    if (const std::int32_t status = GenerateDolphChebyshev(weights.data(), m, ratio)) return status;
    const double greatest = *std::max_element(weights.data(), weights.data() + m);
    for (std::int32_t i = 0; i < n; ++i) x[i] *= weights[static_cast<std::size_t>(i)] / greatest;
    return kOk;
}

template std::int32_t DolphChebyshevWindow(double*, std::int32_t, double, bool);
template std::int32_t DolphChebyshevWindow(Complex*, std::int32_t, double, bool);

}  // namespace krnumer
