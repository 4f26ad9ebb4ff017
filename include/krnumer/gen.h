/*
 * Signal generation: waves that carry their phase from block to block, patterns that start afresh, pulse shapes.
 *
 * The first argument of each function is the 1-D array of double that is sized to n samples and filled. It is emptied
 * by every failure. Frequencies of waves are in cycles per sample, phases in degrees, times in seconds.
 *
 * Except for the ramps, a size that the host refuses leaves -20001 in `err` and makes the host's status the function
 * result.
 */
#ifndef KRNUMER_GEN_H
#define KRNUMER_GEN_H

#include <krnumer/types.h>

/* ---- Waves: `phase` is the phase of the first sample, and on return, within 0 up to 360, of the one after the last.
 *      Handed on from call to call it joins blocks without a seam. A call that fails leaves it alone. ------------- */

/**
 * Sine, amplitude sin(2 pi frequency i + phase).
 *
 * By the two-step recurrence of sine and cosine from five trigonometric calls for the whole block, cut off at
 * +-amplitude. Its rounding grows with the block, and with frequencies of many cycles per sample from the start.
 *
 * @param[out]    x          samples
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  peak value
 * @param[in]     frequency  cycles per sample
 * @param[in,out] phase      degrees
 * @param[out]    err        status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 * @return                   0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t SineWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency,
                                double* phase, int32_t* err);

/**
 * Square wave: amplitude in the first `duty` percent of a period, -amplitude in the rest.
 *
 * The phase of sample i is phase + i frequency 360, formed by multiplication, so that rounding does not add up.
 *
 * @param[out]    x          samples
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  high level; the low level is its negative
 * @param[in]     frequency  cycles per sample
 * @param[in,out] phase      degrees
 * @param[in]     duty       percent; values outside 0 to 100 act as the limit, NaN as 0. The sample on the edge is low
 * @param[out]    err        status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 * @return                   0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t SquareWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency,
                                  double* phase, const double* duty, int32_t* err);

/**
 * Sawtooth: rises from 0 at phase 0 towards amplitude, falls to -amplitude at 180 degrees and rises on.
 *
 * @param[out]    x          samples
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  peak value
 * @param[in]     frequency  cycles per sample
 * @param[in,out] phase      degrees
 * @param[out]    err        status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 * @return                   0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t SawtoothWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency,
                                    double* phase, int32_t* err);

/**
 * Triangle: 0 at phase 0, amplitude at 90, 0 at 180, -amplitude at 270 degrees.
 *
 * @param[out]    x          samples
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  peak value
 * @param[in]     frequency  cycles per sample
 * @param[in,out] phase      degrees
 * @param[out]    err        status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 * @return                   0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t TriangleWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency,
                                    double* phase, int32_t* err);

/**
 * Wave of any shape, read out of a table that holds one period.
 *
 * The position in the table advances by its length times `frequency` from sample to sample as a running sum.
 *
 * @param[out]    x              samples
 * @param[in]     n              number of samples, from 1 on
 * @param[in]     amplitude      factor of the table's values
 * @param[in]     frequency      cycles per sample
 * @param[in,out] phase          degrees; 0 on return from an empty table
 * @param[in]     table          one period, 1-D double; an empty one gives zeros
 * @param[in]     interpolation  1 on the straight line between neighbours, else the entry at or before the position
 * @param[out]    err            status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 * @return                       0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t ArbitraryWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency,
                                     double* phase, KrHandle table, const int32_t* interpolation, int32_t* err);

/* ---- Patterns ---------------------------------------------------------------------------------------------------- */

/**
 * Chirp, a sine whose frequency runs linearly from f1 at sample 0 to f2 at sample n: amplitude sin((i k + 2 pi f1) i)
 * with k = (f2 - f1) pi / n.
 *
 * @param[out] x          samples
 * @param[in]  n          number of samples, from 1 on
 * @param[in]  amplitude  peak value
 * @param[in]  f1         first frequency in cycles per sample
 * @param[in]  f2         last frequency in cycles per sample
 * @param[out] err        status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 * @return                0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t ChirpCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* f1, const double* f2,
                             int32_t* err);

/**
 * Sine of a given number of cycles over the whole array, by the recurrence of SineWaveCIN.
 *
 * @param[out] x          samples
 * @param[in]  n          number of samples, from 1 on
 * @param[in]  amplitude  peak value
 * @param[in]  phase      phase of the first sample in degrees; not changed
 * @param[in]  cycles     periods in the array, whole or broken, above 0 and at most `n`
 * @param[out] err        status: 0; -20003 when `n` is less than 1; -20012 when `cycles` is out of range; -20001 when
 *                        `x` cannot be sized
 * @return                0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t SinePtrn(KrHandle x, const int32_t* n, const double* amplitude, const double* phase,
                             const double* cycles, int32_t* err);

/**
 * Square pattern: amplitude in the first `duty` percent of each period, 0 in the rest. Period, trunc(n / cycles + 0.5),
 * and its high part, trunc(period duty / 100 + 0.5), are whole samples.
 *
 * @param[out] x          samples
 * @param[in]  n          number of samples, from 1 on
 * @param[in]  amplitude  high level; the low level is 0
 * @param[in]  duty       percent, above 0; from 100 on all samples are high
 * @param[in]  cycles     periods in the array, above 0 and at most n / 2 (whole part)
 * @param[out] err        status: 0; -20003 when `n` is less than 1; else -20001 when `x` cannot be sized; else -20012
 *                        when `cycles` is out of range; else -20011 when `duty` is not positive
 * @return                0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t Square(KrHandle x, const int32_t* n, const double* amplitude, const double* duty,
                           const double* cycles, int32_t* err);

/**
 * Impulse: one sample of `amplitude` among zeros.
 *
 * @param[out] x          samples
 * @param[in]  n          number of samples, from 1 on
 * @param[in]  amplitude  value of the impulse
 * @param[in]  delay      its index, from 0 to n - 1
 * @param[out] err        status: 0; -20003 when `n` is less than 1; -20017 when `delay` is out of range; -20001 when
 *                        `x` cannot be sized
 * @return                0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t ImpulsePtrn(KrHandle x, const int32_t* n, const double* amplitude, const int32_t* delay,
                                int32_t* err);

/**
 * Pulse: `width` samples of `amplitude` after `delay` zeros, then zeros.
 *
 * @param[out] x          samples
 * @param[in]  n          number of samples, from 1 on
 * @param[in]  amplitude  value of the pulse
 * @param[in]  delay      samples before the pulse, from 0 on
 * @param[in]  width      samples of the pulse, from 0 on
 * @param[out] err        status: 0; -20003 when `n` is less than 1; -20014 when `delay` or `width` is negative or their
 *                        sum above `n`; -20001 when `x` cannot be sized
 * @return                0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t PulsePtrn(KrHandle x, const int32_t* n, const double* amplitude, const int32_t* delay,
                              const int32_t* width, int32_t* err);

/**
 * Sinc, amplitude sin(u) / u at u = pi (i dt - delay), and `amplitude` at u = 0.
 *
 * @param[out] x          samples
 * @param[in]  n          number of samples, from 1 on
 * @param[in]  amplitude  peak value; also the value where the time is NaN
 * @param[in]  delay      time of the peak
 * @param[in]  dt         sampling interval, above 0
 * @param[out] err        status: 0; -20003 when `n` is less than 1; -20016 when `dt` is not positive; -20001 when `x`
 *                        cannot be sized
 * @return                0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t SincWave(KrHandle x, const int32_t* n, const double* amplitude, const double* delay,
                             const double* dt, int32_t* err);

/**
 * Ramp with both ends: RampPtrn80 with `option` 0.
 *
 * @param[out] x      samples
 * @param[in]  n      number of samples
 * @param[in]  start  first sample
 * @param[in]  end    last sample
 * @param[out] err    the status of RampPtrn80
 * @return            0
 */
KRNUMER_API int32_t RampPtrn(KrHandle x, const int32_t* n, const double* start, const double* end, int32_t* err);

/**
 * Ramp, start + i step, the step being end - start over n - 1 (`option` 0) or n.
 *
 * @param[out] x       samples
 * @param[in]  n       number of samples; with `option` 0 from 2 on, or 1 if both ends are equal, else from 1 on
 * @param[in]  start   first sample
 * @param[in]  end     with `option` 0 the last sample, exactly; else the sample that would come next
 * @param[in]  option  0 with the end, anything else without
 * @return             0; -20006 when `option` is 0 and `n` less than 2, unless it is 1 and the ends are equal; -20005
 *                     when `option` is not 0 and `n` less than 1; -20001 when `x` cannot be sized
 */
KRNUMER_API int32_t RampPtrn80(KrHandle x, int32_t n, double start, double end, int32_t option);

/* ---- Pulse shapes on the time axis t = i dt - delay. An array that already holds elements is taken for an axis of
 *      time of its own, which has no sampling interval: after the checks that come before the one of `dt`, the call
 *      ends with -20016. Samples come out of an empty array only. ------------------------------------------------- */

/**
 * Single triangle of `width` seconds from t = 0 on, with its peak at `skew` of the width.
 *
 * @param[in,out] x          empty; samples on return
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  height of the peak
 * @param[in]     delay      time of sample 0 before t = 0
 * @param[in]     dt         sampling interval, above 0
 * @param[in]     width      seconds, above 0
 * @param[in]     skew       place of the peak, 0 at the start of the triangle to 1 at its end
 * @return                   0; -20003 when `n` is less than 1; -20140 when `width` is not positive; -20016 when `dt` is
 *                           not positive or `x` is not empty; -20053 when `skew` is outside 0 to 1; the host's status
 *                           when `x` cannot be sized
 */
KRNUMER_API int32_t AperiodTriangleH(KrHandle x, int32_t n, double amplitude, double delay, double dt, double width,
                                     double skew);

/**
 * Gaussian monopulse, 2 sqrt(e) amplitude u exp(-2 u^2) with u = pi fc t: the first derivative of a Gaussian.
 *
 * @param[in,out] x          empty; samples on return
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     dt         sampling interval, above 0
 * @param[in]     delay      time of sample 0 before t = 0
 * @param[in]     fc         centre frequency in hertz, above 0
 * @param[in]     amplitude  peak value
 * @return                   0; -20140 when `fc` is not positive; -20003 when `n` is less than 1; -20016 when `dt` is
 *                           not positive or `x` is not empty; the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t GaussMonopulseH(KrHandle x, int32_t n, double dt, double delay, double fc, double amplitude);

/**
 * Gaussian pulse, amplitude exp(c u^2) cos(2 u) with u = pi fc t and c = -5 bandwidth^2 / (attenuation ln 10).
 *
 * @param[in,out] x            empty; samples on return
 * @param[in]     n            number of samples, from 1 on
 * @param[in]     amplitude    peak value
 * @param[in]     delay        time of sample 0 before t = 0
 * @param[in]     dt           sampling interval, above 0
 * @param[in]     fc           centre frequency in hertz, above 0
 * @param[in]     bandwidth    width of the band as a fraction of fc, above 0
 * @param[in]     attenuation  dB, above 0
 * @return                     0; -20140 when `fc`, `bandwidth` or `attenuation` is not positive; -20003 when `n` is
 *                             less than 1; -20016 when `dt` is not positive or `x` is not empty; the host's status when
 *                             `x` cannot be sized
 */
KRNUMER_API int32_t GaussPulseH(KrHandle x, int32_t n, double amplitude, double delay, double dt, double fc,
                                double bandwidth, double attenuation);

/**
 * Periodic sinc (Dirichlet kernel), amplitude sin(order t / 2) / (order sin(t / 2)).
 *
 * Where |sin(t / 2)| is not above 2^-52 the value is `amplitude`, also where the limit would be its negative.
 *
 * @param[in,out] x          empty; samples on return
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  peak value
 * @param[in]     order      order of the kernel, from 1 on
 * @param[in]     dt         sampling interval, above 0
 * @param[in]     delay      time of sample 0 before t = 0
 * @return                   0; -20140 when `order` is less than 1; -20003 when `n` is less than 1; -20016 when `dt` is
 *                           not positive or `x` is not empty; the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t PeriodicSincH(KrHandle x, int32_t n, double amplitude, int32_t order, double dt, double delay);

#endif
