#include "krnumer/special.h"

#include "special/dawson.h"
#include "special/error_function.h"
#include "special/exponential_integral.h"
#include "special/fresnel.h"
#include "special/hyperbolic_integral.h"
#include "special/sine_integral.h"

using namespace krnumer;

void KR_Erf(double x, double* out) {
    *out = Erf(x);
}

void KR_ErfC(double x, double* out) {
    *out = ErfC(x);
}

void KR_Dawson(double x, double* out) {
    *out = Dawson(x);
}

void KR_FresnelIntegrals(double x, double* c, double* s) {
    FresnelIntegrals(x, c, s);
}

void KR_ExpI(double x, int32_t n, double* out) {
    *out = ExponentialIntegral(n, x);
}

void KR_CosI(double x, double* out) {
    SiCi(x, nullptr, out);
}

void KR_SinI(double x, double* out) {
    SiCi(x, out, nullptr);
}

void KR_CoshI(double x, double* out) {
    *out = Chi(x);
}

void KR_SinhI(double x, double* out) {
    *out = Shi(x);
}
