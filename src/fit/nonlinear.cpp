#include "fit/nonlinear.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "fit/least_squares.h"
#include "fit/line.h"
#include "fit/residual.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/finite.h"

namespace krnumer {

namespace {

// Steps are counted wide, since one more is made than the budget says.
int32_t ReportedSteps(int64_t steps) {
    return static_cast<int32_t>(std::min<int64_t>(steps, std::numeric_limits<int32_t>::max()));
}

// ---- Exponential and power ----

struct GaussNewtonWork {
    int32_t Allocate(int32_t n) {
        if (!block.Allocate(4 * Count(n))) return kOutOfMemory;
        rows = block.data();
        right = rows + 2 * Count(n);
        values = right + Count(n);
        return kOk;
    }

    Scratch<double> block;
    double* rows = nullptr;  // n by 2
    double* right = nullptr;
    double* values = nullptr;
};

// The sign that most ordinates have; the fit is to their magnitudes.
double PrevailingSign(const FitData& data) {
    int32_t positive = 0;
    int32_t negative = 0;
    for (int32_t i = 0; i < data.n; ++i) {
        positive += data.y[i] > 0.0;
        negative += data.y[i] < 0.0;
    }
    return positive >= negative ? 1.0 : -1.0;
}

// Straight line through the logarithms of the ordinates of that sign. The weight y^2 makes up for what the logarithm
// does to the errors.
template <class Model>
int32_t FitLogarithms(const FitData& data, double sign, GaussNewtonWork& work, double* coef) {
    double* const weights = work.values;
    int32_t m = 0;
    for (int32_t i = 0; i < data.n; ++i) {
        const double y = data.y[i];
        if (!(sign * y > 0.0)) continue;
        work.rows[2 * Count(m)] = 1.0;
        work.rows[2 * Count(m) + 1] = Model::Abscissa(data.x[i]);
        work.right[m] = std::log(sign * y);
        weights[m] = data.w != nullptr ? std::fabs(y * data.w[i] * y) : y * y;
        ++m;
    }
    const int32_t status =
        GenLSFitCore(work.rows, m, 2, work.right, weights, coef, nullptr, nullptr, nullptr, kSvdMethod);
    if (status != kOk) return status;
    coef[0] = sign * std::exp(coef[0]);
    return kOk;
}

template <class Model>
int32_t Iterate(const Model& model, const FitData& data, const Iteration& how, GaussNewtonWork& work, double* coef,
                int32_t* steps) {
    const double tol = RelativeTolerance(how.tol);
    const double floor = SquaredErrorFloor(how.msetol);
    const auto error = [&](double* e) {
        EvaluateModel(model, coef, data.x, data.n, work.values);
        return FitMeanSquareError(data.y, work.values, data.w, data.n, e);
    };
    double e;
    if (const int32_t status = error(&e)) return status;
    double best[2] = {coef[0], coef[1]};
    double least = e;
    double previous = 2.0 * e;
    int64_t t = 0;
    while (t <= how.budget) {
        if (previous * tol >= std::fabs(previous - e) || e <= floor) break;
        previous = e;
        for (int32_t i = 0; i < data.n; ++i) {
            model.Gradient(coef, data.x[i], work.rows + 2 * Count(i));
            work.right[i] = data.y[i] - work.values[i];
        }
        double step[2];
        const int32_t status =
            GenLSFitCore(work.rows, data.n, 2, work.right, data.w, step, nullptr, nullptr, nullptr, kSvdMethod);
        if (status != kOk) return status;
        for (int j = 0; j < 2; ++j) coef[j] += step[j];
        if (const int32_t failure = error(&e)) return failure;
        ++t;
        if (!std::isfinite(e)) break;
        if (t > how.budget / 10 && e > previous && e > least) break;
        if (e < least) {
            least = e;
            std::copy_n(coef, 2, best);
        }
    }
    std::copy_n(best, 2, coef);
    *steps = ReportedSteps(t);
    return kOk;
}

template <class Model>
int32_t FitAmplitude(const Model& model, const FitData& data, int32_t method, const Iteration& how, double* coef,
                     int32_t* steps, double* best_fit, double* mse) {
    const double sign = PrevailingSign(data);
    GaussNewtonWork work;
    if (const int32_t status = work.Allocate(data.n)) return status;
    if (method == kGaussNewton && how.init != nullptr && CheckFiniteArray(how.init, 2) == 0) {
        std::copy_n(how.init, 2, coef);
    } else if (const int32_t status = FitLogarithms<Model>(data, sign, work, coef)) {
        return status;
    }
    if (method == kGaussNewton)
        if (const int32_t status = Iterate(model, data, how, work, coef, steps)) return status;
    if (best_fit != nullptr && mse != nullptr) BestFit(model, data, coef, best_fit, mse);
    return kOk;
}

// ---- Logarithmic ----

// The sign that all abscissas have; 0 where they differ, or one of them has none.
double CommonSign(const FitData& data) {
    const auto all = [&](auto test) { return std::all_of(data.x, data.x + data.n, test); };
    if (all([](double x) { return x > 0.0; })) return 1.0;
    return all([](double x) { return x < 0.0; }) ? -1.0 : 0.0;
}

// ---- Gaussian ----

// The peak is the largest ordinate. The width comes from the points above a tenth of it, each of which would give
// sigma^2 = (x - mu)^2 / ln((a/y)^2) on its own.
void EstimatePeak(const FitData& data, double* coef) {
    int32_t peak = 0;
    for (int32_t i = 1; i < data.n; ++i)
        if (std::fabs(data.y[i]) > std::fabs(data.y[peak])) peak = i;
    const double a = coef[0] = data.y[peak];
    const double mu = coef[1] = data.x[peak];
    double logarithms = 0.0;
    double squares = 0.0;
    for (int32_t i = 0; i < data.n; ++i) {
        const double y = data.y[i];
        if (y == 0.0 || !(std::fabs(y) > 0.1 * std::fabs(a))) continue;
        logarithms += std::log((a / y) * (a / y));
        squares += (data.x[i] - mu) * (data.x[i] - mu);
    }
    coef[2] = std::sqrt(squares / logarithms);
}

// The direction of ascent, which is -n/2 times the gradient of the mean square error.
void Direction(const FitData& data, const double* coef, double* direction) {
    const double a = coef[0];
    const double sigma = coef[2];
    std::fill_n(direction, 3, 0.0);
    for (int32_t i = 0; i < data.n; ++i) {
        const double off = data.x[i] - coef[1];
        const double z = off / sigma;
        const double shape = std::exp(-0.5 * z * z);
        const double weight = data.w != nullptr ? std::fabs(data.w[i]) : 1.0;
        const double r = (data.y[i] - a * shape) * weight;
        const double d = off * shape * a / (sigma * sigma);
        direction[0] += r * shape;
        direction[1] += r * d;
        direction[2] += r * d * off / sigma;
    }
}

bool AllNaN(const double* coef) {
    return std::isnan(coef[0]) && std::isnan(coef[1]) && std::isnan(coef[2]);
}

// Leaves the mean square error of the last candidate in `e`, also where that was rejected.
int32_t Descend(const FitData& data, const Iteration& how, double* coef, double* e, int32_t* steps) {
    const double tol = RelativeTolerance(how.tol);
    const double floor = SquaredErrorFloor(how.msetol);
    Scratch<double> values(Count(data.n));
    if (!values) return kOutOfMemory;
    const auto error = [&](const double* at) {
        EvaluateModel(GaussianModel{}, at, data.x, data.n, values.data());
        return FitMeanSquareError(data.y, values.data(), data.w, data.n, e);
    };
    if (const int32_t status = error(coef)) return status;
    const double start[3] = {coef[0], coef[1], coef[2]};
    const double start_error = *e;
    double direction[3] = {};
    double previous = *e + 1.0;
    double h = 1.0;
    bool moved = true;
    int64_t t = 0;
    while (t <= how.budget) {
        if (std::fabs(previous - *e) <= previous * tol || *e <= floor) break;
        if (moved) {
            previous = *e;
            Direction(data, coef, direction);
        }
        double candidate[3];
        for (int j = 0; j < 3; ++j) candidate[j] = coef[j] + h * direction[j];
        if (const int32_t status = error(candidate)) return status;
        moved = !(*e > previous);
        if (moved) {
            std::copy_n(candidate, 3, coef);
        } else {
            h /= 2.0;
        }
        ++t;
        if (std::isnan(*e) && std::isnan(previous) && AllNaN(coef)) t = int64_t{how.budget} + 1;  // for good
    }
    if (start_error <= *e && start_error <= previous) {
        std::copy_n(start, 3, coef);
        *e = start_error;
    }
    coef[2] = std::fabs(coef[2]);
    *steps = ReportedSteps(t);
    return kOk;
}

}  // namespace

int32_t ExpFitCore(const FitData& data, int32_t method, const Iteration& how, double* coef, int32_t* steps,
                   double* best_fit, double* mse) {
    if (data.n < 2) return kFewerThanTwo;
    if (method != kLogLinear && method != kGaussNewton) return kBadSelector;
    return FitAmplitude(ExponentialModel{}, data, method, how, coef, steps, best_fit, mse);
}

int32_t PowerFitCore(const FitData& data, const Iteration& how, double* coef, int32_t* steps, double* best_fit,
                     double* mse) {
    if (data.n < 2) return kFewerThanTwo;
    for (int32_t i = 0; i < data.n; ++i)
        if (!(data.x[i] > 0.0)) return kNotPositive;
    return FitAmplitude(PowerModel{}, data, kGaussNewton, how, coef, steps, best_fit, mse);
}

int32_t LogFitCore(const FitData& data, double base, double* coef, double* best_fit, double* mse) {
    if (!(base > 0.0)) return kNotPositive;
    if (data.n < 2) return kFewerThanTwo;
    const double sign = CommonSign(data);
    if (sign == 0.0) return kMixedSigns;
    Scratch<double> logarithms(Count(data.n));
    if (!logarithms) return kOutOfMemory;
    const LogModel model(base);
    for (int32_t i = 0; i < data.n; ++i) logarithms[Count(i)] = LogOfBase(sign * data.x[i], base, model.ln_base);
    double intercept;
    const int32_t status =
        LinFitCore(logarithms.data(), data.y, data.n, data.w, nullptr, &coef[0], &intercept, nullptr);
    if (status != kOk) return status;
    coef[1] = coef[0] != 0.0 ? sign * PowerOfBase(base, intercept / coef[0]) : sign;
    if (best_fit != nullptr && mse != nullptr) BestFit(model, data, coef, best_fit, mse);
    return kOk;
}

int32_t GaussFitCore(const FitData& data, const Iteration& how, double* coef, int32_t* steps, double* best_fit,
                     double* mse) {
    if (data.n < 3) return kFewerThanThree;
    if (CheckFiniteArray(data.x, Count(data.n)) != 0) return kNotFinite;
    if (how.init != nullptr && CheckFiniteArray(how.init, 3) == 0) {
        std::copy_n(how.init, 3, coef);
    } else {
        EstimatePeak(data, coef);
    }
    if (coef[2] == 0.0) return kZeroSigma;
    double error;
    if (const int32_t status = Descend(data, how, coef, &error, steps)) return status;
    if (best_fit == nullptr || mse == nullptr) return kOk;
    EvaluateModel(GaussianModel{}, coef, data.x, data.n, best_fit);
    *mse = error;
    return kOk;
}

}  // namespace krnumer
