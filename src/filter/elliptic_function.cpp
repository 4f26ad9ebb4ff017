#include "filter/elliptic_function.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"

namespace krnumer {
namespace {

// All iterations here converge quadratically. Where they cannot converge at all, at a modulus of 1, this ends them.
constexpr int kMaxRounds = 25;
constexpr double kTolerance = 1e-15;

}  // namespace

// M. Abramowitz, I. Stegun, Handbook of Mathematical Functions, 17.6.
double CompleteK(double complementary) {
    double a = 1.0;
    double b = complementary;
    for (int round = 0; round < kMaxRounds && !((a - b) / a < kTolerance); ++round) {
        const double mean = 0.5 * (a + b);
        b = std::sqrt(a * b);
        a = mean;
    }
    return kPi / (2.0 * a);
}

// R. Bulirsch, Numerical calculation of elliptic integrals and elliptic functions, Numer. Math. 7, 78 (1965).
JacobiValues JacobiSnCnDn(double u, double complementary) {
    if (u == 0.0) return {0.0, 1.0, 1.0};
    double arithmetic[kMaxRounds];
    double geometric[kMaxRounds];
    double a = 1.0;
    double b = complementary;
    int levels = 0;
    for (bool apart = true; apart && levels < kMaxRounds; ++levels) {
        arithmetic[levels] = a;
        geometric[levels] = b;
        apart = !((a - b) / a < kTolerance);
        const double mean = 0.5 * (a + b);
        b = std::sqrt(a * b);
        a = mean;
    }
    double t = a / std::tan(a * u);
    double dn = 1.0;
    double next = a;
    for (int level = levels - 1; level >= 0; --level) {
        const double r = t * t / next;
        t *= dn;
        dn = (geometric[level] + r) / (arithmetic[level] + r);
        next = arithmetic[level];
    }
    const double sn = 1.0 / std::sqrt(1.0 + t * t);
    return {sn, sn * t, dn};
}

// el1 of the same paper. Its tolerance is the square root of the accuracy that it gives.
double IncompleteEl1(double x, double complementary) {
    constexpr double kRootTolerance = 1.2e-7;
    constexpr double kInsteadOfZero = 1e-15;
    double y = 1.0 / x;
    double kc = complementary;
    double m = 1.0;
    double turns = 0.0;
    for (int round = 0; round < kMaxRounds; ++round) {
        const double e = m * kc;
        const double g = m;
        m += kc;
        y -= e / y;
        if (y == 0.0) y = std::sqrt(e) * kInsteadOfZero;
        if (std::fabs(g - kc) <= kRootTolerance * g) break;
        kc = 2.0 * std::sqrt(e);
        turns *= 2.0;
        if (y < 0.0) turns += 1.0;
    }
    if (y < 0.0) turns += 1.0;
    return (std::atan(m / y) + kPi * turns) / m;
}

// By the theta functions of the nome; Abramowitz and Stegun, 16.38.
double ModulusFromRatio(double ratio) {
    const double q = std::exp(-kPi * ratio);
    double numerator = 1.0;
    double denominator = 1.0;
    double term = 1.0;
    for (int n = 1; n <= kMaxRounds && !(term < kTolerance); ++n) {
        term = std::pow(q, n * n);
        numerator += std::pow(q, n * (n + 1));
        denominator += 2.0 * term;
    }
    const double quotient = numerator / denominator;
    return std::min(1.0, 4.0 * std::sqrt(q) * quotient * quotient);
}

}  // namespace krnumer
