// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: the argument is moved to 2 <= x < 3 for a
// rational approximation, from 33 on Stirling's formula serves.
#include "special/gamma.h"

#include <cmath>

#include "special/domain.h"
#include "special/gamma_coefficients.h"
#include "special/parity.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kStirlingFrom = 33.0;
constexpr int32_t kLargestFactorial = 170;
constexpr double kLargestPower = 143.01608;  // beyond, x^(x - 1/2) overflows
constexpr double kLargestExponent = 709.782712893384;
constexpr double kSqrtTwoPi = 2.5066282746310007;
constexpr double kLnSqrtTwoPi = 0.9189385332046728;

// Moves x >= 3 to 2 <= x < 3, and gives (x - 1) (x - 2) ... down to there, in this order; the differences are exact.
// With the steps counted beforehand, and four in a pass, the processor need not wait for x to find the end of the loop.
double Descend(double& x) {
    double product = 1.0;
    int32_t steps = static_cast<int32_t>(x) - 2;
    for (; steps >= 4; steps -= 4) {
        product = product * (x - 1.0) * (x - 2.0) * (x - 3.0) * (x - 4.0);
        x -= 4.0;
    }
    for (; steps > 0; --steps) {
        x -= 1.0;
        product *= x;
    }
    return product;
}

// Gamma(x) Gamma(-x) = -pi / (x sin(pi x)) for x below -33.
double ReflectedGamma(double x) {
    const double size = std::abs(x);
    const double whole = std::floor(size);
    if (whole == size) return DomainError(kQuietNaN);
    const double sign = IsOdd(whole) ? 1.0 : -1.0;
    double fraction = size - whole;
    if (fraction >= 0.5) fraction = size - (whole + 1.0);
    const double z = size * std::sin(kPi * fraction);
    if (z == 0.0) return sign * z;
    return kPi / (std::abs(z) * Stirling(size)) * sign;
}

double ComputedFactorial(int32_t n) {
    if (n < 34) return kFactorials[n];
    if (n >= 51) return Gamma(n + 1.0);
    double product = kFactorials[33];
    for (int32_t k = n; k >= 34; --k) product *= k;
    return product;
}

double ComputedLnFactorial(int32_t n) {
    return n == 1 ? 0.0 : LnGamma(n + 1.0);
}

// The values of a function of n = 0, 1, ..., as far as n! is finite.
template <double (*function)(int32_t)>
class Table {
  public:
    Table() {
        for (int32_t n = 0; n <= kLargestFactorial; ++n) values_[n] = function(n);
    }
    double operator[](int32_t n) const { return values_[n]; }

  private:
    double values_[kLargestFactorial + 1];
};

}  // namespace

double Gamma(double x) {
    if (std::isnan(x) || x == -kInfinity) return kQuietNaN;
    if (x == kInfinity) return x;
    if (std::abs(x) > kStirlingFrom) return x > 0.0 ? Stirling(x) : ReflectedGamma(x);

    double factor = Descend(x);
    while (x < 2.0) {
        if (std::abs(x) < 1e-9) {
            return x == 0.0 ? DomainError(kQuietNaN) : factor / ((1.0 + kEulerGamma * x) * x);
        }
        factor /= x;
        x += 1.0;
    }
    if (x == 2.0) return factor;
    x -= 2.0;
    return factor * PolyEval(x, kGammaP) / PolyEval(x, kGammaQ);
}

double Stirling(double x) {
    if (std::isnan(x) || x == -kInfinity) return kQuietNaN;
    if (x == kInfinity) return x;
    if (x > kLargestExponent || x == 0.0) return DomainError(kInfinity);
    if (x < 0.0) return DomainError(kQuietNaN);

    const double correction = 1.0 + PolyEval(1.0 / x, kStirlingCoef) / x;
    if (!std::isfinite(correction)) return kInfinity;
    const double e_to_x = std::exp(x);
    double power;
    if (x <= kLargestPower) {
        power = std::pow(x, x - 0.5) / e_to_x;
    } else {
        const double half_power = std::pow(x, 0.5 * x - 0.25);
        power = half_power / e_to_x * half_power;
    }
    return power * correction * kSqrtTwoPi;
}

double LnGamma(double x) {
    if (std::isnan(x) || x == -kInfinity) return kQuietNaN;
    if (x == kInfinity) return x;
    if (x < 0.0) return DomainError(kQuietNaN);

    if (x >= kStirlingFrom) {
        const double leading = std::log(x) * (x - 0.5) - x + kLnSqrtTwoPi;
        const double p = 1.0 / (x * x);
        if (x < 1000.0) return PolyEval(p, kLnGammaA) / x + leading;
        return ((0.0007936507936507937 * p - 0.002777777777777778) * p + 0.08333333333333333) / x + leading;
    }
    double factor = Descend(x);
    while (x < 2.0) {
        if (x == 0.0) return DomainError(kInfinity);
        factor /= x;
        x += 1.0;
    }
    factor = std::abs(factor);
    if (x == 2.0) return std::log(factor);
    x -= 2.0;
    return x * PolyEval(x, kLnGammaB) / PolyEvalMonic(x, kLnGammaC) + std::log(factor);
}

double ReciprocalGamma(double x) {
    if (x <= 0.0 && IsWhole(x)) return 0.0;
    return 1.0 / Gamma(x);
}

double Factorial(int32_t n) {
    if (n < 0) return DomainError(kQuietNaN);
    static const Table<ComputedFactorial> table;
    return n <= kLargestFactorial ? table[n] : kInfinity;
}

double LnFactorial(int32_t n) {
    if (n < 0) return DomainError(kQuietNaN);
    static const Table<ComputedLnFactorial> table;
    return n <= kLargestFactorial ? table[n] : ComputedLnFactorial(n);
}

double Digamma(double x) {
    if (std::isnan(x) || x == -kInfinity) return kQuietNaN;
    if (x == kInfinity) return x;

    const bool reflected = x <= 0.0;
    if (reflected) {
        if (x == std::ceil(x)) return kInfinity;
        x = 1.0 - x;
    }
    double psi;
    const int32_t whole = x <= 10.0 ? static_cast<int32_t>(x) : 10;
    double harmonic = 0.0;
    if (x == whole) {
        for (double i = 1.0; i < x; i += 1.0) harmonic += 1.0 / i;
        psi = -kEulerGamma + harmonic;
    } else {
        double s = x;
        for (int32_t steps = 10 - whole; steps > 0; --steps, s += 1.0) harmonic += 1.0 / s;
        const double reciprocal = 1.0 / s, z = reciprocal * reciprocal;
        const double series = s < 1e9 ? z * PolyEval(z, kPsiA) : 0.0;
        psi = std::log(s) - 0.5 * reciprocal - series - harmonic;
    }
    return reflected ? psi - kPi / std::tan(kPi * (1.0 - x)) : psi;
}

}  // namespace krnumer
