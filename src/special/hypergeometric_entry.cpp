#include "krnumer/special.h"

#include "special/dilogarithm.h"
#include "special/hypergeometric.h"
#include "special/parabolic_cylinder.h"
#include "special/zeta.h"

using namespace krnumer;

void KR_Gauss(double x, double a, double b, double c, double* out) {
    *out = Hypergeometric2F1(a, b, c, x);
}

void KR_Kummer(double x, double a, double b, double* out) {
    *out = KummerM(a, b, x);
}

void KR_Tricomi(double x, double a, double b, double* out) {
    *out = TricomiU(a, b, x);
}

void KR_ParabolicCylinder(double x, double v, double* out) {
    *out = ParabolicCylinder(v, x);
}

void KR_Diln(double x, double* out) {
    *out = Dilogarithm(x);
}

void KR_Zeta(double x, double* out) {
    *out = Zeta(x);
}
