// M. Abramowitz and I. A. Stegun, Handbook of Mathematical Functions, 1964, 19.3 and 19.2: the even and the odd
// solution by their power series.
#include "special/parabolic_cylinder.h"

#include <cmath>

#include "special/domain.h"
#include "special/parity.h"

namespace krnumer {
namespace {

// sqrt(pi) / Gamma(z) by Stirling's series from 3 on; 0 at the poles of Gamma.
double GammaRatio(double z) {
    if (z <= 0.0 && IsWhole(z)) return 0.0;
    double product = 1.0;
    while (z < 3.0 && std::isfinite(product)) {
        product *= z;
        z += 1.0;
    }
    const double t = 2.0 / z, u = t / z;
    const double s = ((u / 3.0 - 1.0) * (u / 7.0) + 1.0) * u / 60.0;
    const double exponent = (s - 1.0) / (12.0 * z) - (std::log(z) - 1.0) * z;
    return product * std::exp(exponent) * std::sqrt(z / 2.0);
}

double AtMinusInfinity(double v) {
    if (v == kInfinity) return DomainError(kQuietNaN);
    if (v < 0.0) return DomainError(kInfinity);
    if (IsWhole(v)) return DomainError(0.0);
    return DomainError(IsOdd(std::trunc(v)) ? kInfinity : -kInfinity);  // the sign of Gamma(-v)
}

bool IsSpent(double term) {
    return term == 0.0 || !std::isfinite(term);
}

}  // namespace

double ParabolicCylinder(double v, double x) {
    if (std::isnan(v) || std::isnan(x)) return kQuietNaN;
    if (x == kInfinity) return 0.0;
    if (x == -kInfinity) return AtMinusInfinity(v);
    if (v == kInfinity) return kQuietNaN;

    const double square = x * x;
    const double scale = std::exp(0.34657359027997264 * v - square / 4.0);  // 2^(v / 2) e^(-x^2 / 4)
    const double a = (v + 1.0) / 2.0, y = square / 2.0;
    double even = scale * GammaRatio((1.0 - v) / 2.0);
    double odd = -1.4142135623730951 * x * GammaRatio(-v / 2.0) * scale;
    double sum = even + odd;
    const double terms = 6.0 * std::abs(x) + std::abs((2.0 - v) * (x + 2.0) * 0.2) + 0.5 * square + 3.0;
    for (double k = 1.0; k <= terms; k += 1.0) {
        if (IsSpent(even) && IsSpent(odd)) break;
        even *= (k - 0.5 - a) * y / ((k - 0.5) * k);
        odd *= (k - a) * y / ((k + 0.5) * k);
        sum += even + odd;
    }
    return std::isfinite(sum) ? sum : kQuietNaN;
}

}  // namespace krnumer
