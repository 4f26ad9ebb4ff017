#include "special/dawson.h"

#include <cmath>

#include "frame/numeric.h"
#include "special/dawson_coefficients.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

double PositiveDawson(double x) {
    if (x < 3.25) {
        const double z = x * x;
        return x * PolyEval(z, kDawsonAN) / PolyEval(z, kDawsonAD);
    }
    if (x > 1e9) return 0.5 / x;
    const double z = 1.0 / (x * x);
    const double ratio = x < 6.25 ? z * PolyEval(z, kDawsonBN) / (x * PolyEvalMonic(z, kDawsonBD))
                                  : z * PolyEval(z, kDawsonCN) / (x * PolyEvalMonic(z, kDawsonCD));
    return 0.5 * (ratio + 1.0 / x);
}

}  // namespace

double Dawson(double x) {
    if (!std::isfinite(x)) return kQuietNaN;
    if (x == 0.0) return 0.0;
    return x > 0.0 ? PositiveDawson(x) : -PositiveDawson(-x);
}

}  // namespace krnumer
