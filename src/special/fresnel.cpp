#include "special/fresnel.h"

#include <cmath>

#include "frame/numeric.h"
#include "special/fresnel_coefficients.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

// From here on the limit stands for the values, which still oscillate about it by 1 / (pi x), 8.6e-6 and less.
constexpr double kLimitFrom = 36974.0;

}  // namespace

void FresnelIntegrals(double x, double* c, double* s) {
    const auto deliver = [=](double cosine, double sine) {
        if (c != nullptr) *c = cosine;
        if (s != nullptr) *s = sine;
    };
    if (std::isnan(x)) return deliver(kQuietNaN, kQuietNaN);
    if (std::isinf(x)) return deliver(x, x);

    const double size = std::abs(x);
    const double sign = x < 0.0 ? -1.0 : 1.0;
    const double square = size * size;
    if (square < 2.5625) {
        const double t = square * square;
        if (c != nullptr) *c = sign * (size * PolyEval(t, kFresnelCN) / PolyEval(t, kFresnelCD));
        if (s != nullptr) *s = sign * (size * square * PolyEval(t, kFresnelSN) / PolyEvalMonic(t, kFresnelSD));
        return;
    }
    if (size > kLimitFrom) return deliver(sign * 0.5, sign * 0.5);

    const double t = kPi * square;
    const double u = 1.0 / (t * t);
    const double f = 1.0 - u * PolyEval(u, kFresnelFN) / PolyEvalMonic(u, kFresnelFD);
    const double g = 1.0 / t * PolyEval(u, kFresnelGN) / PolyEvalMonic(u, kFresnelGD);
    const double phase = kPi / 2.0 * square;
    const double cosine = std::cos(phase), sine = std::sin(phase);
    const double scale = kPi * size;
    deliver(sign * (0.5 + (f * sine - g * cosine) / scale), sign * (0.5 - (f * cosine + g * sine) / scale));
}

}  // namespace krnumer
