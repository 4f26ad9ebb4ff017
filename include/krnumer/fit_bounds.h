/*
 * Bands around fitted curves, bounds of their coefficients, and the goodness of a fit.
 *
 * Nothing is fitted here: the coefficients are those of a fit of linear_fit.h, nonlinear_fit.h or robust_fit.h. With
 * the derivatives J of the model by its q coefficients at the n points, N = J' |W| J, and s^2 the weighted sum of the
 * squared residuals over n - q, the half-width of the band is
 *
 *     t sqrt(s^2 (J N^-1 J'))              of the curve (confidence, names in ConfBnd)
 *     t sqrt(s^2 (J N^-1 J' + 1 / |w|))    of a new observation (prediction, names in PredBnd)
 *
 * and that of a coefficient t sqrt(s^2 (N^-1)jj), where t is the quantile (1 + c) / 2 of Student's distribution with n
 * - q degrees of freedom as InvTdist_head gives it, up to 1e-4 below the exact one and 10000 at most. This is the band
 * to first order in the errors (G. A. F. Seber and C. J. Wild, Nonlinear Regression, 1989, chapter 5). N is inverted by
 * its singular values; a negative square under a root gives NaN with status 0.
 *
 * What they share:
 *
 *   y, x, w                ordinates, abscissas and weights, 1-D double of n; w may be empty
 *   c                      level of confidence, between 0 and 1
 *   upper, lower           the bands, 1-D double, resized to n
 *   upperCoef, lowerCoef   bounds of the coefficients in the order of the arguments, 1-D double, resized to q
 *   dSlope, dA, ...        half-widths of their intervals
 *
 * A failure empties the arrays and sets the half-widths to 0. Statuses of all bands, in the order of the checks: 0;
 * -20007 for fewer than three points; -20002 when the arrays differ in length; -20001 when an output cannot be sized or
 * without memory; -20140 for a `base` that is not above 0; -20068 for a coefficient that is not finite; -20026 for a
 * `sigma` of 0; -20053 for another `c`; -20068 for derivatives that are not finite; -20062 when the singular values do
 * not converge.
 */
#ifndef KRNUMER_FIT_BOUNDS_H
#define KRNUMER_FIT_BOUNDS_H

#include <krnumer/types.h>

/**
 * Confidence band of the straight line slope x + intercept, and bounds of its coefficients.
 *
 * N is formed with the signs of the weights here, and here alone: weights that are all negative make the half-widths
 * NaN.
 *
 * @param[in]  y           ordinates
 * @param[in]  x           abscissas
 * @param[in]  w           weights, or empty
 * @param[in]  slope       slope
 * @param[in]  intercept   intercept
 * @param[in]  c           level of confidence
 * @param[out] upper       upper end of the band
 * @param[out] lower       lower end
 * @param[out] upperCoef   upper bounds of the coefficients
 * @param[out] lowerCoef   lower bounds
 * @param[out] dSlope      half-width of the interval of slope
 * @param[out] dIntercept  half-width of the interval of intercept
 * @return                 as above
 */
KRNUMER_API int32_t ConfBndLinear_head(KrHandle y, KrHandle x, KrHandle w, double slope, double intercept, double c,
                                       KrHandle upper, KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef,
                                       double* dSlope, double* dIntercept);

/**
 * Confidence band of the exponential a exp(b x), and bounds of its coefficients.
 *
 * @param[in]  y          ordinates
 * @param[in]  x          abscissas
 * @param[in]  w          weights, or empty
 * @param[in]  a          amplitude
 * @param[in]  b          rate
 * @param[in]  c          level of confidence
 * @param[out] upper      upper end of the band
 * @param[out] lower      lower end
 * @param[out] upperCoef  upper bounds of the coefficients
 * @param[out] lowerCoef  lower bounds
 * @param[out] dA         half-width of the interval of a
 * @param[out] dB         half-width of the interval of b
 * @return                as above
 */
KRNUMER_API int32_t ConfBndExp_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                                    KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dA, double* dB);

/**
 * Confidence band of the power a x^b, and bounds of its coefficients.
 *
 * @param[in]  y          ordinates
 * @param[in]  x          abscissas
 * @param[in]  w          weights, or empty
 * @param[in]  a          amplitude
 * @param[in]  b          exponent
 * @param[in]  c          level of confidence
 * @param[out] upper      upper end of the band
 * @param[out] lower      lower end
 * @param[out] upperCoef  upper bounds of the coefficients
 * @param[out] lowerCoef  lower bounds
 * @param[out] dA         half-width of the interval of a
 * @param[out] dB         half-width of the interval of b
 * @return                as above
 */
KRNUMER_API int32_t ConfBndPower_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                                      KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dA, double* dB);

/**
 * Confidence band of the logarithm a log(b x) to a base, and bounds of its coefficients.
 *
 * @param[in]  y          ordinates
 * @param[in]  x          abscissas
 * @param[in]  w          weights, or empty
 * @param[in]  base       base of the logarithm; 2.71828, in exactly these digits, stands for e
 * @param[in]  a          amplitude
 * @param[in]  b          scale
 * @param[in]  c          level of confidence
 * @param[out] upper      upper end of the band
 * @param[out] lower      lower end
 * @param[out] upperCoef  upper bounds of the coefficients
 * @param[out] lowerCoef  lower bounds
 * @param[out] dA         half-width of the interval of a
 * @param[out] dB         half-width of the interval of b
 * @return                as above
 */
KRNUMER_API int32_t ConfBndLog_head(KrHandle y, KrHandle x, KrHandle w, double base, double a, double b, double c,
                                    KrHandle upper, KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef, double* dA,
                                    double* dB);

/**
 * Confidence band of the Gaussian peak a exp(-((x - mu) / sigma)^2 / 2), and bounds of its coefficients.
 *
 * @param[in]  y          ordinates
 * @param[in]  x          abscissas
 * @param[in]  w          weights, or empty
 * @param[in]  a          height
 * @param[in]  mu         centre
 * @param[in]  sigma      standard deviation
 * @param[in]  c          level of confidence
 * @param[out] upper      upper end of the band
 * @param[out] lower      lower end
 * @param[out] upperCoef  upper bounds of the coefficients
 * @param[out] lowerCoef  lower bounds
 * @param[out] dA         half-width of the interval of a
 * @param[out] dMu        half-width of the interval of mu
 * @param[out] dSigma     half-width of the interval of sigma
 * @return                as above, with -20069 for fewer than four points in place of -20007
 */
KRNUMER_API int32_t ConfBndGauss_head(KrHandle y, KrHandle x, KrHandle w, double a, double mu, double sigma, double c,
                                      KrHandle upper, KrHandle lower, KrHandle upperCoef, KrHandle lowerCoef,
                                      double* dA, double* dMu, double* dSigma);

/**
 * Prediction band of the straight line slope x + intercept. Where a weight is 0 it is infinitely wide.
 *
 * @param[in]  y          ordinates
 * @param[in]  x          abscissas
 * @param[in]  w          weights, or empty
 * @param[in]  slope      slope
 * @param[in]  intercept  intercept
 * @param[in]  c          level of confidence
 * @param[out] upper      upper end of the band
 * @param[out] lower      lower end
 * @return                as above
 */
KRNUMER_API int32_t PredBndLinear_head(KrHandle y, KrHandle x, KrHandle w, double slope, double intercept, double c,
                                       KrHandle upper, KrHandle lower);

/**
 * Prediction band of the exponential a exp(b x). Where a weight is 0 it is infinitely wide.
 *
 * @param[in]  y      ordinates
 * @param[in]  x      abscissas
 * @param[in]  w      weights, or empty
 * @param[in]  a      amplitude
 * @param[in]  b      rate
 * @param[in]  c      level of confidence
 * @param[out] upper  upper end of the band
 * @param[out] lower  lower end
 * @return            as above
 */
KRNUMER_API int32_t PredBndExp_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                                    KrHandle lower);

/**
 * Prediction band of the power a x^b. Where a weight is 0 it is infinitely wide.
 *
 * @param[in]  y      ordinates
 * @param[in]  x      abscissas
 * @param[in]  w      weights, or empty
 * @param[in]  a      amplitude
 * @param[in]  b      exponent
 * @param[in]  c      level of confidence
 * @param[out] upper  upper end of the band
 * @param[out] lower  lower end
 * @return            as above
 */
KRNUMER_API int32_t PredBndPower_head(KrHandle y, KrHandle x, KrHandle w, double a, double b, double c, KrHandle upper,
                                      KrHandle lower);

/**
 * Prediction band of the logarithm a log(b x) to a base. Where a weight is 0 it is infinitely wide.
 *
 * @param[in]  y      ordinates
 * @param[in]  x      abscissas
 * @param[in]  w      weights, or empty
 * @param[in]  base   base of the logarithm; 2.71828, in exactly these digits, stands for e
 * @param[in]  a      amplitude
 * @param[in]  b      scale
 * @param[in]  c      level of confidence
 * @param[out] upper  upper end of the band
 * @param[out] lower  lower end
 * @return            as above
 */
KRNUMER_API int32_t PredBndLog_head(KrHandle y, KrHandle x, KrHandle w, double base, double a, double b, double c,
                                    KrHandle upper, KrHandle lower);

/**
 * Prediction band of the Gaussian peak a exp(-((x - mu) / sigma)^2 / 2). Where a weight is 0 it is infinitely wide.
 *
 * @param[in]  y      ordinates
 * @param[in]  x      abscissas
 * @param[in]  w      weights, or empty
 * @param[in]  a      height
 * @param[in]  mu     centre
 * @param[in]  sigma  standard deviation
 * @param[in]  c      level of confidence
 * @param[out] upper  upper end of the band
 * @param[out] lower  lower end
 * @return            as above, with -20069 for fewer than four points in place of -20007
 */
KRNUMER_API int32_t PredBndGauss_head(KrHandle y, KrHandle x, KrHandle w, double a, double mu, double sigma, double c,
                                      KrHandle upper, KrHandle lower);

/**
 * Goodness of a fit.
 *
 * With the fitted values f, SSE is the sum of w (f - y)^2, R^2 = 1 - SSE / SST with SST the sum of w (y - m)^2 about
 * the plain mean m of y, and the root mean square error sqrt(SSE / dof). Weights have their sign. Constant data have
 * R^2 = 1 when SSE is 0, and infinity otherwise. Two points leave no degree of freedom: with dof below 1 the root mean
 * square error is infinite, or NaN when SSE is 0. A failure makes the outputs NaN.
 *
 * @param[in]  y        ordinates
 * @param[in]  fit      fitted values
 * @param[in]  w        weights, or empty
 * @param[in]  dof      degrees of freedom; n - 2 where it is below 1
 * @param[out] sse      sum of squared errors
 * @param[out] rSquare  coefficient of determination
 * @param[out] rmse     root mean square error
 * @return              0; -20003 without data; -20002 when the arrays differ in length; -20006 for a single point;
 *                      -20052 for a `dof` of n or more; -20001 without memory
 */
KRNUMER_API int32_t GoodnessOfFit_head(KrHandle y, KrHandle fit, KrHandle w, int32_t dof, double* sse, double* rSquare,
                                       double* rmse);

#endif
