/*
 * Linear least squares: lines, polynomials, general linear models, and one step of a non-linear fit.
 *
 * Data are 1-D arrays of double. Weights count by their magnitude, and an empty array means none. A mean square error
 * is the sum of the weighted squared differences over the number of points, not over the sum of the weights; a squared
 * difference of fit f and datum y is formed as (f - 2y) f + y y. A failure empties the output arrays and makes the
 * scalars NaN.
 *
 * Methods: 0 singular values, all but those that are 0; 1, 2, 3 QR factorisation, one code under three names; 4 LU and
 * 5 Cholesky factorisation of the normal equations, which square the condition number; 6 singular values above m eps
 * times the largest. Only 0 and 6 take rank-deficient data.
 */
#ifndef KRNUMER_LINEAR_FIT_H
#define KRNUMER_LINEAR_FIT_H

#include <krnumer/types.h>

/**
 * Straight line, y = slope x + intercept, in closed form.
 *
 * Equal abscissas give infinities or NaN with status 0, and so do weights that are all 0.
 *
 * @param[in,out] y          ordinates; the fitted values on return, emptied on failure
 * @param[in]     x          abscissas
 * @param[in]     w          weights, or empty
 * @param[out]    slope      slope
 * @param[out]    intercept  intercept
 * @param[out]    mse        mean square error
 * @return                   0; -20002 when the arrays differ in length; -20006 for fewer than two points; -20001
 *                           without memory
 */
KRNUMER_API int32_t LinFit_head(KrHandle y, KrHandle x, KrHandle w, double* slope, double* intercept, double* mse);

/**
 * Coefficients of the straight line of LinFit_head, without weights.
 *
 * @param[in]  y          ordinates
 * @param[in]  x          abscissas
 * @param[out] slope      slope
 * @param[out] intercept  intercept
 * @param[out] err        status: that of LinFit_head
 * @return                0
 */
KRNUMER_API int32_t LinFitCoef_head(KrHandle y, KrHandle x, double* slope, double* intercept, int32_t* err);

/**
 * Coefficients of the straight line of LinFit_head.
 *
 * @param[in]  y          ordinates
 * @param[in]  x          abscissas
 * @param[in]  w          weights, or empty
 * @param[out] slope      slope
 * @param[out] intercept  intercept
 * @param[out] err        status: that of LinFit_head
 * @return                0
 */
KRNUMER_API int32_t LinFitCoef80_head(KrHandle y, KrHandle x, KrHandle w, double* slope, double* intercept,
                                      int32_t* err);

/**
 * Polynomial, coef[0] + coef[1] x + ... + coef[order] x^order.
 *
 * @param[in]  x        abscissas
 * @param[in]  y        ordinates
 * @param[in]  order    order, from 0 on and below the number of points
 * @param[in]  method   0 to 6, see above
 * @param[out] bestFit  fitted values
 * @param[out] coef     coefficients, the constant first
 * @param[out] mse      mean square error
 * @return              0; -20002 when the arrays differ in length; -20103 when `order` is negative; -20037 when it is
 *                      not below the number of points; -20061 for another `method`; -20041 when the system is singular
 *                      (methods 1 to 5); -20071 when the normal equations are not positive definite (5); -20062 when
 *                      the singular values do not converge (0, 6); -20068 for data that are not finite (0, 5, 6);
 *                      -20001 without memory or when an output cannot be sized
 */
KRNUMER_API int32_t PolyFit_head(KrHandle x, KrHandle y, int32_t order, int32_t method, KrHandle bestFit, KrHandle coef,
                                 double* mse);

/**
 * Polynomial of which the caller fixes some coefficients.
 *
 * @param[in]  x            abscissas
 * @param[in]  y            ordinates
 * @param[in]  order        order, from 0 on
 * @param[in]  method       0 to 6, not looked at where all coefficients are fixed
 * @param[in]  fixedPowers  powers whose coefficients are fixed, 1-D int32; of a power listed twice the last value
 *                          counts, one out of range is skipped
 * @param[in]  fixedValues  the coefficients of these powers
 * @param[out] bestFit      fitted values
 * @param[out] coef         coefficients, the constant first
 * @param[out] mse          mean square error
 * @return                  0; -20002 when x and y, or the two lists, differ in length; -20103 when `order` is negative;
 *                          -20037 unless there are more points than `order` less the length of the lists, or than free
 *                          coefficients; -20003 without points; and the codes of PolyFit_head
 */
KRNUMER_API int32_t PolyFit80_head(KrHandle x, KrHandle y, int32_t order, int32_t method, KrHandle fixedPowers,
                                   KrHandle fixedValues, KrHandle bestFit, KrHandle coef, double* mse);

/**
 * PolyFit80_head with weights.
 *
 * @param[in]  x            abscissas
 * @param[in]  y            ordinates
 * @param[in]  order        order, from 0 on
 * @param[in]  w            weights, or empty
 * @param[in]  method       0 to 6
 * @param[in]  fixedPowers  powers whose coefficients are fixed, 1-D int32
 * @param[in]  fixedValues  the coefficients of these powers
 * @param[out] bestFit      fitted values
 * @param[out] coef         coefficients, the constant first
 * @param[out] mse          mean square error
 * @return                  0; -20002 also when `w` has another length; and the codes of PolyFit80_head
 */
KRNUMER_API int32_t PolyFit81_head(KrHandle x, KrHandle y, int32_t order, KrHandle w, int32_t method,
                                   KrHandle fixedPowers, KrHandle fixedValues, KrHandle bestFit, KrHandle coef,
                                   double* mse);

/**
 * General linear model, y = H c, with the standard deviations of the ordinates.
 *
 * @param[in]  h               observations, 2-D, a row for each ordinate and a column for each of the k functions
 * @param[in]  y               ordinates
 * @param[in]  sigma           standard deviations, or empty; at least as many as rows, of which the first count; 0
 *                             stands for a weight of 1
 * @param[in]  method          0 to 6, see above
 * @param[in]  wantCovariance  not 0 for the covariance matrix
 * @param[out] coef            coefficients
 * @param[out] bestFit         fitted values
 * @param[out] covariance      (H' W H)^-1 as a pseudo-inverse, 2-D of k by k; 0 by 0 when it is not wanted. Scaling by
 *                             the variance of the residuals is the caller's
 * @param[out] mse             mean square error
 * @return                     0; -20002 when `y` or `sigma` does not match the rows; -20001 without memory or when an
 *                             output cannot be sized; -20021 without columns; -20037 for fewer rows than columns;
 *                             -20061 for another `method`; and the codes of the solvers under PolyFit_head
 */
KRNUMER_API int32_t GenLSFit_head(KrHandle h, KrHandle y, KrHandle sigma, int32_t method, int32_t wantCovariance,
                                  KrHandle coef, KrHandle bestFit, KrHandle covariance, double* mse);

/** GenLSFit_head with the weights of the rows, `w`, in place of standard deviations. */
KRNUMER_API int32_t GenLSFit80_head(KrHandle h, KrHandle y, KrHandle w, int32_t method, int32_t wantCovariance,
                                    KrHandle coef, KrHandle bestFit, KrHandle covariance, double* mse);

/**
 * One step of Levenberg and Marquardt (D. W. Marquardt, J. SIAM 11, 431, 1963): adds to the coefficients the solution d
 * of hessian' d = gradient, the diagonal of hessian' being 1 + lambda times that of the hessian.
 *
 * @param[in,out] coef      coefficients, k of them; emptied on failure
 * @param[in]     hessian   2-D, k by k
 * @param[in]     gradient  1-D, k of them
 * @param[in]     lambda    damping
 * @param[out]    err       status: 0, also for a rank-deficient hessian; -20003 when the sizes do not match; -20068 for
 *                          data that are not finite; -20041 when a new coefficient is NaN; -20062 when the singular
 *                          values do not converge; -20001 without memory
 * @return                  0
 */
KRNUMER_API int32_t GetNewCoef_head(KrHandle coef, KrHandle hessian, KrHandle gradient, const double* lambda,
                                    int32_t* err);

#endif
