/*
 * Linear algebra: singular value decomposition, A = U diag(S) V^T for a real and A = U diag(S) V^H for a complex
 * matrix.
 *
 * With k = min(m, n) for A of m rows and n columns, the thin form has U of m by k and V of n by k, the full form U of m
 * by m and V of n by n. V is V itself, not its transpose. The singular values are real and descend.
 *
 * Method: Householder bidiagonalisation and implicit QR iteration (G. H. Golub and C. Reinsch, Numer. Math. 14, 403,
 * 1970). What is smaller than the unit of rounding, 2.2e-16, counts as zero whatever the size of the rest, so matrices
 * whose elements are that small should be scaled by the caller.
 */
#ifndef KRNUMER_LINALG_SVD_H
#define KRNUMER_LINALG_SVD_H

#include <krnumer/types.h>

/**
 * Singular value decomposition in thin form, with U in the place of A.
 *
 * @param[in,out] a    2-D double, m by n; becomes U, m by k; empty on failure
 * @param[out]    s    1-D double, k singular values; empty on failure
 * @param[out]    v    2-D double, n by k; empty on failure
 * @param[out]    err  status: 0; -20003 when `a` has no elements; -20068 when an element is not finite or is one of the
 *                     extreme doubles that stand for a missing value; -20062 when a singular value does not converge
 *                     within 99 sweeps, as with elements whose squares overflow; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t SVD_head(KrHandle a, KrHandle s, KrHandle v, int32_t* err);

/** Complex form of SVD_head. `s` is a complex array, too, with imaginary parts 0. */
KRNUMER_API int32_t CxSVD_head(KrHandle a, KrHandle s, KrHandle v, int32_t* err);

/**
 * Singular value decomposition in thin or full form.
 *
 * In the full form the further columns of U or V complete an orthonormal basis, by a Householder QR decomposition of
 * the columns of the thin form.
 *
 * @param[in]  a     2-D double, m by n
 * @param[in]  full  0 for the thin form, any other value for the full form
 * @param[out] u     2-D double, m by k, or m by m in the full form; empty on failure
 * @param[out] s     1-D double, k singular values; empty on failure
 * @param[out] v     2-D double, n by k, or n by n in the full form; empty on failure
 * @return           status: 0; -20003 when `a` has no elements; -20068 when an element is not finite or is one of the
 *                   extreme doubles that stand for a missing value; -20062 when a singular value does not converge
 *                   within 99 sweeps; -20001 out of memory
 */
KRNUMER_API int32_t SVDEx_head(KrHandle a, int32_t full, KrHandle u, KrHandle s, KrHandle v);

/** Complex form of SVDEx_head. `s` is an array of doubles. */
KRNUMER_API int32_t CxSVDEx_head(KrHandle a, int32_t full, KrHandle u, KrHandle s, KrHandle v);

/**
 * Singular values alone.
 *
 * @param[in]  a    2-D double, m by n
 * @param[out] s    1-D double, k singular values; empty on failure
 * @param[out] err  status: 0; -20003 when `a` has no elements; -20068 when an element is not finite or is one of the
 *                  extreme doubles that stand for a missing value; -20062 when a singular value does not converge
 *                  within 99 sweeps; -20001 out of memory
 * @return          0
 */
KRNUMER_API int32_t SVDS_head(KrHandle a, KrHandle s, int32_t* err);

/** Complex form of SVDS_head. `s` is an array of doubles. */
KRNUMER_API int32_t CxSVDS_head(KrHandle a, KrHandle s, int32_t* err);

#endif
