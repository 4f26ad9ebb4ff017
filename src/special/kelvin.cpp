// M. Abramowitz and I. A. Stegun, Handbook of Mathematical Functions, 1964, 9.9.9 to 9.9.11: the power series.
#include "special/kelvin.h"

#include <cmath>
#include <limits>

#include "special/domain.h"
#include "special/gamma.h"
#include "special/ln_half.h"
#include "special/parity.h"

namespace krnumer {
namespace {

constexpr double kQuarterPi = 0.7853981633974483;
constexpr double kLnSmallest = -745.2;       // of the smallest double
constexpr double kLargestFactorial = 170.0;  // of those that a double holds

// The cosine, or the sine, of an angle and of that plus one, two and three quarters of a turn.
struct Cycle {
    double factors[4];
    double operator[](int i) const { return factors[i % 4]; }
};

Cycle CosineCycle(double theta) {
    const double c = std::cos(theta), s = std::sin(theta);
    return {{c, -s, -c, s}};
}

Cycle SineCycle(double theta) {
    const double c = std::cos(theta), s = std::sin(theta);
    return {{s, c, -s, -c}};
}

// Adds terms in groups of four, until a group changes the sum by no more than eps. NaN where it overflows.
template <class Term>
double SumInGroups(double sum, Term&& term) {
    for (double k = 1.0;;) {
        const double previous = sum;
        for (int i = 0; i < 4; ++i, k += 1.0) sum += term(k, i);
        const double change = (previous - sum) / (previous + 1.0);
        if (!std::isfinite(change)) return kQuietNaN;
        if (std::abs(change) < kEpsilon) return sum;
    }
}

// (x / 2)^n / n! is below the smallest double.
bool LeadingTermVanishes(double n, double x) {
    return n * LnHalf(x) - LnGamma(n + 1.0) < kLnSmallest;
}

// The series of ber or bei, for n >= 0 and x >= 0, from its leading sign and the factors of the terms after the first.
double AscendingSeries(double n, double x, double leading, const Cycle& cycle) {
    const double z = x / 2.0;
    double power = leading, factorial = 1.0;
    if (n > kLargestFactorial) {
        power *= std::pow(-z, n);
        factorial = kInfinity;
    } else {
        for (double k = 1.0; k <= n; k += 1.0) {
            power *= -z;
            factorial *= k;
        }
    }
    return SumInGroups(power * cycle[3] / factorial, [&](double k, int i) {
        power *= -(z * z);
        factorial *= k * (k + n);
        return power * cycle[i] / factorial;
    });
}

// ber_n and bei_n for n >= 0 and x >= 0.
KelvinParts Ascending(double n, double x) {
    if (n > 0.0 && LeadingTermVanishes(n, x)) return {0.0, 0.0};
    const double c = std::cos(n * kQuarterPi), s = std::sin(n * kQuarterPi);
    return {AscendingSeries(n, x, 1.0, {{-s, -c, s, c}}), AscendingSeries(n, x, -1.0, {{c, -s, -c, s}})};
}

// (x / 2)^-n / 2 times the sum of (n - k - 1)! / k! (x^2 / 4)^k with the factors of both parts, for n > 0.
KelvinParts FiniteSum(double n, double x, const Cycle& cosines, const Cycle& sines) {
    const double z = x / 2.0;
    double term = 0.5 / z;
    for (double j = 1.0; j < n; j += 1.0) term *= j / z;
    KelvinParts sum{0.0, 0.0};
    int i = 0;
    for (double k = 0.0; k < n; k += 1.0, i = (i + 1) % 4) {
        sum.real += term * cosines[i];
        sum.imaginary += term * sines[i];
        term *= z * z / ((k + 1.0) * (n - k - 1.0));
    }
    return sum;
}

// (x / 2)^n / 2 times the sum of (psi(k + 1) + psi(n + k + 1)) / (k! (n + k)!) (x^2 / 4)^k with the factors of a part.
double PsiSeries(double n, double x, const Cycle& cycle) {
    const double z = x / 2.0;
    double psi = -2.0 * kEulerGamma, term = 0.5;
    for (double k = 1.0; k <= n; k += 1.0) {
        psi += 1.0 / k;
        term *= z / k;
    }
    return SumInGroups(term * psi * cycle[0], [&](double k, int i) {
        psi += 1.0 / (n + k) + 1.0 / k;
        term *= z * z / (k * (n + k));
        return term * psi * cycle[i + 1];
    });
}

}  // namespace

KelvinParts KelvinI(int32_t n, double x) {
    if (!std::isfinite(x)) return {kQuietNaN, kQuietNaN};
    const double order = std::abs(static_cast<double>(n));
    KelvinParts parts = Ascending(order, std::abs(x));
    if (IsOdd(order) && (x < 0.0) != (n < 0)) parts = {-parts.real, -parts.imaginary};
    return parts;
}

KelvinParts KelvinK(int32_t n, double x) {
    if (!std::isfinite(x)) return {kQuietNaN, kQuietNaN};
    if (x <= 0.0) {
        const double nan = DomainError(kQuietNaN);
        return {nan, nan};
    }
    const double order = std::abs(static_cast<double>(n));
    const double theta = order * 2.356194490192345;  // 3 pi / 4
    const Cycle cosines = CosineCycle(theta), sines = SineCycle(theta);

    if (order > 0.0 && LeadingTermVanishes(order, x)) {  // its reciprocal overflows
        const double sign = n < 0 && IsOdd(order) ? -1.0 : 1.0;
        return {sign * cosines[0] * kInfinity, -sign * sines[0] * kInfinity};
    }
    const KelvinParts first_kind = Ascending(order, x);
    if (std::isnan(first_kind.real) || std::isnan(first_kind.imaginary)) return {kQuietNaN, kQuietNaN};
    const double ln_half = LnHalf(x);
    KelvinParts sum{-ln_half * first_kind.real + kQuarterPi * first_kind.imaginary,
                    -ln_half * first_kind.imaginary - kQuarterPi * first_kind.real};
    if (order > 0.0) {
        const KelvinParts finite = FiniteSum(order, x, cosines, sines);
        sum.real += finite.real;
        sum.imaginary -= finite.imaginary;
    }
    sum.real += PsiSeries(order, x, cosines);
    sum.imaginary += PsiSeries(order, x, sines);
    if (n < 0 && IsOdd(order)) sum = {-sum.real, -sum.imaginary};
    return sum;
}

}  // namespace krnumer
