// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: two continued fractions for the incomplete
// beta function, one in x and one in x / (1 - x).
#include "special/beta.h"

#include <cmath>
#include <cstdint>
#include <utility>

#include "special/continued_fraction.h"
#include "special/domain.h"
#include "special/gamma.h"

namespace krnumer {
namespace {

constexpr int32_t kMostPasses = 100;

// 1 / (1 + odd(0) / (1 + even(0) / (1 + odd(1) / (1 + ...)))).
template <class Odd, class Even>
double AlternatingFraction(Odd&& odd, Even&& even) {
    ContinuedFraction fraction(0.0, 1.0, 1.0, 1.0, 1.0);
    for (int32_t n = 0; n < kMostPasses; ++n) {
        fraction.Append(odd(n), 1.0);
        fraction.Append(even(n), 1.0);
        if (!(fraction.Update() >= kEpsilon)) break;
        fraction.KeepInRange();
    }
    return fraction.value();
}

// I_x(a, b) = x^a (1 - x)^b / (a B(a, b)) times this.
double incbcf(double a, double b, double x) {
    return AlternatingFraction(
        [=](double n) { return -(x * (a + n) * (a + b + n)) / ((a + 2.0 * n) * (a + 2.0 * n + 1.0)); },
        [=](double n) { return x * (n + 1.0) * (b - 1.0 - n) / ((a + 2.0 * n + 1.0) * (a + 2.0 * n + 2.0)); });
}

// I_x(a, b) = x^a (1 - x)^(b - 1) / (a B(a, b)) times this, z = x / (1 - x).
double incbd(double a, double b, double z) {
    return AlternatingFraction(
        [=](double n) { return -(z * (a + n) * (b - 1.0 - n)) / ((a + 2.0 * n) * (a + 2.0 * n + 1.0)); },
        [=](double n) { return z * (n + 1.0) * (a + b + n) / ((a + 2.0 * n + 1.0) * (a + 2.0 * n + 2.0)); });
}

}  // namespace

double Beta(double a, double b) {
    if (!std::isfinite(a) || !std::isfinite(b)) return kQuietNaN;
    const double s = a + b;
    if (a > 0.0 && b > 0.0) return std::exp(LnGamma(a) + LnGamma(b) - LnGamma(s));
    if (a > 0.0 && s > 0.0) return std::exp(LnGamma(a) - LnGamma(s)) * Gamma(b);
    if (b > 0.0 && s > 0.0) return std::exp(LnGamma(b) - LnGamma(s)) * Gamma(a);
    return Gamma(a) * Gamma(b) / Gamma(s);
}

double IncompleteBeta(double a, double b, double x) {
    if (!std::isfinite(a) || !std::isfinite(b) || !std::isfinite(x)) return kQuietNaN;
    if (a <= 0.0 || b <= 0.0 || x < 0.0 || x > 1.0) return DomainError(kQuietNaN);
    if (x == 0.0 || x == 1.0) return x;
    if (a == 1.0) {
        if (b == 1.0) return x;
        if (b <= 3.637978807091712e-13) return -std::log(1.0 - x) * b;  // 1 - (1 - x)^b would cancel
        return 1.0 - std::pow(1.0 - x, b);
    }

    double complement = 1.0 - x;
    const bool swapped = x > a / (a + b);
    if (swapped) {
        std::swap(a, b);
        std::swap(x, complement);
    }
    const bool in_x = (a + b - 2.0) * x / (a - 1.0) < 1.0;
    const double fraction = in_x ? incbcf(a, b, x) : incbd(a, b, x / complement);
    const double power = in_x ? b : b - 1.0;
    const double tail = std::exp(a * std::log(x) + power * std::log(complement) + LnGamma(a + b) - LnGamma(a) -
                                 LnGamma(b) + std::log(fraction / a));
    return swapped ? 1.0 - tail : tail;
}

}  // namespace krnumer
