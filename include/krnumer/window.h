/*
 * Windows: samples, real or complex, are multiplied by a window in place.
 *
 * The array `x` is 1-D of double, or of complex double for the functions with Cx in their name, where both parts of a
 * sample are multiplied by the same real weight. Any failure empties it: a call that fails costs the caller the
 * samples. Windows are periodic, the form for spectral analysis: w[i] = w[n-i], and w[0] stands alone. The symmetric
 * form comes from SymmWinH. A single sample stays as it is unless a function says otherwise.
 *
 * Numbers of windows: 0 rectangle, 1 Hann, 2 Hamming, 3 Blackman-Harris of 3 terms, 4 exact Blackman, 5 Blackman,
 * 6 flat top, 7 Blackman-Harris of 4 terms, 8 Blackman-Harris of 7 terms, 9 low side lobe, 11 Blackman-Nuttall (sums of
 * cosines); 30 triangle, 31 Bartlett-Hanning, 32 Bohman, 33 Parzen, 34 Welch, 60 Kaiser, 61 Dolph-Chebyshev,
 * 62 Gaussian. There is no other.
 */
#ifndef KRNUMER_WINDOW_H
#define KRNUMER_WINDOW_H

#include <krnumer/types.h>

/* ---- Sums of cosines, w[i] = a[0] - a[1] cos(2 pi i / n) + a[2] cos(4 pi i / n) - ... The weights come from a
 *      rotation per term, without a trigonometric call per sample. Coefficients: F. J. Harris, Proc. IEEE 66, 51
 *      (1978); A. H. Nuttall, IEEE Trans. ASSP 29, 84 (1981). ---------------------------------------------------- */

/**
 * Named sum of cosines.
 *
 * @param[in,out] x       samples
 * @param[in]     type    number of the window, 0 to 9 or 11
 * @param[in]     scaled  0 for the window as it is, else divided by a[0], its mean
 * @return                0; -20003 when `x` is empty; -20061 when `type` is no sum of cosines; -20001 without memory
 */
KRNUMER_API int32_t AllCosWinH(KrHandle x, int32_t type, int32_t scaled);

/** AllCosWinH of complex samples. */
KRNUMER_API int32_t CxAllCosWinH(KrHandle x, int32_t type, int32_t scaled);

/**
 * Sum of cosines with the caller's coefficients.
 *
 * A single coefficient of exactly 1 leaves the samples untouched.
 *
 * @param[in,out] x             samples
 * @param[in]     coefficients  a[0], a[1], ..., 1-D double; the alternating signs are not in them
 * @return                      0; -20003 when `x`, or for two samples or more `coefficients`, is empty; -20001 without
 *                              memory
 */
KRNUMER_API int32_t GenCosWinH(KrHandle x, KrHandle coefficients);

/** GenCosWinH of complex samples. */
KRNUMER_API int32_t CxGenCosWinH(KrHandle x, KrHandle coefficients);

/**
 * GenCosWinH with the window divided by a[0], so that its mean is 1.
 *
 * @param[in,out] x             samples
 * @param[in]     coefficients  a[0], a[1], ..., 1-D double
 * @return                      0; -20003 when `x`, or for two samples or more `coefficients`, is empty; -20001 without
 *                              memory
 */
KRNUMER_API int32_t ScaledGenCosWinH(KrHandle x, KrHandle coefficients);

/** ScaledGenCosWinH of complex samples. */
KRNUMER_API int32_t ScaledCxGenCosWinH(KrHandle x, KrHandle coefficients);

/* ---- Windows of their own kinds ---------------------------------------------------------------------------------- */

/**
 * Bartlett-Hanning window, w[i] = 0.62 - 0.48 |i/n - 0.5| - 0.38 cos(2 pi i / n), with w[0] = 0 (Y. H. Ha and
 * J. A. Pearce, IEEE Trans. ASSP 37, 298, 1989).
 *
 * @param[in,out] x  samples
 * @return           0; -20003 when `x` is empty; -20001 without memory for the weights
 */
KRNUMER_API int32_t BartHannWinH(KrHandle x);

/** BartHannWinH of complex samples. */
KRNUMER_API int32_t CxBartHannWinH(KrHandle x);

/**
 * Bohman window, w[i] = sin(2 pi i / n) / pi - (2 i / n) cos(2 pi i / n) up to the middle, with w[0] = 0: the
 * convolution of a half-cycle cosine with itself.
 *
 * @param[in,out] x  samples
 * @return           0; -20003 when `x` is empty; -20001 without memory for the weights
 */
KRNUMER_API int32_t BohmanWinH(KrHandle x);

/** BohmanWinH of complex samples. */
KRNUMER_API int32_t CxBohmanWinH(KrHandle x);

/**
 * Parzen window: with d = |i - h| and h = n/2, w[i] = 2 (1 - d/h)^3 where d is above h/2 and
 * 1 - 6 (d/h)^2 + 6 (d/h)^3 elsewhere; w[0] = 0 (E. Parzen, Technometrics 3, 167, 1961).
 *
 * @param[in,out] x  samples
 * @return           0; -20003 when `x` is empty; -20001 without memory for the weights
 */
KRNUMER_API int32_t ParzenWinH(KrHandle x);

/** ParzenWinH of complex samples. */
KRNUMER_API int32_t CxParzenWinH(KrHandle x);

/**
 * Welch window, w[i] = 1 - ((i - h) / h)^2 with h = n/2 (P. D. Welch, IEEE Trans. Audio Electroacoust. 15, 70,
 * 1967).
 *
 * @param[in,out] x  samples
 * @return           0; -20003 when `x` is empty; -20001 without memory for the weights
 */
KRNUMER_API int32_t WelchWinH(KrHandle x);

/** WelchWinH of complex samples. */
KRNUMER_API int32_t CxWelchWinH(KrHandle x);

/**
 * Triangle, w[i] = 2 i / n up to the middle. x[0] becomes 0, the only sample of an array of one too.
 *
 * @param[in,out] x  samples
 * @return           0; -20003 when `x` is empty
 */
KRNUMER_API int32_t TriangleWinH(KrHandle x);

/** TriangleWinH of complex samples. */
KRNUMER_API int32_t CxTriangleWinH(KrHandle x);

/**
 * TriangleWinH with its status in `err`.
 *
 * @param[in,out] x    samples
 * @param[out]    err  status: that of TriangleWinH
 * @return             0
 */
KRNUMER_API int32_t TriangleWin(KrHandle x, int32_t* err);

/**
 * Cosine taper: m = trunc(n fraction / 2) samples at either end are multiplied by sin(i pi / (2 m))^2, i counted from
 * the end; the first and the last sample become 0. Symmetric about (n-1)/2.
 *
 * @param[in,out] x         samples
 * @param[in]     fraction  tapered part of the samples; at 0 or below, or where m is 0, nothing is done; from 1 on the
 *                          Hann window is applied, in its periodic form
 * @return                  0; -20003 when `x` is empty; -20001 without memory
 */
KRNUMER_API int32_t CosTaperedH(KrHandle x, double fraction);

/** CosTaperedH of complex samples. */
KRNUMER_API int32_t CxCosTaperedH(KrHandle x, double fraction);

/**
 * CosTaperedH with a fraction of 0.2 and its status in `err`.
 *
 * @param[in,out] x    samples
 * @param[out]    err  status: that of CosTaperedH
 * @return             0
 */
KRNUMER_API int32_t CosTapered(KrHandle x, int32_t* err);

/**
 * Exponential window, w[i] = finalValue^(i / (n-1)).
 *
 * @param[in,out] x           samples
 * @param[in]     finalValue  weight of the last sample, above 0
 * @return                    0; -20006 when `x` has fewer than two samples; -20027 when `finalValue` is not positive
 */
KRNUMER_API int32_t ExpWinH(KrHandle x, double finalValue);

/** ExpWinH of complex samples. */
KRNUMER_API int32_t CxExpWinH(KrHandle x, double finalValue);

/**
 * ExpWinH with its status in `err`.
 *
 * @param[in,out] x           samples
 * @param[in]     finalValue  weight of the last sample, above 0
 * @param[out]    err         status: that of ExpWinH
 * @return                    0
 */
KRNUMER_API int32_t ExpWindCIN(KrHandle x, const double* finalValue, int32_t* err);

/**
 * Force window: the first trunc(duty n / 100) samples stay, the others become 0.
 *
 * @param[in,out] x     samples
 * @param[in]     duty  percent; values outside 0 to 100 act as the limit, NaN as 0
 * @return              0; -20006 when `x` has fewer than two samples
 */
KRNUMER_API int32_t ForceWinH(KrHandle x, double duty);

/** ForceWinH of complex samples. */
KRNUMER_API int32_t CxForceWinH(KrHandle x, double duty);

/**
 * ForceWinH with its status in `err`.
 *
 * @param[in,out] x     samples
 * @param[in]     duty  percent; values outside 0 to 100 act as the limit, NaN as 0
 * @param[out]    err   status: that of ForceWinH
 * @return              0
 */
KRNUMER_API int32_t ForceWindCIN(KrHandle x, const double* duty, int32_t* err);

/**
 * Kaiser window, w[i] = I0(beta sqrt(1 - u^2)) / I0(beta) with u = 1 - 2 i / n up to the middle (J. F. Kaiser, 1966).
 *
 * I0 is summed as Kaiser did, over at most 25 terms and until a term adds no more than 1e-8: exact to some 1e-9 for the
 * usual beta, visibly off from 40 on. A single sample is multiplied by 1 / I0(beta).
 *
 * @param[in,out] x     samples
 * @param[in]     beta  shape; 0 leaves the samples
 * @return              0; -20003 when `x` is empty
 */
KRNUMER_API int32_t KaiserH(KrHandle x, double beta);

/** KaiserH of complex samples. */
KRNUMER_API int32_t CxKaiserH(KrHandle x, double beta);

/**
 * KaiserH with its status in `err`.
 *
 * @param[in,out] x     samples
 * @param[in]     beta  shape
 * @param[out]    err   status: that of KaiserH
 * @return              0
 */
KRNUMER_API int32_t Kaiser_Bessel(KrHandle x, const double* beta, int32_t* err);

/**
 * Gaussian window, w[i] = exp(-0.5 (d / (sigma L))^2), d from the middle of the window.
 *
 * @param[in,out] x          samples
 * @param[in]     sigma      standard deviation as a part of the length; not positive, or NaN, means 0.2
 * @param[in]     symmetric  0: middle at n/2 and L = n + 1; else middle at (n-1)/2 and L = n
 * @return                   0; -20003 when `x` is empty
 */
KRNUMER_API int32_t GaussWinH(KrHandle x, double sigma, int32_t symmetric);

/** GaussWinH of complex samples. */
KRNUMER_API int32_t CxGaussWinH(KrHandle x, double sigma, int32_t symmetric);

/**
 * Dolph-Chebyshev window, whose side lobes all have one height, divided by its greatest weight (C. L. Dolph, Proc. IRE
 * 34, 335, 1946): the Fourier transform of samples of a Chebyshev polynomial.
 *
 * @param[in,out] x          samples
 * @param[in]     ratio      height of the main lobe over that of the side lobes; below 1, or NaN, means 1; above
 *                           1.3e154 the weights are NaN
 * @param[in]     symmetric  0: the symmetric window of n + 1 without its last weight; else the symmetric window
 * @return                   0; -20003 when `x` is empty; -20001 without memory for the weights, or
 *                           where their spectrum has more than 2^31 - 1 terms
 */
KRNUMER_API int32_t DolChebyWinH(KrHandle x, double ratio, int32_t symmetric);

/** DolChebyWinH of complex samples. */
KRNUMER_API int32_t CxDolChebyWinH(KrHandle x, double ratio, int32_t symmetric);

/* ---- Windows by number, and their constants ---------------------------------------------------------------------- */

/** A window's figures of merit in spectral measurements. */
typedef struct KrWindowConstants {
    double enbw;         /**< equivalent noise bandwidth in bins, n sum(w^2) / sum(w)^2 */
    double coherentGain; /**< mean of the weights */
} KrWindowConstants;

/**
 * Measures an array of weights.
 *
 * @param[in]  x          weights, 1-D double
 * @param[out] constants  not finite where the weights add up to 0; both fields NaN on failure
 * @return                0, or -20003 when `x` is empty
 */
KRNUMER_API int32_t NumWinConstH(KrHandle x, KrWindowConstants* constants);

/**
 * Window of unit gain: the periodic window divided by its coherent gain, and the constants of the unscaled window.
 *
 * Sums of cosines are divided by a[0], and their constants are those of the literature, whatever the length. All others
 * are measured: divided by the mean of their weights at this length. The rectangle leaves the samples.
 *
 * @param[in,out] x          samples
 * @param[in]     type       number of the window
 * @param[in]     parameter  beta of 60, ratio of 61, sigma of 62; the others ignore it
 * @param[out]    constants  constants of the window; a sum of cosines reports them for no samples too. Both fields NaN
 *                           on failure, except where it left no time to look: negative length and no memory for the
 *                           weights
 * @return                   0; -20004 when the length word of `x` is negative; -20061 when there is no such window;
 *                           -20003 when `x` is empty and the window has to be measured; -20001 without memory
 */
KRNUMER_API int32_t ScaledWinH(KrHandle x, int32_t type, double parameter, KrWindowConstants* constants);

/** ScaledWinH of complex samples. */
KRNUMER_API int32_t CxScaledWinH(KrHandle x, int32_t type, double parameter, KrWindowConstants* constants);

/**
 * Symmetric window: the periodic window of n - 1 samples with its first weight repeated at the end; for 61 and 62 their
 * own symmetric form.
 *
 * @param[in,out] x          samples; one alone stays as it is, whatever the type
 * @param[in]     type       number of the window
 * @param[in]     parameter  beta of 60, ratio of 61, sigma of 62; the others ignore it
 * @return                   0; -20003 when `x` is empty; -20061 when there is no such window; -20001 without memory
 */
KRNUMER_API int32_t SymmWinH(KrHandle x, int32_t type, double parameter);

/** SymmWinH of complex samples. */
KRNUMER_API int32_t CxSymmWinH(KrHandle x, int32_t type, double parameter);

#endif
