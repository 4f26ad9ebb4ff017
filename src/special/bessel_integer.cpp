// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989, for the orders 0 and 1. Higher orders by the
// three-term recurrence in the direction in which it is stable (W. Gautschi, Computational aspects of three-term
// recurrence relations, 1967).
#include "special/bessel_integer.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "frame/numeric.h"
#include "special/bessel_coefficients.h"
#include "special/continued_fraction.h"
#include "special/gamma.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kQuarterPi = 0.7853981633974483;
constexpr double kThreeQuarterPi = 2.356194490192345;
constexpr double kTwoOverPi = 0.6366197723675814;
constexpr double kTwoOverFivePi = 0.12732395447351627;
constexpr double kLnSmallest = -745.2;  // of the smallest double

// Both functions of one order for x > 5: P cos t - w Q sin t and P sin t + w Q cos t, times sqrt(2 / (pi x)).
struct Modulus {
    double p, wq;  // with that factor

    double J(double t) const { return p * std::cos(t) - wq * std::sin(t); }
    double Y(double t) const { return p * std::sin(t) + wq * std::cos(t); }
};

// P = pp / pq and Q = qp / qq.
Modulus ModulusOf(double w, double pp, double pq, double qp, double qq) {
    const double factor = std::sqrt(kTwoOverFivePi * w) / (pq * qq);
    return {pp * qq * factor, w * qp * pq * factor};
}

Modulus ModulusOfOrder0(double x) {
    const double w = 5.0 / x, q = w * w;
    return ModulusOf(w, PolyEval(q, kJ0PP), PolyEval(q, kJ0PQ), PolyEval(q, kJ0QP), PolyEvalMonic(q, kJ0QQ));
}

Modulus ModulusOfOrder1(double x) {
    const double w = 5.0 / x, q = w * w;
    return ModulusOf(w, PolyEval(q, kJ1PP), PolyEval(q, kJ1PQ), PolyEval(q, kJ1QP), PolyEvalMonic(q, kJ1QQ));
}

// The orders 0 and 1, from which the recurrences start.
struct Orders {
    double zero, one;
};

// For x > 5, with t = x - pi / 4 for both, and cos(t - pi / 2) = sin t.
Orders LargeJ(double x) {
    const Modulus zero = ModulusOfOrder0(x), one = ModulusOfOrder1(x);
    const double sine = std::sin(x - kQuarterPi), cosine = std::cos(x - kQuarterPi);
    return {zero.p * cosine - zero.wq * sine, one.p * sine + one.wq * cosine};
}

Orders LargeY(double x) {
    const Modulus zero = ModulusOfOrder0(x), one = ModulusOfOrder1(x);
    const double sine = std::sin(x - kQuarterPi), cosine = std::cos(x - kQuarterPi);
    return {zero.p * sine + zero.wq * cosine, one.wq * sine - one.p * cosine};
}

// True where 2 k / x times one of the two orders is lost beside the other for every k up to n, so that the recurrence
// only turns signs.
bool OnlyTurns(const Orders& start, double n, double x) {
    constexpr double kLost = 0x1p-55;
    if (!(n < kLost * x)) return false;
    const double zero = std::abs(start.zero), one = std::abs(start.one);
    return 2.0 * n / x * std::max(zero, one) < kLost * std::min(zero, one);
}

// Upward. Stable for J where x > n, and for Y.
double Upward(const Orders& start, double n, double x) {
    if (OnlyTurns(start, n, x)) {
        const auto order = static_cast<int64_t>(n);
        const double value = order & 1 ? start.one : start.zero;
        return order & 2 ? -value : value;
    }
    double before = start.zero, value = start.one;
    for (double k = 1.0; k < n; k += 1.0) {
        const double next = 2.0 * k / x * value - before;
        before = value;
        value = next;
        if (!std::isfinite(value)) break;
    }
    return value;
}

// Downward from the ratio of J_n and J_(n - 1) to the known orders 0 and 1, for x <= n.
double DownwardJ(double n, double x) {
    constexpr double kLarge = 1e100;
    double start = 1.0, above = 1.0, value = 1.0 / BesselRatio(n, x);
    for (double k = n - 1.0; k > 0.0; k -= 1.0) {
        if (std::abs(value) > kLarge) {
            start /= kLarge;
            above /= kLarge;
            value /= kLarge;
        }
        const double next = 2.0 * k / x * value - above;
        above = value;
        value = next;
    }
    return std::abs(above) > std::abs(value) ? BesselJ1(x) / above * start : BesselJ0(x) / value * start;
}

// Kapteyn's bound of ln |J_n(n z)|, 0 <= z <= 1 (M. Abramowitz and I. A. Stegun, Handbook of Mathematical Functions,
// 1964, 9.1.63).
double LnBound(double n, double z) {
    const double s = std::sqrt(1.0 - z * z);
    return n * (std::log(z / (1.0 + s)) + s);
}

}  // namespace

double BesselJ0(double x) {
    if (x > 5.0) return ModulusOfOrder0(x).J(x - kQuarterPi);
    const double z = x * x;
    if (x < 1e-5) return 1.0 - z / 4.0;
    return (z - kJ0Z1) * (z - kJ0Z2) * PolyEval(z, kJ0RP) / PolyEvalMonic(z, kJ0RQ);
}

double BesselY0(double x) {
    if (x > 5.0) return ModulusOfOrder0(x).Y(x - kQuarterPi);
    const double z = x * x;
    return PolyEval(z, kY0YP) / PolyEvalMonic(z, kY0YQ) + kTwoOverPi * std::log(x) * BesselJ0(x);
}

double BesselJ1(double x) {
    if (x > 5.0) return ModulusOfOrder1(x).J(x - kThreeQuarterPi);
    const double z = x * x;
    return PolyEval(z, kJ1RP) / PolyEvalMonic(z, kJ1RQ) * x * (z - kJ1Z1) * (z - kJ1Z2);
}

double BesselY1(double x) {
    if (x > 5.0) return ModulusOfOrder1(x).Y(x - kThreeQuarterPi);
    const double z = x * x;
    return x * (PolyEval(z, kY1YP) / PolyEvalMonic(z, kY1YQ)) + kTwoOverPi * (BesselJ1(x) * std::log(x) - 1.0 / x);
}

double BesselRatio(double n, double x) {
    ContinuedFraction fraction(0.0, 1.0, x, 2.0 * n, 1.0);
    double b = 2.0 * n, change;
    do {
        fraction.Append(-(x * x), b + 2.0);
        fraction.KeepFromOverflow();
        fraction.Append(-(x * x), b += 4.0);
        change = fraction.Update();
        fraction.KeepFromOverflow();
    } while (change >= kEpsilon);
    return fraction.value();
}

double BesselJn(double n, double x) {
    if (n == 0.0) return BesselJ0(x);
    if (n == 1.0) return BesselJ1(x);
    if (x > n) return Upward(x > 5.0 ? LargeJ(x) : Orders{BesselJ0(x), BesselJ1(x)}, n, x);
    return LnBound(n, x / n) < kLnSmallest ? 0.0 : DownwardJ(n, x);
}

double BesselYn(double n, double x) {
    if (n == 0.0) return BesselY0(x);
    if (n == 1.0) return BesselY1(x);
    constexpr double kMany = 1000.0;  // steps, which take longer than the bound
    if (n > kMany && x < n && LnBound(n, x / n) < kLnSmallest) return -kInfinity;  // |J_n Y_n| is at least 1 / (pi n)
    return Upward(x > 5.0 ? LargeY(x) : Orders{BesselY0(x), BesselY1(x)}, n, x);
}

}  // namespace krnumer
