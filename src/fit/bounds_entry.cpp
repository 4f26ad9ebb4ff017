#include "fit/bounds.h"

#include <cstring>

#include "fit/weights.h"
#include "frame/entry.h"
#include "krnumer/fit_bounds.h"

using namespace krnumer;

namespace {

// The data of a band.
struct BandInputs {
    BandInputs(Call& call, KrHandle y_in, KrHandle x_in, KrHandle w_in) : y(call, y_in), x(call, x_in), w(call, w_in) {}

    template <class Model>
    int32_t Check() const {
        if (const int32_t status = Band<Model>::CheckCount(y.size())) return status;
        if (x.size() != y.size() || !WeightsFit(w, y.size())) return kSizesDiffer;
        return kOk;
    }
    FitData data() const { return {x.data(), y.data(), OptionalWeights(w), y.size()}; }

    In<double> y;
    In<double> x;
    In<double> w;
};

struct ConfidenceOutputs {
    KrHandle upper;
    KrHandle lower;
    KrHandle upper_coef;
    KrHandle lower_coef;
};

template <class Model, size_t k>
int32_t Confidence(const Model& model, KrHandle y, KrHandle x, KrHandle w, const double (&coef)[k], double level,
                   const ConfidenceOutputs& outputs, double* const (&targets)[k]) {
    double half_widths[k] = {};  // what a failure leaves is 0, not NaN
    const auto run = [&] {
        ByValue call;
        const BandInputs inputs(call, y, x, w);
        Out<double> upper(call, outputs.upper);
        Out<double> lower(call, outputs.lower);
        Out<double> upper_coef(call, outputs.upper_coef);
        Out<double> lower_coef(call, outputs.lower_coef);
        if (const int32_t status = inputs.Check<Model>()) return call.Fail(status);
        const int32_t n = inputs.y.size();
        const auto count = static_cast<int32_t>(k);
        if (upper.Resize(n) || lower.Resize(n) || upper_coef.Resize(count) || lower_coef.Resize(count))
            return call.Fail(kOutOfMemory);
        return call.Run([&] {
            return ConfidenceBand(model, inputs.data(), coef, level, upper.data(), lower.data(), upper_coef.data(),
                                  lower_coef.data(), half_widths);
        });
    };
    const int32_t status = run();
    for (size_t j = 0; j < k; ++j) std::memcpy(targets[j], &half_widths[j], sizeof(double));
    return status;
}

template <class Model, size_t k>
int32_t Prediction(const Model& model, KrHandle y, KrHandle x, KrHandle w, const double (&coef)[k], double level,
                   KrHandle upper, KrHandle lower) {
    ByValue call;
    const BandInputs inputs(call, y, x, w);
    Out<double> above(call, upper);
    Out<double> below(call, lower);
    if (const int32_t status = inputs.Check<Model>()) return call.Fail(status);
    const int32_t n = inputs.y.size();
    if (above.Resize(n) || below.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return PredictionBand(model, inputs.data(), coef, level, above.data(), below.data()); });
}

}  // namespace

// ---- Of the curve ----

int32_t ConfBndLinear_head(KrHandle y, KrHandle x, KrHandle w, double slope, double intercept, double c, KrHandle upper,
                           KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dSlope, double* dIntercept) {
    return Confidence(LineModel{}, y, x, w, {slope, intercept}, c, {upper, lower, upperCoef, lowerCoef},
                      {dSlope, dIntercept});
}

int32_t ConfBndExp_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                        KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dA, double* dB) {
    return Confidence(ExponentialModel{}, y, x, w, {a, b}, c, {upper, lower, upperCoef, lowerCoef}, {dA, dB});
}

int32_t ConfBndPower_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                          KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dA, double* dB) {
    return Confidence(PowerModel{}, y, x, w, {a, b}, c, {upper, lower, upperCoef, lowerCoef}, {dA, dB});
}

int32_t ConfBndLog_head(KrHandle y, KrHandle x, KrHandle w, double base, double a, double b, double c, KrHandle upper,
                        KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dA, double* dB) {
    return Confidence(LogModel(base), y, x, w, {a, b}, c, {upper, lower, upperCoef, lowerCoef}, {dA, dB});
}

int32_t ConfBndGauss_head(KrHandle y, KrHandle x, KrHandle w, double a, double mu, double sigma, double c,
                          KrHandle upper, KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dA,
                          double* dMu, double* dSigma) {
    return Confidence(GaussianModel{}, y, x, w, {a, mu, sigma}, c, {upper, lower, upperCoef, lowerCoef},
                      {dA, dMu, dSigma});
}

// ---- Of an observation ----

int32_t PredBndLinear_head(KrHandle y, KrHandle x, KrHandle w, double slope, double intercept, double c, KrHandle upper,
                           KrHandle lower) {
    return Prediction(LineModel{}, y, x, w, {slope, intercept}, c, upper, lower);
}

int32_t PredBndExp_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                        KrHandle lower) {
    return Prediction(ExponentialModel{}, y, x, w, {a, b}, c, upper, lower);
}

int32_t PredBndPower_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                          KrHandle lower) {
    return Prediction(PowerModel{}, y, x, w, {a, b}, c, upper, lower);
}

int32_t PredBndLog_head(KrHandle y, KrHandle x, KrHandle w, double base, double a, double b, double c, KrHandle upper,
                        KrHandle lower) {
    return Prediction(LogModel(base), y, x, w, {a, b}, c, upper, lower);
}

int32_t PredBndGauss_head(KrHandle y, KrHandle x, KrHandle w, double a, double mu, double sigma, double c,
                          KrHandle upper, KrHandle lower) {
    return Prediction(GaussianModel{}, y, x, w, {a, mu, sigma}, c, upper, lower);
}

// ---- Goodness ----

int32_t GoodnessOfFit_head(KrHandle y, KrHandle fit, KrHandle w, int32_t dof, double* sse, double* rSquare,
                           double* rmse) {
    ByValue call;
    In<double> ordinates(call, y);
    In<double> fitted(call, fit);
    In<double> weights(call, w);
    Result<double> errors(call, sse);
    Result<double> explained(call, rSquare);
    Result<double> deviation(call, rmse);
    const int32_t n = ordinates.size();
    if (n < 1) return call.Fail(kEmptyInput);
    if (fitted.size() != n || !WeightsFit(weights, n)) return call.Fail(kSizesDiffer);
    return call.Run([&] {
        return GoodnessOfFit(ordinates.data(), fitted.data(), OptionalWeights(weights), n, dof, errors.data(),
                             explained.data(), deviation.data());
    });
}
