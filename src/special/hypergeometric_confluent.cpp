// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989, for M; M. Abramowitz and I. A. Stegun, Handbook
// of Mathematical Functions, 1964, 13.1.3 and 13.5.2, for U.
#include <algorithm>
#include <cmath>
#include <limits>

#include "special/domain.h"
#include "special/gamma.h"
#include "special/hypergeometric.h"
#include "special/hypergeometric_series.h"
#include "special/parity.h"

namespace krnumer {
namespace {

constexpr double kLargest = std::numeric_limits<double>::max();

// How many steps of 1 lead to 0, at most one more than the series has passes.
int32_t StepsToZero(double x) {
    return x <= 0.0 && x >= -kMostPasses && IsWhole(x) ? static_cast<int32_t>(-x) : kMostPasses + 1;
}

// The power series of M. It ends at the first of its terms that is below eps itself.
Estimate Hy1F1Series(double a, double b, double x) {
    const int32_t last_of_a = StepsToZero(a), last_of_b = StepsToZero(b);
    const double most = std::min({last_of_a, last_of_b, kMostPasses});
    double term = 1.0, sum = 1.0, size = 1.0, largest = 0.0, n = 1.0;
    for (; n <= most && size > kEpsilon; n += 1.0) {
        const double before = sum;
        term *= x * (a / (b * n));
        sum += term;
        size = std::abs(term);
        if (size == kInfinity) return {n > 1.0 ? before : sum, 1.0};
        largest = std::max(largest, size);
        a += 1.0;
        b += 1.0;
    }
    const bool cut_short = size > kEpsilon;
    if (cut_short && b == 0.0) return {DomainError(kInfinity), 0.0};
    if (cut_short && a == 0.0) return {sum, 0.0};
    const double cancelled = sum != 0.0 ? largest / std::abs(sum) : largest;
    const double rounding = std::abs(kEpsilon * n + kEpsilon * cancelled);
    return {sum, cut_short ? std::max(rounding, std::abs(term / sum)) : rounding};
}

// Which of the two asymptotic series of M a factor stands for; their converging factors differ.
enum class Asymptotic { kAlgebraic, kExponential };

// 2F0(a, b; ; x) up to its smallest term, with a converging factor in its place.
Estimate Hyp2F0(const double a, const double b, const double x, Asymptotic kind) {
    double an = a, bn = b, n = 1.0;
    double term = 1.0, last = 1.0, sum = 0.0, largest = 0.0, size = 1.0, previous = 1e9;
    do {
        if (an == 0.0 || bn == 0.0) break;
        const double ratio = an * (bn * x / n);
        if (largest * std::abs(ratio) > kLargest) return {sum, kLargest};
        term *= ratio;
        size = std::abs(term);
        if (size > previous || n > kMostPasses) {
            const bool grows = size > previous;
            if (!grows) {
                sum += last;
                last = term;
            }
            n -= 1.0;
            const double z = 1.0 / x;
            last *= kind == Asymptotic::kAlgebraic ? 0.5 + (0.125 + 0.25 * b - 0.5 * a + 0.25 * z - 0.25 * n) / z
                                                   : 2.0 / 3.0 - b + 2.0 * a + z - n;
            return {sum + last, kEpsilon * (n + largest) + size};
        }
        previous = size;
        sum += last;
        last = term;
        an += 1.0;
        bn += 1.0;
        n += 1.0;
        largest = std::max(largest, size);
    } while (size > kEpsilon);
    return {sum + term, std::abs(kEpsilon * (n + largest))};
}

// M for large |x|.
Estimate Hy1F1Asym(double a, double b, double x) {
    const double ln_x = std::log(std::abs(x));
    const double ln_gamma = b > 0.0 ? LnGamma(b) : 0.0;
    const double exponential = x + ln_x * (a - b) + ln_gamma, algebraic = ln_gamma - ln_x * a;

    const Estimate first = Hyp2F0(a, a - b + 1.0, -1.0 / x, Asymptotic::kAlgebraic);
    const double first_factor = std::exp(algebraic) * ReciprocalGamma(b - a);
    const Estimate second = Hyp2F0(b - a, 1.0 - a, 1.0 / x, Asymptotic::kExponential);
    const double second_factor =
        a < 0.0 ? std::exp(exponential) * ReciprocalGamma(a) : std::exp(exponential - LnGamma(a));

    double value = x < 0.0 ? first.value * first_factor : second.value * second_factor;
    double error = std::abs(first.error * first_factor) + std::abs(second.error * second_factor);
    if (b < 0.0) {
        value *= Gamma(b);
        error *= std::abs(Gamma(b));
    }
    if (value != 0.0) error /= std::abs(value);
    return {value, 30.0 * error};
}

bool IsPole(double z) {
    return z <= 0.0 && IsWhole(z);
}

// Of Gamma(z).
bool IsNegative(double z) {
    return z < 0.0 && IsOdd(std::floor(z));
}

// The limit of M at an infinite x. Its leading term is that of the polynomial for a = -n, otherwise for x > 0
// Gamma(b) / Gamma(a) e^x x^(a - b), for x < 0 Gamma(b) / Gamma(b - a) (-x)^-a.
double KummerAtInfinity(double a, double b, double x) {
    if (IsPole(b) && !(IsPole(a) && a > b)) return DomainError(kInfinity);
    if (a == 0.0) return 1.0;
    bool is_negative;
    if (IsPole(a)) {  // the sign of x^n (a)_n / (b)_n, of whose denominator every negative factor counts
        const double negative_factors = b < 0.0 ? std::min(-a, std::ceil(-b)) : 0.0;
        is_negative = IsOdd(negative_factors - (x > 0.0 ? a : 0.0));
    } else {
        if (x < 0.0 && (a > 0.0 || IsPole(b - a))) return 0.0;
        is_negative = IsNegative(b) != IsNegative(x > 0.0 ? a : b - a);
    }
    return is_negative ? -kInfinity : kInfinity;
}

// U by M, for b that is no integer.
double PlainTricomi(double a, double b, double x) {
    const double first = ReciprocalGamma(1.0 + a - b) * ReciprocalGamma(b);
    const double second = ReciprocalGamma(a) * ReciprocalGamma(2.0 - b);
    double difference = 0.0;
    if (first != 0.0) difference += first * KummerM(a, b, x);
    if (second != 0.0) difference -= second * std::pow(x, 1.0 - b) * KummerM(1.0 + a - b, 2.0 - b, x);
    return kPi / std::sin(kPi * b) * difference;
}

double TricomiSmall(double a, double b, double x) {
    constexpr double kNear = 0.0005, kStep = 0.0001;
    const double integer = std::round(b);
    const double u = std::abs(b - integer) < kNear
                         ? (PlainTricomi(a, integer + kStep, x) + PlainTricomi(a, integer - kStep, x)) / 2.0
                         : PlainTricomi(a, b, x);
    return std::isfinite(u) ? u : DomainError(u);
}

double TricomiAsymptotic(double a, double b, double x) {
    constexpr double kMostTerms = 1e7;  // with b near x the terms fall as powers of k only
    const double c = a + 1.0 - b;
    double sum = 0.0, term = 1.0, k = 0.0, ratio;
    do {
        sum += term;
        k += 1.0;
        ratio = (k - 1.0 + c) * (k - 1.0 + a) / (k * x);
        term *= -ratio;
        if (k > kMostTerms) return DomainError(kQuietNaN);
    } while (std::abs(ratio) < 1.0 && term != 0.0);
    if (term != 0.0) sum -= (2.5 - a - c - x - k) * term / (ratio * x * 4.0);  // half of the first term left out
    return sum / std::pow(x, a);
}

}  // namespace

double KummerM(double a, double b, double x) {
    if (std::isnan(a) || std::isnan(b) || std::isnan(x)) return kQuietNaN;
    if (std::isinf(a) || std::isinf(b)) return x == kInfinity && a == b ? std::exp(x) : kQuietNaN;
    if (std::isinf(x)) return KummerAtInfinity(a, b, x);
    const double difference = b - a;
    if (std::abs(difference) < 0.0001220703125 * std::abs(a)) return std::exp(x) * KummerM(difference, b, -x);

    const Estimate series = Hy1F1Series(a, b, x);
    if (series.error < kDoubtful) return series.value;
    Estimate best = series;
    if (std::abs(x) >= 30.0) {
        const Estimate asymptotic = Hy1F1Asym(a, b, x);
        if (asymptotic.error < series.error) best = asymptotic;
    }
    return best.error > kDoubtful ? DomainError(best.value) : best.value;
}

double TricomiU(double a, double b, double x) {
    if (!std::isfinite(a) || !std::isfinite(b) || !std::isfinite(x)) return kQuietNaN;
    if (x < 0.0) return DomainError(kQuietNaN);
    if (x == 0.0) return DomainError(kInfinity);
    return x < 6.0 ? TricomiSmall(a, b, x) : TricomiAsymptotic(a, b, x);
}

}  // namespace krnumer
