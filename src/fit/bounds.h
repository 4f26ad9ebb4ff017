// Bands around a fitted curve and bounds of its coefficients, to first order in the errors (G. A. F. Seber and C. J.
// Wild, Nonlinear Regression, 1989, chapter 5), and the goodness of a fit.
#pragma once

#include <cmath>
#include <cstdint>
#include <type_traits>

#include "fit/information.h"
#include "frame/status.h"
#include "linalg/finite.h"
#include "stat/distribution.h"
#include "stat/moments.h"

namespace krnumer {

// The band of a model at given coefficients and a level of confidence.
template <class Model>
class Band {
  public:
    static constexpr int32_t kCoefficients = Model::kCoefficients;

    // One degree of freedom at least has to be left. kFewerThanThree, or kTooFewForGaussian.
    static int32_t CheckCount(int32_t n) {
        if (n > kCoefficients) return kOk;
        return kCoefficients == 3 ? kTooFewForGaussian : kFewerThanThree;
    }

    Band(const Model& model, const FitData& data, const double* coef) : model_(model), data_(data), coef_(coef) {}

    // As CheckCount; kNotPositive for the base of a logarithm, kNotFinite for a coefficient, kZeroSigma,
    // kBadProbability for a level not between 0 and 1, in this order; and what the inversion says.
    int32_t Prepare(double level, WeightSign sign) {
        if (const int32_t status = CheckCount(data_.n)) return status;
        if constexpr (std::is_same_v<Model, LogModel>)
            if (!(model_.base > 0.0)) return kNotPositive;
        if (CheckFiniteArray(coef_, kCoefficients) != 0) return kNotFinite;
        if constexpr (std::is_same_v<Model, GaussianModel>)
            if (coef_[2] == 0.0) return kZeroSigma;
        if (!(level > 0.0 && level < 1.0)) return kBadProbability;

        if (const int32_t status = InverseInformation(model_, data_, coef_, inverse_, sign)) return status;
        double sse = 0.0;
        for (int32_t i = 0; i < data_.n; ++i)
            sse += WeightOf(data_, i) * SquaredDifference(data_.y[i], model_.Value(coef_, data_.x[i]));
        const int32_t freedom = data_.n - kCoefficients;
        variance_ = sse / freedom;
        return InverseTDistribution(1.0 - (1.0 - level) * 0.5, freedom, &t_);
    }

    // The curve plus and minus the half-widths; `Noise(i)` is the variance of an observation there in units of that of
    // weight 1, and 0 where only the curve counts.
    template <class Noise>
    void Bounds(Noise&& noise, double* upper, double* lower) const {
        for (int32_t i = 0; i < data_.n; ++i) {
            double gradient[kCoefficients];
            model_.Gradient(coef_, data_.x[i], gradient);
            const double spread = QuadraticForm<kCoefficients>(gradient, inverse_) + noise(i);
            const double half = std::sqrt(spread * variance_) * t_;
            const double value = model_.Value(coef_, data_.x[i]);
            upper[i] = value + half;
            lower[i] = value - half;
        }
    }

    // Half-width of the interval of a coefficient.
    double HalfWidth(int32_t j) const {
        return std::sqrt(inverse_[j * (kCoefficients + 1)]) * std::sqrt(variance_) * t_;
    }

  private:
    const Model& model_;
    const FitData& data_;
    const double* coef_;
    double inverse_[kCoefficients * kCoefficients] = {};
    double variance_ = 0.0;
    double t_ = 0.0;
};

// Band of the curve, and bounds of its coefficients with their half-widths. For a straight line the weights have their
// sign in the information.
template <class Model>
int32_t ConfidenceBand(const Model& model, const FitData& data, const double* coef, double level, double* upper,
                       double* lower, double* upper_coef, double* lower_coef, double* half_widths) {
    Band<Model> band(model, data, coef);
    constexpr bool kIsLine = std::is_same_v<Model, LineModel>;
    if (const int32_t status = band.Prepare(level, kIsLine ? WeightSign::kAsGiven : WeightSign::kMagnitude))
        return status;
    band.Bounds([](int32_t) { return 0.0; }, upper, lower);
    for (int32_t j = 0; j < Model::kCoefficients; ++j) {
        half_widths[j] = band.HalfWidth(j);
        upper_coef[j] = coef[j] + half_widths[j];
        lower_coef[j] = coef[j] - half_widths[j];
    }
    return kOk;
}

// Band of a new observation. A weight of 0 makes it infinitely wide.
template <class Model>
int32_t PredictionBand(const Model& model, const FitData& data, const double* coef, double level, double* upper,
                       double* lower) {
    Band<Model> band(model, data, coef);
    if (const int32_t status = band.Prepare(level, WeightSign::kMagnitude)) return status;
    band.Bounds([&](int32_t i) { return 1.0 / WeightOf(data, i); }, upper, lower);
    return kOk;
}

// Sum of squared errors, share of the variation that the fit explains, and root mean square error. Weights have their
// sign. kFewerThanTwo; kBadFreedom where `freedom` is n or more; below 1 it is n - 2.
int32_t GoodnessOfFit(const double* y, const double* fit, const double* w, int32_t n, int32_t freedom, double* sse,
                      double* r_square, double* rmse);

}  // namespace krnumer
