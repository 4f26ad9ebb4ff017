#include "fit/fit_call.h"
#include "fit/robust.h"
#include "krnumer/robust_fit.h"

using namespace krnumer;

// ---- Bisquare weights ----

int32_t BiExpFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, int32_t method, double* a,
                      double* b, double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return BisquareFit(ExponentialFitter{Low16Bits(method), msetol}, data, start, tol, coef, iter, best_fit, error);
    });
}

int32_t BiPowerFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* b,
                        double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return BisquareFit(PowerFitter{msetol}, data, start, tol, coef, iter, best_fit, error);
    });
}

int32_t BiGaussFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* mu,
                        double* sigma, double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<3> fit({.y = y, .x = x, .w = w, .init = init}, {a, mu, sigma}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return BisquareFit(GaussianFitter{msetol}, data, start, tol, coef, iter, best_fit, error);
    });
}

int32_t BiLinearFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, double* slope, double* intercept,
                         double* residue, int32_t* iter, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w}, {slope, intercept}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return BisquareFit(LineFitter{}, data, start, tol, coef, iter, best_fit, error);
    });
}

int32_t BiLogFit_head(KrHandle y, KrHandle x, KrHandle w, double base, double tol, double* a, double* b,
                      double* residue, int32_t* iter, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w}, {a, b}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return BisquareFit(LogFitter(base), data, start, tol, coef, iter, best_fit, error);
    });
}

// ---- Least absolute residuals ----

int32_t LARExpFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, int32_t method, double* a,
                       double* b, double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return LeastAbsoluteFit(ExponentialFitter{Low16Bits(method), msetol}, data, start, tol, msetol, coef, iter,
                                best_fit, error);
    });
}

int32_t LARPowerFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* b,
                         double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w, .init = init}, {a, b}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return LeastAbsoluteFit(PowerFitter{msetol}, data, start, tol, msetol, coef, iter, best_fit, error);
    });
}

int32_t LARGaussFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* mu,
                         double* sigma, double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<3> fit({.y = y, .x = x, .w = w, .init = init}, {a, mu, sigma}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return LeastAbsoluteFit(GaussianFitter{msetol}, data, start, tol, msetol, coef, iter, best_fit, error);
    });
}

int32_t LARLinearFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, double* slope, double* intercept,
                          double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w}, {slope, intercept}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double*, double* coef, double* best_fit, double* error) {
        return LeastAbsoluteLine(data, tol, msetol, coef, iter, best_fit, error);
    });
}

int32_t LARLogFit_head(KrHandle y, KrHandle x, KrHandle w, double base, double tol, double* a, double* b,
                       double* residue, int32_t* iter, double msetol, int32_t coefOnly) {
    FitCall<2> fit({.y = y, .x = x, .w = w}, {a, b}, residue, coefOnly != 0);
    return fit.Run([&](const FitData& data, const double* start, double* coef, double* best_fit, double* error) {
        return LeastAbsoluteFit(LogFitter(base), data, start, tol, msetol, coef, iter, best_fit, error);
    });
}
