#include "special/exponential_integral.h"

#include <cmath>

#include "special/continued_fraction.h"
#include "special/domain.h"
#include "special/gamma.h"

namespace krnumer {
namespace {

constexpr double kLargestExponent = 709.782712893384;
constexpr int32_t kLargeOrder = 5000;

// W. Gautschi, Exponential integral for large values of n, 1959: three terms in 1 / (x + n)^2.
double ForLargeOrder(double n, double x) {
    const double sum = x + n;
    const double y = 1.0 / (sum * sum);
    double series = y * n * (6.0 * x * x - 8.0 * n * x + n * n);
    series = y * (series + n * (n - 2.0 * x));
    series = y * (series + n);
    return (series + 1.0) * std::exp(-x) / sum;
}

double ByFraction(double n, double x) {
    ContinuedFraction fraction(1.0, x, 1.0, x + n, 1.0 / (x + n));
    double change = 1.0;
    for (double k = 1.0; change > kEpsilon; k += 1.0) {
        fraction.Append(k, x);
        change = fraction.Update();
        fraction.KeepFromOverflow();
        if (!(change > kEpsilon)) break;
        fraction.Append(n + k, 1.0);
        change = fraction.Update();
        fraction.KeepFromOverflow();
    }
    return fraction.value() * std::exp(-x);
}

double BySeries(int32_t n, double x) {
    double psi = -kEulerGamma - std::log(x);
    for (int32_t i = 1; i < n; ++i) psi += 1.0 / i;

    double k = 0.0, power = 1.0, denominator = 1.0 - n;
    double sum = n == 1 ? 0.0 : 1.0 / denominator;
    double change = 1.0;
    while (change > kEpsilon) {
        k += 1.0;
        power *= -x / k;
        denominator += 1.0;
        if (denominator != 0.0) sum += power / denominator;
        change = sum != 0.0 ? std::abs(power / sum) : 1.0;
    }
    if (n - 1 >= 170) return -sum;  // Gamma(n) overflows
    return std::pow(-x, n - 1.0) * psi / Gamma(n) - sum;
}

}  // namespace

double ExponentialIntegral(int32_t n, double x) {
    if (!std::isfinite(x)) return kQuietNaN;
    if (n < 0 || x < 0.0) return DomainError(kQuietNaN);
    if (x > kLargestExponent) return 0.0;
    if (x == 0.0) return n < 2 ? DomainError(kInfinity) : 1.0 / (n - 1.0);
    if (n == 0) return std::exp(-x) / x;
    if (n > kLargeOrder) return ForLargeOrder(n, x);
    return x > 1.0 ? ByFraction(n, x) : BySeries(n, x);
}

}  // namespace krnumer
