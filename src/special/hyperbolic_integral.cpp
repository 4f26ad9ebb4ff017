#include "special/hyperbolic_integral.h"

#include <cmath>

#include "special/domain.h"
#include "special/gamma.h"
#include "special/hyperbolic_integral_coefficients.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

// Where the functions are taken for infinite; e^x has overflowed before.
constexpr double kLargest = 880.0;

struct Sums {
    double sine = 1.0;    // of x^2j / ((2j + 1)! (2j + 1))
    double cosine = 0.0;  // of x^2j / ((2j)! 2j), j > 0
};

Sums PowerSeries(double x) {
    const double z = x * x;
    Sums sums;
    double term = 1.0, k = 2.0;
    do {
        term *= z / k;
        sums.cosine += term / k;
        k += 1.0;
        term /= k;
        sums.sine += term / k;
        k += 1.0;
    } while (std::abs(term / sums.sine) > kEpsilon);
    return sums;
}

// Up to 18, and beyond; the series are fitted up to 88.
double LowArgument(double x) {
    return (576.0 / x - 52.0) / 10.0;
}
double HighArgument(double x) {
    return (6336.0 / x - 212.0) / 70.0;
}

}  // namespace

double Shi(double x) {
    if (std::isnan(x)) return kQuietNaN;
    if (std::isinf(x)) return x;
    const double size = std::abs(x);
    const double sign = x < 0.0 ? -1.0 : 1.0;
    if (size > kLargest) return DomainError(sign * kInfinity);
    if (x == 0.0) return 0.0;
    if (size <= 8.0) return sign * PowerSeries(size).sine * size;
    const double series =
        size <= 18.0 ? ChebyshevSum(LowArgument(size), kHyperbolicS1) : ChebyshevSum(HighArgument(size), kHyperbolicS2);
    return sign * series * std::exp(size) / size;
}

double Chi(double x) {
    if (std::isnan(x)) return kQuietNaN;
    if (std::isinf(x)) return kInfinity;
    const double size = std::abs(x);
    if (x == 0.0) return DomainError(-kInfinity);
    if (size > kLargest) return DomainError(kInfinity);
    if (size <= 8.0) return kEulerGamma + std::log(size) + PowerSeries(size).cosine;
    const double series =
        size <= 18.0 ? ChebyshevSum(LowArgument(size), kHyperbolicC1) : ChebyshevSum(HighArgument(size), kHyperbolicC2);
    return series * std::exp(size) / size + std::log(size) + kEulerGamma;
}

}  // namespace krnumer
