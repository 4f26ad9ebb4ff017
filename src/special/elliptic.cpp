#include "special/elliptic.h"

#include <cmath>

#include "special/domain.h"
#include "special/elliptic_coefficients.h"
#include "special/parity.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kHalfPi = 1.5707963267948966;
constexpr double kMostQuarters = 2147483648.0;  // quarter periods are counted in 32 bits

double Signed(double size, double sign_of) {
    return sign_of < 0.0 ? -size : size;
}

// How many half periods lie between 0 and phi >= 0, to the nearest.
double HalfPeriods(double phi) {
    return std::floor((phi + kHalfPi) / kPi);
}

struct Landen {
    double first;   // F(phi | m)
    double second;  // what E(phi | m) has beyond F(phi | m) E(m) / K(m)
};

// Descending Landen transformation of phi >= 0, 0 < m < 1. Of the amplitude only its tangent is kept, and the half
// periods that the tangent does not tell: a step adds two angles of tangent t and t b / a, whose sum passes a quarter
// period where the denominator of the new tangent is negative.
template <bool second_kind>
Landen Descend(double phi, double m) {
    double a = 1.0, b = std::sqrt(1.0 - m), c = std::sqrt(m);
    double t = std::tan(phi), scale = 1.0, correction = 0.0;
    double halves = phi <= kHalfPi ? 0.0 : HalfPeriods(phi);  // one unit below pi / 2 the sum would round up
    while (c > kEpsilon * a) {
        const double ratio = b / a;
        const double numerator = t * (1.0 + ratio);
        double denominator = 1.0 - ratio * t * t;
        if (denominator == 0.0) denominator = 1e-30;  // the quarter period itself
        halves += halves + std::copysign(static_cast<double>(denominator < 0.0), t);
        t = numerator / denominator;
        c = (a - b) / 2.0;
        const double mean = std::sqrt(a * b);
        a = (a + b) / 2.0;
        b = mean;
        scale += scale;
        if constexpr (second_kind) {  // c sin phi
            correction += c * numerator / std::sqrt(numerator * numerator + denominator * denominator);
        }
    }
    return {(std::atan(t) + halves * kPi) / (scale * a), correction};
}

bool InDomain(double m) {
    return m >= 0.0 && m <= 1.0;
}

// K and E of t = 1 - m and its logarithm, 0 < t <= 1.
double CompleteK(double t, double ln_t) {
    if (t <= 7e-06) return 1.3862943611198906 - 0.5 * ln_t;
    return PolyEval(t, kEllipticKP) - ln_t * PolyEval(t, kEllipticKQ);
}

double CompleteE(double t, double ln_t) {
    return PolyEval(t, kEllipticEP) - ln_t * t * PolyEval(t, kEllipticEQ);
}

}  // namespace

double EllipticK(double m) {
    if (!std::isfinite(m)) return kQuietNaN;
    if (!InDomain(m)) return DomainError(kQuietNaN);
    if (m == 1.0) return DomainError(kInfinity);
    return CompleteK(1.0 - m, std::log(1.0 - m));
}

double EllipticE(double m) {
    if (!std::isfinite(m)) return kQuietNaN;
    if (!InDomain(m)) return DomainError(kQuietNaN);
    if (m == 1.0) return 1.0;
    return CompleteE(1.0 - m, std::log(1.0 - m));
}

double EllipticF(double phi, double m) {
    if (!std::isfinite(phi) || !std::isfinite(m)) return kQuietNaN;
    if (!InDomain(m)) return DomainError(kQuietNaN);
    const double size = std::abs(phi);
    if (size > kHalfPi) {
        const double quarters = size / kHalfPi;
        if (quarters >= kMostQuarters) return kQuietNaN;
        if (m == 1.0) return Signed(kInfinity, phi);
        const double whole = std::floor(quarters);
        const double even = IsOdd(whole) ? whole + 1.0 : whole;
        return Signed(even * EllipticK(m) + EllipticF((quarters - even) * kHalfPi, m), phi);
    }
    if (phi == 0.0) return 0.0;
    if (m == 0.0) return phi;
    if (std::abs(size - kHalfPi) < kEpsilon) return Signed(EllipticK(m), phi);
    if (m == 1.0) return Signed(std::log(std::tan((size + kHalfPi) / 2.0)), phi);
    return Signed(Descend<false>(size, m).first, phi);
}

double EllipticE(double phi, double m) {
    if (!std::isfinite(phi) || !std::isfinite(m)) return kQuietNaN;
    if (!InDomain(m)) return DomainError(kQuietNaN);
    if (m == 0.0) return phi;
    const double size = std::abs(phi);
    const double quarters = size / kHalfPi;
    if (quarters >= kMostQuarters) return kQuietNaN;
    if (m == 1.0) {
        const double halves = HalfPeriods(size);
        return Signed(std::sin(size - halves * kPi) + 2.0 * halves, phi);
    }
    constexpr double kNear = 8.881784197001252e-16;
    const double fraction = quarters - std::floor(quarters);
    if (fraction < kNear * quarters || 1.0 - fraction < kNear * quarters) {
        return Signed(EllipticE(m) * quarters, phi);
    }
    const Landen landen = Descend<true>(size, m);
    const double t = 1.0 - m, ln_t = std::log(t);
    return Signed(CompleteE(t, ln_t) / CompleteK(t, ln_t) * landen.first + landen.second, phi);
}

}  // namespace krnumer
