// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: a power series and an asymptotic one, of which
// the more accurate by its own estimate counts.
#include "special/struve.h"

#include <cmath>

#include "special/bessel_real.h"
#include "special/domain.h"
#include "special/gamma.h"
#include "special/hypergeometric_series.h"
#include "special/parity.h"

namespace krnumer {
namespace {

constexpr Estimate kSkipped{0.0, 1e38};

// For x > 0.
double OfPositive(double v, double x) {
    const double t = 0.25 * x * x;
    const bool far = x > 30.0 && x > 1.5 * std::abs(v);
    const Estimate ascending = far ? kSkipped : OneF2(1.0, 1.5, v + 1.5, -t);
    const Estimate asymptotic = x < 18.0 ? kSkipped : ThreeF0(1.0, 0.5, 0.5 - v, -1.0 / t);

    const bool ascend = ascending.error <= asymptotic.error;
    const double power = std::pow(0.5 * x, v - 1.0);
    const double gamma = Gamma(v + (ascend ? 1.5 : 0.5));
    if (!std::isfinite(power) || !std::isfinite(gamma)) return kQuietNaN;
    if (ascend) return power * t * ascending.value / (0.886226925452758 * gamma);  // sqrt(pi) / 2
    return power * asymptotic.value / (1.772453850905516 * gamma) + BesselY(v, x);
}

}  // namespace

double Struve(double v, double x) {
    if (!std::isfinite(x) || std::isnan(v)) return kQuietNaN;
    if (x == 0.0 && v < 0.0) return DomainError(kQuietNaN);
    if (x < 0.0 && !IsWhole(v)) return DomainError(kQuietNaN);
    if (x == 0.0) return 0.0;
    if (std::isinf(v)) return kQuietNaN;
    const double whole = std::floor(v);
    if (v < 0.0 && v - whole == 0.5) {  // H_(-n - 1/2) = (-1)^n J_(n + 1/2)
        const double j = BesselJ(-v, x);
        return IsOdd(1.0 - whole) ? -j : j;
    }
    const double value = OfPositive(v, std::abs(x));
    return x < 0.0 && !IsOdd(v) ? -value : value;
}

}  // namespace krnumer
