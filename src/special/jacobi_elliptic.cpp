// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: the arithmetic-geometric mean, and first-order
// expansions about m = 0 and m = 1.
#include "special/jacobi_elliptic.h"

#include <cmath>
#include <cstdint>

#include "special/domain.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kHalfPi = 1.5707963267948966;
constexpr double kSixth = 1.0 / 6.0;
constexpr JacobiElliptic kNoValue = {kQuietNaN, kQuietNaN, kQuietNaN, kQuietNaN};

JacobiElliptic NearCircular(double u, double m) {
    const double sine = std::sin(u), cosine = std::cos(u);
    const double a = 0.25 * m * (u - sine * cosine);
    const double sn = sine - a * cosine;
    return {sn, cosine + a * sine, 1.0 - 0.5 * m * sn * sn, u - a};
}

JacobiElliptic NearHyperbolic(double u, double m) {
    const double a = 0.25 * (1.0 - m);
    const double amplitude = 2.0 * std::atan(std::exp(u)) - kHalfPi;
    if (std::abs(u) > 355.0) {  // cosh^2 overflows
        const double sign = u < 0.0 ? -1.0 : 1.0;
        return {sign, 0.0, 0.0, amplitude + sign * a};
    }
    const double cosh = std::cosh(u), tanh = std::tanh(u), sech = 1.0 / cosh;
    const double w = cosh * std::sinh(u);
    const double b = a * tanh * sech;
    return {tanh + a * (w - u) / (cosh * cosh), sech - b * (w - u), sech + b * (w + u), amplitude + a * (w - u) / cosh};
}

// Of x^2, times x for the odd functions.
constexpr double kSine[] = {-1.0 / 5040.0, 1.0 / 120.0, -kSixth, 1.0};
constexpr double kCosine[] = {1.0 / 40320.0, -1.0 / 720.0, 1.0 / 24.0, -0.5, 1.0};
constexpr double kArcSine[] = {105.0 / 3456.0, 15.0 / 336.0, 3.0 / 40.0, kSixth, 1.0};

// One level of the scale.
struct Level {
    double ratio;                // c / a
    double angle, sine, cosine;  // 2^n a u
};

// ratio sin(angle + e), where e is about an eighth of ratio^2: the smaller the ratio, the fewer terms of a series in e
// count.
double ScaledSine(const Level& level, double e) {
    const auto& [ratio, angle, sine, cosine] = level;
    const double z = e * e;
    if (ratio < 2e-4) return ratio * (sine + cosine * e);
    if (ratio < 0.03) return ratio * (sine * (1.0 - z * 0.5) + cosine * (e * (1.0 - z * kSixth)));
    if (ratio < 0.5) return ratio * (sine * PolyEval(z, kCosine) + cosine * (e * PolyEval(z, kSine)));
    return ratio * std::sin(angle + e);
}

// asin(x) of |x| <= ratio.
double ArcSine(double ratio, double x) {
    const double z = x * x;
    if (ratio < 2e-4) return x * (1.0 + z * kSixth);
    return ratio < 0.03 ? x * PolyEval(z, kArcSine) : std::asin(x);
}

// From the amplitude phi = 2^n a u of the lowest level n, sin(2 phi' - phi) = c / a sin(phi) gives the phi' of the level
// above it. What phi differs from 2^n a u by is carried apart, because sines and cosines of the doubled angles cost no
// more than products.
JacobiElliptic ByMean(double u, double m) {
    constexpr int32_t kMostLevels = 8;
    constexpr double kLastRatio = 7.45e-9;  // 2^-27; the next, its square over 4, changes neither a nor phi
    Level levels[kMostLevels + 1];
    double a = 1.0, b = std::sqrt(1.0 - m);
    int32_t last = 0;
    do {
        if (last == kMostLevels) {
            DomainError(kQuietNaN);
            break;
        }
        const double previous = a;
        levels[++last].ratio = (previous - b) / (previous + b);
        a = (previous + b) / 2.0;
        b = std::sqrt(previous * b);
    } while (levels[last].ratio > kLastRatio);

    double angle = a * u, sine = std::sin(angle), cosine = std::cos(angle);
    levels[0].angle = angle;
    for (int32_t n = 1; n <= last; ++n) {
        const double doubled = 2.0 * sine * cosine;
        cosine = (cosine - sine) * (cosine + sine);
        sine = doubled;
        angle *= 2.0;
        levels[n] = {levels[n].ratio, angle, sine, cosine};
    }
    if (!std::isfinite(angle)) return kNoValue;
    double x = 0.0, excess = -0.0;  // of which the sign of u = -0 survives
    for (int32_t n = last; n > 0; --n) {
        x = ScaledSine(levels[n], excess);
        excess = (excess + ArcSine(levels[n].ratio, x)) / 2.0;
    }

    // For dn the cosine of the last two amplitudes' difference, which is phi - asin(x).
    const double phi = levels[0].angle + excess;
    const double sn = std::sin(phi), cn = std::cos(phi);
    const double versine = x * x / (1.0 + std::sqrt(1.0 - x * x));
    const double divisor = cn + (sn * x - cn * versine);
    const double dn = std::abs(divisor) >= 0.1 ? cn / divisor : std::sqrt(1.0 - m * sn * sn);
    return {sn, cn, dn, phi};
}

}  // namespace

JacobiElliptic JacobiEllipticFunctions(double u, double m) {
    if (!std::isfinite(u) || !std::isfinite(m)) return kNoValue;
    if (m < 0.0 || m > 1.0) {
        const double zero = DomainError(0.0);
        return {zero, zero, zero, zero};
    }
    if (m < 1e-9) return NearCircular(u, m);
    return m >= 0.999999999 ? NearHyperbolic(u, m) : ByMean(u, m);
}

}  // namespace krnumer
