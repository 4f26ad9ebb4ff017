/*
 * Distributions: lower-tail probabilities of the normal, t, chi-square and F distributions, and their inverses.
 *
 * All arguments are scalars and come by pointer. The normal pair are short approximations, the other probabilities
 * stand on the incomplete beta and gamma functions. Their inverses are bisections of a fixed interval: the result is
 * the lower end of the last one, within 1e-4 below the quantile of the probability as it is computed, however small the
 * quantile is.
 */
#ifndef KRNUMER_DISTRIBUTIONS_H
#define KRNUMER_DISTRIBUTIONS_H

#include <krnumer/types.h>

/**
 * Probability that a standard normal variable is at most x, by a polynomial of three terms with an absolute error below
 * 1.2e-5 (Abramowitz and Stegun, Handbook of Mathematical Functions, 1964, 26.2.16).
 *
 * At 0 it is 0.50000015555. The error is absolute, so tails below 1e-5 carry no information.
 *
 * @param[in]  x  quantile; NaN gives NaN
 * @param[out] p  lower-tail probability
 * @return        0; there is no status
 */
KRNUMER_API int32_t NormDist_head(const double* x, double* p);

/**
 * Probability that a t variable with `df` degrees of freedom is at most t.
 *
 * 1 - I_w(df / 2, 1 / 2) / 2 with w = df / (df + t^2) for t >= 0, its complement below. Error 1e-12 of
 * the smaller tail (1e-15 absolute for df = 2) for df up to 1000, 1e-9 at 1e6; above 1e8 about 1e-7. Towards t = 0, as
 * w rounds to 1, the error grows like 2e-17 df / |t|, to at most 3e-9 sqrt(df).
 *
 * @param[in]  t    quantile
 * @param[in]  df   degrees of freedom, from 1 on
 * @param[out] p    lower-tail probability, exactly 0.5 at t = 0; NaN on failure
 * @param[out] err  status: 0; -20052 when `df` is less than 1; -20104 when `t` is NaN
 * @return          0
 */
KRNUMER_API int32_t TDist_head(const double* t, const int32_t* df, double* p, int32_t* err);

/**
 * Probability that a chi-square variable with `df` degrees of freedom is at most x: P(df / 2, x / 2), P the regularised
 * lower incomplete gamma function. Relative error as that of P.
 *
 * @param[in]  x    quantile; the result is 0 for x <= 0 and for NaN
 * @param[in]  df   degrees of freedom, from 0 on; 0 gives NaN for x > 0
 * @param[out] p    lower-tail probability; NaN on failure
 * @param[out] err  status: 0, or -20052 when `df` is negative
 * @return          0
 */
KRNUMER_API int32_t ChiSquare_head(const double* x, const int32_t* df, double* p, int32_t* err);

/**
 * Probability that an F variable with n and m degrees of freedom is at most f: 1 - I_w(m / 2, n / 2) with
 * w = m / (n f + m), so the error is absolute: 1e-12 for n and m up to 1000, 1e-11 up to 30000. Where both are larger,
 * the continued fraction of I is cut short, with an error of 3e-6 at 1e5 and 2e-2 at 1e6. For n = 1 the error near
 * f = 0 is twice that of TDist_head at t = sqrt(f).
 *
 * @param[in]  f    quantile; the result is 0 for f <= 0
 * @param[in]  n    degrees of freedom of the numerator, from 1 on
 * @param[in]  m    degrees of freedom of the denominator, from 1 on
 * @param[out] p    lower-tail probability; NaN on failure
 * @param[out] err  status: 0; -20052 when `n` or `m` is less than 1; -20104 when `f` is NaN
 * @return          0
 */
KRNUMER_API int32_t FDist_head(const double* f, const int32_t* n, const int32_t* m, double* p, int32_t* err);

/**
 * Quantile of the standard normal distribution by a rational approximation with an absolute error below 4.5e-4
 * (Abramowitz and Stegun, 26.2.23).
 *
 * @param[in]  p    probability, 0 to 1; below about 7.46e-155, 0 excepted, the result is NaN with status 0
 * @param[out] x    quantile, -infinity for 0 and +infinity for 1; NaN on failure
 * @param[out] err  status: 0, or -20053 when `p` is outside 0 to 1 or NaN
 * @return          0
 */
KRNUMER_API int32_t InvNdist_head(const double* p, double* x, int32_t* err);

/**
 * Quantile of the t distribution by bisection of -10000 to 10000. Quantiles beyond report the end of the interval.
 *
 * @param[in]  p    probability, 0 to 1
 * @param[in]  df   degrees of freedom, from 1 on
 * @param[out] t    quantile, within 1e-4 below; -infinity for 0 and +infinity for 1; NaN on failure
 * @param[out] err  status: 0; -20052 when `df` is less than 1; -20053 when `p` is outside 0 to 1 or NaN. `df` is looked
 *                  at first
 * @return          0
 */
KRNUMER_API int32_t InvTdist_head(const double* p, const int32_t* df, double* t, int32_t* err);

/**
 * Quantile of the chi-square distribution by bisection of 0 to the first multiple of 5000 that is above it.
 *
 * Degrees of freedom near 2^31 take some 400000 multiples.
 *
 * @param[in]  p    probability, 0 to 1
 * @param[in]  df   degrees of freedom, from 1 on
 * @param[out] x    quantile, within 1e-4 below; 0 for 0 and +infinity for 1; NaN on failure
 * @param[out] err  status: 0; -20053 when `p` is outside 0 to 1 or NaN; -20052 when `df` is less than 1. `p` is looked
 *                  at first
 * @return          0
 */
KRNUMER_API int32_t InvChiSquare_head(const double* p, const int32_t* df, double* x, int32_t* err);

/**
 * Quantile of the F distribution by bisection of 1e-6 to 10000. Quantiles beyond report the end of the interval.
 *
 * @param[in]  p    probability, 0 to 1
 * @param[in]  n    degrees of freedom of the numerator, from 1 on
 * @param[in]  m    degrees of freedom of the denominator, from 1 on
 * @param[out] f    quantile, within 1e-4 below; 0 for 0 and +infinity for 1; NaN on failure
 * @param[out] err  status: 0; -20052 when `n` or `m` is less than 1; -20053 when `p` is outside 0 to 1 or NaN. `n` and
 *                  `m` are looked at first
 * @return          0
 */
KRNUMER_API int32_t InvFDist_head(const double* p, const int32_t* n, const int32_t* m, double* f, int32_t* err);

#endif
