#include "fit/least_squares.h"
#include "fit/line.h"
#include "fit/polynomial.h"
#include "fit/weights.h"
#include "frame/entry.h"
#include "krnumer/linear_fit.h"

using namespace krnumer;

// ---- Lines ----

int32_t LinFit_head(KrHandle y, KrHandle x, KrHandle w, double* slope, double* intercept, double* mse) {
    ByValue call;
    InOut<double> ordinates(call, y);
    In<double> abscissas(call, x);
    In<double> weights(call, w);
    Result<double> steepness(call, slope);
    Result<double> offset(call, intercept);
    Result<double> error(call, mse);
    const int32_t n = ordinates.size();
    if (abscissas.size() != n || !WeightsFit(weights, n)) return call.Fail(kSizesDiffer);
    return call.Run([&] {
        return LinFitCore(abscissas.data(), ordinates.data(), n, OptionalWeights(weights), ordinates.data(),
                          steepness.data(), offset.data(), error.data());
    });
}

int32_t LinFitCoef_head(KrHandle y, KrHandle x, double* slope, double* intercept, int32_t* err) {
    ByReference call(err);
    In<double> ordinates(call, y);
    In<double> abscissas(call, x);
    Result<double> steepness(call, slope);
    Result<double> offset(call, intercept);
    if (abscissas.size() != ordinates.size()) return call.Fail(kSizesDiffer);
    return call.Run([&] {
        return LinFitCore(abscissas.data(), ordinates.data(), ordinates.size(), nullptr, nullptr, steepness.data(),
                          offset.data(), nullptr);
    });
}

int32_t LinFitCoef80_head(KrHandle y, KrHandle x, KrHandle w, double* slope, double* intercept, int32_t* err) {
    ByReference call(err);
    In<double> ordinates(call, y);
    In<double> abscissas(call, x);
    In<double> weights(call, w);
    Result<double> steepness(call, slope);
    Result<double> offset(call, intercept);
    const int32_t n = ordinates.size();
    if (abscissas.size() != n || !WeightsFit(weights, n)) return call.Fail(kSizesDiffer);
    return call.Run([&] {
        return LinFitCore(abscissas.data(), ordinates.data(), n, OptionalWeights(weights), nullptr, steepness.data(),
                          offset.data(), nullptr);
    });
}

// ---- Polynomials ----

namespace {

// The data of a polynomial fit; what a generation does not have is null.
struct PolynomialData {
    const In<double>& x;
    const In<double>& y;
    const In<double>* w;
    const In<int32_t>* powers;
    const In<double>* values;
};

int32_t FitPolynomial(Call& call, const PolynomialData& data, int32_t order, int32_t method, Out<double>& fit,
                      Out<double>& coefficients, Result<double>& error) {
    const int32_t n = data.x.size();
    const int32_t fixed = data.powers != nullptr ? data.powers->size() : 0;
    if (data.y.size() != n) return call.Fail(kSizesDiffer);
    if (data.w != nullptr && !WeightsFit(*data.w, n)) return call.Fail(kSizesDiffer);
    if (data.values != nullptr && data.values->size() != fixed) return call.Fail(kSizesDiffer);
    if (order < 0) return call.Fail(kNegativeOrder);
    if (n <= int64_t{order} - fixed) return call.Fail(kUnderdetermined);
    if (fit.Resize(n) || coefficients.Resize(WrappingAdd(order, 1))) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return PolyFitCore(data.x.data(), data.y.data(), data.w != nullptr ? OptionalWeights(*data.w) : nullptr, n,
                           order, method, fixed > 0 ? data.powers->data() : nullptr,
                           fixed > 0 ? data.values->data() : nullptr, fixed, fit.data(), coefficients.data(),
                           error.data());
    });
}

}  // namespace

int32_t PolyFit_head(KrHandle x, KrHandle y, int32_t order, int32_t method, KrHandle bestFit, KrHandle coef,
                     double* mse) {
    ByValue call;
    In<double> abscissas(call, x);
    In<double> ordinates(call, y);
    Out<double> fit(call, bestFit);
    Out<double> coefficients(call, coef);
    Result<double> error(call, mse);
    return FitPolynomial(call, {abscissas, ordinates, nullptr, nullptr, nullptr}, order, method, fit, coefficients,
                         error);
}

int32_t PolyFit80_head(KrHandle x, KrHandle y, int32_t order, int32_t method, KrHandle fixedPowers,
                       KrHandle fixedValues, KrHandle bestFit, KrHandle coef, double* mse) {
    ByValue call;
    In<double> abscissas(call, x);
    In<double> ordinates(call, y);
    In<int32_t> powers(call, fixedPowers);
    In<double> values(call, fixedValues);
    Out<double> fit(call, bestFit);
    Out<double> coefficients(call, coef);
    Result<double> error(call, mse);
    return FitPolynomial(call, {abscissas, ordinates, nullptr, &powers, &values}, order, method, fit, coefficients,
                         error);
}

int32_t PolyFit81_head(KrHandle x, KrHandle y, int32_t order, KrHandle w, int32_t method, KrHandle fixedPowers,
                       KrHandle fixedValues, KrHandle bestFit, KrHandle coef, double* mse) {
    ByValue call;
    In<double> abscissas(call, x);
    In<double> ordinates(call, y);
    In<double> weights(call, w);
    In<int32_t> powers(call, fixedPowers);
    In<double> values(call, fixedValues);
    Out<double> fit(call, bestFit);
    Out<double> coefficients(call, coef);
    Result<double> error(call, mse);
    return FitPolynomial(call, {abscissas, ordinates, &weights, &powers, &values}, order, method, fit, coefficients,
                         error);
}

// ---- General linear models ----

namespace {

enum class RowWeights { kStandardDeviations, kWeights };

int32_t FitGeneral(KrHandle h, KrHandle y, KrHandle w, RowWeights meaning, int32_t method, int32_t want_covariance,
                   KrHandle coef, KrHandle best_fit, KrHandle covariance, double* mse) {
    ByValue call;
    InMatrix<double> observations(call, h);
    In<double> ordinates(call, y);
    In<double> given(call, w);
    Out<double> coefficients(call, coef);
    Out<double> fit(call, best_fit);
    OutMatrix<double> spread(call, covariance);
    Result<double> error(call, mse);
    const int32_t m = observations.rows();
    const int32_t k = observations.columns();
    if (ordinates.size() != m || (given.size() != 0 && given.size() < m)) return call.Fail(kSizesDiffer);
    const int32_t side = want_covariance != 0 ? k : 0;
    if (coefficients.Resize(k) || fit.Resize(m) || spread.Resize(side, side)) return call.Fail(kOutOfMemory);
    return call.Run([&]() -> int32_t {
        const double* weights = OptionalWeights(given);
        Scratch<double> from_deviations;
        if (weights != nullptr && meaning == RowWeights::kStandardDeviations) {
            if (const int32_t status = WeightsOfDeviations(weights, m, &from_deviations)) return status;
            weights = from_deviations.data();
        }
        return GenLSFitCore(observations.data(), m, k, ordinates.data(), weights, coefficients.data(), fit.data(),
                            error.data(), want_covariance != 0 ? spread.data() : nullptr, method);
    });
}

}  // namespace

int32_t GenLSFit_head(KrHandle h, KrHandle y, KrHandle sigma, int32_t method, int32_t wantCovariance, KrHandle coef,
                      KrHandle bestFit, KrHandle covariance, double* mse) {
    return FitGeneral(h, y, sigma, RowWeights::kStandardDeviations, method, wantCovariance, coef, bestFit, covariance,
                      mse);
}

int32_t GenLSFit80_head(KrHandle h, KrHandle y, KrHandle w, int32_t method, int32_t wantCovariance, KrHandle coef,
                        KrHandle bestFit, KrHandle covariance, double* mse) {
    return FitGeneral(h, y, w, RowWeights::kWeights, method, wantCovariance, coef, bestFit, covariance, mse);
}

int32_t GetNewCoef_head(KrHandle coef, KrHandle hessian, KrHandle gradient, const double* lambda, int32_t* err) {
    ByReference call(err);
    InOut<double> coefficients(call, coef);
    InMatrix<double> curvature(call, hessian);
    In<double> slope(call, gradient);
    const int32_t k = coefficients.size();
    if (k < 1 || curvature.rows() != k || curvature.columns() != k || slope.size() != k) return call.Fail(kEmptyInput);
    return call.Run([&] {
        const int32_t status = GetNewCoefCore(curvature.data(), slope.data(), k, *lambda, coefficients.data());
        if (status < 0) return status;
        for (int32_t i = 0; i < k; ++i)
            if (coefficients.data()[i] != coefficients.data()[i]) return kSingular;
        return kOk;  // a rank-deficient hessian has a step, too
    });
}
