/* A line with and without an outlier in its way, its goodness, and an exponential decay. */
#include <math.h>
#include "arrays.h"

int main(void) {
    KrHandle x = DOUBLES(0, 1, 2, 3, 4, 5, 6, 7), none = Empty();
    const double data[] = {1.1, 2.9, 5.2, 6.8, 9.1, 30.0, 13.1, 14.9};
    KrHandle plain = NewDoubles(8, data), robust = NewDoubles(8, data), y = NewDoubles(8, data);
    double slope, intercept, mse, sse, rSquare, rmse, a, b;
    int32_t passes = 100;

    Check(LinFit_head(plain, x, none, &slope, &intercept, &mse));
    Check(GoodnessOfFit_head(y, plain, none, 0, &sse, &rSquare, &rmse));
    printf("least squares: %.3f x %+.3f, R^2 %.3f\n", slope, intercept, rSquare);
    Check(BiLinearFit_head(robust, x, none, 1e-6, &slope, &intercept, &mse, &passes, 0));
    printf("bisquare:      %.3f x %+.3f\n", slope, intercept);

    for (int i = 0; i < 8; ++i) Elements(y)[i] = 5.0 * exp(-0.4 * i);
    Check(ExpFit_head(y, x, none, &a, &b, &mse));
    printf("decay:         %.3f exp(%.3f x)\n", a, b);
    FREE(x, none, plain, robust, y);
    return 0;
}
