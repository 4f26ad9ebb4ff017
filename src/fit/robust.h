// Fits that outliers do not spoil: a loop around the plain fit of a model, which computes a weight for each point and
// fits again.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <type_traits>

#include "fit/information.h"
#include "fit/line.h"
#include "fit/nonlinear.h"
#include "fit/residual.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "stat/moments.h"
#include "stat/order.h"

namespace krnumer {

// ---- Plain fits as the loops call them ----

// What the fits within a loop may cost.
struct RobustBudgets {
    int32_t bisquare_start;
    int32_t bisquare_refit;
    double bisquare_tol;
    int32_t absolute_start;  // multiples of the caller's budget
    int32_t absolute_refit;
};

struct ExponentialFitter {
    static constexpr RobustBudgets kBudgets{100, 50, -1.0, 1, 1};
    int32_t Fit(const FitData& data, const double* init, double tol, int32_t budget, double* coef) const {
        return ExpFitCore(data, method, {tol, msetol, init, budget}, coef, &budget, nullptr, nullptr);
    }

    int32_t method;
    double msetol;
    ExponentialModel model{};
    ExponentialModel start_model{};
};

struct PowerFitter {
    static constexpr RobustBudgets kBudgets{100, 50, -1.0, 1, 1};
    int32_t Fit(const FitData& data, const double* init, double tol, int32_t budget, double* coef) const {
        return PowerFitCore(data, {tol, msetol, init, budget}, coef, &budget, nullptr, nullptr);
    }

    double msetol;
    PowerModel model{};
    PowerModel start_model{};
};

// The first residue of a Gaussian fit by absolute residuals is that of a curve narrower by the root of 2.
struct NarrowGaussian {
    static double Value(const double* coef, double x) {
        const double z = GaussianModel::Standardised(coef, x);
        return coef[0] * std::exp(-z * z);
    }
};

struct GaussianFitter {
    static constexpr RobustBudgets kBudgets{500, 300, 1e-8, 10, 5};
    int32_t Fit(const FitData& data, const double* init, double tol, int32_t budget, double* coef) const {
        return GaussFitCore(data, {tol, msetol, init, budget}, coef, &budget, nullptr, nullptr);
    }

    double msetol;
    GaussianModel model{};
    NarrowGaussian start_model{};
};

// Closed forms have no budget.
struct LogFitter {
    static constexpr RobustBudgets kBudgets{};
    explicit LogFitter(double base) : model(base), start_model(base) {}
    int32_t Fit(const FitData& data, const double*, double, int32_t, double* coef) const {
        return LogFitCore(data, model.base, coef, nullptr, nullptr);
    }

    LogModel model;
    LogModel start_model;
};

struct LineFitter {
    static constexpr RobustBudgets kBudgets{};
    int32_t Fit(const FitData& data, const double*, double, int32_t, double* coef) const {
        return LinFitCore(data.x, data.y, data.n, data.w, nullptr, &coef[0], &coef[1], nullptr);
    }

    LineModel model{};
};

template <class Fitter>
inline constexpr int32_t kCoefficientsOf = decltype(Fitter::model)::kCoefficients;

// The line through both points, whatever their weights.
inline void LineThroughBoth(const FitData& data, double* coef) {
    coef[0] = (data.y[1] - data.y[0]) / (data.x[1] - data.x[0]);
    coef[1] = data.y[0] - coef[0] * data.x[0];
}

// ---- Bisquare weights ----

// Factors that make up for the leverage of the points, 1 / sqrt(1 - h), and weigh them. Those of a point with all the
// leverage would be infinite.
template <class Model>
int32_t LeverageFactors(const Model& model, const FitData& data, const double* coef, double* factors) {
    constexpr int32_t k = Model::kCoefficients;
    constexpr double kMostLeverage = 0.9999;
    constexpr double kLargestFactor = 10000.0000000011;  // squared
    double inverse[k * k];
    if (const int32_t status = InverseInformation(model, data, coef, inverse)) return status;
    for (int32_t i = 0; i < data.n; ++i) {
        double row[k];
        model.Gradient(coef, data.x[i], row);
        const double weight = WeightOf(data, i);
        const double h = QuadraticForm<k>(row, inverse) * weight;
        factors[i] = std::sqrt(h <= kMostLeverage ? weight / (1.0 - h) : weight * kLargestFactor);
    }
    return kOk;
}

// The bisquare weights of adjusted residuals (A. E. Beaton and J. W. Tukey, Technometrics 16, 147, 1974) in units of
// their median absolute deviation. `scale` comes back 0, and the weights as they were, where the residuals do not
// spread at all.
inline int32_t BisquareWeights(const FitData& data, const double* residuals, double* deviations, double* weights,
                               double* scale) {
    double center;
    if (const int32_t status = Median(residuals, data.n, &center)) return status;
    double widest = 0.0;
    for (int32_t i = 0; i < data.n; ++i) {
        deviations[i] = std::fabs(residuals[i] - center);
        widest = std::max(widest, deviations[i]);
    }
    if (widest <= std::fabs(center))
        std::transform(residuals, residuals + data.n, deviations, [](double r) { return std::fabs(r); });
    if (const int32_t status = Median(deviations, data.n, scale)) return status;
    if (*scale == 0.0)
        if (const int32_t status = Mean(deviations, data.n, scale)) return status;
    if (*scale == 0.0) return kOk;
    const double unit = 0.6745 / (*scale * 4.685);
    for (int32_t i = 0; i < data.n; ++i) {
        const double u = unit * residuals[i];
        const double inside = 1.0 - u * u;
        weights[i] = (std::fabs(u) < 1.0 ? inside * inside : 0.0) * WeightOf(data, i);
    }
    return kOk;
}

// Every coefficient has moved by more than the tolerance.
template <int32_t k>
bool AllMoved(const double* previous, const double* coef, double tol) {
    for (int32_t j = 0; j < k; ++j)
        if (!(std::fabs(previous[j]) * tol < std::fabs(previous[j] - coef[j]))) return false;
    return true;
}

// `steps` is the budget on entry, of which one pass is made in any case, and the passes made on return. The residue is
// the mean square error with the caller's weights.
template <class Fitter>
int32_t BisquareFit(const Fitter& fitter, const FitData& data, const double* init, double tol, double* coef,
                    int32_t* steps, double* best_fit, double* residue) {
    constexpr int32_t k = kCoefficientsOf<Fitter>;
    constexpr bool kIsLine = std::is_same_v<Fitter, LineFitter>;
    const std::size_t n = Count(data.n);
    const bool exact = kIsLine && data.n == 2;
    if (exact) {
        LineThroughBoth(data, coef);
    } else if (const int32_t status = fitter.Fit(data, init, -1.0, Fitter::kBudgets.bisquare_start, coef)) {
        return status;
    }
    Scratch<double> work(4 * n);
    if (!work) return kOutOfMemory;
    double* const factors = work.data();
    double* const residuals = factors + n;
    double* const deviations = residuals + n;
    double* const weights = deviations + n;

    double previous[k];
    std::transform(coef, coef + k, previous, [](double p) { return p + 100000.0; });
    int32_t t = 0;
    while (!exact && (t == 0 || (t < *steps && AllMoved<k>(previous, coef, RelativeTolerance(tol))))) {
        std::copy_n(coef, k, previous);
        if (t == 0 || !kIsLine)  // the leverages of a line do not depend on it
            if (const int32_t status = LeverageFactors(fitter.model, data, coef, factors)) return status;
        for (int32_t i = 0; i < data.n; ++i)
            residuals[i] = (data.y[i] - fitter.model.Value(coef, data.x[i])) * factors[i];
        double scale;
        if (const int32_t status = BisquareWeights(data, residuals, deviations, weights, &scale)) return status;
        if (scale == 0.0) break;
        const int32_t status = fitter.Fit({data.x, data.y, weights, data.n}, nullptr, Fitter::kBudgets.bisquare_tol,
                                          Fitter::kBudgets.bisquare_refit, coef);
        if (status != kOk) return status;
        ++t;
    }
    *steps = t;
    if (best_fit == nullptr || residue == nullptr) return kOk;
    double* const values = residuals;
    EvaluateModel(fitter.model, coef, data.x, data.n, values);
    if (const int32_t status = FitMeanSquareError(data.y, values, data.w, data.n, residue)) return status;
    std::copy_n(values, n, best_fit);
    return kOk;
}

// ---- Least absolute residuals ----

// Mean of the magnitudes of the weighted residuals.
inline double FitMeanAbsResidual(const double* fit, const double* y, const double* w, int32_t n) {
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) sum += std::fabs(w != nullptr ? (y[i] - fit[i]) * w[i] : y[i] - fit[i]);
    return sum / n;
}

// Coefficients with their mean absolute residual.
template <int32_t k>
struct AbsoluteRecord {
    double coef[k];
    double residue;
};

// The three fits that a search for the least absolute residuals remembers.
template <int32_t k>
struct AbsoluteSearch {
    AbsoluteRecord<k> current;
    AbsoluteRecord<k> previous;
    AbsoluteRecord<k> preliminary;

    // Before the first step the previous fit is a stand-in of twice the residue.
    void Start() {
        preliminary = previous = current;
        for (double& p : previous.coef) p += 100000.0;
        previous.residue *= 2.0;
    }
    bool Settled(double tol, double floor) const {
        return std::fabs(previous.residue - current.residue) <= previous.residue * tol || current.residue <= floor ||
               previous.residue <= current.residue;
    }
    // The least residue; the preliminary fit among equals, then the previous one. One that is NaN is never the least.
    const AbsoluteRecord<k>& Least() const {
        const auto* least = &preliminary;
        for (const auto* record : {&previous, &current})
            if (record->residue < least->residue || (std::isnan(least->residue) && !std::isnan(record->residue)))
                least = record;
        return *least;
    }
};

inline int32_t SaturatingMultiply(int32_t a, int32_t b) {
    using Limits = std::numeric_limits<int32_t>;
    return static_cast<int32_t>(std::clamp<int64_t>(int64_t{a} * b, Limits::min(), Limits::max()));
}

// Least squares with weights that are the inverses of the residuals, again and again (E. J. Schlossmacher, J. Amer.
// Statist. Assoc. 68, 857, 1973). `steps` is the budget on entry and the steps made on return.
template <class Fitter>
int32_t LeastAbsoluteFit(const Fitter& fitter, const FitData& data, const double* init, double tol, double msetol,
                         double* coef, int32_t* steps, double* best_fit, double* residue) {
    constexpr int32_t k = kCoefficientsOf<Fitter>;
    const std::size_t n = Count(data.n);
    const int32_t budget = *steps;
    AbsoluteSearch<k> search;
    auto& [current, residual] = search.current;
    if (const int32_t status =
            fitter.Fit(data, init, tol, SaturatingMultiply(budget, Fitter::kBudgets.absolute_start), current))
        return status;
    Scratch<double> work(2 * n);
    if (!work) return kOutOfMemory;
    double* const values = work.data();
    double* const weights = values + n;
    EvaluateModel(fitter.start_model, current, data.x, data.n, values);
    residual = FitMeanAbsResidual(values, data.y, data.w, data.n);
    search.Start();

    EvaluateModel(fitter.model, current, data.x, data.n, values);
    int32_t t = 0;
    while (t < budget && !search.Settled(RelativeTolerance(tol), SquaredErrorFloor(msetol))) {
        search.previous = search.current;
        for (int32_t i = 0; i < data.n; ++i) weights[i] = std::fabs(data.y[i] - values[i]);
        double smallest;
        if (const int32_t status = Median(weights, data.n, &smallest)) return status;
        smallest *= 0.01;
        if (smallest == 0.0) smallest = 1e-7;
        for (int32_t i = 0; i < data.n; ++i) weights[i] = WeightOf(data, i) / std::max(smallest, weights[i]);
        const int32_t status = fitter.Fit({data.x, data.y, weights, data.n}, search.previous.coef, tol,
                                          SaturatingMultiply(budget, Fitter::kBudgets.absolute_refit), current);
        if (status != kOk) return status;
        EvaluateModel(fitter.model, current, data.x, data.n, values);
        residual = FitMeanAbsResidual(values, data.y, data.w, data.n);
        ++t;
    }
    *steps = t;
    const auto& least = search.Least();
    std::copy_n(least.coef, k, coef);
    if (best_fit == nullptr || residue == nullptr) return kOk;
    EvaluateModel(fitter.model, coef, data.x, data.n, best_fit);
    *residue = least.residue;
    return kOk;
}

// The same for a straight line, by weighted medians of slopes through the intercept and of intercepts in turn. The
// search may settle short of the least residue. kFewerThanTwo, kTableTooSmall where more than one x is 0, kOutOfMemory.
int32_t LeastAbsoluteLine(const FitData& data, double tol, double msetol, double* coef, int32_t* steps,
                          double* best_fit, double* residue);

}  // namespace krnumer
