#include "krnumer/special.h"

#include <cmath>

#include "special/elliptic.h"
#include "special/jacobi_elliptic.h"

using namespace krnumer;

void KR_Elliptic1(double m, double x, double* out) {
    *out = std::isnan(x) ? EllipticK(m) : EllipticF(x, m);
}

void KR_Elliptic2(double m, double x, double* out) {
    *out = std::isnan(x) ? EllipticE(m) : EllipticE(x, m);
}

void KR_EllipticJ(double u, double m, double* sn, double* cn, double* dn, double* phi) {
    const JacobiElliptic functions = JacobiEllipticFunctions(u, m);
    *sn = functions.sn;
    *cn = functions.cn;
    *dn = functions.dn;
    if (phi != nullptr) *phi = functions.phi;
}
