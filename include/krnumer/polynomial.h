/*
 * Polynomials: values, roots and greatest common divisors.
 *
 * Coefficients are 1-D arrays that run from the constant up: c[k] multiplies x^k.
 */
#ifndef KRNUMER_POLYNOMIAL_H
#define KRNUMER_POLYNOMIAL_H

#include <krnumer/types.h>

/**
 * Values of a polynomial, summed from the low powers up with a running power. This is not Horner's rule: infinities and
 * underflow show elsewhere.
 *
 * @param[in,out] x     arguments, 1-D double; the values on return, emptied on failure
 * @param[in]     coef  coefficients, 1-D double
 * @param[out]    err   status: 0, or -20003 when `x` or `coef` is empty
 * @return              0
 */
KRNUMER_API int32_t PolyEv(KrHandle x, KrHandle coef, int32_t* err);

/** PolyEv of a 2-D array. */
KRNUMER_API int32_t EvPoly2D(KrHandle x, KrHandle coef, int32_t* err);

/**
 * Roots of a real polynomial near the caller's guesses: real ones by Newton's method, pairs by Bairstow's (L. Bairstow,
 * Applied Aerodynamics, 1920).
 *
 * Newton's method returns the point of least |p| that it met; a step more than five times the last is refused and the
 * last one repeated. Bairstow's method refines a quadratic factor from two guesses, until both its coefficients change
 * by less than `pairTol` relative; a step whose changes are not smaller than those of the step before (0.1 before the
 * first, as a rule) is taken back and ends it, so guesses that are far off come back as they were. Polynomials of
 * degree 2 and below leave pairs as they are.
 *
 * @param[in]  coef           coefficients, 1-D double
 * @param[in]  newtonGuesses  guesses of real roots, 1-D double, or empty
 * @param[in]  newtonLimit    most steps for each
 * @param[in]  newtonTol      least relative step
 * @param[in]  pairGuesses    guesses of pairs, 1-D complex double, two in a row, or empty; an odd last one is its own
 *                            partner and counts once
 * @param[in]  pairLimit      most steps for each pair
 * @param[in]  pairTol        least relative change of the factor
 * @param[out] roots          1-D complex double, one for each guess: Newton's roots, the real roots of pairs, the
 *                            complex ones; emptied by anything but 0
 * @return                    0; the warning 20002 when `coef` is empty; -20001 without memory or when `roots` cannot be
 *                            sized
 */
KRNUMER_API int32_t PolyRootsNtBst_head(KrHandle coef, KrHandle newtonGuesses, int32_t newtonLimit, double newtonTol,
                                        KrHandle pairGuesses, int32_t pairLimit, double pairTol, KrHandle roots);

/**
 * All roots of a complex polynomial without guesses (K. Madsen, BIT 13, 71, 1973): one after the other by Newton's
 * method with a search along the step, each divided out before the next.
 *
 * @param[in,out] coef   coefficients, 1-D complex double; on return one element less: the roots in the order in which
 *                       they were found, those at 0 first. Zeros in the place of the highest coefficients give fewer
 *                       roots, and zeros behind them. Emptied on failure
 * @param[in]     limit  how often the step towards a root may be turned in a row before the search is given up; 20 for
 *                       simple roots, 50 where roots are multiple
 * @param[out]    err    status: 0; -20003 when `coef` is empty; -20063 for a coefficient that is not finite, and when
 *                       nothing but a constant is left; -20062 without convergence, also when a root is beyond the
 *                       range of doubles; -20001 without memory
 * @return               0
 */
KRNUMER_API int32_t CxPolyRoots_head(KrHandle coef, const int32_t* limit, int32_t* err);

/**
 * Distinct roots of a real polynomial and their multiplicities (Z. Zeng, Math. Comp. 74, 869, 2005): a multiple root is
 * one root and not a cluster.
 *
 * A chain of approximate greatest common divisors gives the distinct roots and their multiplicities; with `distinct`, a
 * Gauss-Newton iteration that holds the multiplicities improves the roots. Where the multiplicities do not sum to the
 * degree, or the iteration does not converge, the last list becomes the eigenvalues of the companion matrix, of which
 * only those that are equal to the last bit count as one root.
 *
 * @param[in,out] coef           coefficients, 1-D double; zeros in the place of the highest ones are left out. Kept on
 *                               success, emptied on failure
 * @param[in]     distinct       0 to leave out the second stage
 * @param[in]     tol            residual below which a divisor is accepted, and 1/100 of the limit of its singular
 *                               value; not positive for 1e-10
 * @param[out]    roots          1-D complex double: the distinct roots of the first stage, the root 0 last
 * @param[out]    distinctRoots  1-D complex double: the roots of the second stage by descending modulus, the root 0
 *                               last; empty without it
 * @param[out]    mult           1-D int32: multiplicities of `distinctRoots`, or without the second stage of `roots`
 * @return                       0; -20003 when `coef` is empty; -20063 for a coefficient that is not finite, as it
 *                               comes or over the highest one; -20111 when all are 0; -20021 for a constant; -20062
 *                               when eigenvalues or singular values do not converge; -20068 when extreme coefficients
 *                               overflow on the way; -20001 without memory or when an output cannot be sized. All
 *                               arrays are emptied by a failure
 */
KRNUMER_API int32_t MultPolyRoots_head(KrHandle coef, int32_t distinct, double tol, KrHandle roots,
                                       KrHandle distinctRoots, KrHandle mult);

/** MultPolyRoots_head of a complex polynomial. */
KRNUMER_API int32_t CxMultPolyRoots_head(KrHandle coef, int32_t distinct, double tol, KrHandle roots,
                                         KrHandle distinctRoots, KrHandle mult);

/**
 * Approximate greatest common divisor of two polynomials, from the singular values of Sylvester matrices (R. M. Corless
 * et al., ISSAC 1995, 195).
 *
 * Zeros in the place of the highest coefficients are left out. The divisor and the cofactors have the highest
 * coefficient 1.
 *
 * @param[in]  p              coefficients, 1-D double
 * @param[in]  q              coefficients, 1-D double
 * @param[in]  tol            a divisor is seen where the least singular value of a matrix of c columns is below sqrt(c)
 *                            tol; not positive for 1e-8
 * @param[out] gcd            the divisor, 1 for polynomials without a common root
 * @param[out] pCofactor      p over the divisor; touched only where `wantCofactors` is 1, or by a failure
 * @param[out] qCofactor      q over the divisor, likewise
 * @param[in]  wantCofactors  1 for the cofactors
 * @return                    0; -20003 when `p` or `q` is empty; -20063 for a coefficient that is not finite, as it
 *                            comes or over the highest one; -20111 when one polynomial is 0; -20062 when the singular
 *                            values do not converge; -20001 without memory or when an output cannot be sized. All
 *                            outputs are emptied by a failure
 */
KRNUMER_API int32_t PolyGCD_H(KrHandle p, KrHandle q, double tol, KrHandle gcd, KrHandle pCofactor, KrHandle qCofactor,
                              int32_t wantCofactors);

/** PolyGCD_H of complex polynomials. */
KRNUMER_API int32_t CxPolyGCD_H(KrHandle p, KrHandle q, double tol, KrHandle gcd, KrHandle pCofactor,
                                KrHandle qCofactor, int32_t wantCofactors);

#endif
