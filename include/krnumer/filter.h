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

#pragma pack(push, 1)
/** A band of an equiripple design; bands follow each other upward. */
typedef struct KrFirBand {
    double desired;  /**< the response wanted, not negative; of a differentiator, per unit of normalised frequency */
    double lowEdge;  /**< where the band begins */
    double highEdge; /**< where it ends, above lowEdge and below the next band */
    double weight;   /**< how much errors count, above 0; of a differentiator, relative to the response */
} KrFirBand;

/** A narrowband filter: a prototype with its taps apart, and an interpolator. */
typedef struct KrNarrowbandFilter {
    int32_t type;   /**< 0 lowpass, 1 highpass, 2 bandpass, 3 bandstop, 4 and 5 lowpass and highpass as complements */
    int32_t factor; /**< distance of the prototype's taps; with 1 there is no interpolator */
    KrHandle prototype;    /**< 1-D double */
    KrHandle interpolator; /**< 1-D double */
} KrNarrowbandFilter;
#pragma pack(pop)

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
 *                              no `b`; -20001 out of memory. The last two leave `x` and both states empty.
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
 *                              arrays are empty
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

/* ---- Filters without feedback ----------------------------------------------------------------------------------- */

/**
 * Impulse response of an ideal filter, cut off at `taps` values without any window. With t counted from the middle tap,
 * w1 = 2 pi fl / fs and w2 = 2 pi fh / fs:
 *
 *     lowpass    sin(w1 t) / (pi t)                   w1 / pi in the middle
 *     highpass  -sin(w1 t) / (pi t)               1 - w1 / pi
 *     bandpass  (sin(w2 t) - sin(w1 t)) / (pi t)      (w2 - w1) / pi
 *     bandstop  (sin(w1 t) - sin(w2 t)) / (pi t)  1 - (w2 - w1) / pi
 *
 * @param[in]  fs    sampling frequency; any unit that the edges share
 * @param[in]  fl    cut-off of types 0 and 1; lower edge of types 2 and 3
 * @param[in]  fh    upper edge of types 2 and 3; types 0 and 1 do not look at it
 * @param[in]  taps  number of values; odd for types 1 and 3
 * @param[out] h     1-D double, `taps` values, symmetric; empty on failure
 * @param[in]  type  0 lowpass, 1 highpass, 2 bandpass, 3 bandstop
 * @param[out] err   status, by the first that applies: 0; -20021 `taps` below 1; -20001 out of memory; -20061 another
 *                   type; -20020 an edge above fs/2; -20023 `fs`, `fl` or `fh` not positive, or `fl` not below `fh`;
 *                   -20033 `taps` even where it has to be odd
 * @return           0, or the status of the host when it refused the resize
 */
KRNUMER_API int32_t FIRCoefs(const double* fs, const double* fl, const double* fh, const int32_t* taps, KrHandle h,
                             const int32_t* type, int32_t* err);

/**
 * Equiripple filter: among all filters of its length the one whose largest weighted error over the bands is least, by
 * the exchange of J. H. McClellan, T. W. Parks and L. R. Rabiner (IEEE Trans. Audio Electroacoust. AU-21, 506, 1973) on
 * a grid of 16 points per cosine.
 *
 * Multiband filters are symmetric; their bands begin at 0 and end at fs/2 (up to 0.001 fs). Differentiators and Hilbert
 * transformers are antisymmetric. A differentiator approximates desired times f / fs, its weight counting relative to
 * that. With odd `taps` a differentiator has to end 0.01 fs below fs/2, a Hilbert transformer 0.001 fs, and a Hilbert
 * transformer always begins above 0.001 fs, since no response is to be had there.
 *
 * @param[in]  taps           number of values, 3 to about 4090
 * @param[in]  fs             sampling frequency
 * @param[in]  bands          1-D KrFirBand
 * @param[in]  type           0 multiband, 1 differentiator, 2 Hilbert transformer
 * @param[out] h              1-D double, `taps` values; empty on failure
 * @param[out] ripple         the largest error where the weight is 1; NaN on failure
 * @param[in]  maxIterations  rounds of the exchange, one less than this at the most; 100 when below 1
 * @param[out] err            status, by the first that applies: 0; -20021 `taps` below 1; -20023 another type; -20031
 *                            no bands; -20001 out of memory; -20031 `taps` below 3; -20023 `fs` not positive, an edge
 *                            or `desired` negative, or `weight` not positive; -20020 the last edge above fs/2; -20023
 *                            edges not ascending; -20031 bands that the type cannot serve; -20033 even `taps` where a
 *                            multiband filter shall let pass fs/2; -20001 too many taps; -20031 the exchange failed or
 *                            needs more rounds
 * @return                    0; the status of the host when it refused the resize; 2 when memory ran out in the design
 *                            or there are too many taps
 */
KRNUMER_API int32_t Parks(const int32_t* taps, const double* fs, KrHandle bands, const int32_t* type, KrHandle h,
                          double* ripple, const int32_t* maxIterations, int32_t* err);

/**
 * Narrowband filter that costs little: a prototype with its taps a factor apart and an interpolator that removes the
 * repetitions of its response (Y. Neuvo, C.-Y. Dong, S. K. Mitra, IEEE Trans. Acoust. Speech Signal Process. ASSP-32,
 * 563, 1984), both equiripple. The factor is the one with the fewest taps; with 1 there is only the prototype. What is
 * wide is designed as the complement of something narrow.
 *
 * @param[in]     fs           sampling frequency
 * @param[in]     fp           edge of the pass band; of types 2 and 3 its full width around `fc`
 * @param[in]     fstop        edge of the stop band; of types 2 and 3 its full width around `fc`
 * @param[in]     fc           centre of types 2 and 3; the others do not look at it
 * @param[in]     ripple       of the pass band: the response stays within 1 - ripple and 1 + ripple
 * @param[in]     attenuation  of the stop band in dB
 * @param[in]     type         0 lowpass, 1 highpass, 2 bandpass, 3 bandstop
 * @param[in,out] filter       the filter. Its arrays are replaced, and left empty on failure; its type becomes 4 for a
 *                             lowpass and 5 for a highpass that is a complement
 * @param[out]    err          status: 0; -20031 `fp` not positive, `fp` not below `fstop` after types 1 and 3 have
 *                             become their mirrors, `fstop` not below fs/2, another type, `ripple` not positive, an
 *                             attenuation beyond all numbers, a filter of more than a million taps, or of none; -20001
 *                             out of memory or too many taps; and what Parks reports
 * @return                     0
 */
KRNUMER_API int32_t FIRNarrowCoef_head(const double* fs, const double* fp, const double* fstop, const double* fc,
                                       const double* ripple, const double* attenuation, const int32_t* type,
                                       KrNarrowbandFilter* filter, int32_t* err);

/**
 * Filters by a narrowband filter: convolution with the interpolator, if there is one, and with the prototype, whose
 * taps stand `factor` samples apart. For types 3, 4 and 5 the signal itself is added, delayed by half of what the
 * filter is longer than one sample.
 *
 * @param[in]  x       1-D double, n samples
 * @param[in]  filter  as FIRNarrowCoef_head delivers it
 * @param[out] y       1-D double: the full convolution, of (np - 1) factor + ni + n - 1 samples for np taps of the
 *                     prototype and ni of the interpolator, or np + n - 1 with factor 1; empty on failure
 * @param[out] err     status, by the first that applies: 0; -20003 `x` empty; -20061 `factor` below 1; -20003 a filter
 *                     without taps; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t FIRnarrowFilter_head(KrHandle x, const KrNarrowbandFilter* filter, KrHandle y, int32_t* err);

/** FIRnarrowFilter_head for a complex signal, its parts filtered each for itself. `x` and `y` are 1-D complex. */
KRNUMER_API int32_t CxSigFIRnarrowFilter_head(KrHandle x, const KrNarrowbandFilter* filter, KrHandle y, int32_t* err);

/* ---- Smoothing, medians, zero phase ----------------------------------------------------------------------------- */

/**
 * Sliding median: every sample becomes the median of the window from `rank` samples before it to `rank` samples behind
 * it. The signal counts as 0 outside. NaN sorts below all numbers.
 *
 * @param[in,out] x     1-D double, n samples; empty on failure
 * @param[in]     rank  samples on each side; 0 leaves the signal as it is
 * @param[out]    err   status, by the first that applies: 0; -20032 `rank` negative; -20008 n not above `rank` (an
 *                      empty signal passes); -20001 out of memory
 * @return              0
 */
KRNUMER_API int32_t MedianFilterCIN(KrHandle x, const int32_t* rank, int32_t* err);

/**
 * Sliding median of a window with two sides. Where it holds an even number of samples, its median is the mean of the
 * two in the middle.
 *
 * @param[in,out] x      1-D double, n samples; empty on failure
 * @param[in]     left   samples before the middle; may exceed n
 * @param[in]     right  samples behind the middle; negative: as many as before it
 * @return               0, or the first that applies: -20032 `left` negative; -20008 n not above `right` (an empty
 *                       signal passes); -20001 out of memory
 */
KRNUMER_API int32_t MedianFilter81_H(KrHandle x, int32_t left, int32_t right);

/**
 * Matrices that fit polynomials to frames of samples (A. Savitzky, M. J. E. Golay, Anal. Chem. 36, 1627, 1964). With V
 * the powers t^k of t = -(frame - 1)/2 ... (frame - 1)/2 and W the weights' magnitudes on the diagonal,
 *
 *     differentiators  D = (V^T W V)^-1 V^T W,   smoothing  S = V D.
 *
 * Row k of D, applied to a frame, gives the coefficient of t^k of the best polynomial: the derivative in the middle, in
 * units of samples, without the factor k!. Row i of S gives the value of the polynomial at sample i.
 *
 * @param[in]  order                of the polynomial
 * @param[in]  frame                samples in a frame, odd
 * @param[in]  weights              1-D double, `frame` weights of the squared deviations, or empty for equal ones
 * @param[in]  wantDifferentiators  0 leaves `differentiators` as it came
 * @param[out] smoothing            2-D double, `frame` by `frame`
 * @param[out] differentiators      2-D double, order + 1 rows of `frame` columns
 * @return                          0, or the first that applies: -20063 `order` below 1; -20037 `frame` not above
 *                                  `order`; -20002 another number of weights; -20001 out of memory; -20033 `frame`
 *                                  even; -20068 a weight that is not finite; -20071 weights that leave the polynomial
 *                                  undetermined. Both matrices are empty on failure.
 */
KRNUMER_API int32_t SavitzkyGolayCoefH(int32_t order, int32_t frame, KrHandle weights, int32_t wantDifferentiators,
                                       KrHandle smoothing, KrHandle differentiators);

/**
 * Smooths by polynomials: every sample becomes the value there of the polynomial that fits the frame around it best,
 * the first and last ones that of the first or last full frame. Polynomials up to `order` stay as they are, to the
 * ends.
 *
 * @param[in]  x        1-D double, n samples
 * @param[in]  order    of the polynomials
 * @param[in]  frame    samples in a frame, odd
 * @param[in]  weights  1-D double, `frame` weights of the squared deviations, or empty for equal ones
 * @param[out] y        1-D double, n samples; empty on failure
 * @return              0, or the first that applies: -20063 `order` below 1; -20037 `frame` not above `order`; -20002
 *                      another number of weights; -20001 out of memory; -20008 n below `frame`; then as
 *                      SavitzkyGolayCoefH
 */
KRNUMER_API int32_t SavitzkyGolayFiltH(KrHandle x, int32_t order, int32_t frame, KrHandle weights, KrHandle y);

/**
 * Filters forward and backward in direct form (see IIR_Filter), which squares the magnitude of the response and cancels
 * its phase. On both sides the signal is continued by as many zeros as the longer coefficient array has elements; what
 * has not died out there is lost. Without both coefficient arrays nothing is done.
 *
 * @param[in,out] x              1-D double: the signal, replaced by the filtered one; stays on failure
 * @param[in]     a              1-D double, na feedback coefficients, or empty
 * @param[in]     b              1-D double, nb feedforward coefficients
 * @param[in,out] forwardState1  1-D double, nb - 1 elements: state of the forward pass
 * @param[in,out] forwardState2  1-D double, nb - 1 elements: state of the backward pass
 * @param[in,out] reverseState1  1-D double, na - 1 elements: state of the forward pass
 * @param[in,out] reverseState2  1-D double, na - 1 elements: state of the backward pass
 * @param[in]     keepState      0 clears the states first. A state of another length is resized and cleared in any
 *                               case. Reverse states are not looked at when `a` is empty.
 * @return                       0; -20003 `x` empty (nothing is touched); -20008 `a` without `b`, -20001 out of memory
 *                               (both leave the four states empty)
 */
KRNUMER_API int32_t zeroPhaseFiltH(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState1, KrHandle forwardState2,
                                   KrHandle reverseState1, KrHandle reverseState2, int32_t keepState);

#endif
