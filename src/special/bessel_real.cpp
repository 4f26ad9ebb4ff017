// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: the power series for small x, Hankel's
// asymptotic series for large x, between them a recurrence to an order where either serves, and expansions that are
// uniform in x from order 200 on.
#include "special/bessel_real.h"

#include <cmath>

#include "special/bessel_integer.h"
#include "special/bessel_uniform.h"
#include "special/domain.h"
#include "special/gamma.h"
#include "special/parity.h"

namespace krnumer {
namespace {

constexpr double kLeastOrder = -200.0;  // of orders that are no integers
constexpr double kUniformFrom = 200.0;
constexpr double kLargestInteger = 2147483647.0;

// The power series in -x^2 / 4.
double JvSeries(double v, double x) {
    const double y = -(x * x) / 4.0;
    double term = 1.0, sum = 1.0;
    for (double k = 1.0; std::abs(term) >= kEpsilon * std::abs(sum) && term != 0.0; k += 1.0) {
        term *= y / ((k + v) * k);
        sum += term;
    }
    if (x >= 0.0 && v >= -1.0) return sum * std::exp(v * std::log(x / 2.0) - LnGamma(v + 1.0));
    return sum * std::pow(0.5 * x, v) / Gamma(v + 1.0);
}

// Hankel's series for x far from 0, the same for v and -v.
struct HankelSums {
    double p, q;

    double J(double v, double x) const {
        const double phase = x - (0.5 * v + 0.25) * kPi;
        return std::sqrt(2.0 / (x * kPi)) * (p * std::cos(phase) - q * std::sin(phase));
    }
};

// In pairs of terms, up to the smallest.
HankelSums SumHankel(double v, double x) {
    const double m = 4.0 * v * v, z = 8.0 * x;
    double j = 1.0, k = 1.0, sign = 1.0;
    double term = (m - 1.0) / z, p = 1.0, q = term;
    double best_p = 1.0, best_q = term, smallest = 1.0, change = 1.0;
    bool fallen = false;
    while (change > kEpsilon) {
        k += 2.0;
        j += 1.0;
        sign = -sign;
        term *= (m - k * k) / (j * z);
        p += sign * term;
        k += 2.0;
        j += 1.0;
        term *= (m - k * k) / (j * z);
        q += sign * term;
        change = std::abs(term / p);
        if (change < smallest) {
            smallest = change;
            best_p = p;
            best_q = q;
            fallen = true;
        }
        if (fallen && change > smallest) break;
    }
    return {best_p, best_q};
}

double JvHankel(double v, double x) {
    return SumHankel(v, x).J(v, x);
}

struct Recurrence {
    double from, to;  // orders, which may differ by 1 from what was asked for
    double ratio;     // J_to / J_from
};

// From order n down to order k.
Recurrence JvRecur(double n, double x, double k) {
    double start = BesselRatio(n, x);
    if (n < 0.0 && std::abs(start) < 0.125) {  // J_n is near one of its zeros
        n -= 1.0;
        start = BesselRatio(n, x);
    }
    double above = 1.0, value = 1.0 / start, order = n - 1.0;
    do {
        const double next = 2.0 * order / x * value - above;
        above = value;
        value = next;
        order -= 1.0;
    } while (order > k + 0.5);
    if (k >= 0.0 && std::abs(above) > std::abs(value)) return {n, order + 1.0, above};
    return {n, order, value};
}

enum class Method { kSeries, kHankel, kRecurrence, kUniform };

// Which of the two series is good for an order below about 20 or not far above 3.6 sqrt(x).
Method SeriesFor(double size, double x) {
    const double meeting = size >= 26.0 ? 0.9 * size : (0.0083 * size + 0.09) * size + 12.9;
    return x <= meeting ? Method::kSeries : Method::kHankel;
}

double BySeries(Method method, double v, double x) {
    return method == Method::kSeries ? JvSeries(v, x) : JvHankel(v, x);
}

// The order to which the recurrence leads, apart from the fraction.
double Reach(double x) {
    const double reach = 3.6 * std::sqrt(x);
    return reach <= 17.0 ? 2.0 : reach;
}

double ByRecurrence(double v, double x) {
    const double reach = Reach(x), fraction = v - std::floor(v);
    const bool is_positive = v > 0.0;
    const Recurrence down =
        is_positive ? JvRecur(v, x, std::floor(reach) + fraction) : JvRecur(std::floor(-reach) + fraction, x, v);
    if (down.ratio == 0.0) return 0.0;
    const double known = is_positive ? down.to : down.from;
    const double j = BySeries(SeriesFor(std::abs(known), x), known, x);
    return is_positive ? j / down.ratio : down.ratio * j;
}

// For order v and -v, size = |v|.
Method MethodFor(double size, double x) {
    if (size > 17.0) {
        if (x < 3.6 * std::sqrt(size)) return Method::kSeries;
        if (size < 3.6 * std::sqrt(x)) return Method::kHankel;
    }
    if (size < kUniformFrom) return size <= Reach(x) + 3.0 ? SeriesFor(size, x) : Method::kRecurrence;
    return x / size / size > 0.3 ? Method::kHankel : Method::kUniform;
}

// For x >= 0.
double JOfRealOrder(double v, double x) {
    if (x < kEpsilon) return DomainError(0.0);
    switch (const Method method = MethodFor(std::abs(v), x)) {
        case Method::kRecurrence:
            return ByRecurrence(v, x);
        case Method::kUniform:
            return BesselJUniform(v, x);
        default:
            return BySeries(method, v, x);
    }
}

}  // namespace

double BesselJ(double v, double x) {
    if (!std::isfinite(x) || !std::isfinite(v)) return kQuietNaN;
    if (IsWhole(v)) {
        const double order = std::abs(v), size = std::abs(x);
        const double j = order <= kLargestInteger ? BesselJn(order, size) : JOfRealOrder(order, size);
        return (v < 0.0) != (x < 0.0) && IsOdd(v) ? -j : j;
    }
    if (v < kLeastOrder || x < 0.0) return DomainError(kQuietNaN);
    return JOfRealOrder(v, x);
}

double BesselY(double v, double x) {
    if (!std::isfinite(x)) return kQuietNaN;
    if (x <= 0.0) return DomainError(kQuietNaN);
    if (!(std::abs(v) <= kLargestInteger + 1.0)) return DomainError(kQuietNaN);
    if (IsWhole(v)) {
        if (v > kLargestInteger) return DomainError(kQuietNaN);
        const double y = BesselYn(std::abs(v), x);
        return v < 0.0 && IsOdd(v) ? -y : y;
    }
    if (v < kLeastOrder) return DomainError(kQuietNaN);
    if (v - std::floor(v) < 1e-8) DomainError(v);  // digits are lost below
    const double cosine = std::cos(kPi * v), sine = std::sin(kPi * v);
    double j, reflected;
    if (v < kUniformFrom && x >= kEpsilon && MethodFor(std::abs(v), x) == Method::kHankel) {
        const HankelSums sums = SumHankel(v, x);
        j = sums.J(v, x);
        reflected = sums.J(-v, x);
    } else {
        reflected = BesselJ(-v, x);
        constexpr double kOutweighs = 0x1p55;  // J_v, which is at most 1 for v > 0, by a digit more than a double has
        if (v > 0.0 && std::abs(reflected) > kOutweighs * std::abs(cosine) && std::isfinite(reflected)) {
            return -reflected / sine;
        }
        j = BesselJ(v, x);
    }
    if (!std::isfinite(j) || !std::isfinite(reflected)) return kQuietNaN;
    return (cosine * j - reflected) / sine;
}

double SphericalBesselJ(int32_t n, double x) {
    if (x == kInfinity) return 0.0;
    if (!std::isfinite(x)) return kQuietNaN;
    if (x < 0.0) return DomainError(kQuietNaN);
    if (x == 0.0) return n == 0 ? 1.0 : 0.0;
    return std::sqrt(1.5707963267948966 / x) * BesselJ(n + 0.5, x);
}

double SphericalBesselY(int32_t n, double x) {
    if (x == kInfinity) return 0.0;
    if (!std::isfinite(x)) return kQuietNaN;
    if (x < 0.0) return DomainError(kQuietNaN);
    if (x == 0.0) return DomainError(-kInfinity);
    return std::sqrt(1.5707963267948966 / x) * BesselY(n + 0.5, x);
}

}  // namespace krnumer
