#include "filter/savitzky_golay.h"

#include <algorithm>
#include <cmath>

#include "filter/direct_form.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/cholesky_solve.h"
#include "linalg/packed.h"
#include "linalg/products.h"

namespace krnumer {
namespace {

int32_t CheckOrder(int32_t order, int32_t frame) {
    if (order < 1) return kBadCoefficient;
    return frame <= order ? kUnderdetermined : kOk;
}

}  // namespace

int32_t SavitzkyGolayMatrices(int32_t order, int32_t frame, const double* weights, double* smoothing,
                              double* differentiators) {
    if (const int32_t status = CheckOrder(order, frame)) return status;
    if (frame % 2 == 0) return kEvenLength;
    const int32_t terms = order + 1;
    const int32_t half = frame / 2;
    const size_t rows = Count(frame), columns = Count(terms);
    Scratch<double> powers(rows * columns), weighted(rows * columns), solution(rows * columns);
    Scratch<double> normal(columns * columns);
    if (!powers || !weighted || !solution || !normal) return kOutOfMemory;

    // Powers of t / half instead of t, which all have about the same size: the normal equations of the powers of t
    // would lose all digits at higher orders.
    int32_t weighing = 0;
    for (size_t i = 0; i < rows; ++i) {
        const double t = (static_cast<double>(i) - half) / half;
        const double weight = weights != nullptr ? std::fabs(weights[i]) : 1.0;
        if (weight != 0.0) ++weighing;
        double power = 1.0;
        for (size_t k = 0; k < columns; ++k, power *= t) {
            powers[i * columns + k] = power;
            weighted[k * rows + i] = weight * power;
        }
    }
    // The normal equations are singular then, which the rounding of their factor may hide.
    if (weighing < terms) return kNotPositiveDefinite;
    if (const int32_t status = MatMulCore(weighted.data(), powers.data(), terms, frame, terms, normal.data()))
        return status;
    if (const int32_t status = CholeskySolveFull(normal.data(), terms, kLower, weighted.data(), frame, solution.data()))
        return status;
    if (const int32_t status = MatMulCore(powers.data(), solution.data(), frame, terms, frame, smoothing))
        return status;
    if (differentiators == nullptr) return kOk;
    double scale = 1.0;
    for (size_t k = 0; k < columns; ++k, scale *= half)
        for (size_t i = 0; i < rows; ++i) differentiators[k * rows + i] = solution[k * rows + i] / scale;
    return kOk;
}

int32_t SavitzkyGolayFilter(const double* x, int32_t n, int32_t order, int32_t frame, const double* weights,
                            double* y) {
    if (const int32_t status = CheckOrder(order, frame)) return status;
    if (n < frame) return kBadDimension;
    const size_t width = Count(frame);
    Scratch<double> matrix(width * width);
    Scratch<double> work(2 * width);
    if (!matrix || !work) return kOutOfMemory;
    if (const int32_t status = SavitzkyGolayMatrices(order, frame, weights, matrix.data(), nullptr)) return status;

    const int32_t half = frame / 2;
    const auto fit = [&](int32_t row, const double* samples) {
        const double* const coefficients = matrix.data() + Count(row) * width;
        double sum = 0.0;
        for (int32_t j = 0; j < frame; ++j) sum += coefficients[j] * samples[j];
        return sum;
    };
    for (int32_t i = 0; i < half; ++i) y[i] = fit(i, x);
    for (int32_t i = 0; i < half; ++i) y[n - half + i] = fit(frame - half + i, x + n - frame);

    // In between it is a filter without feedback, which has seen all of the first frame but its last sample.
    double* const coefficients = work.data();
    double* const seen = coefficients + frame;
    std::reverse_copy(matrix.data() + Count(half) * width, matrix.data() + Count(half + 1) * width, coefficients);
    std::copy_n(x, frame - 1, seen);
    return DirectFormFilter(x + frame - 1, n - frame + 1, nullptr, 0, coefficients, frame, seen, nullptr, y + half);
}

}  // namespace krnumer
