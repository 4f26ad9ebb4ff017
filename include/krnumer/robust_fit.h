/*
 * Curves that outliers do not spoil: lines, exponentials, powers, logarithms and Gaussian peaks, by bisquare weights
 * (names in Bi) or by least absolute residuals (names in LAR). Both compute weights for the points and make the plain
 * fit again with them.
 *
 * Bisquare fits adjust the residuals by the leverage of their points and take r in units of u = 4.685 s / 0.6745, s the
 * median of the deviations from the median: a point has the weight (1 - (r/u)^2)^2, or none beyond u (A. E. Beaton and
 * J. W. Tukey, Technometrics 16, 147, 1974). One pass is always made; passes end when a coefficient has settled.
 *
 * Fits by least absolute residuals weigh a point by the inverse of its residual, but not of one below a hundredth of
 * the median residual (E. J. Schlossmacher, J. Amer. Statist. Assoc. 68, 857, 1973). Of the last fit, the one before
 * and the preliminary one the best stands.
 *
 * What all of them share:
 *
 *   y         ordinates, 1-D double; the fitted values on return, unless only coefficients are wanted
 *   x         abscissas, as many
 *   w         weights, as many, which count by magnitude and times the computed ones; or empty
 *   tol       relative change that is settled, bisquare of a coefficient, least absolute of the residue; 0.0001 where
 *             it is not above 0
 *   init      start values of the preliminary fit in the order of the coefficients; empty, or not finite, for the fit's
 *             own. Another length gives the warning 20010: a shorter array is ignored, of a longer one the first values
 *             count
 *   residue   bisquare: mean square error with the caller's weights; least absolute: mean of |w (y - f)|. Not written
 *             by a call that succeeds with coefficients alone
 *   iter      on entry the most passes, on return those made
 *   msetol    mean square error that is good enough, and residue for least absolute; 1e-12 where it is not above 0
 *   coefOnly  not 0 for coefficients alone
 *
 * A failure makes the scalars NaN, leaves `iter`, and empties y unless only coefficients are wanted. Statuses of all:
 * 0; -20002 when the arrays differ in length; -20006 for fewer than two points; -20068 for data that are not finite;
 * -20062 when singular values do not converge; -20104 for residuals that are NaN; -20001 without memory.
 */
#ifndef KRNUMER_ROBUST_FIT_H
#define KRNUMER_ROBUST_FIT_H

#include <krnumer/types.h>

/**
 * Exponential, y = a exp(b x), by bisquare weights around ExpFit80_head.
 *
 * The preliminary fit has a budget of 100, the others one of 50.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas
 * @param[in]     w         weights, or empty
 * @param[in]     tol       see above
 * @param[in]     init      a and b to start from, or empty
 * @param[in]     method    0 for lines through the logarithms, 1 to iterate each fit; its low 16 bits count
 * @param[out]    a         amplitude
 * @param[out]    b         rate, 1 / unit of x
 * @param[out]    residue   mean square error
 * @param[in,out] iter      passes
 * @param[in]     msetol    see above
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones; 20010 for the length of `init`; -20061 for another `method`; -20037 when
 *                          fewer than two points have the prevailing sign of y
 */
KRNUMER_API int32_t BiExpFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, int32_t method,
                                  double* a, double* b, double* residue, int32_t* iter, double msetol,
                                  int32_t coefOnly);

/**
 * Power of x, y = a x^b, by bisquare weights around PowerFit_head.
 *
 * The preliminary fit has a budget of 100, the others one of 50.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas, above 0
 * @param[in]     w         weights, or empty
 * @param[in]     tol       see above
 * @param[in]     init      a and b to start from, or empty
 * @param[out]    a         amplitude
 * @param[out]    b         exponent
 * @param[out]    residue   mean square error
 * @param[in,out] iter      passes
 * @param[in]     msetol    see above
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones; 20010 for the length of `init`; -20140 for an x that is not above 0; -20037
 *                          when fewer than two points have the prevailing sign of y
 */
KRNUMER_API int32_t BiPowerFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a, double* b,
                                    double* residue, int32_t* iter, double msetol, int32_t coefOnly);

/**
 * Gaussian peak, y = a exp(-((x - mu) / sigma)^2 / 2), by bisquare weights around GaussianPeakFit_head.
 *
 * The preliminary fit has a budget of 500, the others one of 300 with a tolerance of 1e-8.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas
 * @param[in]     w         weights, or empty
 * @param[in]     tol       see above
 * @param[in]     init      a, mu and sigma to start from, or empty
 * @param[out]    a         height
 * @param[out]    mu        centre, unit of x
 * @param[out]    sigma     standard deviation, unit of x
 * @param[out]    residue   mean square error
 * @param[in,out] iter      passes
 * @param[in]     msetol    see above
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones, with -20007 for fewer than three points in place of -20006; 20010 for the
 *                          length of `init`; -20026 for a sigma of 0 at the start
 */
KRNUMER_API int32_t BiGaussFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a,
                                    double* mu, double* sigma, double* residue, int32_t* iter, double msetol,
                                    int32_t coefOnly);

/**
 * Straight line, y = slope x + intercept, by bisquare weights around LinFit_head.
 *
 * Two points have the line through both, without a pass.
 *
 * @param[in,out] y          ordinates; the fitted values on return
 * @param[in]     x          abscissas
 * @param[in]     w          weights, or empty
 * @param[in]     tol        see above
 * @param[out]    slope      slope
 * @param[out]    intercept  intercept
 * @param[out]    residue    mean square error
 * @param[in,out] iter       passes
 * @param[in]     coefOnly   not 0 for coefficients alone
 * @return                   the common ones
 */
KRNUMER_API int32_t BiLinearFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, double* slope, double* intercept,
                                     double* residue, int32_t* iter, int32_t coefOnly);

/**
 * Logarithm of x to a base, y = a log(b x), by bisquare weights around LogFit_head.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas, all above 0 or all below
 * @param[in]     w         weights, or empty
 * @param[in]     base      base of the logarithm, above 0; 2.71828, in exactly these digits, stands for e
 * @param[in]     tol       see above
 * @param[out]    a         amplitude
 * @param[out]    b         scale, 1 / unit of x
 * @param[out]    residue   mean square error
 * @param[in,out] iter      passes
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones; -20140 for a `base` that is not above 0, before the number of points;
 *                          -20036 where x does not have one sign
 */
KRNUMER_API int32_t BiLogFit_head(KrHandle y, KrHandle x, KrHandle w, double base, double tol, double* a, double* b,
                                  double* residue, int32_t* iter, int32_t coefOnly);

/**
 * Exponential, y = a exp(b x), by least absolute residuals around ExpFit80_head.
 *
 * Each fit has the budget `iter` of its own.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas
 * @param[in]     w         weights, or empty
 * @param[in]     tol       see above
 * @param[in]     init      a and b to start from, or empty
 * @param[in]     method    0 for lines through the logarithms, 1 to iterate each fit; its low 16 bits count
 * @param[out]    a         amplitude
 * @param[out]    b         rate, 1 / unit of x
 * @param[out]    residue   mean absolute residual
 * @param[in,out] iter      passes
 * @param[in]     msetol    see above
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones; 20010 for the length of `init`; -20061 for another `method`; -20037 when
 *                          fewer than two points have the prevailing sign of y
 */
KRNUMER_API int32_t LARExpFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, int32_t method,
                                   double* a, double* b, double* residue, int32_t* iter, double msetol,
                                   int32_t coefOnly);

/**
 * Power of x, y = a x^b, by least absolute residuals around PowerFit_head.
 *
 * Each fit has the budget `iter` of its own.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas, above 0
 * @param[in]     w         weights, or empty
 * @param[in]     tol       see above
 * @param[in]     init      a and b to start from, or empty
 * @param[out]    a         amplitude
 * @param[out]    b         exponent
 * @param[out]    residue   mean absolute residual
 * @param[in,out] iter      passes
 * @param[in]     msetol    see above
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones; 20010 for the length of `init`; -20140 for an x that is not above 0; -20037
 *                          when fewer than two points have the prevailing sign of y
 */
KRNUMER_API int32_t LARPowerFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a,
                                     double* b, double* residue, int32_t* iter, double msetol, int32_t coefOnly);

/**
 * Gaussian peak, y = a exp(-((x - mu) / sigma)^2 / 2), by least absolute residuals around GaussianPeakFit_head.
 *
 * The preliminary fit has 10 times the budget `iter`, the others 5 times. The first residue is that of the curve a
 * exp(-z^2), without the half, so that a perfect preliminary fit is tried again.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas
 * @param[in]     w         weights, or empty
 * @param[in]     tol       see above
 * @param[in]     init      a, mu and sigma to start from, or empty
 * @param[out]    a         height
 * @param[out]    mu        centre, unit of x
 * @param[out]    sigma     standard deviation, unit of x
 * @param[out]    residue   mean absolute residual
 * @param[in,out] iter      passes
 * @param[in]     msetol    see above
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones, with -20007 for fewer than three points in place of -20006; 20010 for the
 *                          length of `init`; -20026 for a sigma of 0 at the start
 */
KRNUMER_API int32_t LARGaussFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, KrHandle init, double* a,
                                     double* mu, double* sigma, double* residue, int32_t* iter, double msetol,
                                     int32_t coefOnly);

/**
 * Straight line, y = slope x + intercept, by least absolute residuals.
 *
 * The slope is the median of the slopes through the intercept, weighted by |w x|, and the intercept the median of y -
 * slope x, weighted by |w|, in turn. They may settle short of the least residue. Two points have the line through both,
 * without a step and with a residue of 1 by convention. Ordinates that are NaN go through to the results.
 *
 * @param[in,out] y          ordinates; the fitted values on return
 * @param[in]     x          abscissas
 * @param[in]     w          weights, or empty
 * @param[in]     tol        see above
 * @param[out]    slope      slope
 * @param[out]    intercept  intercept
 * @param[out]    residue    mean absolute residual
 * @param[in,out] iter       passes
 * @param[in]     msetol     see above
 * @param[in]     coefOnly   not 0 for coefficients alone
 * @return                   the common ones; -20055 where more than one x is 0
 */
KRNUMER_API int32_t LARLinearFit_head(KrHandle y, KrHandle x, KrHandle w, double tol, double* slope, double* intercept,
                                      double* residue, int32_t* iter, double msetol, int32_t coefOnly);

/**
 * Logarithm of x to a base, y = a log(b x), by least absolute residuals around LogFit_head.
 *
 * @param[in,out] y         ordinates; the fitted values on return
 * @param[in]     x         abscissas, all above 0 or all below
 * @param[in]     w         weights, or empty
 * @param[in]     base      base of the logarithm, above 0; 2.71828, in exactly these digits, stands for e
 * @param[in]     tol       see above
 * @param[out]    a         amplitude
 * @param[out]    b         scale, 1 / unit of x
 * @param[out]    residue   mean absolute residual
 * @param[in,out] iter      passes
 * @param[in]     msetol    see above
 * @param[in]     coefOnly  not 0 for coefficients alone
 * @return                  the common ones; -20140 for a `base` that is not above 0, before the number of points;
 *                          -20036 where x does not have one sign
 */
KRNUMER_API int32_t LARLogFit_head(KrHandle y, KrHandle x, KrHandle w, double base, double tol, double* a, double* b,
                                   double* residue, int32_t* iter, double msetol, int32_t coefOnly);

#endif
