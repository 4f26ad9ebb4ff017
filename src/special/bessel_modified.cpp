// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989, for the orders 0 and 1 by Chebyshev series.
// Other integer orders by recurrence, upward for K and downward (J. C. P. Miller's) for I; real orders by Kummer's
// function, M. Abramowitz and I. A. Stegun, Handbook of Mathematical Functions, 1964, 9.6.47.
#include "special/bessel_modified.h"

#include <algorithm>
#include <cmath>

#include "special/bessel_modified_coefficients.h"
#include "special/domain.h"
#include "special/gamma.h"
#include "special/hypergeometric.h"
#include "special/ln_half.h"
#include "special/parity.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kLeastOrder = -200.0;  // of orders that are no integers
constexpr double kMostOrder = 2147483648.0;
constexpr double kLnSmallest = -745.2;  // of the smallest double

// For x > 0.
double BesselK0(double x) {
    if (x <= 2.0) return ChebyshevSum(x * x - 2.0, kK0A) - LnHalf(x) * BesselI0(x);
    return std::exp(-x) * ChebyshevSum(8.0 / x - 2.0, kK0B) / std::sqrt(x);
}

double BesselK1(double x) {
    if (x <= 2.0) return LnHalf(x) * BesselI1(x) + ChebyshevSum(x * x - 2.0, kK1A) / x;
    return std::exp(-x) * ChebyshevSum(8.0 / x - 2.0, kK1B) / std::sqrt(x);
}

// The orders 0 and 1, from which the recurrence starts.
struct Orders {
    double zero, one;
};

Orders BesselK01(double x) {
    if (x <= 2.0) return {BesselK0(x), BesselK1(x)};
    const Pair sums = ChebyshevSums(8.0 / x - 2.0, kK0B, kK1B);
    const double decay = std::exp(-x), root = std::sqrt(x);
    return {decay * sums[0] / root, decay * sums[1] / root};
}

// Where to start the downward recurrence for I_n(x): at 2 (n + sqrt(100 n)), or nearer where that changes nothing. From
// n on every order divides the error of the start by the square of x / (n + sqrt(n^2 + x^2)), at least
// (D. E. Amos, Computation of modified Bessel functions and their ratios, 1974).
double MillerStart(double n, double x) {
    constexpr double kLnNegligible = -40.0;
    const double farthest = 2.0 * (n + std::floor(std::sqrt(100.0 * n)));
    const double ln_ratio = std::log(x / (n + std::sqrt(n * n + x * x)));
    return std::min(farthest, std::ceil(n + 2.0 + kLnNegligible / (2.0 * ln_ratio)));
}

// I_n(x) for n > 1 and x > 0 by the downward recurrence, made true by I_0.
double Miller(double n, double x) {
    const double ln_leading = n * LnHalf(x) - LnGamma(n + 1.0);
    if (ln_leading + x * x / (4.0 * (n + 1.0)) < kLnSmallest) return 0.0;  // a bound of ln I_n
    const double i0 = BesselI0(x);
    if (std::isinf(i0)) return kInfinity;

    double above = 0.0, value = 1.0, answer = 0.0;
    for (double j = MillerStart(n, x); j > 0.0; j -= 1.0) {
        const double below = above + 2.0 * j / x * value;
        above = value;
        value = below;
        if (std::abs(value) > 1e10) {
            value *= 1e-10;
            above *= 1e-10;
            answer *= 1e-10;
        }
        if (j == n) answer = above;
    }
    if (!std::isfinite(value)) return std::pow(x / 2.0, n) / Gamma(n + 1.0);  // x so small that no more counts
    return answer * i0 / value;
}

double ModifiedOfInteger(double n, double x) {
    if (x == 0.0) return n == 0.0 ? 1.0 : 0.0;
    n = std::abs(n);
    if (n == 0.0) return BesselI0(x);
    if (n == 1.0) return BesselI1(x);
    const double value = Miller(n, std::abs(x));
    return x < 0.0 && IsOdd(n) ? -value : value;
}

// The power series, for orders where Kummer's function has a pole.
double ModifiedSeries(double v, double x) {
    const double y = x * x / 4.0;
    double term = std::pow(x / 2.0, v) / Gamma(v + 1.0), sum = term;
    for (double k = 1.0; std::isfinite(sum); k += 1.0) {
        term *= y / (k * (v + k));
        sum += term;
        if (!(std::abs(term) > kEpsilon * std::abs(sum)) && k > -v) break;
    }
    return sum;
}

}  // namespace

double BesselI0(double x) {
    const double size = std::abs(x);
    if (size <= 8.0) return std::exp(size) * ChebyshevSum(size / 2.0 - 2.0, kI0A);
    return std::exp(size) * ChebyshevSum(32.0 / size - 2.0, kI0B) / std::sqrt(size);
}

double BesselI1(double x) {
    const double size = std::abs(x);
    const double value = size <= 8.0 ? std::exp(size) * size * ChebyshevSum(size / 2.0 - 2.0, kI1A)
                                     : std::exp(size) * ChebyshevSum(32.0 / size - 2.0, kI1B) / std::sqrt(size);
    return x < 0.0 ? -value : value;
}

double BesselI(double v, double x) {
    if (std::isnan(v) || std::isnan(x) || v == -kInfinity || x == -kInfinity) return kQuietNaN;
    if (v == kInfinity) return x == 0.0 ? 0.0 : kQuietNaN;
    if (x == kInfinity) return kInfinity;
    if (std::abs(v) > kMostOrder) return kQuietNaN;
    if (IsWhole(v)) return ModifiedOfInteger(v, x);
    if (v < kLeastOrder || x < 0.0) return DomainError(kQuietNaN);
    if (x == 0.0) {
        if (v > 0.0) return 0.0;
        return DomainError(IsOdd(std::floor(v)) ? kInfinity : -kInfinity);
    }
    const double a = v + 0.5;
    if (a <= 0.0 && IsWhole(a)) return ModifiedSeries(v, x);
    const double scale = std::exp(v * LnHalf(x) - x) / Gamma(v + 1.0);
    return scale * KummerM(a, 2.0 * a, 2.0 * x);
}

double BesselK(int32_t n, double x) {
    if (x == kInfinity) return 0.0;
    if (!std::isfinite(x)) return kQuietNaN;
    if (x == 0.0) return DomainError(kInfinity);
    if (x < 0.0) return DomainError(kQuietNaN);
    const double order = std::abs(static_cast<double>(n));
    if (order == 0.0) return BesselK0(x);
    if (order == 1.0) return BesselK1(x);
    auto [below, value] = BesselK01(x);
    if (value == 0.0) return 0.0;
    for (double j = 1.0; j < order && value < kInfinity; j += 1.0) {
        const double above = 2.0 * j / x * value + below;
        below = value;
        value = above;
    }
    return value;
}

}  // namespace krnumer
