#include "support/numbers.h"

#include <algorithm>
#include <cmath>
#include <iomanip>
#include <limits>
#include <sstream>

namespace krnumer {
namespace {

// Maps doubles to integers in the same order, with 0 and -0 at the same place.
std::int64_t Rank(double x) {
    const auto bits = std::bit_cast<std::int64_t>(x);
    return bits >= 0 ? bits : std::numeric_limits<std::int64_t>::min() - bits;
}

}  // namespace

std::uint64_t UlpDistance(double a, double b) {
    if (std::isnan(a) || std::isnan(b)) return std::numeric_limits<std::uint64_t>::max();
    const auto [low, high] = std::minmax({Rank(a), Rank(b)});
    return static_cast<std::uint64_t>(high) - static_cast<std::uint64_t>(low);
}

bool IsNear(double actual, double expected, double relative, double absolute) {
    if (std::isnan(expected)) return std::isnan(actual);
    if (std::isinf(expected)) return actual == expected;
    return std::fabs(actual - expected) <= relative * std::fabs(expected) + absolute;
}

bool IsNear(Complex actual, Complex expected, double relative, double absolute) {
    if (!std::isfinite(expected.re) || !std::isfinite(expected.im)) {
        return IsNear(actual.re, expected.re, relative, absolute) && IsNear(actual.im, expected.im, relative, absolute);
    }
    const double error = std::hypot(actual.re - expected.re, actual.im - expected.im);
    return error <= relative * std::hypot(expected.re, expected.im) + absolute;
}

std::string Show(double x) {
    std::ostringstream text;
    text << std::setprecision(std::numeric_limits<double>::max_digits10) << x;
    return text.str();
}

std::string Show(Complex z) {
    std::ostringstream text;
    text << '(' << Show(z.re) << ", " << Show(z.im) << ')';
    return text.str();
}

void PrintTo(Complex z, std::ostream* out) {
    *out << Show(z);
}

}  // namespace krnumer
