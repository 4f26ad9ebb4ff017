// F. W. J. Olver, The asymptotic expansion of Bessel functions of large order, 1954 (M. Abramowitz and I. A. Stegun,
// Handbook of Mathematical Functions, 1964, 9.3.35), and for x near v the transition region's own, 9.3.23.
#include "special/bessel_uniform.h"

#include <cmath>
#include <cstdint>
#include <limits>

#include "special/airy.h"
#include "special/bessel_uniform_coefficients.h"
#include "special/domain.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

bool IsFinite(const AiryFunctions& airy) {
    return std::isfinite(airy.ai) && std::isfinite(airy.bi) && std::isfinite(airy.ai_prime) &&
           std::isfinite(airy.bi_prime);
}

// The terms of a series as long as they fall.
class FallingSum {
  public:
    void Add(double term) {
        falling_ = falling_ && std::abs(term) < last_;
        if (!falling_) return;
        sum_ += term;
        last_ = std::abs(term);
    }
    double value() const { return sum_; }

  private:
    double sum_ = 0.0;
    double last_ = std::numeric_limits<double>::max();
    bool falling_ = true;
};

double Olver(double v, double x) {
    const double z = x / v;
    const double w = 1.0 - z * z;
    if (w == 0.0) return 0.0;
    const double s = std::sqrt(std::abs(w));
    const double tau = 1.5 * (w > 0.0 ? std::log((1.0 + s) / z) - s : s - std::acos(1.0 / z));
    const double g = std::cbrt(tau);
    const double zeta = w > 0.0 ? g * g : -(g * g);
    const double sigma = w > 0.0 ? 1.0 : -1.0;

    const double cube_root = std::cbrt(v);
    const AiryFunctions airy = Airy(cube_root * cube_root * zeta);
    if (!IsFinite(airy)) return kQuietNaN;

    const double i = 1.0 / w;
    const double u[] = {1.0,
                        PolyEval(i, kDebye1) / s,
                        PolyEval(i, kDebye2) / w,
                        PolyEval(i, kDebye3) / (s * w),
                        PolyEval(i, kDebye4) / (w * w),
                        PolyEval(i, kDebye5) / (w * w * s),
                        PolyEval(i, kDebye6) / (w * w * w),
                        PolyEval(i, kDebye7) / (w * w * w * s)};

    constexpr int32_t kTerms = 4;  // what the tables suffice for
    FallingSum even, odd;
    double factor = 1.0;
    for (int32_t k = 0; k < kTerms; ++k) {
        double a = 0.0, b = 0.0, power = 1.0;
        for (int32_t j = 0; j <= 2 * k; ++j) {
            const double sign_a = j % 4 >= 2 ? sigma : 1.0;
            const double sign_b = (2 * k + 2 - j) % 4 >= 2 ? sigma : 1.0;
            a += sign_a * kMu[j] * power * u[2 * k - j];
            b += sign_b * kLambda[j] * power * u[2 * k + 1 - j];
            power /= tau;
        }
        b += kLambda[2 * k + 1] * power;
        even.Add(factor * a);
        odd.Add(-(factor / g) * b);
        if (factor < kEpsilon) break;
        factor /= v * v;
    }
    const double scale = std::sqrt(std::sqrt(4.0 * zeta / w));
    return scale * (airy.ai * even.value() / cube_root + airy.ai_prime * odd.value() / (cube_root * cube_root * v));
}

double Transition(double v, double x) {
    constexpr double kCubeRootOfTwo = 1.2599210498948732;
    constexpr double kCubeRootOfFour = 1.5874010519681996;
    const double cube_root = std::cbrt(v);
    const double z = (x - v) / cube_root, z2 = z * z, z3 = z2 * z;
    const AiryFunctions airy = Airy(-kCubeRootOfTwo * z);
    if (!IsFinite(airy)) return kQuietNaN;

    const double f[] = {1.0, -z / 5.0, PolyEval(z3, kPF2) * z2, PolyEval(z3, kPF3), PolyEval(z3, kPF4) * z};
    const double g[] = {0.3 * z2, PolyEval(z3, kPG1), PolyEval(z3, kPG2) * z, PolyEval(z3, kPG3) * z2};
    const double step = 1.0 / (cube_root * cube_root);
    double first = 0.0, second = 0.0, power = 1.0;
    for (int32_t k = 0; k < 5; ++k) {
        first += f[k] * power;
        if (k < 4) second += g[k] * power;
        power *= step;
    }
    return kCubeRootOfTwo * airy.ai * first / cube_root + kCubeRootOfFour * airy.ai_prime * second / v;
}

}  // namespace

double BesselJUniform(double v, double x) {
    return std::abs((x - v) / std::cbrt(v)) > 0.7 ? Olver(v, x) : Transition(v, x);
}

}  // namespace krnumer
