#include "window/dolph_chebyshev.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

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

    // spectrum[k-1] for k from 1 to half, and behind it cos(pi r / m) for r below 2m
    Scratch<double> work(static_cast<std::size_t>(half + 2 * m));
    if (!work) return kOutOfMemory;
    double* const spectrum = work.data();
    double* const cosines = spectrum + half;

    const double phi = kPi / static_cast<double>(m);
    const double twice_cos_phi = 2.0 * std::cos(phi);
    double cosine = std::cos(phi), next = std::cos(2.0 * phi);
    for (std::ptrdiff_t k = 0; k < half; ++k) {
        const double t = stretch * cosine;
        spectrum[k] = std::fabs(t) > 1.0 ? std::cosh(InverseCosh(t) * degree) : std::cos(std::acos(t) * degree);
        const double after = twice_cos_phi * next - cosine;
        cosine = next;
        next = after;
    }

    for (std::ptrdiff_t r = 0; r <= m; ++r)
        cosines[r] = std::cos(static_cast<double>(r) * kPi / static_cast<double>(m));
    for (std::ptrdiff_t r = m + 1; r < 2 * m; ++r) cosines[r] = cosines[2 * m - r];

    // The angle of cos(2 k d pi / m), with d = j - (m - 1) / 2, is a multiple of pi / m: the table has them all. A few
    // weights are summed side by side, each in the order of k, so that the additions need not wait for one another.
    constexpr std::ptrdiff_t kTogether = 4;
    for (std::ptrdiff_t first = 0; first <= half; first += kTogether) {
        std::ptrdiff_t step[kTogether], r[kTogether] = {};
        double sum[kTogether] = {};
        for (std::ptrdiff_t l = 0; l < kTogether; ++l) step[l] = m - 1 - 2 * std::min(first + l, half);
        for (std::ptrdiff_t k = 0; k < half; ++k) {
            for (std::ptrdiff_t l = 0; l < kTogether; ++l) {
                r[l] += step[l];
                if (r[l] >= 2 * m) r[l] -= 2 * m;
                sum[l] += cosines[r[l]] * spectrum[k];
            }
        }
        for (std::ptrdiff_t l = 0; l < kTogether; ++l) {
            const std::ptrdiff_t j = std::min(first + l, half);
            w[j] = w[m - 1 - j] = (2.0 * sum[l] + ratio) / static_cast<double>(m);
        }
    }
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
