#include "special/error_function.h"

#include <cmath>

#include "special/domain.h"
#include "special/error_function_coefficients.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kLargestExponent = 709.782712893384;

// For |x| <= 1.
double ErfNearZero(double x) {
    const double z = x * x;
    return x * PolyEval(z, kErfT) / PolyEvalMonic(z, kErfU);
}

}  // namespace

double Erf(double x) {
    if (std::isnan(x)) return kQuietNaN;
    if (const int sign = IsInfSign(x)) return sign;
    return std::abs(x) <= 1.0 ? ErfNearZero(x) : 1.0 - ErfC(x);
}

double ErfC(double x) {
    if (std::isnan(x)) return kQuietNaN;
    if (const int sign = IsInfSign(x)) return 1.0 - sign;
    const double size = std::abs(x);
    if (size < 1.0) return 1.0 - ErfNearZero(x);

    const double exponent = -(x * x);
    if (exponent < -kLargestExponent) return x <= 0.0 ? 2.0 : 0.0;
    const double ratio = size < 8.0 ? PolyEval(size, kErfCP) / PolyEvalMonic(size, kErfCQ)
                                    : PolyEval(size, kErfCR) / PolyEvalMonic(size, kErfCS);
    const double tail = std::exp(exponent) * ratio;
    return x < 0.0 ? 2.0 - tail : tail;
}

}  // namespace krnumer
