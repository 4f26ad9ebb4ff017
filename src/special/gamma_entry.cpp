#include "krnumer/special.h"

#include <cmath>

#include "special/beta.h"
#include "special/gamma.h"
#include "special/incomplete_gamma.h"

using namespace krnumer;

void KR_Gamma(double a, double x, double* out) {
    *out = std::isnan(x) ? Gamma(a) : IncompleteGamma(a, x);
}

void KR_GammaC(double a, double x, double* out) {
    *out = IncompleteGammaC(a, x);
}

void KR_LnGamma(double x, double* out) {
    *out = LnGamma(x);
}

void KR_Beta(double a, double b, double x, double* out) {
    *out = std::isnan(x) ? Beta(a, b) : IncompleteBeta(a, b, x);
}

void KR_Fact(int32_t n, double* out) {
    *out = Factorial(n);
}

void KR_LnFact(int32_t n, double* out) {
    *out = LnFactorial(n);
}

void KR_Psi(double x, double* out) {
    *out = Digamma(x);
}

void KR_Stirling(double x, double* out) {
    *out = Stirling(x);
}
