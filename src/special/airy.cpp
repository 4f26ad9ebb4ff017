// S. L. Moshier, Methods and Programs for Mathematical Functions, 1989: Maclaurin's series about 0, rational
// approximations of the asymptotic forms elsewhere.
#include "special/airy.h"

#include <cmath>
#include <limits>

#include "frame/numeric.h"
#include "special/airy_coefficients.h"
#include "special/polynomial.h"

namespace krnumer {
namespace {

constexpr double kLargestArgument = 103.892;  // beyond, Bi overflows
constexpr double kReciprocalSqrtPi = 0.5641895835477563;
constexpr double kAiAtZero = 0.3550280538878172;            // c1
constexpr double kMinusAiPrimeAtZero = 0.2588194037928068;  // c2
constexpr double kSqrtThree = 1.7320508075688772;

AiryFunctions Oscillating(double x) {
    const double root = std::sqrt(-x);
    const double zeta = -2.0 * x * root / 3.0;
    const double t = std::sqrt(root);
    const double z = 1.0 / zeta, zz = z * z;
    const double theta = zeta + 0.7853981633974483;
    const double sine = std::sin(theta), cosine = std::cos(theta);

    double k = kReciprocalSqrtPi / t;
    double f = 1.0 + zz * PolyEval(zz, kAiryAFN) / PolyEvalMonic(zz, kAiryAFD);
    double g = z * PolyEval(zz, kAiryAGN) / PolyEvalMonic(zz, kAiryAGD);
    AiryFunctions airy;
    airy.ai = k * (sine * f - cosine * g);
    airy.bi = k * (cosine * f + sine * g);

    k = kReciprocalSqrtPi * t;
    f = 1.0 + zz * PolyEval(zz, kAiryAPFN) / PolyEvalMonic(zz, kAiryAPFD);
    g = z * PolyEval(zz, kAiryAPGN) / PolyEvalMonic(zz, kAiryAPGD);
    airy.ai_prime = -k * (cosine * f + sine * g);
    airy.bi_prime = k * (sine * f - cosine * g);
    return airy;
}

AiryFunctions Maclaurin(double x) {
    const double z = x * x * x;
    double f = 1.0, g = x, f_term = 1.0, g_term = x, k = 1.0;
    for (double change = 1.0; change > kEpsilon;) {
        f_term *= z / (k + 1.0) / (k + 2.0);
        g_term *= z / (k + 2.0) / (k + 3.0);
        f += f_term;
        g += g_term;
        k += 3.0;
        change = std::abs(f_term / f);
    }
    AiryFunctions airy;
    airy.ai = kAiAtZero * f - kMinusAiPrimeAtZero * g;
    airy.bi = kSqrtThree * (kAiAtZero * f + kMinusAiPrimeAtZero * g);

    f = x * x / 2.0;
    f_term = f / 3.0;
    g_term = z / 3.0;
    g = 1.0 + g_term;
    k = 4.0;
    for (double change = 1.0; change > kEpsilon;) {
        f_term *= z / (k + 1.0);
        f += f_term;
        f_term /= k + 2.0;
        g_term *= z / (k * (k + 2.0));
        g += g_term;
        k += 3.0;
        change = std::abs(g_term / g);
    }
    airy.ai_prime = kAiAtZero * f - kMinusAiPrimeAtZero * g;
    airy.bi_prime = kSqrtThree * (kAiAtZero * f + kMinusAiPrimeAtZero * g);
    return airy;
}

// Ai falls and Bi grows. Up to 8.3 the series still serves Bi.
AiryFunctions Monotone(double x) {
    const double root = std::sqrt(x);
    const double zeta = 2.0 * x * root / 3.0;
    const double growth = std::exp(zeta);
    const double t = std::sqrt(root);
    const double z = 1.0 / zeta;
    AiryFunctions airy;
    if (x > 8.3203353) {
        airy.bi = kReciprocalSqrtPi * growth * (1.0 + z * PolyEval(z, kAiryBN16) / PolyEvalMonic(z, kAiryBD16)) / t;
        airy.bi_prime =
            kReciprocalSqrtPi * growth * t * (1.0 + z * PolyEval(z, kAiryBPPN) / PolyEvalMonic(z, kAiryBPPD));
    } else {
        airy = Maclaurin(x);
    }
    airy.ai = kReciprocalSqrtPi * PolyEval(z, kAiryAN) / PolyEval(z, kAiryAD) / (2.0 * t * growth);
    airy.ai_prime = -0.28209479177387814 * t / growth * PolyEval(z, kAiryAPN) / PolyEval(z, kAiryAPD);
    return airy;
}

}  // namespace

AiryFunctions Airy(double x) {
    if (std::isnan(x)) return {kQuietNaN, kQuietNaN, kQuietNaN, kQuietNaN};
    if (std::isinf(x) || x > kLargestArgument) {
        constexpr double kLargest = std::numeric_limits<double>::max();
        return {0.0, x > 0.0 ? kInfinity : 0.0, kLargest, kLargest};
    }
    if (x < -2.09) return Oscillating(x);
    return x >= 2.09 ? Monotone(x) : Maclaurin(x);
}

}  // namespace krnumer
