/*
 * Spectra at points that the plain Fourier transform does not reach: the chirp-Z transform on a spiral of the z-plane
 * and its inverse, and bands of lines out of long transforms.
 *
 * Outputs are 1-D arrays of complex double and are emptied by a failure.
 */
#ifndef KRNUMER_ZOOM_H
#define KRNUMER_ZOOM_H

#include <krnumer/types.h>

/**
 * Chirp-Z transform of real samples, X[k] = sum of x[j] A^-j W^(jk) for k from 0 to m - 1: the z-transform at A W^-k
 * (L. R. Rabiner, R. W. Schafer and C. M. Rader, Bell Syst. Tech. J. 48, 1249, 1969).
 *
 * With A = 1, W = exp(-2 pi i / n) and m = n it is the discrete Fourier transform.
 *
 * @param[in]  x          samples, 1-D double
 * @param[in]  a          A, where the spiral starts
 * @param[in]  w          W, the ratio of a point to the next
 * @param[in]  m          number of values; not positive for as many as samples
 * @param[in]  algorithm  0 the sum itself, n m terms with a power of W each; 1 as a convolution with a chirp (L. I.
 *                        Bluestein, IEEE Trans. AU 18, 451, 1970)
 * @param[out] y          values
 * @return                0; -20003 when `x` is empty; -20061 for another `algorithm`; -20001 without memory or when `y`
 *                        cannot be sized; -20068 when A, and then W, is not finite (the largest double counts as
 *                        infinite); -20141 when its squared modulus is 0
 */
KRNUMER_API int32_t ChirpZT_head(KrHandle x, const KrComplex* a, const KrComplex* w, int32_t m, int32_t algorithm,
                                 KrHandle y);

/** ChirpZT_head of complex samples, 1-D complex double. */
KRNUMER_API int32_t CxChirpZT_head(KrHandle x, const KrComplex* a, const KrComplex* w, int32_t m, int32_t algorithm,
                                   KrHandle y);

/**
 * Inverse chirp-Z transform: the m samples whose transform passes through m of the n values.
 *
 * With fewer samples than values, those values are taken that lie nearest the unit circle. The Vandermonde matrix of
 * the points is inverted explicitly, in O(m^2) steps; away from the unit circle it is badly conditioned.
 *
 * @param[in]  x  values, 1-D complex double
 * @param[in]  a  A, where the spiral starts
 * @param[in]  w  W, the ratio of a point to the next
 * @param[in]  m  number of samples, at most the number of values; not positive for as many
 * @param[out] y  samples
 * @return        0; -20003 when `x` is empty; -20008 when `m` is more than the values; -20001 without memory or when
 *                `y` cannot be sized; -20068 when A, and then W, is not finite; -20141 when its squared modulus is 0,
 *                or that of 1/W; -20060 when points of the spiral coincide
 */
KRNUMER_API int32_t InvChirpZT_head(KrHandle x, const KrComplex* a, const KrComplex* w, int32_t m, KrHandle y);

/**
 * Band of the discrete Fourier transform of length p k: lines start to start + count - 1, from p transforms of length
 * k.
 *
 * Fewer samples than p k are padded with zeros. More are folded, in place: what lies behind the first k samples (not
 * the first p k) is added to the front, p k at a time.
 *
 * @param[in,out] x      samples, 1-D complex double; folded on return where there are more than p k
 * @param[in]     p      number of phases, from 1 on
 * @param[in]     k      length of the short transforms, from 1 on
 * @param[in]     start  first line; negative lines continue the transform periodically
 * @param[in]     count  number of lines, from 1 on
 * @param[out]    y      lines; not touched where `x` is empty
 * @param[in,out] slot   table slot for length k, see krnumer/fft.h
 * @return               0, also where `x` is empty; -20021 when `p` is less than 1; -20115 when `count` is less than 1;
 *                       -20001 without memory or a table, so also when `k` is less than 1; the host's status when `y`
 *                       cannot be sized
 */
KRNUMER_API int32_t CxDZTH(KrHandle x, int32_t p, int32_t k, int32_t start, int32_t count, KrHandle y, void** slot);

/** CxDZTH of real samples, 1-D double. */
KRNUMER_API int32_t ReDZTH(KrHandle x, int32_t p, int32_t k, int32_t start, int32_t count, KrHandle y, void** slot);

#endif
