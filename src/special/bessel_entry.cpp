#include "krnumer/special.h"

#include "special/airy.h"
#include "special/bessel_modified.h"
#include "special/bessel_real.h"
#include "special/kelvin.h"
#include "special/struve.h"

using namespace krnumer;

void KR_BesselJr(double v, double x, double* out) {
    *out = BesselJ(v, x);
}

void KR_BesselYr(double v, double x, double* out) {
    *out = BesselY(v, x);
}

void KR_BesselJs(int32_t n, double x, double* out) {
    *out = SphericalBesselJ(n, x);
}

void KR_BesselYs(int32_t n, double x, double* out) {
    *out = SphericalBesselY(n, x);
}

void KR_BesselIr(double v, double x, double* out) {
    *out = BesselI(v, x);
}

void KR_BesselKn(int32_t n, double x, double* out) {
    *out = BesselK(n, x);
}

void KR_KelvinI(double x, int32_t n, double* ber, double* bei) {
    const KelvinParts parts = KelvinI(n, x);
    *ber = parts.real;
    *bei = parts.imaginary;
}

void KR_KelvinK(double x, int32_t n, double* ker, double* kei) {
    const KelvinParts parts = KelvinK(n, x);
    *ker = parts.real;
    *kei = parts.imaginary;
}

void KR_Airy(double x, double* ai, double* bi, double* aiPrime, double* biPrime) {
    const AiryFunctions airy = Airy(x);
    *ai = airy.ai;
    *bi = airy.bi;
    if (aiPrime == nullptr) return;
    *aiPrime = airy.ai_prime;
    if (biPrime != nullptr) *biPrime = airy.bi_prime;
}

void KR_Struve(double x, double v, double* out) {
    *out = Struve(v, x);
}
