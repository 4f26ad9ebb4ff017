/*
 * Cosine, sine, Hilbert and Hartley transforms of real data in one and two dimensions.
 *
 * All arrays are of double. A table slot is a pointer cell of the caller, see krnumer/fft.h; a two-dimensional
 * transform has one for its rows (of which it holds the table for the number of rows) and one for its columns. Except
 * where a function says otherwise a failure empties the output, and in place the samples.
 *
 *     cosine transform (type II, orthonormal)   y[k] = s(k) sum of x[i] cos(pi (2i+1) k / (2n)), s(0) = sqrt(1/n), else
 *                                               s(k) = sqrt(2/n)
 *     sine transform (type I, unnormalised)     y[k] = sum of x[i] sin(pi (i+1)(k+1) / (n+1)); inverse with the
 *                                               factor 2 / (n+1)
 *
 * Cosine transforms of even length reorder their input (J. Makhoul, IEEE Trans. ASSP 28, 27, 1980); those of odd length
 * work on its even extension and take about twice the time.
 */
#ifndef KRNUMER_TRANSFORM_H
#define KRNUMER_TRANSFORM_H

#include <krnumer/types.h>

/**
 * Discrete cosine transform.
 *
 * @param[in]     x     samples, 1-D
 * @param[out]    y     transform, 1-D of `size`; left as it is when it cannot be sized
 * @param[in]     size  length of the transform: samples beyond it are left out, missing ones are 0; not positive for
 *                      the length of `x`
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table, or when `y` cannot be sized
 */
KRNUMER_API int32_t DCT_1DH(KrHandle x, KrHandle y, int32_t size, void** slot);

/**
 * Discrete sine transform.
 *
 * @param[in]     x     samples, 1-D
 * @param[out]    y     transform, 1-D of `size`; left as it is when it cannot be sized
 * @param[in]     size  length of the transform: samples beyond it are left out, missing ones are 0; not positive for
 *                      the length of `x`
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table, or when `y` cannot be sized
 */
KRNUMER_API int32_t DST_1DH(KrHandle x, KrHandle y, int32_t size, void** slot);

/**
 * Inverse discrete cosine transform.
 *
 * @param[in]     x     transform, 1-D
 * @param[out]    y     samples, 1-D of the length of `x`
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table, or when `y` cannot be sized
 */
KRNUMER_API int32_t InvDCT_1DH(KrHandle x, KrHandle y, void** slot);

/**
 * Inverse discrete sine transform.
 *
 * @param[in]     x     transform, 1-D
 * @param[out]    y     samples, 1-D of the length of `x`
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table, or when `y` cannot be sized
 */
KRNUMER_API int32_t InvDST_1DH(KrHandle x, KrHandle y, void** slot);

/**
 * Two-dimensional discrete cosine transform: rows first, then columns.
 *
 * @param[in]     x         samples, 2-D
 * @param[out]    y         transform, 2-D of `rows` by `cols`
 * @param[in]     rows      rows of the transform: what lies beyond is left out, what is missing is 0; not positive for
 *                          the rows of `x`
 * @param[in]     cols      columns of the transform, likewise
 * @param[in,out] slotRows  table slot for the number of rows
 * @param[in,out] slotCols  table slot for the number of columns
 * @return                  0; -20003 when `x` has no row or no column; -20001 without memory or a table, or when `y`
 *                          cannot be sized
 */
KRNUMER_API int32_t DCT_2DH(KrHandle x, KrHandle y, int32_t rows, int32_t cols, void** slotRows, void** slotCols);

/**
 * Two-dimensional discrete sine transform: rows first, then columns.
 *
 * @param[in]     x         samples, 2-D
 * @param[out]    y         transform, 2-D of `rows` by `cols`
 * @param[in]     rows      rows of the transform: what lies beyond is left out, what is missing is 0; not positive for
 *                          the rows of `x`
 * @param[in]     cols      columns of the transform, likewise
 * @param[in,out] slotRows  table slot for the number of rows
 * @param[in,out] slotCols  table slot for the number of columns
 * @return                  0; -20003 when `x` has no row or no column; -20001 without memory or a table, or when `y`
 *                          cannot be sized
 */
KRNUMER_API int32_t DST_2DH(KrHandle x, KrHandle y, int32_t rows, int32_t cols, void** slotRows, void** slotCols);

/**
 * Inverse two-dimensional discrete cosine transform: columns first, then rows.
 *
 * @param[in]     x         transform, 2-D
 * @param[out]    y         samples, 2-D of the size of `x`
 * @param[in,out] slotRows  table slot for the number of rows
 * @param[in,out] slotCols  table slot for the number of columns
 * @return                  0; -20003 when `x` has no row or no column; -20001 without memory or a table, or when `y`
 *                          cannot be sized
 */
KRNUMER_API int32_t InvDCT_2DH(KrHandle x, KrHandle y, void** slotRows, void** slotCols);

/**
 * Inverse two-dimensional discrete sine transform: rows first, then columns.
 *
 * @param[in]     x         transform, 2-D
 * @param[out]    y         samples, 2-D of the size of `x`
 * @param[in,out] slotRows  table slot for the number of rows
 * @param[in,out] slotCols  table slot for the number of columns
 * @return                  0; -20003 when `x` has no row or no column; -20001 without memory or a table, or when `y`
 *                          cannot be sized
 */
KRNUMER_API int32_t InvDST_2DH(KrHandle x, KrHandle y, void** slotRows, void** slotCols);

/**
 * Hilbert transform, in place: the spectrum times -i at positive and i at negative frequencies; DC and, for an even
 * length, the highest line become 0. So does a single sample.
 *
 * @param[in,out] x     samples, 1-D
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table
 */
KRNUMER_API int32_t FastHilbertTransformH(KrHandle x, void** slot);

/**
 * Inverse Hilbert transform, in place: the negative of the Hilbert transform. What the transform lost, mean and highest
 * line, does not come back.
 *
 * @param[in,out] x     samples, 1-D
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table
 */
KRNUMER_API int32_t InvFastHilbertTransformH(KrHandle x, void** slot);

/**
 * Hartley transform, in place: y[k] = Re X[k] - Im X[k], X the Fourier transform (R. N. Bracewell, Proc. IEEE 72, 1010,
 * 1984). A single sample stays.
 *
 * @param[in,out] x     samples, 1-D
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table
 */
KRNUMER_API int32_t FHTH(KrHandle x, void** slot);

/**
 * Inverse Hartley transform, in place: the Hartley transform over n.
 *
 * @param[in,out] x     samples, 1-D
 * @param[in,out] slot  table slot
 * @return              0; -20003 when `x` is empty; -20001 without memory or a table
 */
KRNUMER_API int32_t InvFHTH(KrHandle x, void** slot);

#endif
