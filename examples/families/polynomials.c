/* A triple root, a value between the points of a table, and the integral of a sine. */
#include <math.h>
#include "arrays.h"

int main(void) {
    KrHandle coef = DOUBLES(-2, 5, -3, -1, 1); /* (x - 1)^3 (x + 2), the constant first */
    KrHandle roots = KrrtNewArray(KRRT_COMPLEX, 0), distinct = KrrtNewArray(KRRT_COMPLEX, 0);
    KrHandle times = KrrtNewArray(KRRT_INT32, 0);
    Check(MultPolyRoots_head(coef, 1, 0.0, roots, distinct, times));
    for (int32_t i = 0; i < KrrtSize(distinct, 0); ++i)
        printf("root %.6f, %d times\n", ((const KrComplex*)KrrtElements(distinct))[i].re,
               (int)((const int32_t*)KrrtElements(times))[i]);

    KrHandle x = DOUBLES(1, 2, 3, 4, 5), y = DOUBLES(1, 4, 9, 16, 25), bends = Empty();
    const double slopeFirst = 2.0, slopeLast = 10.0, place = 2.5;
    double value;
    int32_t err;
    Spline_head(y, x, &slopeFirst, &slopeLast, bends, &err), Check(err);
    SpInterp_head(y, x, bends, &place, &value, &err), Check(err);
    printf("spline at %.1f: %.4f\n", place, value);

    enum { n = 13 };
    const double step = acos(-1.0) / (n - 1);
    const int32_t boole = 3;
    KrHandle sine = KrrtNewArray(KRRT_DOUBLE, n);
    for (int i = 0; i < n; ++i) Elements(sine)[i] = sin(i * step);
    NumerIntegration_head(sine, &step, &boole, &value, &err), Check(err);
    printf("integral of the sine: %.5f\n", value);
    FREE(coef, roots, distinct, times, x, y, bends, sine);
    return 0;
}
