/*
 * Signal operations: convolution and correlation, changes of the sampling rate, and operations on samples in the time
 * domain.
 *
 * Sequences are 1-D arrays and planes 2-D arrays of rows, of double, or of complex double for the functions with Cx in
 * their name. Unless a function says otherwise, a failure empties its output arrays, those that are inputs too
 * included.
 *
 * Numbers that select, in every function below:
 *   algorithm      0 by the definition, 1 through the frequency domain. The caller chooses, whatever the sizes; the
 *                  results are the same up to rounding.
 *   normalization  of a correlation: 0 none; 1 unbiased, each value divided by the number of its terms; 2 biased,
 *                  all divided by the longer length.
 */
#ifndef KRNUMER_SIGOP_H
#define KRNUMER_SIGOP_H

#include <krnumer/types.h>

/* ---- Convolution and correlation of sequences: A. V. Oppenheim and R. W. Schafer, Discrete-Time Signal Processing,
 *      chapters 2 and 8. In the frequency domain the length is rounded up to a product of small primes. ------------ */

/**
 * Convolution, z[k] = sum of x[i] y[k-i], of nx + ny - 1 values.
 *
 * By the definition, the terms of a value are added in the order of `x`.
 *
 * @param[in]  x          nx samples
 * @param[in]  y          ny samples
 * @param[out] z          the convolution
 * @param[in]  algorithm  0 or 1; any other value gives `z` its length and does not write its elements
 * @param[out] err        status: 0; -20003 when `x` or `y` is empty; -20001 without memory
 * @return                0
 */
KRNUMER_API int32_t Convolution(KrHandle x, KrHandle y, KrHandle z, const int32_t* algorithm, int32_t* err);

/**
 * Convolution of complex sequences, or their cross-correlation, z[k] = sum over i + j = k of conj(x[nx-1-i]) y[j] with
 * lag 0 at k = nx - 1.
 *
 * @param[in]  x              nx complex samples
 * @param[in]  y              ny complex samples
 * @param[out] z              nx + ny - 1 complex values
 * @param[in]  algorithm      0 or 1
 * @param[in]  correlate      0 for the convolution, else the cross-correlation
 * @param[in]  normalization  of the cross-correlation, 0 to 2; not looked at for the convolution
 * @return                    0; -20003 when `x` or `y` is empty; -20061 when `algorithm` or `normalization` is none;
 *                            -20001 without memory
 */
KRNUMER_API int32_t CxConvolution(KrHandle x, KrHandle y, KrHandle z, int32_t algorithm, int32_t correlate,
                                  int32_t normalization);

/**
 * Cross-correlation, z[k] = sum over i + j = k of x[nx-1-i] y[j], with lag 0 at k = nx - 1: Rxy80 without
 * normalization.
 *
 * @param[in]  x          nx samples
 * @param[in]  y          ny samples
 * @param[out] z          nx + ny - 1 values
 * @param[in]  algorithm  0 or 1; any other value gives `z` its length and does not write its elements
 * @param[out] err        status: 0; -20003 when `x` or `y` is empty; -20001 without memory
 * @return                0
 */
KRNUMER_API int32_t Rxy(KrHandle x, KrHandle y, KrHandle z, const int32_t* algorithm, int32_t* err);

/**
 * Cross-correlation with normalization.
 *
 * One array given as `x` and as `y` is correlated through its power spectrum where `algorithm` is 1.
 *
 * @param[in]  x              nx samples
 * @param[in]  y              ny samples
 * @param[out] z              nx + ny - 1 values, lag 0 at nx - 1
 * @param[in]  algorithm      0 or 1; any other value gives `z` its length and does not write its elements
 * @param[in]  normalization  0 to 2
 * @param[out] err            status: 0; -20003 when `x` or `y` is empty; -20061 when `normalization` is none; -20001
 *                            without memory
 * @return                    0
 */
KRNUMER_API int32_t Rxy80(KrHandle x, KrHandle y, KrHandle z, const int32_t* algorithm, int32_t normalization,
                          int32_t* err);

/**
 * Autocorrelation without normalization: AutoCorrelation80 with 0.
 *
 * @param[in,out] x    n samples; 2 n - 1 values afterwards
 * @param[out]    err  status: 0; -20003 when `x` is empty; -20001 without memory
 * @return             0
 */
KRNUMER_API int32_t AutoCorrelation(KrHandle x, int32_t* err);

/**
 * Autocorrelation, z[k] = sum of x[i] x[i+k-n+1], with lag 0 at k = n - 1, by the inverse transform of the power
 * spectrum (Wiener-Khinchin).
 *
 * @param[in,out] x              n samples; 2 n - 1 values afterwards
 * @param[in]     normalization  0 to 2
 * @param[out]    err            status: 0; -20003 when `x` is empty; -20061 when `normalization` is none; -20001
 *                               without memory
 * @return                       0
 */
KRNUMER_API int32_t AutoCorrelation80(KrHandle x, int32_t normalization, int32_t* err);

/**
 * Undoes a convolution: the quotient of the spectra of `x` and `y`, zeros added up to a power of two, transformed back.
 *
 * Where the spectrum of `y` is zero the quotient is not finite, and then neither is any output; near a zero it
 * magnifies noise. When there is no memory for the tables of the transform, the first values of `x` stay what they
 * were, and that is not told.
 *
 * @param[in,out] x    the convolution, n samples, at most 8388608; its first n - m + 1 values afterwards give the other
 *                     factor
 * @param[in]     y    the factor to remove, m samples, not longer than `x`
 * @param[out]    err  status: 0; -20010 when `x` or `y` has more than 8388608 samples; -20003 when one is empty; -20008
 *                     when `y` is longer than `x`; -20001 without memory
 * @return             the status too
 */
KRNUMER_API int32_t Deconvolution(KrHandle x, KrHandle y, int32_t* err);

/* ---- Convolution and correlation of planes. Transforms have exactly the full size, so that full sizes with large
 *      prime factors are slow in the frequency domain. ----------------------------------------------------------- */

/**
 * Convolution of planes, z[r][c] = sum of x[i][j] y[r-i][c-j], or a part of it.
 *
 * @param[in]  x           rx by cx
 * @param[in]  y           ry by cy
 * @param[out] z           0: rx + ry - 1 by cx + cy - 1, all of it; 1: rx by cx, from row ry / 2 and column cy / 2 on,
 *                         rounded down; 2: rx - ry + 1 by cx - cy + 1, where `y` lies within `x`
 * @param[in]  outputSize  which of these parts
 * @param[in]  algorithm   0 or 1
 * @return                 0; -20003 when a dimension is 0; -20061 when `outputSize` or `algorithm` is none; -20008 when
 *                         part 2 is empty; -20001 without memory. A failure while computing, an `algorithm` that is
 *                         none among them, leaves `z` without elements but with the dimensions of the result.
 */
KRNUMER_API int32_t Convolve_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t outputSize, int32_t algorithm);

/**
 * Convolve_2DH of complex planes. Part 2 takes neither an `x` nor a `y` of more columns than rows: -20008, as a failure
 * while computing.
 */
KRNUMER_API int32_t CxConvolve_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t outputSize, int32_t algorithm);

/**
 * Cross-correlation of planes: the convolution of `x`, reversed along both axes, with `y`. Lag 0 stands in row rx - 1,
 * column cx - 1.
 *
 * @param[in]  x          rx by cx
 * @param[in]  y          ry by cy
 * @param[out] z          rx + ry - 1 by cx + cy - 1
 * @param[in]  algorithm  0 or 1
 * @return                0; -20003 when a dimension is 0; -20061 when `algorithm` is none; -20001 without memory
 */
KRNUMER_API int32_t Correlation_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t algorithm);

/** Correlation_2DH of complex planes; `x` is conjugated too. */
KRNUMER_API int32_t CxCorrelation_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t algorithm);

/* ---- Samples in the time domain ----------------------------------------------------------------------------------
 */

/**
 * Derivative by central differences, y[i] = (x[i+1] - x[i-1]) / (2 dt).
 *
 * @param[in,out] x        samples
 * @param[in]     initial  the sample before the first
 * @param[in]     final    the sample after the last
 * @param[in]     dt       sampling interval
 * @param[out]    err      status: 0; -20016 unless `dt` is above 0; -20003 when `x` is empty and `dt` is not to blame
 * @return                 0
 */
KRNUMER_API int32_t Derivative(KrHandle x, const double* initial, const double* final, const double* dt, int32_t* err);

/**
 * Integral by a running sum of Simpson's rule, y[i] = y[i-1] + (x[i-1] + 4 x[i] + x[i+1]) dt / 6.
 *
 * @param[in,out] x        samples
 * @param[in]     initial  the sample before the first
 * @param[in]     final    the sample after the last
 * @param[in]     dt       sampling interval; NaN gives NaN
 * @param[out]    err      status: 0; -20003 when `x` is empty; -20016 when `dt` is 0 or less
 * @return                 0
 */
KRNUMER_API int32_t Integral(KrHandle x, const double* initial, const double* final, const double* dt, int32_t* err);

/**
 * Unwraps a phase: whole turns are taken off so that no sample lies more than pi from the one before it, as that was
 * corrected. A step of exactly pi is taken down, one of -pi stays.
 *
 * @param[in,out] x    phase in radians
 * @param[out]    err  status: 0, or -20003 when `x` is empty
 * @return             0
 */
KRNUMER_API int32_t unWrap(KrHandle x, int32_t* err);

/**
 * Finds where channels cross their trigger levels.
 *
 * A rising trigger is armed by a sample below level - |hysteresis| and hit by the next sample at or above the level; a
 * falling one by a sample above level + |hysteresis| and hit by the next at or below the level. A hit disarms it.
 *
 * @param[in]  x           channels by samples
 * @param[in]  levels      1-D double, an element per channel, as the next three
 * @param[in]  previous    the sample before the first
 * @param[in]  hysteresis  distance from the level; its sign does not matter
 * @param[in]  slopes      1-D int32: 1 rising, 0 falling; any other value never hits
 * @param[in]  maxPerRow   hits looked for in a channel; below 1, none
 * @param[out] found       1-D int32, channels times maxPerRow: the indices of the hits of all channels, one after the
 *                         other, with a 0 for a channel without a hit. The first 50 are stored; elements behind the
 *                         last stay as the host delivers them.
 * @param[out] counts      1-D int32: hits of each channel, those beyond the 50 too
 * @param[out] flags       1-D int32: 1 for a channel with a hit, else 0
 * @param[out] last        1-D double: the last sample of each channel, to be `previous` of the next block; without
 *                         samples, `previous` itself
 * @param[out] err         status: 0; -20002 when an array has fewer elements than there are channels; -20001 without
 *                         memory
 * @return                 0
 */
KRNUMER_API int32_t Triggerh(KrHandle x, KrHandle levels, KrHandle previous, KrHandle hysteresis, KrHandle slopes,
                             int32_t maxPerRow, KrHandle found, KrHandle counts, KrHandle flags, KrHandle last,
                             int32_t* err);

/**
 * Measures of a single pulse, after the histogram method of IEEE Std 181.
 *
 * Base and top are the centers of the fullest bins in the lower and the upper half of a histogram of 101 bins.
 * Crossings of 10, 50 and 90 % of the amplitude are interpolated linearly; times count samples. A waveform whose first
 * sample lies above the middle is a negative pulse: base lies above top then, the amplitude is negative, and the times
 * are those of the mirror image. A pulse that ends before a level is met is measured to its end.
 *
 * @param[in]  x           samples
 * @param[out] top         level of the pulse
 * @param[out] base        level outside the pulse
 * @param[out] amplitude   top - base
 * @param[out] delay       time of the first crossing of the middle
 * @param[out] width       time from there to the crossing back
 * @param[out] slewRate    0.8 amplitude / riseTime; 1e+30 for a riseTime of 0
 * @param[out] fallTime    time from 90 % to 10 %
 * @param[out] riseTime    time from 10 % to 90 %
 * @param[out] overshoot   largest sample - upper level
 * @param[out] undershoot  lower level - smallest sample
 * @param[out] err         status: 0; -20003 when `x` is empty; -20001 without memory. Any other than 0 makes all
 *                         measures 0
 * @return                 0
 */
KRNUMER_API int32_t PulseParameters(KrHandle x, double* top, double* base, double* amplitude, double* delay,
                                    double* width, double* slewRate, double* fallTime, double* riseTime,
                                    double* overshoot, double* undershoot, int32_t* err);

/**
 * Frequency modulation of a sine: the phase advances by 2 pi (f + x) with every sample x of the message, then moves by
 * its period 2 pi / c, down if it has reached it and up otherwise, and sin(c phase) replaces the sample.
 *
 * @param[in]     n         samples
 * @param[in]     c         factor from phase to angle
 * @param[out]    angleOut  the last angle, c phase, in degrees
 * @param[in]     f         frequency of the carrier in cycles per sample
 * @param[in,out] data      n samples of the message, then of the modulated carrier
 * @param[in,out] peak      the largest sample so far: replaced by one whose integer part is larger in magnitude, within
 *                          32 bits
 * @param[in,out] phase     phase in radians, carried from call to call
 * @return                  0
 */
KRNUMER_API int32_t FreqMod(int32_t n, double c, double* angleOut, double f, double* data, double* peak, double* phase);

/**
 * Phase modulation of a sine: the phase advances by 2 pi f and is moved as in FreqMod, and a sample x of the message,
 * in degrees, becomes sin(c phase + x pi / 180).
 *
 * @param[in]     n         samples
 * @param[in]     c         factor from phase to angle
 * @param[out]    angleOut  the last angle, c phase, in degrees, plus the last sample of the output
 * @param[in]     f         frequency of the carrier in cycles per sample
 * @param[in,out] data      n samples of the message, then of the modulated carrier
 * @param[in,out] peak      the largest sample so far, as in FreqMod
 * @param[in,out] phase     phase in radians, carried from call to call
 * @return                  0
 */
KRNUMER_API int32_t PhasMod(int32_t n, double c, double* angleOut, double f, double* data, double* peak, double* phase);

#endif
