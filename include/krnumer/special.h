/*
 * Special functions of real arguments.
 *
 * Plain functions of scalars: arguments come by value, the result goes through the pointer `out`, nothing is returned.
 * There is no status. A NaN or an infinity in the result tells that the arguments lie outside the domain or that the
 * value does not fit; each function says which. NaN arguments give NaN, except where NaN as one argument asks for
 * another form of the function.
 *
 * The methods are those of S. L. Moshier, Methods and Programs for Mathematical Functions, 1989 (the Cephes library),
 * unless a function says otherwise. Accuracies are peak errors measured against 40-digit values; eps is 2^-52, and
 * docs/accuracy.md has the whole picture.
 */
#ifndef KRNUMER_SPECIAL_H
#define KRNUMER_SPECIAL_H

#include <krnumer/types.h>

/**
 * Gamma function, or the regularised lower incomplete gamma function
 * P(a, x) = 1 / Gamma(a) * integral of t^(a - 1) e^-t from 0 to x.
 *
 * Gamma(a): a rational approximation on 2 to 3 with the recurrence, Stirling's formula for |a| above 33, reflection
 * below -33. Relative error below 8 eps. NaN at 0 and at the negative integers; +infinity from 171.63 on.
 *
 * P(a, x): power series for x up to max(1, a), otherwise 1 - Q(a, x). Relative error 4e-14 for a up to 100, growing
 * with a: 2e-11 at 1e4, 2e-9 at 1e6. P is 0 at x = 0, 1 at x = +infinity (whatever a is), +infinity for infinite a and
 * where a ln x - x - ln Gamma(a) overflows, NaN for a <= 0, for x < 0, and where x is near an a above 1e12: the series
 * is given up after ten million terms.
 *
 * @param[in]  a    argument of Gamma, or shape a > 0 of P
 * @param[in]  x    NaN for Gamma(a); otherwise the upper limit of the integral, x >= 0
 * @param[out] out  Gamma(a) or P(a, x)
 */
KRNUMER_API void KR_Gamma(double a, double x, double* out);

/**
 * Regularised upper incomplete gamma function, Q(a, x) = 1 - P(a, x).
 *
 * Legendre's continued fraction for x from max(1, a) on, otherwise 1 - P(a, x), so that small values below the mean
 * have an absolute error of 1e-14. Relative error of the fraction 2e-13 for a up to 100, 2e-11 at 1e4, 2e-9 at 1e6.
 *
 * Q is 1 at x = 0, 0 at x = +infinity (whatever a is) and where x^a e^-x / Gamma(a) underflows, +infinity for infinite
 * a and where a ln x - x - ln Gamma(a) overflows, NaN for a <= 0 and for x < 0.
 *
 * @param[in]  a    shape, a > 0
 * @param[in]  x    lower limit of the integral, x >= 0
 * @param[out] out  Q(a, x)
 */
KRNUMER_API void KR_GammaC(double a, double x, double* out);

/**
 * Logarithm of the gamma function, ln Gamma(x), for x >= 0.
 *
 * A rational approximation on 2 to 3 with the recurrence below 33, Stirling's series above. Error below 3 eps, relative
 * or absolute whichever is larger (the zeros at 1 and 2 are approached with absolute accuracy). +infinity at 0, below
 * 5.6e-309, from 2.6e305 on and at +infinity. NaN for negative x: there is no reflection.
 *
 * @param[in]  x    x >= 0
 * @param[out] out  ln Gamma(x)
 */
KRNUMER_API void KR_LnGamma(double x, double* out);

/**
 * Beta function, B(a, b) = Gamma(a) Gamma(b) / Gamma(a + b), or the regularised incomplete beta function
 * I_x(a, b) = 1 / B(a, b) * integral of t^(a - 1) (1 - t)^(b - 1) from 0 to x.
 *
 * B(a, b): from ln Gamma where the arguments are positive, otherwise with Gamma. Relative error 3e-13 for a and b up to
 * 100; near 1e6 it is 3e-9. NaN where one of the three gamma functions has a pole, even where the poles would cancel,
 * and for infinite arguments.
 *
 * I_x(a, b): two continued fractions of at most 100 passes; 1 - (1 - x)^b for a = 1. Relative error 1e-12 for a and b
 * up to 1000. The passes do not suffice for b near 0 with x near 1 (absolute error 5e-6 at b = 0.002) and for a and b
 * above 1e4 near the mean (1e-2 at 1e6). NaN for a <= 0, b <= 0, x outside 0 to 1, and infinite arguments.
 *
 * @param[in]  a    first shape
 * @param[in]  b    second shape
 * @param[in]  x    NaN for B(a, b); otherwise the upper limit of the integral, 0 to 1
 * @param[out] out  B(a, b) or I_x(a, b)
 */
KRNUMER_API void KR_Beta(double a, double b, double x, double* out);

/**
 * Factorial, n! = 1 * 2 * ... * n.
 *
 * From a table up to 33, by multiplication up to 50, as Gamma(n + 1) above; relative error below 5 eps. +infinity from
 * 171 on, NaN for negative n.
 *
 * @param[in]  n    n >= 0
 * @param[out] out  n!
 */
KRNUMER_API void KR_Fact(int32_t n, double* out);

/**
 * Logarithm of the factorial, ln n! = ln Gamma(n + 1), relative error below 3 eps. NaN for negative n.
 *
 * @param[in]  n    n >= 0
 * @param[out] out  ln n!
 */
KRNUMER_API void KR_LnFact(int32_t n, double* out);

/**
 * Digamma function, psi(x) = Gamma'(x) / Gamma(x).
 *
 * Upward recurrence to 10 and the asymptotic series with Bernoulli numbers; reflection for negative x. Error below 8
 * eps, relative or absolute whichever is larger, for positive x. Negative x lose digits near the poles and with their
 * size, since the tangent of the reflection is taken of pi x without reduction: absolute error 4e-10 near a pole at
 * -26, 1e-6 near one at -1600, relative error 2e-16 / |x| for x just below 0 (-infinity above -1.1e-16).
 *
 * +infinity at 0, at the negative integers and at +infinity; NaN at -infinity.
 *
 * @param[in]  x    any
 * @param[out] out  psi(x)
 */
KRNUMER_API void KR_Psi(double x, double* out);

/**
 * Stirling's approximation of the gamma function,
 * sqrt(2 pi) x^(x - 1/2) e^-x (1 + c1 / x + ... + c5 / x^5).
 *
 * The coefficients are fitted for x from 33 on, where the relative error is below 5 eps. Below, the approximation
 * itself shows: 1e-11 at 10, 8e-5 at 1.2. +infinity at 0, where the correction overflows, from 171.63 on and at
 * +infinity. NaN for negative x.
 *
 * @param[in]  x    x > 0
 * @param[out] out  approximation of Gamma(x)
 */
KRNUMER_API void KR_Stirling(double x, double* out);

/**
 * Error function, erf x = 2 / sqrt(pi) * integral of e^(-t^2) from 0 to x.
 *
 * A rational approximation for |x| <= 1, otherwise 1 - erfc x. Relative error below 3 eps. 1 at +infinity, -1 at
 * -infinity.
 *
 * @param[in]  x    any
 * @param[out] out  erf x
 */
KRNUMER_API void KR_Erf(double x, double* out);

/**
 * Complementary error function, erfc x = 1 - erf x.
 *
 * e^(-x^2) times a rational approximation for |x| from 1 on. The exponential is taken of the rounded square, so the
 * relative error grows with x^2: 1e-14 up to 8, 1e-13 at 26. The results are 2 and 0 where e^(-x^2) underflows, below
 * -26.7 and above 26.7, and at the infinities.
 *
 * @param[in]  x    any
 * @param[out] out  erfc x
 */
KRNUMER_API void KR_ErfC(double x, double* out);

/**
 * Dawson's integral, e^(-x^2) * integral of e^(t^2) from 0 to x.
 *
 * Rational approximations, 1 / (2x) above 1e9. Relative error below 3 eps. NaN for infinite x.
 *
 * @param[in]  x    any
 * @param[out] out  Dawson's integral
 */
KRNUMER_API void KR_Dawson(double x, double* out);

/**
 * Fresnel integrals, C(x) of cos(pi t^2 / 2) and S(x) of sin(pi t^2 / 2), from 0 to x.
 *
 * Rational approximations for x^2 < 2.5625, otherwise through auxiliary functions. Relative error below 5 eps up to
 * there, absolute error 5e-15 up to 40 and 1e-11 up to 36974. Beyond, for finite x, both are +-0.5, off by up to 9e-6.
 * For an infinite x both are that infinity.
 *
 * @param[in]  x  any
 * @param[out] c  C(x); may be null
 * @param[out] s  S(x); may be null
 */
KRNUMER_API void KR_FresnelIntegrals(double x, double* c, double* s);

/**
 * Exponential integral, E_n(x) = integral of e^(-x t) / t^n from 1 to infinity.
 *
 * e^-x / x for n = 0; a power series up to x = 1, a continued fraction beyond; for n above 5000 three terms of the
 * expansion in 1 / (x + n)^2. Error below 10 eps, relative or absolute whichever is larger. 0 for x above 709.78. At x
 * = 0, +infinity for n = 0 and 1, otherwise 1 / (n - 1). NaN for negative n, negative x and infinite x.
 *
 * @param[in]  x    x >= 0
 * @param[in]  n    order, n >= 0
 * @param[out] out  E_n(x)
 */
KRNUMER_API void KR_ExpI(double x, int32_t n, double* out);

/**
 * Cosine integral, Ci(x) = gamma + ln|x| + integral of (cos t - 1) / t from 0 to |x|.
 *
 * Rational approximations up to 4, through auxiliary functions beyond. Error below 8 eps, relative or absolute
 * whichever is larger. -infinity at 0, 0 at +infinity, NaN at -infinity; a finite negative x counts as |x|.
 *
 * @param[in]  x    any
 * @param[out] out  Ci(x)
 */
KRNUMER_API void KR_CosI(double x, double* out);

/**
 * Sine integral, Si(x) = integral of sin t / t from 0 to x. Methods of KR_CosI; relative error below 2 eps. +-pi / 2 at
 * the infinities.
 *
 * @param[in]  x    any
 * @param[out] out  Si(x)
 */
KRNUMER_API void KR_SinI(double x, double* out);

/**
 * Hyperbolic cosine integral, Chi(x) = gamma + ln|x| + integral of (cosh t - 1) / t from 0 to |x|.
 *
 * A power series up to 8, Chebyshev series beyond; they are fitted up to 88 and lose digits above. Error below 4 eps,
 * relative or absolute whichever is larger, up to 88; relative error 2e-14 at 100, 2e-10 at 200, 9e-9 at 709. -infinity
 * at 0, +infinity for |x| from 709.79 on and at the infinities.
 *
 * @param[in]  x    any
 * @param[out] out  Chi(x)
 */
KRNUMER_API void KR_CoshI(double x, double* out);

/**
 * Hyperbolic sine integral, Shi(x) = integral of sinh t / t from 0 to x. Methods of KR_CoshI; relative error below 4
 * eps up to 88, 9e-15 at 100, 8e-11 at 200, 4e-9 at 709. +-infinity for |x| from 709.79 on.
 *
 * @param[in]  x    any
 * @param[out] out  Shi(x)
 */
KRNUMER_API void KR_SinhI(double x, double* out);

/**
 * Elliptic integral of the first kind, F(x | m) = integral of 1 / sqrt(1 - m sin^2 t) from 0 to x, or the complete one,
 * K(m) = F(pi/2 | m).
 *
 * K: a polynomial pair in 1 - m, and ln 4 - ln(1 - m) / 2 from 1 - m = 7e-6 down. Relative error 2 eps, in the latter
 * range 1.5e-6 at its edge, 2e-9 at 1e-8. F: descending Landen transformation within a quarter period, relative error 4
 * eps, but for m = 1 ln tan(x / 2 + pi / 4), absolute error 3e-16; beyond a quarter multiples of K are added, with the
 * error of K.
 *
 * K(1) is +infinity, and so is F(x | 1) beyond a quarter period, with the sign of x. NaN for m outside 0 to 1, for
 * infinite arguments, and for |x| above 3.3e9.
 *
 * @param[in]  m    parameter, k^2, 0 to 1
 * @param[in]  x    NaN for K(m); otherwise the amplitude in radians
 * @param[out] out  K(m) or F(x | m)
 */
KRNUMER_API void KR_Elliptic1(double m, double x, double* out);

/**
 * Elliptic integral of the second kind, E(x | m) = integral of sqrt(1 - m sin^2 t) from 0 to x, or the complete one,
 * E(m) = E(pi/2 | m).
 *
 * E(m): a polynomial pair in 1 - m, relative error 2 eps. E(x | m): the Landen transformation of KR_Elliptic1 without
 * reduction, relative error 8 eps; it stands on K(m), whose error gives 5e-7 from 1 - m = 7e-6 down. NaN for m outside
 * 0 to 1, for infinite arguments, and for |x| above 3.3e9 unless m is 0.
 *
 * @param[in]  m    parameter, k^2, 0 to 1
 * @param[in]  x    NaN for E(m); otherwise the amplitude in radians
 * @param[out] out  E(m) or E(x | m)
 */
KRNUMER_API void KR_Elliptic2(double m, double x, double* out);

/**
 * Jacobian elliptic functions sn, cn and dn of u, and the amplitude phi, F(phi | m) = u.
 *
 * Arithmetic-geometric mean; expansions of first order in m below 1e-9 and in 1 - m from 0.999999999 on, the latter for
 * |u| below K(m). Absolute error 1e-14 for |u| up to 20. Beyond |u| = 355 the latter gives the limits +-1, 0 and 0.
 * Outside 0 <= m <= 1 all results are 0; they are NaN for infinite or NaN arguments.
 *
 * @param[in]  u    argument
 * @param[in]  m    parameter, k^2, 0 to 1
 * @param[out] sn   sine of the amplitude
 * @param[out] cn   cosine of the amplitude
 * @param[out] dn   sqrt(1 - m sn^2)
 * @param[out] phi  amplitude in radians; may be null
 */
KRNUMER_API void KR_EllipticJ(double u, double m, double* sn, double* cn, double* dn, double* phi);

/**
 * Gauss's hypergeometric function, 2F1(a, b; c; x).
 *
 * Power series of at most 200 terms, directly or after a transformation to x / (x - 1) below -0.5, to 1 - x above 0.9
 * (with the psi function where c - a - b is an integer), by Euler's transformation where it ends the series, or by
 * recurrence from larger c. Relative error 1e-13 for parameters up to 5, 1e-11 up to 30; above 0.9 up to 5e-7 where
 * c - a - b is no integer but within 1e-3 of one.
 *
 * +infinity for |x| above 1 unless a or b is 0 or a negative integer, at x = 1 for c - a - b <= 0, and for c = 0, -1,
 * ... unless a or b ends the series before. Within 2^-28 a parameter counts as an integer. NaN for arguments that are
 * not finite and where parameters above 1e6 would have to be recurred that often.
 *
 * @param[in]  x    argument
 * @param[in]  a    first numerator parameter
 * @param[in]  b    second numerator parameter
 * @param[in]  c    denominator parameter
 * @param[out] out  2F1(a, b; c; x)
 */
KRNUMER_API void KR_Gauss(double x, double a, double b, double c, double* out);

/**
 * Kummer's confluent hypergeometric function, M(a, b, x) = 1F1(a; b; x).
 *
 * Power series of at most 200 terms; for |x| from 30 on, where that is doubtful, an asymptotic form if its own estimate
 * of error is the smaller; e^x M(b - a, b, -x) where b is within a relative 2^-13 of a. Relative error 1e-12 for x
 * above 0 and parameters up to 6. For negative x the series cancels: absolute error 1e-7 at -12, relative error of
 * M(1.5, 2.5, x) 2e-10 at -15, 4e-8 at -20, 2e-4 at -29.9 and 1e-12 from -30 down.
 *
 * +infinity for b = 0, -1, ... unless a ends the series before; at infinite x the limit, 0 or an infinity with the sign
 * of the leading term. NaN for infinite a or b, unless a = b and x = +infinity.
 *
 * @param[in]  x    argument
 * @param[in]  a    numerator parameter
 * @param[in]  b    denominator parameter
 * @param[out] out  M(a, b, x)
 */
KRNUMER_API void KR_Kummer(double x, double a, double b, double* out);

/**
 * Tricomi's confluent hypergeometric function, U(a, b, x), for x > 0.
 *
 * Below x = 6 from two functions M, relative error 1e-8; for b within 0.0005 of an integer n the mean of the values at
 * n +- 0.0001, 1e-9 as a rule but up to 1e-3 off. From 6 on the asymptotic series up to its smallest term, with a
 * correction for the rest (M. Abramowitz and I. A. Stegun, Handbook of Mathematical Functions, 1964, 13.1.3 and
 * 13.5.2): 1e-15 above 40, 2e-5 between 15 and 40 for a and b up to 2, worse for smaller x and larger a: 24 % at U(3,
 * 2, 6).
 *
 * +infinity at x = 0; NaN for x < 0, for arguments that are not finite, and where the asymptotic series still falls
 * after 1e7 terms, as it may for a huge b near x.
 *
 * @param[in]  x    x > 0
 * @param[in]  a    first parameter
 * @param[in]  b    second parameter
 * @param[out] out  U(a, b, x)
 */
KRNUMER_API void KR_Tricomi(double x, double a, double b, double* out);

/**
 * Dilogarithm in Spence's form, Li2(1 - x) = integral of ln t / (1 - t) from 1 to x, for x >= 0.
 *
 * A rational approximation between 0.5 and 1.5, the functional equations elsewhere. Relative error 4e-15. NaN for x < 0
 * and infinite x.
 *
 * @param[in]  x    x >= 0
 * @param[out] out  Li2(1 - x)
 */
KRNUMER_API void KR_Diln(double x, double* out);

/**
 * Parabolic cylinder function in Whittaker's form, D_v(x).
 *
 * The even and the odd solution by their power series (M. Abramowitz and I. A. Stegun, Handbook of Mathematical
 * Functions, 1964, 19.2 and 19.3), with gamma functions by a short Stirling series: each solution is good to 5e-9. For
 * x > 0 they cancel: the relative error is 1e-7 at D_0.5(4), 1e-3 at 6, and no digit is left at 8.
 *
 * 0 at x = +infinity. At x = -infinity: +infinity for v < 0, 0 for integers v >= 0, otherwise -infinity where the whole
 * part of v is even and +infinity where it is odd; NaN for v = +infinity. NaN where a part overflows.
 *
 * @param[in]  x    argument
 * @param[in]  v    order
 * @param[out] out  D_v(x)
 */
KRNUMER_API void KR_ParabolicCylinder(double x, double v, double* out);

/**
 * Riemann's zeta function, zeta(x), for real x.
 *
 * A table for integers up to 30, rational approximations up to 50, the sum over odd numbers up to 127, where it is 1.
 * Relative error 5 eps. Negative x by reflection: relative error 3e-14, but 1e-13 absolute at the zeros -2, -4, ...,
 * and 0 below -30.8148. +infinity at 1, 1 at +infinity, NaN at -infinity.
 *
 * @param[in]  x    any
 * @param[out] out  zeta(x)
 */
KRNUMER_API void KR_Zeta(double x, double* out);

/**
 * Bessel function of the first kind of real order, J_v(x).
 *
 * Integer orders by recurrence from J_0 and J_1 in the stable direction: absolute error 2e-15 for x up to v, 1e-14 up
 * to x = 1e4; the time grows with v. Other orders by the power series, Hankel's asymptotic series, recurrence between
 * them, and from 200 on uniform expansions with Airy functions: absolute error 5e-12 up to 300, 2e-12 above.
 *
 * J_-n = J_n(-x) = (-1)^n J_n for integers. 0 for |x| below 2^-52 where v is no integer, whatever the sign of v. NaN
 * for v below -200 and for negative x where v is no integer, for infinite arguments, and where Airy functions overflow:
 * v above 200, x far below v but above 3.6 sqrt(v), such as J_1000.3(300).
 *
 * @param[in]  v    order
 * @param[in]  x    argument
 * @param[out] out  J_v(x)
 */
KRNUMER_API void KR_BesselJr(double v, double x, double* out);

/**
 * Bessel function of the second kind of real order, Y_v(x), for x > 0.
 *
 * Integer orders by upward recurrence from Y_0 and Y_1, relative error 1e-14 for x up to v and absolute error 1e-14
 * above; the time grows with v. -infinity, or +infinity for odd negative v, where the value is beyond the largest
 * double. Other orders from J_v and J_-v: absolute error 1e-12, growing as 1 / |v - n| near an integer n.
 *
 * NaN for x <= 0, infinite arguments, v beyond 32 bits, and other than integers outside -200 to 200.
 *
 * @param[in]  v    order
 * @param[in]  x    x > 0
 * @param[out] out  Y_v(x)
 */
KRNUMER_API void KR_BesselYr(double v, double x, double* out);

/**
 * Spherical Bessel function of the first kind, j_n(x) = sqrt(pi / (2x)) J_(n + 1/2)(x), for x >= 0.
 *
 * Absolute error 1e-12 for n up to 10, 1e-14 above. At x = 0, 1 for n = 0 and 0 otherwise;
 * below 2^-52 it is 0 for n = 0 too. 0 at +infinity. NaN for negative x and for n below -200.
 *
 * @param[in]  n    order
 * @param[in]  x    x >= 0
 * @param[out] out  j_n(x)
 */
KRNUMER_API void KR_BesselJs(int32_t n, double x, double* out);

/**
 * Spherical Bessel function of the second kind, y_n(x) = sqrt(pi / (2x)) Y_(n + 1/2)(x), for x >= 0.
 *
 * Absolute error 1e-12 for n up to 10, 2e-13 above. -infinity at x = 0, 0 at +infinity. NaN for negative x and for n
 * outside -200 to 199.
 *
 * @param[in]  n    order
 * @param[in]  x    x >= 0
 * @param[out] out  y_n(x)
 */
KRNUMER_API void KR_BesselYs(int32_t n, double x, double* out);

/**
 * Modified Bessel function of the first kind of real order, I_v(x).
 *
 * Chebyshev series for v = 0 and 1, relative error 1e-15. Other integers by Miller's downward recurrence from 2 (|v| +
 * sqrt(100 |v|)), wherever x is: relative error 1e-13 for x up to 30, but I_2 is 6e-13 off at x = 40, 8e-7 at 100 and
 * 1e-4 at 200, I_3 7e-2 at 500. Other orders from Kummer's function M(v + 1/2, 2v + 1, 2x), from the power series for
 * v = -1/2, -3/2, ...: relative error 1e-13 for x up to 30, 2e-11 up to 300.
 *
 * At x = 0, 1 for v = 0, 0 for other integers and positive v, otherwise an infinity with the sign of Gamma(v + 1).
 * +infinity at x = +infinity, 0 for infinite v and x = 0. NaN for x = -infinity, v = -infinity, |v| above 2^31, and
 * where v is no integer for v below -200 and negative x.
 *
 * @param[in]  v    order
 * @param[in]  x    argument
 * @param[out] out  I_v(x)
 */
KRNUMER_API void KR_BesselIr(double v, double x, double* out);

/**
 * Modified Bessel function of the second kind of integer order, K_n(x) = K_-n(x), for x > 0.
 *
 * Chebyshev series for n = 0 and 1, upward recurrence above: relative error 3e-15 for n up to 50, 1e-14 up to 1000.
 * +infinity at x = 0 and where the value overflows, 0 at +infinity, NaN for negative x.
 *
 * @param[in]  n    order
 * @param[in]  x    x > 0
 * @param[out] out  K_n(x)
 */
KRNUMER_API void KR_BesselKn(int32_t n, double x, double* out);

/**
 * Kelvin functions of the first kind of integer order, ber_n(x) + i bei_n(x) = J_n(x e^(3 pi i / 4)).
 *
 * Power series (M. Abramowitz and I. A. Stegun, Handbook of Mathematical Functions, 1964, 9.9.9 and 9.9.10), whose
 * terms cancel: relative error 1e-13 up to 10, 1e-8 at 60 and 4e-6 at 74; NaN from about 75 on, where the terms
 * overflow. Values far below 1 have an absolute error of 1e-8. NaN for infinite x.
 *
 * @param[in]  x    argument
 * @param[in]  n    order
 * @param[out] ber  ber_n(x)
 * @param[out] bei  bei_n(x)
 */
KRNUMER_API void KR_KelvinI(double x, int32_t n, double* ber, double* bei);

/**
 * Kelvin functions of the second kind of integer order, ker_n(x) + i kei_n(x) = e^(-n pi i / 2) K_n(x e^(pi i / 4)),
 * for x > 0.
 *
 * Power series (9.9.11 and 9.9.12 of the same source), whose parts grow while the functions fall: relative error 1e-12
 * up to 2, 3e-9 at 10, 2e-4 at 15, no digit from 25 on. In ker for n = 2, 6, ... and in kei for n = 4, 8, ... the
 * largest term for small x has a factor 0, a rounded cosine here: relative error up to 2e-14 / x^2. An infinity for
 * orders whose (x / 2)^n / n! underflows. NaN for x <= 0, from about 75 on and for infinite x.
 *
 * @param[in]  x    x > 0
 * @param[in]  n    order
 * @param[out] ker  ker_n(x)
 * @param[out] kei  kei_n(x)
 */
KRNUMER_API void KR_KelvinK(double x, int32_t n, double* ker, double* kei);

/**
 * Airy functions Ai(x) and Bi(x) and their derivatives.
 *
 * Maclaurin's series between -2.09 and 2.09 (to 8.32 for Bi), rational approximations of the asymptotic forms
 * elsewhere. Absolute error 5e-15 about 0 and 1e-13 down to -100 (derivatives 1e-12); relative error 1e-14 up to 8.3,
 * 3e-13 up to 103. The phase loses digits below: absolute error 1e-10 at -1e5.
 *
 * For x above 103.892 and for infinite x, Ai is 0, Bi +infinity (0 at -infinity), and the derivatives are the largest
 * double. NaN below about -1e205, where the phase is infinite.
 *
 * @param[in]  x        argument
 * @param[out] ai       Ai(x)
 * @param[out] bi       Bi(x)
 * @param[out] aiPrime  Ai'(x); null where no derivative is wanted
 * @param[out] biPrime  Bi'(x); not written where `aiPrime` is null
 */
KRNUMER_API void KR_Airy(double x, double* ai, double* bi, double* aiPrime, double* biPrime);

/**
 * Struve function, H_v(x). Note the order of the arguments.
 *
 * A power series below 18, from 18 on also an asymptotic series with Y_v, whichever estimates the smaller error; J_-v
 * for v = -1/2, -3/2, .... Relative error 1e-10 for x up to 15 and from 31 on, 1e-9 between. For v above x the power
 * series cancels, 1e-9 at x = 70, and from there on the asymptotic series misjudges itself: no digit from x = 80 and
 * v = 1.1 x on.
 *
 * H_n(-x) = (-1)^(n + 1) H_n(x) for integers. 0 at x = 0 for v >= 0. NaN for negative x where v is no integer, for x =
 * 0 with negative v, from v = 170.13 on, where gamma functions overflow, and for infinite arguments.
 *
 * @param[in]  x    argument
 * @param[in]  v    order
 * @param[out] out  H_v(x)
 */
KRNUMER_API void KR_Struve(double x, double v, double* out);

#endif
