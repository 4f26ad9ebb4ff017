#include "special/sine_integral.h"

#include <cmath>

#include "special/domain.h"
#include "special/gamma.h"
#include "special/polynomial.h"
#include "special/sine_integral_coefficients.h"

namespace krnumer {

void SiCi(double x, double* si, double* ci) {
    const auto deliver = [=](double sine, double cosine) {
        if (si != nullptr) *si = x < 0.0 ? -sine : sine;
        if (ci != nullptr) *ci = cosine;
    };
    if (std::isnan(x)) return deliver(kQuietNaN, kQuietNaN);
    if (const int sign = IsInfSign(x)) return deliver(kPi / 2.0, sign > 0 ? 0.0 : DomainError(kQuietNaN));
    if (x == 0.0) return deliver(0.0, DomainError(-kInfinity));

    const double size = std::abs(x);
    if (size <= 4.0) {
        const double z = size * size;
        if (si != nullptr) *si = x * PolyEval(z, kSineSN) / PolyEval(z, kSineSD);
        if (ci != nullptr) *ci = kEulerGamma + std::log(size) + z * PolyEval(z, kSineCN) / PolyEval(z, kSineCD);
        return;
    }
    const double sine = std::sin(size), cosine = std::cos(size);
    const double z = 1.0 / (size * size);
    double f, g;
    if (size < 8.0) {
        f = PolyEval(z, kSineFN4) / (size * PolyEvalMonic(z, kSineFD4));
        g = z * PolyEval(z, kSineGN4) / PolyEvalMonic(z, kSineGD4);
    } else {
        f = PolyEval(z, kSineFN8) / (size * PolyEvalMonic(z, kSineFD8));
        g = z * PolyEval(z, kSineGN8) / PolyEvalMonic(z, kSineGD8);
    }
    deliver(kPi / 2.0 - f * cosine - g * sine, f * sine - g * cosine);
}

}  // namespace krnumer
