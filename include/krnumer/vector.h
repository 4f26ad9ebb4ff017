/*
 * Arrays in place: scaling, linear maps, polar and rectangular form, unit vectors.
 *
 * Every function here overwrites its array with the result. A failure empties the array, and the caller's data are
 * gone. 2-D arrays are treated as one run of all their elements.
 */
#ifndef KRNUMER_VECTOR_H
#define KRNUMER_VECTOR_H

#include <krnumer/types.h>

/**
 * Scales to the range from -1 to 1: (x - offset) (1 / scale) with scale = (max - min) / 2 and offset = scale + min.
 *
 * NaNs are left out of the extrema. Where 1 / scale is not finite, as for equal elements, scale is 1 and offset the
 * largest element. Where all elements are NaN, the array stays, and both scalars are NaN.
 *
 * @param[in,out] x       2-D double; emptied on failure
 * @param[out]    scale   half the extent of the data; NaN on failure
 * @param[out]    offset  the middle of the data; NaN on failure
 * @param[out]    err     status: 0, or -20003 when `x` is empty
 * @return                0
 */
KRNUMER_API int32_t Scale(KrHandle x, double* scale, double* offset, int32_t* err);

/**
 * Scales to the range from -1 to 1 as Scale does. Here the offset comes before the scale.
 *
 * @param[in,out] x       1-D double; emptied on failure
 * @param[out]    offset  the middle of the data; NaN on failure
 * @param[out]    scale   half the extent of the data; NaN on failure
 * @param[out]    err     status: 0, or -20003 when `x` is empty
 * @return                0
 */
KRNUMER_API int32_t Scale1DCIN(KrHandle x, double* offset, double* scale, int32_t* err);

/**
 * Scales by the largest magnitude: (1 / max |x|) x. NaNs are left out of the maximum. Where it is 0, the array stays.
 *
 * @param[in,out] x      2-D double; emptied on failure
 * @param[out]    scale  the largest magnitude; NaN on failure
 * @param[out]    err    status: 0, or -20003 when `x` is empty
 * @return               0
 */
KRNUMER_API int32_t QScale(KrHandle x, double* scale, int32_t* err);

/**
 * Scales by the largest magnitude as QScale does.
 *
 * @param[in,out] x      1-D double; emptied on failure
 * @param[out]    scale  the largest magnitude; NaN on failure
 * @param[out]    err    status: 0, or -20003 when `x` is empty
 * @return               0
 */
KRNUMER_API int32_t QS1D(KrHandle x, double* scale, int32_t* err);

/**
 * Normalises to mean 0 and deviation 1: (x - mean) (1 / deviation) with deviation = sqrt(sum (x - mean)^2 / n).
 *
 * Equal elements have no deviation and become NaN or infinite, without a failure.
 *
 * @param[in,out] x          2-D double; emptied on failure
 * @param[out]    deviation  the deviation of the population; NaN on failure
 * @param[out]    mean       the mean; NaN on failure
 * @param[out]    err        status: 0, or -20003 when `x` is empty
 * @return                   0
 */
KRNUMER_API int32_t Norm2(KrHandle x, double* deviation, double* mean, int32_t* err);

/**
 * Normalises to mean 0 and deviation 1 as Norm2 does.
 *
 * @param[in,out] x          1-D double; emptied on failure
 * @param[out]    deviation  the deviation of the population; NaN on failure
 * @param[out]    mean       the mean; NaN on failure
 * @param[out]    err        status: 0, or -20003 when `x` is empty
 * @return                   0
 */
KRNUMER_API int32_t Norm1(KrHandle x, double* deviation, double* mean, int32_t* err);

/**
 * Linear map, slope x + intercept.
 *
 * @param[in,out] x          1-D double
 * @param[in]     slope      factor, applied first
 * @param[in]     intercept  addend
 * @param[out]    err        status: 0, or -20003 when `x` is empty
 * @return                   0
 */
KRNUMER_API int32_t Line1(KrHandle x, const double* slope, const double* intercept, int32_t* err);

/**
 * Linear map, slope x + intercept.
 *
 * @param[in,out] x          2-D double; emptied on failure
 * @param[in]     slope      factor, applied first
 * @param[in]     intercept  addend
 * @param[out]    err        status: 0, or -20003 when `x` is empty
 * @return                   0
 */
KRNUMER_API int32_t LinEv(KrHandle x, const double* slope, const double* intercept, int32_t* err);

/**
 * Polar to rectangular coordinates: x = r cos theta, y = r sin theta.
 *
 * @param[in,out] r      radii, 1-D double; becomes x; emptied on failure
 * @param[in,out] theta  angles in radians, 1-D double; becomes y; emptied on failure
 * @param[out]    err    status: 0; -20002 when the lengths differ; -20003 when both are empty
 * @return               0
 */
KRNUMER_API int32_t PolarToRect1D_head(KrHandle r, KrHandle theta, int32_t* err);

/**
 * Rectangular to polar coordinates: r = sqrt(x^2 + y^2), theta = atan2(y, x) from -pi to pi; 0 at the origin whatever
 * the signs of its zeros.
 *
 * @param[in,out] x    1-D double; becomes r; emptied on failure
 * @param[in,out] y    1-D double; becomes theta, in radians; emptied on failure
 * @param[out]    err  status: 0; -20002 when the lengths differ; -20003 when both are empty
 * @return             0
 */
KRNUMER_API int32_t RectToPolar1D_head(KrHandle x, KrHandle y, int32_t* err);

/**
 * Unit vector in the Euclidean norm: x (1 / norm) with norm = sqrt(x[0]^2 + ... + x[n-1]^2). A zero vector stays.
 *
 * @param[in,out] x     1-D double; emptied on failure
 * @param[out]    norm  the norm of `x` as it came; NaN on failure
 * @param[out]    err   status: 0, or -20003 when `x` is empty
 * @return              0
 */
KRNUMER_API int32_t unitVector_head(KrHandle x, double* norm, int32_t* err);

/**
 * Unit vector in the p-norm: x (1 / norm) with norm = (|x[0]|^p + ... + |x[n-1]|^p)^(1/p).
 *
 * An infinite p gives the largest magnitude, minus infinity the smallest. Where the norm is 0, the vector stays: for
 * a negative p that is so as soon as one element is 0.
 *
 * @param[in,out] x     1-D double; emptied on failure
 * @param[in]     p     order of the norm, by value
 * @param[out]    norm  the norm of `x` as it came; NaN on failure
 * @param[out]    err   status: 0; -20003 when `x` is empty; -20068 when `p` is NaN; -20141 when `p` is 0
 * @return              0
 */
KRNUMER_API int32_t unitVector80_head(KrHandle x, double p, double* norm, int32_t* err);

/**
 * Unit vector in the Euclidean norm, with magnitudes sqrt(re^2 + im^2). A zero vector stays.
 *
 * @param[in,out] x     1-D complex; emptied on failure
 * @param[out]    norm  the norm of `x` as it came; NaN on failure
 * @return              0, or -20003 when `x` is empty
 */
KRNUMER_API int32_t CxUnitVector_head(KrHandle x, double* norm);

/**
 * Unit vector in the p-norm as by unitVector80_head, with magnitudes sqrt(re^2 + im^2).
 *
 * @param[in,out] x     1-D complex; emptied on failure
 * @param[in]     p     order of the norm
 * @param[out]    norm  the norm of `x` as it came; NaN on failure
 * @return              0; -20003 when `x` is empty; -20068 when `p` is NaN; -20141 when `p` is 0
 */
KRNUMER_API int32_t CxUnitVector80_head(KrHandle x, double p, double* norm);

#endif
