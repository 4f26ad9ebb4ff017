/*
 * Power and cross power spectra, and the streaming blocks of a digital down-converter: moving sums and modulators.
 *
 * A table slot is a pointer cell of the caller, see krnumer/fft.h.
 */
#ifndef KRNUMER_SPECTRUM_H
#define KRNUMER_SPECTRUM_H

#include <krnumer/types.h>

/* ---- Spectra: two-sided, all n lines filled, scaled by 1/n^2, so that a constant v has v^2 at DC at any length. A
 *      single sample is its own line. ----------------------------------------------------------------------------- */

/**
 * Power spectrum of real samples, |X[k]|^2 / n^2, in place.
 *
 * @param[in,out] x     samples, 1-D double; the spectrum on return, emptied on failure
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table
 */
KRNUMER_API int32_t SpectrumH(KrHandle x, void** slot);

/**
 * Power spectrum of complex samples, |X[k]|^2 / n^2.
 *
 * @param[in]     x     samples, 1-D complex double
 * @param[out]    y     spectrum, 1-D double; emptied on failure
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table, or when `y` cannot be sized
 */
KRNUMER_API int32_t CxSpectrumH(KrHandle x, KrHandle y, void** slot);

/**
 * Cross power spectrum of real samples, conj(X[k]) Y[k] / n^2.
 *
 * @param[in]     x     samples, 1-D double
 * @param[in]     y     samples, 1-D double, as many as in `x`
 * @param[out]    z     spectrum, 1-D complex double; emptied on failure
 * @param[in,out] slot  table slot; not bound when `z` cannot be sized
 * @return              0; -20003 when `x` or `y` is empty; -20002 when they differ in length; -20001 without memory or
 *                      a table, or when `z` cannot be sized
 */
KRNUMER_API int32_t CrossSpectrumH(KrHandle x, KrHandle y, KrHandle z, void** slot);

/** CrossSpectrumH of complex samples, 1-D complex double. */
KRNUMER_API int32_t CxCrossSpectrumH(KrHandle x, KrHandle y, KrHandle z, void** slot);

/* ---- Moving sums and modulators. All state is the caller's, so that a signal can come in blocks of any size. They
 *      return 0 whenever an aligned copy of an array, where one is needed, can be had, and -20001, with the arrays
 *      emptied, where it cannot. ---------------------------------------------------------------------------------- */

/**
 * Cascade of moving sums of one width, in place: after C stages the gain is w^C.
 *
 * The state is begun anew, all 0, by `reset` and whenever its dimensions or the position do not fit C and w. A state
 * that the host refuses to size is left empty, `x` as it was. The sums run on by what comes and what goes, so a NaN
 * stays.
 *
 * @param[in,out] x        samples, 1-D double
 * @param[in]     stages   C; nothing is done where it is not positive
 * @param[in]     window   w, samples in each sum; nothing is done where it is 1 or less, unless there is a `reset`
 * @param[in,out] sums     running sum of each stage, 1-D double of C
 * @param[in,out] history  last inputs of each stage, 2-D double of C rows and w columns, as rings
 * @param[in,out] index    position in the rings, 0 to w (which is 0 again)
 * @param[in]     reset    not 0: begin anew
 * @return                 0
 */
KRNUMER_API int32_t ReCascadedMovingAverageH(KrHandle x, int32_t stages, int32_t window, KrHandle sums,
                                             KrHandle history, int32_t* index, int32_t reset);

/** ReCascadedMovingAverageH of complex samples, sums and history. */
KRNUMER_API int32_t CxCascadedMovingAverageH(KrHandle x, int32_t stages, int32_t window, KrHandle sums,
                                             KrHandle history, int32_t* index, int32_t reset);

/**
 * Sums of m samples each. They take the place of the first samples; `x` keeps its length.
 *
 * @param[in,out] x         samples, 1-D double
 * @param[in]     m         samples in each sum; below 2 they stay as they are
 * @param[in,out] sum       sum of the block that is still open
 * @param[in,out] count     samples in it; a value that m does not allow begins anew
 * @param[in]     reset     not 0: begin anew
 * @param[out]    outCount  number of sums; the length of `x` where m is below 2
 * @return                  0
 */
KRNUMER_API int32_t ReDecimatedMovingAverageH(KrHandle x, int32_t m, double* sum, int32_t* count, int32_t reset,
                                              int32_t* outCount);

/** ReDecimatedMovingAverageH of complex samples. */
KRNUMER_API int32_t CxDecimatedMovingAverageH(KrHandle x, int32_t m, KrComplex* sum, int32_t* count, int32_t reset,
                                              int32_t* outCount);

/**
 * Shifts real samples in frequency: y[k] = x[k] exp(i (phase + 2 pi k f / fs)).
 *
 * The phasor comes by repeated rotation. Where f / fs is 0 nothing is changed, neither by the phase nor the phase
 * itself: `y` then only has its size.
 *
 * @param[in]     x      samples, 1-D double; where there is none, nothing is done
 * @param[in]     f      frequency of the phasor
 * @param[in]     fs     sampling frequency, in the same unit
 * @param[in,out] phase  radians, of the first sample; on return of the next, within 0 to 2 pi
 * @param[out]    y      shifted samples, 1-D complex double; emptied when it cannot be sized
 * @return               0
 */
KRNUMER_API int32_t ReComplexModulatorH(KrHandle x, double f, double fs, double* phase, KrHandle y);

/**
 * Shifts complex samples in frequency, in place, as ReComplexModulatorH does.
 *
 * @param[in,out] x      samples, 1-D complex double; where there is none, `phase` is still brought into 0 to 2 pi
 * @param[in]     f      frequency of the phasor
 * @param[in]     fs     sampling frequency, in the same unit
 * @param[in,out] phase  radians, of the first sample; on return of the next
 * @return               0
 */
KRNUMER_API int32_t CxComplexModulatorH(KrHandle x, double f, double fs, double* phase);

#endif
