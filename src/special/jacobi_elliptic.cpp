// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: the arithmetic-geometric mean, and first-order
// expansions about m = 0 and m = 1.
#include "special/jacobi_elliptic.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "special/domain.h"

namespace krnumer {
namespace {

constexpr double kHalfPi = 1.5707963267948966;
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

JacobiElliptic ByMean(double u, double m) {
    constexpr int32_t kMostLevels = 8;
    constexpr double kLost = 0x1p-55;  // beside 1; so the last level mostly only halves the amplitude
    double a[kMostLevels + 1] = {1.0}, c[kMostLevels + 1] = {std::sqrt(m)};
    double b = std::sqrt(1.0 - m), scale = 1.0;
    int32_t level = 0;
    while (std::abs(c[level] / a[level]) > kEpsilon) {
        if (level == kMostLevels) {
            DomainError(kQuietNaN);
            break;
        }
        const double previous = a[level++];
        c[level] = (previous - b) / 2.0;
        a[level] = (previous + b) / 2.0;
        b = std::sqrt(previous * b);
        scale *= 2.0;
    }
    double phi = a[level] * u * scale;
    double before = phi;
    if (!std::isfinite(phi)) return kNoValue;
    for (; level > 0; --level) {
        before = phi;
        const bool is_lost = std::abs(c[level]) < kLost * a[level] * std::max(1.0, std::abs(phi));
        if (!is_lost) phi += std::asin(c[level] * std::sin(phi) / a[level]);
        phi /= 2.0;
    }
    const double sn = std::sin(phi), cn = std::cos(phi);
    const double divisor = std::cos(before - phi);
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
