/*
 * Discrete Fourier transforms of any length.
 *
 *     forward   X[k] = sum over j of x[j] exp(-2 pi i j k / n)
 *     inverse   x[j] = 1/n sum over k of X[k] exp(+2 pi i j k / n)
 *
 * Mixed-radix decimation in time over generated short transforms (S. Winograd, Math. Comp. 32, 1978); a prime factor
 * of 53 and above by convolution (C. M. Rader, Proc. IEEE 56, 1968); real data by transforms of their own and the
 * Hartley identity for their inverse (R. N. Bracewell, The Hartley Transform, Oxford 1986). Every length costs
 * O(n log n), lengths of small prime factors the least. Infinities and NaN spread through the arithmetic.
 *
 * Half-complex form of the spectrum of n real samples: n doubles, Re X[p] at p <= n/2 and Im X[n-p] at p > n/2. What it
 * leaves out is zero or follows from X[n-k] = conj X[k].
 *
 * A shifted spectrum has X[0] at index n/2 (rounded down): y[j] = X[(j - n/2) mod n]. For even n the Nyquist term then
 * stands at index 0. `shift` is 0 or not; it acts on the output of a forward transform and on the input of an inverse.
 *
 * A table slot is a pointer cell of the caller, one per call site, that starts as null. The library keeps there the
 * tables of the last length asked for, and has the host release them with the calling instance. Calls at one slot must
 * not overlap in time; otherwise any number of threads may call. Long transforms take up to 300 KiB of their stack.
 *
 * Unless a function says otherwise, the checks of its arguments leave the output as it is, and any failure after the
 * output was resized leaves it empty. Input and output may be the same array.
 */
#ifndef KRNUMER_FFT_H
#define KRNUMER_FFT_H

#include <krnumer/types.h>

/* ---- Tables --------------------------------------------------------------------------------------------------- */

/** The shared table of one length: its factors and its trigonometric values. */
typedef struct qmfft_table qmfft_table;

/**
 * The table of a length, made or found in the list of those alive, and held once more.
 *
 * Any thread may call. A prime factor of 53 and above makes tables for the length less one, which are shared as well.
 *
 * @param length  length of the transform, from 1 on
 * @return        the table; null when `length` is less than 1 or there is no memory
 */
KRNUMER_API qmfft_table* create_qmfft_table(int32_t length);

/**
 * Gives back a table that create_qmfft_table handed out; the last holder's call frees it.
 *
 * @param table  the table; null does nothing
 */
KRNUMER_API void destroy_qmfft_table(qmfft_table* table);

/* ---- One dimension, complex samples --------------------------------------------------------------------------- */

/**
 * Forward transform of complex samples at their own length.
 *
 * @param[in]     x     n samples, 1-D complex
 * @param[out]    y     n values, 1-D complex
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 when memory cannot be had; the host's status when `y`
 *                      cannot be sized
 */
KRNUMER_API int32_t CxQMFFTH(KrHandle x, KrHandle y, void** slot);

/**
 * Forward transform of a section of complex samples, cut or padded with zeros to a length.
 *
 * @param[in]     x         n samples, 1-D complex
 * @param[out]    y         fft_size values, 1-D complex
 * @param[in,out] slot      table slot
 * @param[in]     offset    index of the first sample used, from 0 on; behind the end all samples are zero
 * @param[in]     fft_size  length of the transform, from 1 on
 * @param[in]     shift     not 0 for a shifted spectrum
 * @return                  0; -20003 when `x` is empty; -20115 when `fft_size` is less than 1; -20017 when `offset` is
 *                          negative; -20001 when memory cannot be had; the host's status when `y` cannot be sized
 */
KRNUMER_API int32_t CxQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t offset, int32_t fft_size, int32_t shift);

/**
 * Inverse transform of a complex spectrum.
 *
 * @param[in]     x     spectrum of n values, 1-D complex
 * @param[out]    y     n samples, 1-D complex
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 when memory cannot be had; the host's status when `y`
 *                      cannot be sized
 */
KRNUMER_API int32_t InvCxQMFFTH(KrHandle x, KrHandle y, void** slot);

/**
 * InvCxQMFFTH of a spectrum that may be shifted.
 *
 * @param[in]     x      spectrum of n values, 1-D complex
 * @param[out]    y      n samples, 1-D complex
 * @param[in,out] slot   table slot
 * @param[in]     shift  not 0 when `x` is shifted
 * @return               as InvCxQMFFTH
 */
KRNUMER_API int32_t InvCxQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t shift);

/* ---- One dimension, real samples ------------------------------------------------------------------------------ */

/**
 * Forward transform of real samples at their own length, full spectrum.
 *
 * @param[in]     x     n samples, 1-D double
 * @param[out]    y     n values, 1-D complex; the imaginary parts of X[0] and of the Nyquist term are exactly 0
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 when memory cannot be had; the host's status when `y`
 *                      cannot be sized
 */
KRNUMER_API int32_t ReQMFFTH(KrHandle x, KrHandle y, void** slot);

/**
 * Forward transform of a section of real samples, cut or padded with zeros to a length, full spectrum.
 *
 * @param[in]     x         n samples, 1-D double
 * @param[out]    y         fft_size values, 1-D complex
 * @param[in,out] slot      table slot
 * @param[in]     offset    index of the first sample used, 0 to n-1
 * @param[in]     fft_size  length of the transform, from 1 on
 * @param[in]     shift     not 0 for a shifted spectrum
 * @return                  0; -20003 when `x` is empty; -20017 when `offset` is outside 0 to n-1; -20115 when
 *                          `fft_size` is less than 1; -20001 when memory cannot be had for tables; the host's status
 *                          when `y` cannot be sized. Without memory for the padded samples `y` is sized but not
 *                          written, and the result is 0
 */
KRNUMER_API int32_t ReQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t offset, int32_t fft_size, int32_t shift);

/**
 * Forward transform of real samples into half-complex form.
 *
 * @param[in]     x     n samples, 1-D double
 * @param[out]    y     n values in half-complex form, 1-D double
 * @param[in,out] slot  table slot; stays unbound when `y` cannot be sized
 * @return              0; -20003 when `x` is empty; -20001 when memory cannot be had or `y` cannot be sized
 */
KRNUMER_API int32_t ReQMFFTHCH(KrHandle x, KrHandle y, void** slot);

/**
 * Inverse transform of the spectrum of real samples.
 *
 * Reads X[0] .. X[n/2] only, and of X[0] and of the Nyquist term the real part.
 *
 * @param[in]     x     spectrum of n values, 1-D complex
 * @param[out]    y     n samples, 1-D double
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 when memory cannot be had or `y` cannot be sized
 */
KRNUMER_API int32_t InvReQMFFTH(KrHandle x, KrHandle y, void** slot);

/**
 * InvReQMFFTH of a spectrum that may be shifted.
 *
 * @param[in]     x      spectrum of n values, 1-D complex
 * @param[out]    y      n samples, 1-D double
 * @param[in,out] slot   table slot
 * @param[in]     shift  not 0 when `x` is shifted
 * @return               as InvReQMFFTH
 */
KRNUMER_API int32_t InvReQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t shift);

/**
 * Inverse transform of half-complex form.
 *
 * @param[in,out] x     n values in half-complex form, 1-D double. The transform works in it: it comes back scaled by
 *                      1/n, with x[k] - x[n-k] and x[k] + x[n-k] in the places of x[k] and x[n-k], 0 < k < n/2
 * @param[out]    y     n samples, 1-D double
 * @param[in,out] slot  table slot; stays unbound when `y` cannot be sized
 * @return              0; -20003 when `x` is empty; -20001 when memory cannot be had or `y` cannot be sized
 */
KRNUMER_API int32_t InvReQMFFTHCH(KrHandle x, KrHandle y, void** slot);

/* ---- Two dimensions: along the rows, then along the columns --------------------------------------------------- */

/**
 * Forward transform of a section of a complex array, cut or padded with zeros to a size.
 *
 * @param[in]     x           R by C samples, 2-D complex
 * @param[in]     row_offset  first row used, 0 to R-1
 * @param[in]     col_offset  first column used, 0 to C-1
 * @param[in]     fft_rows    rows of the transform, from 1 on
 * @param[in]     fft_cols    columns of the transform, from 1 on
 * @param[in]     shift       not 0 for a spectrum shifted along both axes
 * @param[out]    y           fft_rows by fft_cols values, 2-D complex
 * @param[in,out] slot_cols   table slot of the transforms along the rows, of length fft_cols
 * @param[in,out] slot_rows   table slot of the transforms along the columns, of length fft_rows
 * @return                    0; -20003 when `x` is empty; -20017 when an offset is too large; -20008 when `fft_rows` or
 *                            `fft_cols` is less than 1; -20001 when memory cannot be had (`y` is emptied, except when
 *                            it is the first slot that cannot be bound); the host's status when `y` cannot be sized;
 *                            -20017 after all of that when an offset is negative, with `y` emptied
 */
KRNUMER_API int32_t CxFFT2D_H(KrHandle x, int32_t row_offset, int32_t col_offset, int32_t fft_rows, int32_t fft_cols,
                              int32_t shift, KrHandle y, void** slot_cols, void** slot_rows);

/**
 * Forward transform of a section of a real array, cut or padded with zeros to a size; full spectrum.
 *
 * @param[in]     x           R by C samples, 2-D double
 * @param[in]     row_offset  first row used, 0 to R-1
 * @param[in]     col_offset  first column used, 0 to C-1
 * @param[in]     fft_rows    rows of the transform, from 1 on
 * @param[in]     fft_cols    columns of the transform, from 1 on
 * @param[in]     shift       not 0 for a spectrum shifted along both axes
 * @param[out]    y           fft_rows by fft_cols values, 2-D complex
 * @param[in,out] slot_cols   table slot of the transforms along the rows, of length fft_cols
 * @param[in,out] slot_rows   table slot of the transforms along the columns, of length fft_rows
 * @return                    as CxFFT2D_H
 */
KRNUMER_API int32_t ReFFT2D_H(KrHandle x, int32_t row_offset, int32_t col_offset, int32_t fft_rows, int32_t fft_cols,
                              int32_t shift, KrHandle y, void** slot_cols, void** slot_rows);

/**
 * Inverse transform of a two-dimensional complex spectrum.
 *
 * @param[in]     x          spectrum of R by C values, 2-D complex
 * @param[in]     shift      not 0 when `x` is shifted along both axes
 * @param[out]    y          R by C samples, 2-D complex
 * @param[in,out] slot_cols  table slot of the transforms along the rows, of length C
 * @param[in,out] slot_rows  table slot of the transforms along the columns, of length R
 * @return                   0; -20003 when `x` is empty; -20001 when memory cannot be had; the host's status when `y`
 *                           cannot be sized
 */
KRNUMER_API int32_t CxInvFFT2D_H(KrHandle x, int32_t shift, KrHandle y, void** slot_cols, void** slot_rows);

/**
 * Inverse transform of the two-dimensional spectrum of a real array.
 *
 * After the transforms along the rows one half of each column is read, and of its first value and its Nyquist term the
 * real part.
 *
 * @param[in]     x          spectrum of R by C values, 2-D complex
 * @param[in]     shift      not 0 when `x` is shifted along both axes
 * @param[out]    y          R by C samples, 2-D double
 * @param[in,out] slot_cols  table slot of the transforms along the rows, of length C
 * @param[in,out] slot_rows  table slot of the transforms along the columns, of length R
 * @return                   0; -20003 when `x` is empty; -20001 when memory cannot be had or `y` cannot be sized
 */
KRNUMER_API int32_t ReInvFFT2D_H(KrHandle x, int32_t shift, KrHandle y, void** slot_cols, void** slot_rows);

#endif
