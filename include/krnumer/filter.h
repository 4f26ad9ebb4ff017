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

#endif
