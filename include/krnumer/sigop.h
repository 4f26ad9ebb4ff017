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

/* ---- Changes of the sampling rate. Streams keep what they need between blocks in arguments of the caller's, so that
 *      the blocks of a signal, however cut, give what the whole would give; at ratios that are not rational, up to
 *      the rounding of positions. --------------------------------------------------------------------------------- */

/**
 * Decimation of a block: every factor-th sample, or the means of blocks of `factor` samples. What is left at the end is
 * dropped.
 *
 * @param[in,out] x          n samples; n / factor afterwards, rounded down
 * @param[in]     factor     1 to n
 * @param[in]     averaging  0 to keep samples, else means
 * @param[out]    err        status: 0; -20003 when `x` is empty; -20022 when `factor` is below 1 or above n; -20001
 *                           without memory
 * @return                   0
 */
KRNUMER_API int32_t DecimateCIN(KrHandle x, const int32_t* factor, const uint8_t* averaging, int32_t* err);

/** DecimateCIN of complex samples; the status is the result. */
KRNUMER_API int32_t CxDecimate_H(KrHandle x, int32_t factor, int32_t averaging);

/**
 * Decimation of a stream, block by block. What is left of a block is kept for the next.
 *
 * @param[in,out] x             samples, of any number; the output afterwards, which may be empty
 * @param[in]     factor        from 1 on
 * @param[in]     averaging     0 to keep every factor-th sample, else means of `factor` samples
 * @param[in,out] start         samples to pass over until the next sample that is kept, or until the next mean begins
 *                              or is complete; 0 to begin with
 * @param[in]     reset         other than 0 forgets `partialCount` and `partialSum`, not `start`
 * @param[in,out] partialCount  samples in a mean that is not complete
 * @param[in,out] partialSum    their sum
 * @return                      0; -20140 when `factor` is below 1; -20059 when `start` is negative; -20001 without
 *                              memory. The stream stays as it was when a check fails.
 */
KRNUMER_API int32_t DecimateContinuous_H(KrHandle x, int32_t factor, int32_t averaging, int32_t* start, int32_t reset,
                                         int32_t* partialCount, double* partialSum);

/** DecimateContinuous_H of complex samples. */
KRNUMER_API int32_t CxDecimateContinuous_H(KrHandle x, int32_t factor, int32_t averaging, int32_t* start, int32_t reset,
                                           int32_t* partialCount, KrComplex* partialSum);

/**
 * Resamples a stream by L / M with an FIR filter at the rate of L samples per sample: y[k] = L * sum of
 * filter[i L - k M + (taps - 1) / 2] x[i] from a start of 0 (R. E. Crochiere and L. R. Rabiner, Multirate Digital
 * Signal Processing, chapter 3). The delay of the filter is taken off, and samples before the first count as 0.
 *
 * Filters of less than 2 L - 1 taps give the outputs of a block, but can leave a negative `start`, which the next call
 * refuses.
 *
 * @param[in]     x             the block's samples, of any number
 * @param[in]     L             factor of the rate, from 1 on
 * @param[in]     M             divisor of the rate, from 1 on
 * @param[in]     reset         other than 0 begins a stream: sizes `history` and forgets what it held, not `start`
 * @param[in,out] start         position of the next output in units of 1 / L samples, counted from the first sample
 *                              kept; 0 to begin with
 * @param[in]     filter        1-D double, an odd number of taps, whose sum is the gain at frequency 0; taken
 *                              forwards, so that one without symmetry correlates
 * @param[in,out] history       the samples kept, as those of `x`; (taps - 1) / L + 1 elements
 * @param[in,out] historyCount  how many of them there are
 * @param[out]    y             the outputs that the samples allow, which may be none
 * @return                      0; -20059 when `start` or `historyCount` is negative; -20140 when `L` or `M` is below 1;
 *                              -20033 when the number of taps is even; -20046 when `history` is too short; -20001
 *                              without memory. A failure empties `history` and `y`; `start` stays as it was.
 */
KRNUMER_API int32_t RationalResample_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start, KrHandle filter,
                                       KrHandle history, int32_t* historyCount, KrHandle y);

/** RationalResample_H of complex samples; the filter is real. */
KRNUMER_API int32_t CxRationalResample_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start,
                                         KrHandle filter, KrHandle history, int32_t* historyCount, KrHandle y);

/**
 * RationalResample_H of several channels at one position: `x`, `history` and `y` are 2-D with a row per channel.
 *
 * A `history` without rows is sized as by `reset`. One of another number of rows than `x`, neither 0, gives -20008.
 */
KRNUMER_API int32_t RationalResampleMultiCh_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start,
                                              KrHandle filter, KrHandle history, int32_t* historyCount, KrHandle y);

/** RationalResampleMultiCh_H of complex channels; the filter is real. */
KRNUMER_API int32_t CxRationalResampleMCh_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start,
                                            KrHandle filter, KrHandle history, int32_t* historyCount, KrHandle y);

#pragma pack(push, 1)

/** How Resample_Const resamples. */
typedef struct KrResampleSpec {
    double ratio;         /**< input samples per output sample, above 0 */
    int32_t mode;         /**< 1 reads the kernel at the nearest point of its table, any other interpolates linearly */
    double start;         /**< position of the first output in input samples */
    KrHandle kernel;      /**< 1-D double: the interpolation kernel, symmetric around its middle */
    int32_t oversampling; /**< points of the kernel per input sample, from 1 on */
} KrResampleSpec;

/** How Resample_Variable resamples. */
typedef struct KrVariableResampleSpec {
    int32_t mode;         /**< as in KrResampleSpec */
    uint8_t adaptive;     /**< other than 0 stretches the kernel by the step to each output where that is above 1 */
    KrHandle kernel;      /**< as in KrResampleSpec */
    int32_t oversampling; /**< as in KrResampleSpec */
} KrVariableResampleSpec;

/** A stream of Resample_Const between two blocks. All but the handles is set by the initialising call. */
typedef struct KrResampleState {
    KrHandle history;     /**< 1-D, as the samples: those kept */
    int32_t historyCount; /**< how many of them there are */
    KrHandle taps;        /**< 1-D double: weights of the samples around the next output */
    double gain;          /**< factor of the outputs */
    int32_t left;         /**< samples under the kernel up to the position of an output */
    int32_t right;        /**< and behind it */
    int32_t mode;         /**< of KrResampleSpec */
    double ratio;         /**< of KrResampleSpec */
    double frac;          /**< the next output stands at index + frac, */
    int32_t index;        /**< counted from the first sample kept */
} KrResampleState;

#pragma pack(pop)

/**
 * Resamples a stream at a constant ratio that need not be rational: y(t) = delta * sum of x[i] k(h + (i - t) delta),
 * with a kernel k of K points in a table, h = (K - 1) / 2 and delta = oversampling, divided by the ratio where that is
 * above 1, so that the kernel also limits the band (J. O. Smith and P. Gossett, ICASSP 1984). Samples before the first
 * count as 0.
 *
 * @param[in]     x            the block's samples, of any number
 * @param[in,out] state        the stream
 * @param[in]     spec         ratio, mode and start count when a stream begins, kernel and oversampling in every call
 * @param[in]     initialize   other than 0 begins a stream
 * @param[out]    y            room for the outputs, rounded up: behind the first `outCount` elements all are 0
 * @param[out]    outCount     number of outputs; 0 on failure
 * @param[in]     scaleKernel  0 keeps the kernel from being stretched
 * @return                     0; -20140 when the ratio is not above 0 or the oversampling is below 1; -20003 when the
 *                             kernel is empty; -20061 when a position does not fit 32 bits; -20059 when the state's
 *                             count is negative; -20046, -20075 when the state's `history` or `taps` is too short;
 *                             -20076 when `y` has no room; -20001 without memory. A failure leaves the state as it was,
 *                             but for sizes and elements of its arrays.
 */
KRNUMER_API int32_t Resample_Const(KrHandle x, KrResampleState* state, const KrResampleSpec* spec, int32_t initialize,
                                   KrHandle y, int32_t* outCount, int32_t scaleKernel);

/** Resample_Const of complex samples; history and outputs are complex, the kernel is real. */
KRNUMER_API int32_t CxResample_Const(KrHandle x, KrResampleState* state, const KrResampleSpec* spec, int32_t initialize,
                                     KrHandle y, int32_t* outCount, int32_t scaleKernel);

/**
 * Resamples at given positions, as Resample_Const does at equal steps. Positions count samples from the start of the
 * block; those that the block does not reach are left for the next, which begins with the samples not consumed.
 *
 * @param[in]     x         the block's samples: those not consumed and new ones
 * @param[in,out] times     positions, 1-D double; afterwards the first `outCount` are outputs, and the others are
 *                          counted from the next block
 * @param[in]     spec      how
 * @param[in,out] lastTime  the position before the first of `times`, in the same count; afterwards that of the last
 *                          output, counted from the next block
 * @param[out]    outCount  number of outputs; 0 on failure
 * @param[out]    consumed  samples that the caller takes off the front of `x` for the next call; 0 on failure
 * @return                  0, always without `times`; -20140 when the oversampling is below 1; -20003 when the kernel
 *                          is empty; -20061 when a position does not fit 32 bits; -20001 without memory. A failure
 *                          empties `times`.
 */
KRNUMER_API int32_t Resample_Variable(KrHandle x, KrHandle times, const KrVariableResampleSpec* spec, double* lastTime,
                                      int32_t* outCount, int32_t* consumed);

/**
 * Resample_Variable of complex samples, whose outputs go to an array of their own.
 *
 * @param[in]     x         the block's samples: those not consumed and new ones
 * @param[in,out] times     positions; those that were reached stay, the others are counted from the next block
 * @param[in]     spec      how
 * @param[out]    y         as many elements as there are `times`: outputs, and 0 behind the first `outCount`
 * @param[in,out] lastTime  as in Resample_Variable
 * @param[out]    outCount  number of outputs; 0 on failure
 * @param[out]    consumed  as in Resample_Variable
 * @return                  as of Resample_Variable. A failure empties `times` and `y`.
 */
KRNUMER_API int32_t CxResample_Variable(KrHandle x, KrHandle times, const KrVariableResampleSpec* spec, KrHandle y,
                                        double* lastTime, int32_t* outCount, int32_t* consumed);

/* ---- Samples in the time domain ---------------------------------------------------------------------------------- */

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
