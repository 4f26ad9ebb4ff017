#include "special/zeta.h"

#include <cmath>
#include <cstdint>

#include "special/domain.h"
#include "special/gamma.h"
#include "special/parity.h"
#include "special/polynomial.h"
#include "special/zeta_coefficients.h"

namespace krnumer {
namespace {

// (1 - 2^-x) zeta(x) as the sum of n^-x over odd n.
double OddSum(double x) {
    double sum = 1.0, n = 1.0, term;
    do {
        n += 2.0;
        term = std::pow(n, -x);
        sum += term;
    } while (term / sum > kEpsilon);
    return sum / (1.0 - std::exp2(-x));
}

double ReflectedZeta(double x) {
    const double s = 1.0 - x;
    return std::sin(1.5707963267948966 * x) * std::pow(6.283185307179586, x) * Gamma(s) * Zeta(s) / kPi;
}

}  // namespace

double Zeta(double x) {
    if (x == kInfinity) return 1.0;
    if (!std::isfinite(x)) return kQuietNaN;
    if (x < -30.8148) return DomainError(0.0);
    if (x < 0.0) return ReflectedZeta(x);
    if (x >= 127.0) return 1.0;
    if (x <= 30.0 && IsWhole(x)) {
        return x == 1.0 ? DomainError(kInfinity) : kZetaLessOne[static_cast<int32_t>(x)] + 1.0;
    }
    if (x < 1.0) return PolyEval(x, kZetaR) / ((1.0 - x) * PolyEvalMonic(x, kZetaS)) + 1.0;
    if (x <= 10.0) {
        const double w = 1.0 / x;
        const double b = std::exp2(x) * (x - 1.0);
        return x * PolyEval(w, kZetaP) / (b * PolyEvalMonic(w, kZetaQ)) + 1.0;
    }
    if (x <= 50.0) {
        return std::exp(PolyEval(x, kZetaA) / PolyEvalMonic(x, kZetaB)) + std::exp2(-x) + 1.0;
    }
    return OddSum(x);
}

}  // namespace krnumer
