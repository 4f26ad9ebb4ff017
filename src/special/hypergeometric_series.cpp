#include "special/hypergeometric_series.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"

namespace krnumer {
namespace {

constexpr double kFailed = 1e35;
constexpr double kRounding = 1.8046660579423136e-14;  // of the largest term

// The sum of 1 and the terms whose ratios `ratio` gives for n = 1, 2, ...
template <class Ratio>
Estimate SumOfRatios(Ratio&& ratio, bool asymptotic) {
    double term = 1.0, sum = 1.0, smallest = 1.0, largest = 1.0;
    for (int32_t n = 1; n <= kMostPasses; ++n) {
        const double next = term * ratio(static_cast<double>(n));
        if (!std::isfinite(next)) return {sum, kFailed};
        if (asymptotic && std::abs(next) > std::abs(term)) break;
        term = next;
        sum += term;
        smallest = std::min(smallest, std::abs(term));
        largest = std::max(largest, std::abs(term));
        if (!(std::abs(term / sum) >= kEpsilon)) break;
    }
    return {sum, std::abs(smallest / sum) + kRounding * largest};
}

}  // namespace

Estimate OneF2(double a, double b, double c, double x) {
    return SumOfRatios([=](double n) { return (a + n - 1.0) * x / ((b + n - 1.0) * (c + n - 1.0) * n); }, false);
}

Estimate ThreeF0(double a, double b, double c, double x) {
    return SumOfRatios([=](double n) { return (a + n - 1.0) * (b + n - 1.0) * (c + n - 1.0) * x / n; }, true);
}

}  // namespace krnumer
