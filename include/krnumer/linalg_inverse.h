/*
 * Linear algebra: inverses. Each takes the place of the matrix that it was made of, and a failure leaves nothing of it.
 *
 * Source: G. H. Golub and C. F. Van Loan, Matrix Computations.
 */
#ifndef KRNUMER_LINALG_INVERSE_H
#define KRNUMER_LINALG_INVERSE_H

#include <krnumer/linalg_basic.h>
#include <krnumer/types.h>

/**
 * Inverse by LU factorisation with partial pivoting. NaN flows through.
 *
 * @param[in,out] a    2-D double, n by n; becomes the inverse; empty on failure
 * @param[out]    err  status: 0; -20040 when A is not square; -20003 when it is empty; -20041 when it is singular;
 *                     -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t InvMatrixLUDri_head(KrHandle a, int32_t* err);

/** Complex form of InvMatrixLUDri_head. */
KRNUMER_API int32_t CxInvMatrixLUDri_head(KrHandle a, int32_t* err);

/**
 * Inverse of a symmetric positive definite matrix by Cholesky factorisation. The lower triangle of A is read; the
 * inverse is written whole.
 *
 * @param[in,out] a    2-D double, n by n; becomes the inverse; empty on failure
 * @param[out]    err  status: 0; -20040 when A is not square; -20003 when it is empty; -20071 when it is not positive
 *                     definite, as for Cholesky_head; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t InvMatrixChoDri_head(KrHandle a, int32_t* err);

/** Complex form of InvMatrixChoDri_head, for Hermitian matrices; -20071 as for CxCholesky_head. */
KRNUMER_API int32_t CxInvMatrixChoDri_head(KrHandle a, int32_t* err);

/**
 * Inverse of a triangle of A. It counts as singular when an element of its diagonal is, in magnitude, at most eps times
 * its largest element, with eps = 2.220446049250313e-16.
 *
 * @param[in,out] a         2-D double, n by n; becomes the inverse, with zeros in the other triangle; empty on failure
 * @param[in]     triangle  0 the lower triangle, 1 the upper one
 * @param[out]    err       status: 0; -20040 when A is not square; -20003 when it is empty; -20061 for another
 *                          triangle; -20041 when the triangle is singular; -20001 out of memory
 * @return                  0
 */
KRNUMER_API int32_t InvMatrixTriDri_head(KrHandle a, const int32_t* triangle, int32_t* err);

/**
 * Complex form of InvMatrixTriDri_head. The triangle counts as singular when the squared modulus of an element of its
 * diagonal is at most 4.930380657631324e-32, which is eps^2, times the largest squared modulus of all.
 */
KRNUMER_API int32_t CxInvMatrixTriDri_head(KrHandle a, const int32_t* triangle, int32_t* err);

/**
 * Inverse by the factors that LU_head gives. A zero on the diagonal of U is not reported; what stands in the array then
 * is no inverse.
 *
 * @param[in,out] lu   2-D double, n by n: the factors; becomes the inverse; empty on failure
 * @param[in]     p    1-D array of n elements, the exchanges as int32 in its first 4 n bytes
 * @param[out]    err  status: 0; -20002 when p does not have n elements; -20040 when LU is not square; -20003 when it
 *                     is empty; -20017 when an exchange is with no row of the matrix; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t LUInvMatrix_head(KrHandle lu, KrHandle p, int32_t* err);

/** Complex form of LUInvMatrix_head. */
KRNUMER_API int32_t CxLUInvMatrix_head(KrHandle lu, KrHandle p, int32_t* err);

/**
 * Inverse of L L^T by its packed factor, as Cholesky_head gives it. The diagonal of L is not tested.
 *
 * @param[in,out] l    1-D double, n(n+1)/2 elements; becomes the lower triangle of the inverse; empty on failure
 * @param[out]    err  status: 0; -20003 when L is empty; -20040 when its length is not n(n+1)/2 for any n; -20001 out
 *                     of memory
 * @return             0
 */
KRNUMER_API int32_t Cholesky_InvMatrix_head(KrHandle l, int32_t* err);

/** Complex form of Cholesky_InvMatrix_head: inverse of L L^H. */
KRNUMER_API int32_t CxCholesky_InvMatrix_head(KrHandle l, int32_t* err);

/**
 * Inverse of a packed triangular matrix, which is a triangle of the same kind. Singularity is judged as by
 * InvMatrixTriDri_head.
 *
 * @param[in,out] t    the elements of the matrix, which become the inverse (empty on failure), and which triangle they
 *                     are: 0 lower, 1 upper
 * @param[out]    err  status: 0; -20003 when there are no elements; -20040 when their number is not n(n+1)/2 for any n;
 *                     -20061 for another triangle; -20041 when the matrix is singular
 * @return             0
 */
KRNUMER_API int32_t Tri_InvMatrix_head(KrTriangle* t, int32_t* err);

/** Complex form of Tri_InvMatrix_head; singularity is judged as by CxInvMatrixTriDri_head. */
KRNUMER_API int32_t CxTri_InvMatrix_head(KrTriangle* t, int32_t* err);

/**
 * Pseudoinverse (E. H. Moore, R. Penrose) by singular value decomposition.
 *
 * @param[in,out] a    2-D double, m by n; becomes the pseudoinverse, n by m; empty on failure
 * @param[in]     tol  absolute tolerance: singular values up to it count as 0. When it is negative or NaN, max(m, n)
 *                     eps times the largest singular value
 * @param[out]    err  status: 0; -20003 when A is empty; -20068 when it holds NaN, an infinity or the largest double;
 *                     -20062 when the decomposition does not converge; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t PseudoInverse_head(KrHandle a, const double* tol, int32_t* err);

/** Complex form of PseudoInverse_head. */
KRNUMER_API int32_t CxPseudoInverse_head(KrHandle a, const double* tol, int32_t* err);

#endif
