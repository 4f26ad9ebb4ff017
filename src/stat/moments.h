// Mean, central moments and mean squares. All sums run in index order; outputs are written on success only.
#pragma once

#include <cstdint>

namespace krnumer {

// Plain running sum over n. kEmptyInput where n < 1.
int32_t Mean(const double* x, int32_t n, double* mean);

// Mean of the powers of the deviations from the mean. The first moment is computed like any other and shows the
// rounding error of the mean. kEmptyInput where n < 1, kBadOrder where order < 1.
int32_t Moment(const double* x, int32_t n, int32_t order, double* moment);

// The square of y - x in the form that all squared residuals share. It cancels: where x and y agree in more than half
// of their digits, hardly a digit of the square is left.
inline double SquaredDifference(double x, double y) {
    return (y - 2.0 * x) * y + x * x;
}

// Mean of SquaredDifference over the common length of the n samples of x and the m samples of y. kEmptyInput where
// either is empty; kWarnSizesDiffer, with the result, where the lengths differ.
int32_t MeanSquareError(const double* x, int32_t n, const double* y, int32_t m, double* mse);

// Root of the mean of the squares. kEmptyInput where n < 1.
int32_t RootMeanSquare(const double* x, int32_t n, double* rms);

}  // namespace krnumer
