#include "fit/bounds.h"

#include "frame/numeric.h"

namespace krnumer {

int32_t GoodnessOfFit(const double* y, const double* fit, const double* w, int32_t n, int32_t freedom, double* sse,
                      double* r_square, double* rmse) {
    if (n < 2) return kFewerThanTwo;
    if (freedom >= n) return kBadFreedom;
    if (freedom < 1) freedom = n - 2;
    double mean;
    if (const int32_t status = Mean(y, n, &mean)) return status;
    double errors = 0.0;
    double total = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        const double squared = SquaredDifference(y[i], fit[i]);
        const double product = (y[i] - 2.0 * mean) * y[i];
        errors += w != nullptr ? w[i] * squared : squared;
        total += w != nullptr ? w[i] * (product + mean * mean) : product;
    }
    if (w == nullptr) total += n * (mean * mean);
    *sse = errors;
    *rmse = std::sqrt(errors / freedom);
    *r_square = total != 0.0 ? 1.0 - errors / total : errors == 0.0 ? 1.0 : kInfinity;
    return kOk;
}

}  // namespace krnumer
