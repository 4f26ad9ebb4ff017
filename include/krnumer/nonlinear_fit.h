/*
 * Curves by least squares: exponential, power, logarithmic and Gaussian.
 *
 * Data are 1-D arrays of double. Weights count by their magnitude, and an empty array means none. A mean square error
 * is the sum of the weighted squared differences over the number of points; a squared difference of fit f and datum y
 * is formed as (f - 2y) f + y y. A failure empties y where the fitted values replace it, makes the scalars NaN and
 * leaves `iter`.
 *
 * What iterated fits share:
 *
 *   tol     relative change of the mean square error at which the fit has settled; 0.0001 where it is not above 0
 *   init    start values, 1-D, in the order of the coefficients. An empty array, or values that are not finite, leave
 *           the start to the fit. Another length is a warning: a shorter array is ignored, of a longer one the first
 *           values are used
 *   iter    on entry the budget, of which N allows N + 1 steps and a negative one none; on return the steps made
 *   msetol  mean square error that is good enough; 1e-12 where it is not above 0
 */
#ifndef KRNUMER_NONLINEAR_FIT_H
#define KRNUMER_NONLINEAR_FIT_H

#include <krnumer/types.h>

/**
 * Exponential, y = a exp(b x), by a straight line through the logarithms of the ordinates with the weights y^2.
 *
 * Points whose sign is not the prevailing one, and zeros, are left out; without a majority the sign is positive.
 *
 * @param[in,out] y      ordinates; the fitted values on return
 * @param[in]     x      abscissas
 * @param[in]     sigma  standard deviations of the ordinates, or empty; 0 stands for a weight of 1
 * @param[out]    a      amplitude
 * @param[out]    b      rate, 1 / unit of x
 * @param[out]    mse    mean square error
 * @return               0; -20002 when the arrays differ in length; -20006 for fewer than two points; -20037 for fewer
 *                       than two points of the sign; -20068 for data that are not finite; -20062 when the singular
 *                       values do not converge; -20001 without memory
 */
KRNUMER_API int32_t ExpFit_head(KrHandle y, KrHandle x, KrHandle sigma, double* a, double* b, double* mse);

/**
 * Exponential, y = a exp(b x), by undamped Gauss-Newton steps from the fit of ExpFit_head or from start values.
 *
 * Of all steps the best one stands. Beyond a tenth of the budget a step that makes the fit worse is the last.
 *
 * @param[in,out] y       ordinates; the fitted values on return
 * @param[in]     x       abscissas
 * @param[in]     w       weights, or empty
 * @param[in]     tol     see above
 * @param[in]     init    a and b to start from, see above
 * @param[in]     method  0 for the straight line through the logarithms alone, which leaves `iter`; 1 to iterate. Its
 *                        low 16 bits count
 * @param[out]    a       amplitude
 * @param[out]    b       rate, 1 / unit of x
 * @param[out]    mse     mean square error
 * @param[in,out] iter    see above
 * @param[in]     msetol  see above
 * @return                0; 20010 when `init` has another length; -20061 for another `method`; and the codes of
 *                        ExpFit_head
 */
KRNUMER_API int32_t ExpFit80_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, int32_t method,
                                  double* a, double* b, double* mse, int32_t* iter, double msetol);

/**
 * Coefficients of ExpFit_head, without standard deviations.
 *
 * @param[in]  y  ordinates
 * @param[in]  x  abscissas
 * @param[out] a  amplitude
 * @param[out] b  rate
 * @return        the codes of ExpFit_head
 */
KRNUMER_API int32_t ExpFitCoef_head(KrHandle y, KrHandle x, double* a, double* b);

/**
 * Coefficients of ExpFit80_head.
 *
 * @param[in]     y       ordinates
 * @param[in]     x       abscissas
 * @param[in]     w       weights, or empty
 * @param[in]     method  0 or 1, in its low 16 bits
 * @param[in]     tol     see above
 * @param[in]     init    a and b to start from
 * @param[out]    a       amplitude
 * @param[out]    b       rate
 * @param[in,out] iter    see above
 * @param[in]     msetol  see above
 * @return                the codes of ExpFit80_head
 */
KRNUMER_API int32_t ExpFitCoef80_head(KrHandle y, KrHandle x, KrHandle w, int32_t method, double tol, KrHandle init,
                                      double* a, double* b, int32_t* iter, double msetol);

/**
 * Power of x, y = a x^b, iterated as ExpFit80_head from the straight line through the logarithms of both.
 *
 * @param[in,out] y       ordinates; the fitted values on return
 * @param[in]     x       abscissas, above 0
 * @param[in]     w       weights, or empty
 * @param[in]     tol     see above
 * @param[in]     init    a and b to start from, see above
 * @param[out]    a       amplitude
 * @param[out]    b       exponent
 * @param[out]    mse     mean square error
 * @param[in,out] iter    see above
 * @param[in]     msetol  see above
 * @return                0; 20010 when `init` has another length; -20140 for an x that is not above 0; and the codes of
 *                        ExpFit_head
 */
KRNUMER_API int32_t PowerFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* b,
                                  double* mse, int32_t* iter, double msetol);

/**
 * Coefficients of PowerFit_head.
 *
 * @param[in]     y       ordinates
 * @param[in]     x       abscissas, above 0
 * @param[in]     w       weights, or empty
 * @param[in]     tol     see above
 * @param[in]     init    a and b to start from
 * @param[out]    a       amplitude
 * @param[out]    b       exponent
 * @param[in,out] iter    see above
 * @param[in]     msetol  see above
 * @return                the codes of PowerFit_head
 */
KRNUMER_API int32_t PowerFitCoef_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a,
                                      double* b, int32_t* iter, double msetol);

/**
 * Logarithm of x to a base, y = a log(b x), as a straight line in log |x|.
 *
 * Where a is exactly 0, b is 1 with the sign of x, and the fitted values are 0.
 *
 * @param[in,out] y     ordinates; the fitted values on return
 * @param[in]     x     abscissas, all above 0 or all below
 * @param[in]     w     weights, or empty
 * @param[in]     base  base of the logarithm, above 0; 2.71828, in exactly these digits, stands for e
 * @param[out]    a     amplitude
 * @param[out]    b     scale, 1 / unit of x
 * @param[out]    mse   mean square error
 * @return              0; -20002 when the arrays differ in length; -20140 for a `base` that is not above 0; -20006 for
 *                      fewer than two points; -20036 where x does not have one sign; -20001 without memory
 */
KRNUMER_API int32_t LogFit_head(KrHandle y, KrHandle x, KrHandle w, double base, double* a, double* b, double* mse);

/**
 * Coefficients of LogFit_head.
 *
 * @param[in]  y     ordinates
 * @param[in]  x     abscissas, all above 0 or all below
 * @param[in]  w     weights, or empty
 * @param[in]  base  base of the logarithm
 * @param[out] a     amplitude
 * @param[out] b     scale
 * @return           the codes of LogFit_head
 */
KRNUMER_API int32_t LogFitCoef_head(KrHandle y, KrHandle x, KrHandle w, double base, double* a, double* b);

/**
 * Gaussian peak, y = a exp(-((x - mu) / sigma)^2 / 2), by steps along the gradient.
 *
 * It starts at the largest ordinate, with the width of the points above a tenth of it. A step that makes the fit worse
 * is undone and halved, and so are all that follow. The mean square error is tested against that of the step before,
 * and at the start against one more than itself: data whose fit starts above 1 / tol stay at the start. The method is
 * slow; budgets of hundreds are in place. Should the last step have been undone, `mse` is still its own.
 *
 * @param[in,out] y       ordinates; the fitted values on return
 * @param[in]     x       abscissas
 * @param[in]     w       weights, or empty
 * @param[in]     tol     see above
 * @param[in]     init    a, mu and sigma to start from, see above
 * @param[out]    a       height
 * @param[out]    mu      centre, unit of x
 * @param[out]    sigma   standard deviation, unit of x, not negative
 * @param[out]    mse     mean square error
 * @param[in,out] iter    see above
 * @param[in]     msetol  see above
 * @return                0; 20010 when `init` has another length; -20002 when the arrays differ in length; -20007 for
 *                        fewer than three points; -20068 for abscissas that are not finite; -20026 for a sigma of 0 at
 *                        the start; -20001 without memory
 */
KRNUMER_API int32_t GaussianPeakFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a,
                                         double* mu, double* sigma, double* mse, int32_t* iter, double msetol);

/**
 * Coefficients of GaussianPeakFit_head.
 *
 * @param[in]     y       ordinates
 * @param[in]     x       abscissas
 * @param[in]     w       weights, or empty
 * @param[in]     tol     see above
 * @param[in]     init    a, mu and sigma to start from
 * @param[out]    a       height
 * @param[out]    mu      centre
 * @param[out]    sigma   standard deviation
 * @param[in,out] iter    see above
 * @param[in]     msetol  see above
 * @return                the codes of GaussianPeakFit_head
 */
KRNUMER_API int32_t GaussianPeakFitCoef_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a,
                                             double* mu, double* sigma, int32_t* iter, double msetol);

#endif
