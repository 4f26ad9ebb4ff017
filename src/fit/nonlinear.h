// Exponential, power, logarithmic and Gaussian curves by least squares.
//
// Coefficients are in the order of the model's. The fitted values, which may take the place of the ordinates, and their
// mean square error are computed where neither output is null.
#pragma once

#include <cstdint>

#include "fit/model.h"

namespace krnumer {

// How an iterated fit runs. Unusable start values are replaced by the fit's own.
struct Iteration {
    double tol;          // relative change of the mean square error at which it has settled
    double msetol;       // mean square error that is good enough
    const double* init;  // start values, or null
    int32_t budget;      // N allows N + 1 steps, and none where it is negative
};

// The defaults for what callers leave at 0 or below.
inline double RelativeTolerance(double tol) {
    return tol > 0.0 ? tol : 0.0001;
}
inline double SquaredErrorFloor(double msetol) {
    return msetol <= 0.0 ? 1e-12 : msetol;
}

enum ExponentialMethod : int32_t {
    kLogLinear = 0,    // straight line through the logarithms, weighted by y^2
    kGaussNewton = 1,  // iterated from there, or from the start values
};

// a exp(b x) by Gauss-Newton steps without damping; the best of all steps stands. `steps` is written by iterated fits
// only. kFewerThanTwo, kBadSelector, kOutOfMemory, and what GenLSFitCore says.
int32_t ExpFitCore(const FitData& data, int32_t method, const Iteration& how, double* coef, int32_t* steps,
                   double* best_fit, double* mse);

// a x^b in the same way, always iterated. kFewerThanTwo, kNotPositive for an x that is not, kOutOfMemory, and what
// GenLSFitCore says.
int32_t PowerFitCore(const FitData& data, const Iteration& how, double* coef, int32_t* steps, double* best_fit,
                     double* mse);

// a log(b x) to a base, in closed form. A slope of 0 has no offset. kNotPositive for the base, kFewerThanTwo,
// kMixedSigns where the abscissas do not all have one sign, kOutOfMemory.
int32_t LogFitCore(const FitData& data, double base, double* coef, double* best_fit, double* mse);

// a exp(-((x - mu) / sigma)^2 / 2), by steps along the gradient, halved while they lead upwards. kFewerThanThree,
// kNotFinite for x, kZeroSigma at the start, kOutOfMemory.
int32_t GaussFitCore(const FitData& data, const Iteration& how, double* coef, int32_t* steps, double* best_fit,
                     double* mse);

}  // namespace krnumer
