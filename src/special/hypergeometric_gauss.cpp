// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989, and M. Abramowitz and I. A. Stegun, Handbook of
// Mathematical Functions, 1964, chapter 15: the power series where it is short, and transformations of its argument.
#include <algorithm>
#include <cmath>
#include <cstdint>

#include "special/domain.h"
#include "special/gamma.h"
#include "special/hypergeometric.h"
#include "special/hypergeometric_series.h"
#include "special/parity.h"

namespace krnumer {
namespace {

constexpr double kIntegerWithin = 3.7252902984619132e-09;  // 2^-28
constexpr double kMostSteps = 1e6;                         // of a recurrence, or terms of a finite sum

bool IsInteger(double x) {
    return std::abs(x - std::round(x)) < kIntegerWithin;
}

bool IsPole(double x) {
    return x <= 0.0 && IsInteger(x);
}

// coefficient * function, where the function may be infinite but the coefficient is exactly 0.
template <class Function>
double Product(double coefficient, Function&& function) {
    return coefficient == 0.0 ? 0.0 : coefficient * function();
}

// The power series itself.
Estimate PowerSeries(double a, double b, double c, double x) {
    if (std::abs(c) < kIntegerWithin) return {kInfinity, 1.0};
    double term = 1.0, sum = 1.0, largest = 0.0, k = 0.0;
    do {
        term *= (a + k) * (b + k) * x / ((c + k) * (k + 1.0));
        sum += term;
        largest = std::max(largest, std::abs(term));
        k += 1.0;
        if (k > kMostPasses) return {sum, 1.0};
    } while (std::abs(term / sum) > kEpsilon);
    return {sum, kEpsilon * largest / std::abs(sum) + kEpsilon * k};
}

// 15.3.4 and 15.3.5: the argument x / (x - 1). A polynomial stays one.
Estimate ByPfaff(double a, double b, double c, double x) {
    const double s = 1.0 - x;
    const bool keep_a = IsPole(a) || (!IsPole(b) && b > a);
    const Estimate series = keep_a ? PowerSeries(a, c - b, c, -x / s) : PowerSeries(c - a, b, c, -x / s);
    return {std::pow(s, keep_a ? -a : -b) * series.value, series.error};
}

// 15.3.6: the argument 1 - x where d = c - a - b is no integer.
Estimate AboutOne(double a, double b, double c, double x) {
    const double s = 1.0 - x, d = c - a - b;
    double error = 0.0;
    const auto part = [&](double coefficient, double p, double q, double r) {
        return Product(coefficient, [&] {
            const Estimate series = PowerSeries(p, q, r, s);
            error += series.error;
            return series.value;
        });
    };
    const double first = part(Gamma(d) * ReciprocalGamma(c - a) * ReciprocalGamma(c - b), a, b, 1.0 - d);
    const double second = part(Gamma(-d) * ReciprocalGamma(a) * ReciprocalGamma(b), c - a, c - b, 1.0 + d);
    const double power = Product(second, [&] { return std::pow(s, d); });
    const double sum = first + power;
    error += kEpsilon * std::max(std::abs(first), std::abs(power)) / std::abs(sum);
    return {Gamma(c) * sum, error};
}

// 15.3.10 to 15.3.12: the same where d is an integer, with the psi function.
double AboutOneByPsi(double a, double b, double c, double x) {
    const double s = 1.0 - x, d = c - a - b;
    const double whole = std::round(d);
    if (std::abs(whole) > kMostSteps) return kQuietNaN;
    const double e = whole >= 0.0 ? d : -d;
    const double above = whole >= 0.0 ? d : 0.0, below = whole >= 0.0 ? 0.0 : d;
    const double ln_s = std::log(s);

    double y = (Digamma(1.0) + Digamma(1.0 + e) - Digamma(a + above) - Digamma(b + above) - ln_s) / Gamma(1.0 + e);
    double factor = (a + above) * (b + above) * s / Gamma(e + 2.0);
    double t = 1.0, change;
    do {
        const double term =
            factor * (Digamma(1.0 + t) + Digamma(1.0 + t + e) - Digamma(a + t + above) - Digamma(b + t + above) - ln_s);
        y += term;
        factor *= s * (a + t + above) * (b + t + above) / ((t + 1.0) * (t + 1.0 + e));
        t += 1.0;
        change = std::abs(term / y);
    } while (change > kEpsilon);
    if (whole == 0.0) return y * Gamma(c) * ReciprocalGamma(a) * ReciprocalGamma(b);

    double finite = 1.0, term = 1.0;
    for (t = 0.0; t < std::abs(whole) - 1.0;) {
        term *= s * (a + t + below) * (b + t + below) / (1.0 - e + t);
        t += 1.0;
        term /= t;
        finite += term;
    }
    finite *= Gamma(e) * Gamma(c) * ReciprocalGamma(a + above) * ReciprocalGamma(b + above);
    y *= Gamma(c) * ReciprocalGamma(a + below) * ReciprocalGamma(b + below);
    if (IsOdd(whole)) y = -y;
    (whole > 0.0 ? y : finite) *= std::pow(s, whole);
    return y + finite;
}

// The series, or a transformation that makes it short.
Estimate Transformed(double a, double b, double c, double x) {
    if (x < -0.5) return ByPfaff(a, b, c, x);
    if (!(x > 0.9)) return PowerSeries(a, b, c, x);
    if (IsInteger(c - a - b)) {
        if (IsPole(a) || IsPole(b)) return PowerSeries(a, b, c, x);  // a polynomial, where psi has its poles
        return {AboutOneByPsi(a, b, c, x), 0.0};
    }
    const Estimate plain = PowerSeries(a, b, c, x);
    return plain.error < kDoubtful ? plain : AboutOne(a, b, c, x);
}

// 15.2.27: down from larger c, where the series converge.
double ByRecurrence(double a, double b, double c, double x) {
    const double steps = 2.0 - std::round(c - a - b);
    if (!(steps <= kMostSteps)) return kQuietNaN;
    const double s = 1.0 - x, q = a + b + 1.0;
    double e = c + steps;
    double value = Hypergeometric2F1(a, b, e, x), after = Hypergeometric2F1(a, b, e + 1.0, x);
    for (double i = 0.0; i < steps; i += 1.0) {
        const double r = e - 1.0;
        const double before = (e * (r - (2.0 * e - q) * x) * value + (e - a) * (e - b) * x * after) / (e * r * s);
        e = r;
        after = value;
        value = before;
    }
    return value;
}

double Checked(const Estimate& estimate) {
    return estimate.error > kDoubtful ? DomainError(estimate.value) : estimate.value;
}

}  // namespace

double Hypergeometric2F1(double a, double b, double c, double x) {
    if (!std::isfinite(a) || !std::isfinite(b) || !std::isfinite(c) || !std::isfinite(x)) return kQuietNaN;
    const double s = 1.0 - x, size = std::abs(x);
    if (size < 1.0) {
        if (std::abs(b - c) < kIntegerWithin) return std::pow(s, -a);
        if (std::abs(a - c) < kIntegerWithin) return std::pow(s, -b);
    }
    const bool polynomial = IsPole(a) || IsPole(b);
    if (IsPole(c)) {
        const bool ends_before_c =
            (IsPole(a) && std::round(a) > std::round(c)) || (IsPole(b) && std::round(b) > std::round(c));
        if (!ends_before_c) return DomainError(kInfinity);
    }
    if (polynomial) return Checked(Transformed(a, b, c, x));
    if (size > 1.0) return DomainError(kInfinity);

    const double d = c - a - b;
    const bool euler = IsPole(c - a) || IsPole(c - b);
    const auto by_euler = [=] {  // 15.3.3
        const Estimate series = PowerSeries(c - a, c - b, c, x);
        return Checked({std::pow(s, d) * series.value, series.error});
    };
    if (std::abs(size - 1.0) < kIntegerWithin) {
        if (x > 0.0) {
            if (euler && d >= 0.0) return by_euler();
            if (euler || d <= 0.0) return DomainError(kInfinity);
            return Gamma(c) * Gamma(d) / (Gamma(c - a) * Gamma(c - b));
        }
        if (d <= -1.0) return DomainError(kInfinity);
    }
    if (d < 0.0) {
        const Estimate direct = Transformed(a, b, c, x);
        return direct.error < kDoubtful ? direct.value : ByRecurrence(a, b, c, x);
    }
    return euler ? by_euler() : Checked(Transformed(a, b, c, x));
}

}  // namespace krnumer
