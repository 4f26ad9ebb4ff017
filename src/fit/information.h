// What data say about the coefficients of a model, to first order.
#pragma once

#include <cstdint>

#include "fit/model.h"
#include "linalg/svd_solve.h"

namespace krnumer {

enum class WeightSign { kMagnitude, kAsGiven };

// (J' W J)^-1, k by k, with the derivatives J of the model at the points. kNotFinite, kNoConvergence, kOutOfMemory.
template <class Model>
int32_t InverseInformation(const Model& model, const FitData& data, const double* coef, double* inverse,
                           WeightSign sign = WeightSign::kMagnitude) {
    constexpr int32_t k = Model::kCoefficients;
    double information[k * k] = {};
    for (int32_t i = 0; i < data.n; ++i) {
        double row[k];
        model.Gradient(coef, data.x[i], row);
        const double weight = sign == WeightSign::kAsGiven && data.w != nullptr ? data.w[i] : WeightOf(data, i);
        for (int32_t a = 0; a < k; ++a)
            for (int32_t b = 0; b < k; ++b) information[a * k + b] += weight * (row[a] * row[b]);
    }
    return PseudoInverseCore(information, k, k, -1.0, inverse);
}

// g' A g
template <int32_t k>
double QuadraticForm(const double* g, const double* a) {
    double sum = 0.0;
    for (int32_t i = 0; i < k; ++i)
        for (int32_t j = 0; j < k; ++j) sum += g[i] * a[i * k + j] * g[j];
    return sum;
}

}  // namespace krnumer
