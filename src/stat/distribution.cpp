#include "stat/distribution.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "special/beta.h"
#include "special/incomplete_gamma.h"

namespace krnumer {
namespace {

constexpr double kTolerance = 1e-4;

// Where the normal upper tail is p, within 4.5e-4: M. Abramowitz and I. A. Stegun, Handbook of Mathematical Functions,
// 1964, 26.2.23.
double UpperTailQuantile(double p) {
    const double u = std::sqrt(std::log(1.0 / (p * p)));
    return u - (2.515517 + u * (0.802853 + 0.010328 * u)) / (1.0 + u * (1.432788 + u * (0.189269 + 0.001308 * u)));
}

double LowerT(double t, double df) {
    const double size = std::abs(t);
    const double both_tails = size > 0.0 ? IncompleteBeta(df / 2.0, 0.5, df / (df + size * size)) : 1.0;
    return t >= 0.0 ? 1.0 - both_tails / 2.0 : both_tails / 2.0;
}

double LowerChiSquare(double x, double df) {
    return x > 0.0 ? IncompleteGamma(df / 2.0, x / 2.0) : 0.0;
}

double LowerF(double f, double n, double m) {
    return f > 0.0 ? 1.0 - IncompleteBeta(m / 2.0, n / 2.0, m / (n * f + m)) : 0.0;
}

bool IsProbability(double p) {
    return p >= 0.0 && p <= 1.0;
}

// The lower end of the last interval.
template <class Distribution>
double Bisect(double lo, double hi, double p, Distribution&& distribution) {
    while (std::abs(hi - lo) > kTolerance) {
        const double mid = (lo + hi) / 2.0;
        (distribution(mid) >= p ? hi : lo) = mid;
    }
    return lo;
}

}  // namespace

double NormalDistribution(double x) {
    // Within 1.2e-5: Abramowitz and Stegun, 26.2.16.
    const double size = std::abs(x);
    const double t = 1.0 / (1.0 + 0.33267 * size);
    const double p =
        1.0 - 0.3989422 * std::exp(-(size * size) / 2.0) * t * (0.4361836 + t * (-0.1201676 + 0.937298 * t));
    return x < 0.0 ? 1.0 - p : p;
}

int32_t InverseNormalDistribution(double p, double* x) {
    if (!IsProbability(p)) return kBadProbability;
    if (p == 0.0 || p == 1.0) {
        *x = p == 0.0 ? -kInfinity : kInfinity;
    } else {
        *x = p < 0.5 ? -UpperTailQuantile(p) : UpperTailQuantile(1.0 - p);
    }
    return kOk;
}

int32_t TDistribution(double t, int32_t df, double* p) {
    if (df < 1) return kBadFreedom;
    if (std::isnan(t)) return kHoldsNaN;
    *p = LowerT(t, df);
    return kOk;
}

int32_t InverseTDistribution(double p, int32_t df, double* t) {
    if (df < 1) return kBadFreedom;
    if (!IsProbability(p)) return kBadProbability;
    if (p == 0.0 || p == 1.0) {
        *t = p == 0.0 ? -kInfinity : kInfinity;
    } else {
        *t = Bisect(-10000.0, 10000.0, p, [=](double mid) { return LowerT(mid, df); });
    }
    return kOk;
}

int32_t ChiSquareDistribution(double x, int32_t df, double* p) {
    if (df < 0) return kBadFreedom;
    *p = LowerChiSquare(x, df);
    return kOk;
}

int32_t InverseChiSquareDistribution(double p, int32_t df, double* x) {
    if (!IsProbability(p)) return kBadProbability;
    if (df < 1) return kBadFreedom;
    if (p == 0.0 || p == 1.0) {
        *x = p == 0.0 ? 0.0 : kInfinity;
        return kOk;
    }
    constexpr double kSpan = 5000.0;
    double hi = kSpan;
    while (LowerChiSquare(hi, df) < p) hi += kSpan;
    *x = Bisect(0.0, hi, p, [=](double mid) { return LowerChiSquare(mid, df); });
    return kOk;
}

int32_t FDistribution(double f, int32_t n, int32_t m, double* p) {
    if (n < 1 || m < 1) return kBadFreedom;
    if (std::isnan(f)) return kHoldsNaN;
    *p = LowerF(f, n, m);
    return kOk;
}

int32_t InverseFDistribution(double p, int32_t n, int32_t m, double* f) {
    if (n < 1 || m < 1) return kBadFreedom;
    if (!IsProbability(p)) return kBadProbability;
    if (p == 0.0 || p == 1.0) {
        *f = p == 0.0 ? 0.0 : kInfinity;
    } else {
        *f = Bisect(1e-6, 10000.0, p, [=](double mid) { return LowerF(mid, n, m); });
    }
    return kOk;
}

}  // namespace krnumer
