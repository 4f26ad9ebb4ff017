/* Three batches of three weights: their mean with its confidence limit, and whether the batches differ. */
#include <math.h>
#include "arrays.h"

int main(void) {
    KrHandle weights = DOUBLES(10.2, 9.9, 10.1, 10.4, 10.6, 10.5, 9.8, 9.7, 10.0);
    KrHandle batch = INTEGERS(0, 0, 0, 1, 1, 1, 2, 2, 2);
    const int32_t n = 9, second = 2, batches = 3, df = n - 1;
    const double level = 0.975;
    double mean, median, variance, t, between, betweenMean, f, p, within, withinMean, total;
    int32_t err;

    Mean_head(weights, &mean, &err), Check(err);
    Median_head(weights, &median, &err), Check(err);
    Moment_head(weights, &second, &variance, &err), Check(err);
    InvTdist_head(&level, &df, &t, &err), Check(err);
    printf("mean %.4f +- %.2f, median %.4f\n", mean, t * sqrt(variance / df), median);

    Anova1Way_head(weights, batch, &batches, &between, &betweenMean, &f, &p, &within, &withinMean, &total, &err);
    Check(err);
    printf("between batches %.4f, within %.4f, F %.2f, p %.4f\n", between, within, f, p);
    FREE(weights, batch);
    return 0;
}
