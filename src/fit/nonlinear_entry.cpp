#include "fit/fit_call.h"
#include "fit/nonlinear.h"
#include "krnumer/nonlinear_fit.h"

using namespace krnumer;

// ---- Exponential ----

namespace {

// The older exponential fits are those of the logarithms.
constexpr Iteration kNotIterated{-1.0, 1e-10, nullptr, 0};

}  // namespace

int32_t ExpFit_head(KrHandle y, KrHandle x, KrHandle sigma, double* a, double* b, double* mse) {
    FitCall<2> fit({.y = y, .x = x, .w = sigma, .deviations = true}, {a, b}, mse);
    return fit.Run([&](const FitData& data, const double*, double* coef, double* best_fit, double* error) {
        return ExpFitCore(data, kLogLinear, kNotIterated, coef, nullptr, best_fit, error);
    });
}

int32_t ExpFitCoef_head(KrHandle y, KrHandle x, double* a, double* b) {
    FitCall<2> fit({.y = y, .x = x}, {a, b});
    return fit.Run([&](const FitData& data, const double*, double* coef, double* best_fit, double* error) {
        return ExpFitCore(data, kLogLinear, kNotIterated, coef, nullptr, best_fit, error);
    });
}

int32_t ExpFit80_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, int32_t method, double* a,
                      double* b, double* mse, int32_t* iter, double msetol) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b}, mse);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return ExpFitCore(data, Low16Bits(method), {tol, msetol, start, *iter}, coef, iter, best_fit, error);
    });
}

int32_t ExpFitCoef80_head(KrHandle y, KrHandle x, KrHandle w, int32_t method, double tol, KrHandle init, double* a,
                          double* b, int32_t* iter, double msetol) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b});
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return ExpFitCore(data, Low16Bits(method), {tol, msetol, start, *iter}, coef, iter, best_fit, error);
    });
}

// ---- Power ----

int32_t PowerFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* b, double* mse,
                      int32_t* iter, double msetol) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b}, mse);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return PowerFitCore(data, {tol, msetol, start, *iter}, coef, iter, best_fit, error);
    });
}

int32_t PowerFitCoef_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* b,
                          int32_t* iter, double msetol) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b});
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return PowerFitCore(data, {tol, msetol, start, *iter}, coef, iter, best_fit, error);
    });
}

// ---- Logarithmic ----

int32_t LogFit_head(KrHandle y, KrHandle x, KrHandle w, double base, double* a, double* b, double* mse) {
    FitCall<2> fit({.y = y, .x = x, .w = w}, {a, b}, mse);
    return fit.Run([&](const FitData& data, const double*, double* coef, double* best_fit, double* error) {
        return LogFitCore(data, base, coef, best_fit, error);
    });
}

int32_t LogFitCoef_head(KrHandle y, KrHandle x, KrHandle w, double base, double* a, double* b) {
    FitCall<2> fit({.y = y, .x = x, .w = w}, {a, b});
    return fit.Run([&](const FitData& data, const double*, double* coef, double* best_fit, double* error) {
        return LogFitCore(data, base, coef, best_fit, error);
    });
}

// ---- Gaussian ----

int32_t GaussianPeakFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* mu,
                             double* sigma, double* mse, int32_t* iter, double msetol) {
    FitCall<3> fit({.y = y, .x = x, .w = w, .init = init}, {a, mu, sigma}, mse);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return GaussFitCore(data, {tol, msetol, start, *iter}, coef, iter, best_fit, error);
    });
}

int32_t GaussianPeakFitCoef_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* mu,
                                 double* sigma, int32_t* iter, double msetol) {
    FitCall<3> fit({.y = y, .x = x, .w = w, .init = init}, {a, mu, sigma});
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return GaussFitCore(data, {tol, msetol, start, *iter}, coef, iter, best_fit, error);
    });
}
