/* Values of special functions, among them some that are known in closed form. */
#include <krnumer/krnumer.h>
#include <math.h>
#include <stdio.h>

int main(void) {
    double value, bi, sn, cn, dn;
    KR_Gamma(0.5, NAN, &value);
    printf("Gamma(1/2)      %.10f (sqrt(pi) is %.10f)\n", value, sqrt(acos(-1.0)));
    KR_Gamma(2.0, 3.0, &value);
    printf("P(2, 3)         %.10f\n", value);
    KR_Erf(1.0, &value);
    printf("erf(1)          %.10f\n", value);
    KR_BesselJr(0.0, 1.0, &value);
    printf("J0(1)           %.10f\n", value);
    KR_Airy(1.0, &value, &bi, NULL, NULL);
    printf("Ai(1), Bi(1)    %.10f %.10f\n", value, bi);
    KR_Elliptic1(0.5, NAN, &value);
    printf("K(1/2)          %.10f\n", value);
    KR_EllipticJ(1.0, 0.5, &sn, &cn, &dn, NULL);
    printf("sn(1 | 1/2)     %.10f\n", sn);
    KR_Zeta(2.0, &value);
    printf("zeta(2)         %.10f\n", value);
    KR_Gamma(-1.0, NAN, &value);
    printf("Gamma(-1)       %s\n", isnan(value) ? "is not a number" : "?");
    return 0;
}
