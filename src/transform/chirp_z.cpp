#include "transform/chirp_z.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "sigop/convolution.h"

namespace krnumer {

namespace {

constexpr double kLargest = std::numeric_limits<double>::max();
constexpr double kLeast = -1.7976931348623e308;  // a little above the most negative double

bool IsUsable(double part) {
    return part > kLeast && part < kLargest;
}

double SquaredModulus(Complex z) {
    return z.re * z.re + z.im * z.im;
}

// Status of a parameter of the spiral.
int32_t CheckParameter(Complex z) {
    if (!IsUsable(z.re) || !IsUsable(z.im)) return kNotFinite;
    return SquaredModulus(z) == 0.0 ? kZeroParameter : kOk;
}

int32_t CheckSpiral(Complex a, Complex w) {
    const int32_t status = CheckParameter(a);
    return status != kOk ? status : CheckParameter(w);
}

// Real powers of a number that is not 0, through its polar form.
class Powers {
  public:
    explicit Powers(Complex base) : squared_modulus_(SquaredModulus(base)), angle_(std::atan2(base.im, base.re)) {}

    Complex operator()(double exponent) const {
        const double modulus = std::pow(squared_modulus_, exponent / 2.0);
        const double angle = exponent * angle_;
        return {modulus * std::cos(angle), modulus * std::sin(angle)};
    }

  private:
    double squared_modulus_;
    double angle_;
};

template <class T>
int32_t DirectChirpZ(const T* x, int32_t n, Complex a, Complex w, int32_t m, Complex* y) {
    Scratch<Complex> scaled(Count(n));  // x[j] A^-j
    if (!scaled) return kOutOfMemory;
    Complex power = Powers(a)(1.0 - n);
    for (int32_t j = n - 1; j >= 0; --j) {
        scaled[Count(j)] = x[j] * power;
        power = a * power;
    }
    const Powers w_power(w);
    for (int32_t k = 0; k < m; ++k) {
        Complex sum{};
        for (int32_t j = 0; j < n; ++j) sum += scaled[Count(j)] * w_power(static_cast<double>(j) * k);
        y[k] = sum;
    }
    return kOk;
}

template <class T>
int32_t BluesteinChirpZ(const T* x, int32_t n, Complex a, Complex w, int32_t m, Complex* y) {
    const std::int64_t chirp_length = std::int64_t{n} + m;
    if (chirp_length + n > std::numeric_limits<int32_t>::max()) return kOutOfMemory;
    const auto length = static_cast<int32_t>(chirp_length);
    Scratch<Complex> work(Count(n) + 2 * Count(length) + Count(n));
    if (!work) return kOutOfMemory;
    Complex* const samples = work.data();
    Complex* const chirp = samples + n;
    Complex* const product = chirp + length;

    const Powers a_power(a);
    const Powers w_power(w);
    for (int32_t t = 0; t < length; ++t) {
        const double distance = t - n;
        chirp[t] = w_power(-(distance * distance) / 2.0);
    }
    for (int32_t j = 0; j < n; ++j) samples[j] = x[j] * a_power(-j) / chirp[n - j];
    if (const int32_t status = ConvolveComplex(samples, n, chirp, length, kFrequencyDomain, product)) return status;
    for (int32_t k = 0; k < m; ++k) y[k] = product[n + k] / chirp[n + k];
    return kOk;
}

int32_t Reciprocal(Complex z, Complex* inverse) {
    const double squared_modulus = SquaredModulus(z);
    if (z.re == 0.0 && z.im == 0.0) return kZeroBase;
    *inverse = {z.re / squared_modulus, -z.im / squared_modulus};
    return kOk;
}

// Where the window of m values begins whose middle is nearest the unit circle: points of the spiral have the moduli
// |b|, |b||w|, |b||w|^2 ..., and the walk ends where they come no nearer.
int32_t WindowStart(Complex b, Complex w, int32_t n, int32_t m) {
    const double ratio = Modulus(w);
    double modulus = Modulus(b);
    int32_t nearest = 0;
    while (nearest + 1 < n && std::fabs(modulus * ratio - 1.0) < std::fabs(modulus - 1.0)) {
        modulus *= ratio;
        ++nearest;
    }
    return std::clamp(nearest - m / 2, 0, n - m);
}

}  // namespace

template <class T>
int32_t ChirpZ(const T* x, int32_t n, Complex a, Complex w, int32_t m, int32_t algorithm, Complex* y) {
    if (n < 1) return kEmptyInput;
    if (algorithm != kDirect && algorithm != kFrequencyDomain) return kBadSelector;
    if (const int32_t status = CheckSpiral(a, w)) return status;
    return algorithm == kDirect ? DirectChirpZ(x, n, a, w, m, y) : BluesteinChirpZ(x, n, a, w, m, y);
}

template int32_t ChirpZ(const double*, int32_t, Complex, Complex, int32_t, int32_t, Complex*);
template int32_t ChirpZ(const Complex*, int32_t, Complex, Complex, int32_t, int32_t, Complex*);

void RootsToPolynomial(Complex* roots, int32_t m, double* weights, Complex* c) {
    // std::max_element keeps the first of equals.
    const auto smaller = [](Complex a, Complex b) { return SquaredModulus(a) < SquaredModulus(b); };
    std::swap(roots[0], *std::max_element(roots, roots + m, smaller));
    std::fill_n(weights, m, 1.0);
    for (int32_t i = 1; i < m; ++i) {
        for (int32_t j = i; j < m; ++j) weights[j] *= SquaredModulus(roots[j] - roots[i - 1]);
        const auto farthest = std::max_element(weights + i, weights + m) - weights;
        std::swap(roots[i], roots[farthest]);
        weights[farthest] = weights[i];
    }

    c[0] = -roots[0];
    for (int32_t q = 1; q < m; ++q) {
        c[q] = c[q - 1] - roots[q];
        for (int32_t j = q - 1; j >= 1; --j) c[j] = c[j - 1] - roots[q] * c[j];
        c[0] = -roots[q] * c[0];
    }
}

int32_t InverseChirpZ(const Complex* x, int32_t n, Complex a, Complex w, int32_t m, Complex* y) {
    if (n < 1) return kEmptyInput;
    if (const int32_t status = CheckSpiral(a, w)) return status;
    if (m > n) return kBadDimension;
    Complex b;
    if (const int32_t status = Reciprocal(a, &b)) return status;
    const int32_t start = m < n ? WindowStart(b, w, n, m) : 0;
    for (int32_t i = 0; i < start; ++i) b = b * w;

    // The last convolution runs from the first block of m + 1 into the second.
    const std::size_t block = Count(m) + 1;
    Scratch<Complex> work(4 * block);
    Scratch<double> weights(Count(m));
    if (!work || !weights) return kOutOfMemory;
    Complex* const p = work.data();
    Complex* const q = p + block;
    Complex* const r = q + block;
    Complex* const s = r + block;

    constexpr Complex kOne{1.0, 0.0};
    p[0] = kOne;
    for (int32_t i = 0; i < m; ++i) p[i + 1] = w * p[i];
    Complex gain = kOne;
    for (int32_t i = 0; i < m; ++i) gain *= p[i];

    Complex factor = kOne;
    for (int32_t i = 1; i < m; ++i) {
        Complex inverse;
        if (const int32_t status = Reciprocal(p[i], &inverse)) return status;
        if (const int32_t status = Reciprocal(kOne - inverse, &inverse)) return status;
        factor *= inverse;
    }
    if (const int32_t status = Reciprocal(p[m], &p[m])) return status;
    q[0] = factor;
    for (int32_t i = 1; i < m; ++i) q[i] = q[i - 1] * (kOne - p[i] * p[m]) / (kOne - p[i]);
    for (int32_t i = 0; i < m; ++i) q[i] = x[start + i] * q[i];

    Complex w_inverse;
    if (const int32_t status = Reciprocal(w, &w_inverse)) return status;
    if (const int32_t status = ChirpZ(q, m, kOne, w_inverse, m, kDirect, r)) return status;

    Complex b_inverse;
    if (const int32_t status = Reciprocal(b, &b_inverse)) return status;
    q[0] = kOne;
    for (int32_t i = 0; i < m; ++i) q[i + 1] = b_inverse * q[i];
    for (int32_t k = 0; k < m; ++k) r[k] *= q[k];
    for (int32_t i = 0; i < m; ++i) p[i] = b * p[i];
    RootsToPolynomial(p, m, weights.data(), s);

    if (const int32_t status = Reciprocal(gain, &gain)) return status;
    gain = gain * q[m] * (m % 2 == 0 ? 1.0 : -1.0);
    for (int32_t i = 0; i < m; ++i) s[i] = gain * s[i];
    s[0] = kOne;
    if (const int32_t status = ConvolveComplex(r, m, s, m, kDirect, p)) return status;
    std::copy_n(p, m, y);
    return kOk;
}

}  // namespace krnumer
