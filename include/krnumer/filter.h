/*
 * Digital filters: design and application of recursive (IIR) and non-recursive (FIR) filters.
 *
 * A cascade is the form in which the recursive designs come. It has h = (order + 1) / 2 sections, in integer division,
 * and each section has m feedback coefficients a[1] ... a[m], behind a leading 1 that is not stored, and m + 1
 * feedforward coefficients b[0] ... b[m]:
 *
 *     type                        section order m   length of a   length of b
 *     0 lowpass,  1 highpass             2              2 h           3 h
 *     2 bandpass, 3 bandstop             4              4 h           5 h
 *
 * With an odd order the first section has half the order of the others; its coefficients above are 0.
 */
#ifndef KRNUMER_FILTER_H
#define KRNUMER_FILTER_H

#include <krnumer/types.h>

/* ---- Recursive filters in closed form --------------------------------------------------------------------------- */

/**
 * Butterworth filter: an analogue prototype with its poles on the unit circle, evenly spread over the left half, goes
 * through the frequency transformation of the type and the bilinear transform, the edges prewarped by the tangent
 * (A. G. Constantinides, Proc. IEE 117, 1585, 1970). The response is -3 dB at the edges.
 *
 * @param[in]  fs     sampling frequency; any unit that the edges share
 * @param[in]  fl     cut-off of types 0 and 1; lower edge of types 2 and 3
 * @param[in]  fh     upper edge of types 2 and 3; types 0 and 1 do not look at it
 * @param[in]  order  order of the prototype; types 2 and 3 make a filter of twice that order
 * @param[in]  type   0 lowpass, 1 highpass, 2 bandpass, 3 bandstop
 * @param[out] a      1-D double: feedback coefficients of the cascade
 * @param[out] b      1-D double: feedforward coefficients of the cascade
 * @param[out] err    status, by the first that applies: 0; -20021 `order` below 1; -20001 out of memory; -20023 `fl`,
 *                    `fh` or `fs` not positive, or `fl` not below `fh`; -20020 an edge above fs/2 (fs/2 itself passes);
 *                    -20061 another type. Both outputs are empty on failure.
 * @return            0, or the status of the host when it refused a resize
 */
KRNUMER_API int32_t BWCoefs(const double* fs, const double* fl, const double* fh, const int32_t* order,
                            const int32_t* type, KrHandle a, KrHandle b, int32_t* err);

/**
 * Filter with poles on the unit circle of the prototype, as those of BWCoefs, but at equal distances along the
 * imaginary axis: pair k is s^2 + 2 d s + 1 with d = sqrt(1 - x^2), x = 1 - (2k + 1) / order. Its transition is gentler
 * and its step response overshoots less. This is not the filter of the Bessel polynomials.
 *
 * Arguments and status codes are those of BWCoefs.
 */
KRNUMER_API int32_t BesselCoefs(const double* fs, const double* fl, const double* fh, const int32_t* order,
                                const int32_t* type, KrHandle a, KrHandle b, int32_t* err);

/**
 * Chebyshev filter: equal ripple in the pass band, down to -ripple dB, which is also the response at the edges. A
 * bandpass or bandstop of order 1 is the Butterworth filter, -3 dB at the edges whatever the ripple.
 *
 * @param[in]  ripple  of the pass band, peak to peak in dB; -20024 when it is not positive, tested after the edges and
 *                     before the type
 *
 * The other arguments and status codes are those of BWCoefs.
 */
KRNUMER_API int32_t ChebyshevCoefs(const double* fs, const double* fl, const double* fh, const double* ripple,
                                   const int32_t* order, const int32_t* type, KrHandle a, KrHandle b, int32_t* err);

/**
 * Inverse Chebyshev filter: a flat pass band, equal ripple in the stop band. The edges are those of the stop band,
 * where the response comes down to -attenuation dB first.
 *
 * @param[in]  attenuation  of the stop band in dB; -20025 when it is not positive, tested after the edges and before
 *                          the type
 *
 * The other arguments and status codes are those of BWCoefs.
 */
KRNUMER_API int32_t InvChebyshevCoefs(const double* fs, const double* fl, const double* fh, const double* attenuation,
                                      const int32_t* order, const int32_t* type, KrHandle a, KrHandle b, int32_t* err);

/**
 * Elliptic filter: equal ripple in pass band and stop band, and with them the steepest transition that the order
 * allows. The response is -ripple dB at the edges. (T. W. Parks, C. S. Burrus, Digital Filter Design, 1987, 7.2.7;
 * elliptic functions by R. Bulirsch, Numer. Math. 7, 78, 1965.)
 *
 * @param[in]  ripple       of the pass band, peak to peak in dB; -20024 when it is not positive
 * @param[in]  attenuation  of the stop band in dB; -20025 when it is not positive; -20028 when it is not above `ripple`
 *
 * These codes come in this order, after those of the edges and before that of the type. The other arguments and status
 * codes are those of BWCoefs.
 */
KRNUMER_API int32_t EllipticCoefs(const double* fs, const double* fl, const double* fh, const double* ripple,
                                  const double* attenuation, const int32_t* order, const int32_t* type, KrHandle a,
                                  KrHandle b, int32_t* err);

/* ---- Recursive filters at work ---------------------------------------------------------------------------------- */

/*
 * A filter keeps what it remembers in state arrays of the caller, so that a long signal can be filtered block by block
 * without a seam: the first call with any `init` but 1, the following ones with `init` 1 and the states that the call
 * before left. A state of another length than the coefficients ask for is no error; it is resized, and the filter
 * starts anew.
 */

/**
 * Filters by one difference equation,
 *
 *     a[0] y[i] = b[0] x[i] + ... + b[nb-1] x[i-nb+1] - a[1] y[i-1] - ... - a[na-1] y[i-na+1],
 *
 * every sum from the oldest sample to the newest. Without `a` this is y[i] = b[0] x[i] + ... + b[nb-1] x[i-nb+1]. a[0]
 * is not tested against 0. Without both coefficient arrays nothing is done.
 *
 * @param[in,out] x             1-D double: the signal, replaced by the filtered one
 * @param[in]     a             1-D double: feedback coefficients, or empty
 * @param[in]     b             1-D double: feedforward coefficients
 * @param[in,out] forwardState  1-D double, nb - 1 elements: the last inputs, the oldest first
 * @param[in,out] reverseState  1-D double, na - 1 elements: the last outputs, the oldest first; not looked at when `a`
 *                              is empty
 * @param[in]     init          1: go on from the states; any other value: clear them first
 * @param[out]    err           status: 0; -20003 when `x` is empty (nothing is touched); -20008 when there is `a` and
 * no `b`; -20001 out of memory. The last two leave `x` and both states empty.
 * @return                      0, or the status of the host when it refused a resize
 */
KRNUMER_API int32_t IIR_Filter(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState, KrHandle reverseState,
                               const uint8_t* init, int32_t* err);

/**
 * IIR_Filter for a complex signal, its parts filtered each for itself by real coefficients. `x` and both states are
 * 1-D complex.
 */
KRNUMER_API int32_t CxSigIIR_Filter(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState, KrHandle reverseState,
                                    const uint8_t* init, int32_t* err);

/** IIR_Filter in complex arithmetic: all arrays are 1-D complex. */
KRNUMER_API int32_t CxIIR_Filter_H(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState, KrHandle reverseState,
                                   const uint8_t* init, int32_t* err);

/**
 * Filters a real signal by complex coefficients; the difference equation is that of IIR_Filter.
 *
 * @param[in]     x             1-D double: the signal
 * @param[out]    y             1-D complex, as long as `x`: the filtered signal; as it came when both coefficient
 * arrays are empty
 * @param[in]     a             1-D complex: feedback coefficients, or empty
 * @param[in]     b             1-D complex: feedforward coefficients
 * @param[in,out] forwardState  1-D double, nb - 1 elements: the last inputs, the oldest first
 * @param[in,out] reverseState  1-D complex, na - 1 elements: the last outputs, the oldest first; not looked at when `a`
 *                              is empty
 * @param[in]     init          1: go on from the states; any other value: clear them first
 * @return                      0; -20003 when `x` is empty (leaves `y` empty and the states as they are); -20008 when
 *                              there is `a` and no `b`, -20001 out of memory (both leave `y` and the states empty)
 */
KRNUMER_API int32_t CxIIRReSig_Filter_H(KrHandle x, KrHandle y, KrHandle a, KrHandle b, KrHandle forwardState,
                                        KrHandle reverseState, const uint8_t* init);

/**
 * Filters by a cascade of ns sections of order m, as the designs above deliver it. Each section runs in direct form II,
 * with its state w[1] ... w[m]:
 *
 *     t = v - (a[1] w[1] + ... + a[m] w[m]),  v = b[0] t + (b[1] w[1] + ... + b[m] w[m]),  w = t, w[1] ... w[m-1]
 *
 * Without both coefficient arrays nothing is done.
 *
 * @param[in,out] x          1-D double: the signal, replaced by the filtered one
 * @param[in]     structure  0: sections of order 2 (lowpass, highpass); 1: of order 4 (bandpass, bandstop)
 * @param[in]     a          1-D double, m ns elements: feedback coefficients
 * @param[in]     b          1-D double, (m + 1) ns elements: feedforward coefficients
 * @param[in,out] state      1-D double, m ns elements: of each section in turn, the newest first
 * @param[in]     init       1: go on from the state; any other value: clear it first
 * @param[out]    err        status, by the first that applies: 0; -20003 when `x` is empty, -20061 for another
 *                           `structure` (both touch nothing); -20008 when one coefficient array is empty, -20001 out of
 *                           memory, -20066 when the lengths of `a` and `b` do not fit (these leave `x` and `state`
 *                           empty)
 * @return                   0, or the status of the host when it refused a resize
 */
KRNUMER_API int32_t IIR_Filter2(KrHandle x, const int32_t* structure, KrHandle a, KrHandle b, KrHandle state,
                                const uint8_t* init, int32_t* err);

/**
 * IIR_Filter2 for a complex signal, its parts filtered each for itself. `x` and `state` are 1-D complex, the
 * coefficients real.
 */
KRNUMER_API int32_t CxSigIIR_Filter2(KrHandle x, const int32_t* structure, KrHandle a, KrHandle b, KrHandle state,
                                     const uint8_t* init, int32_t* err);

#endif
