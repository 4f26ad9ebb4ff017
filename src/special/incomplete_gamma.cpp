// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: a power series for P below x = max(1, a),
// Legendre's continued fraction for Q above.
#include "special/incomplete_gamma.h"

#include <cmath>
#include <cstdint>

#include "special/continued_fraction.h"
#include "special/domain.h"
#include "special/gamma.h"

namespace krnumer {
namespace {

// Near x = a the series takes about sqrt(72 a) terms. These reach to a = 1e12, where the exponent has lost all but
// three digits; at 1e16 and above, a + 1 = a and it would not end.
constexpr int32_t kMostTerms = 10'000'000;

// The logarithm of x^a e^-x / Gamma(a).
double LnPrefactor(double a, double x) {
    return a * std::log(x) - x - LnGamma(a);
}

// P(a, x) Gamma(a + 1) / (x^a e^-x) as the sum of x^k / ((a + 1) ... (a + k)).
double LowerSeries(double a, double x) {
    double r = a, term = 1.0, sum = 1.0;
    for (int32_t k = 0; k < kMostTerms; ++k) {
        r += 1.0;
        term *= x / r;
        sum += term;
        if (!(term / sum > kEpsilon)) return sum;
    }
    return kQuietNaN;
}

// Q(a, x) Gamma(a) / (x^a e^-x).
double UpperFraction(double a, double x) {
    double y = 1.0 - a, z = x + y + 1.0;
    ContinuedFraction fraction(1.0, x, x + 1.0, z * x, (x + 1.0) / (z * x));
    double change = 1.0;
    for (int32_t k = 1; change > kEpsilon; ++k) {
        if (k > kMostTerms) return kQuietNaN;
        y += 1.0;
        z += 2.0;
        fraction.Append(-(y * k), z);
        change = fraction.Update();
        fraction.KeepFromOverflow();
    }
    return fraction.value();
}

}  // namespace

double IncompleteGamma(double a, double x) {
    if (x == kInfinity) return 1.0;
    if (std::isnan(x) || x == -kInfinity || std::isnan(a) || a == -kInfinity) return kQuietNaN;
    if (a == kInfinity && x > 0.0) return kInfinity;
    if (x < 0.0 || a <= 0.0) return DomainError(kQuietNaN);
    if (x == 0.0) return 0.0;
    if (x > 1.0 && x > a) return 1.0 - IncompleteGammaC(a, x);

    const double exponent = LnPrefactor(a, x);
    if (!std::isfinite(exponent)) return kInfinity;
    return LowerSeries(a, x) * std::exp(exponent) / a;
}

double IncompleteGammaC(double a, double x) {
    if (x == kInfinity) return 0.0;
    if (std::isnan(x) || x == -kInfinity || std::isnan(a) || a == -kInfinity) return kQuietNaN;
    if (a == kInfinity) return kInfinity;
    if (x < 0.0 || a <= 0.0) return DomainError(kQuietNaN);
    if (x == 0.0) return 1.0;
    if (x < 1.0 || x < a) return 1.0 - IncompleteGamma(a, x);

    const double exponent = LnPrefactor(a, x);
    if (!std::isfinite(exponent)) return kInfinity;
    const double prefactor = std::exp(exponent);
    if (prefactor == 0.0) return 0.0;  // beyond x = 1e103 the fraction itself would overflow
    return UpperFraction(a, x) * prefactor;
}

}  // namespace krnumer
