#include "special/dilogarithm.h"

#include <cmath>

#include "special/dilogarithm_coefficients.h"
#include "special/domain.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kSixthOfPiSquared = 1.6449340668482264;

}  // namespace

double Dilogarithm(double x) {
    if (!std::isfinite(x)) return kQuietNaN;
    if (x < 0.0) return DomainError(kQuietNaN);
    if (x == 1.0) return 0.0;
    if (x == 0.0) return kSixthOfPiSquared;

    bool inverted = false, complemented = false;  // x <-> 1 / x, x <-> 1 - x
    if (x > 2.0) {
        x = 1.0 / x;
        inverted = true;
    }
    double w;
    if (x > 1.5) {
        w = 1.0 / x - 1.0;
        inverted = true;
    } else if (x < 0.5) {
        w = -x;
        complemented = true;
    } else {
        w = x - 1.0;
    }
    double y = -w * PolyEval(w, kDilogarithmA) / PolyEval(w, kDilogarithmB);
    if (complemented) y = kSixthOfPiSquared - std::log(x) * std::log(1.0 - x) - y;
    if (inverted) {
        const double z = std::log(x);
        y = -0.5 * z * z - y;
    }
    return y;
}

}  // namespace krnumer
