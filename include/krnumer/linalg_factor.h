/*
 * Linear algebra: LU, Cholesky and QR factorisations.
 *
 * Sources: G. H. Golub and C. F. Van Loan, Matrix Computations; for the Householder forms LAPACK.
 */
#ifndef KRNUMER_LINALG_FACTOR_H
#define KRNUMER_LINALG_FACTOR_H

#include <krnumer/types.h>

/**
 * LU factorisation with partial pivoting; the rows of A are exchanged so that L U results.
 *
 * The pivot of a column is its first largest element from the diagonal down. NaN is never a pivot. Where a column
 * offers nothing but zeros and NaN, it is left as it is, the factorisation goes on, and the warning +20003 tells of it.
 *
 * @param[in,out] a     2-D double, n by n; U on and above the diagonal, L without its unit diagonal below; empty on
 *                      failure
 * @param[out]    p     the exchanges, one after the other: row k with row P[k], counted from 0. A 1-D array of n
 *                      elements of 8 bytes, whose first 4 n bytes hold P as int32; empty on failure
 * @param[out]    sign  0 after an even number of exchanges, 1 after an odd one; 0 on failure
 * @param[out]    err   status: 0; +20003 when a column offered no pivot; -20040 when A is not square; -20003 when it is
 *                      empty; -20001 out of memory
 * @return              0
 */
KRNUMER_API int32_t LU_head(KrHandle a, KrHandle p, int32_t* sign, int32_t* err);

/** Complex form of LU_head. Pivots are compared by re^2 + im^2, which is 0 for elements below about 1e-162. */
KRNUMER_API int32_t CxLU_head(KrHandle a, KrHandle p, int32_t* sign, int32_t* err);

/**
 * Cholesky factorisation A = L L^T of a packed lower triangle.
 *
 * A matrix that is positive definite only just is refused too: when an element of the diagonal of L is below sqrt(eps)
 * times the largest element of L, with eps = 2.220446049250313e-16.
 *
 * @param[in,out] l    1-D double, n(n+1)/2 elements: the lower triangle of A, column by column; becomes L; empty on
 *                     failure
 * @param[out]    err  status: 0; -20003 when there are no elements; -20040 when their number is not n(n+1)/2 for any n;
 *                     -20071 when A is not (safely) positive definite
 * @return             0
 */
KRNUMER_API int32_t Cholesky_head(KrHandle l, int32_t* err);

/**
 * Complex form of Cholesky_head, A = L L^H. Of the diagonal of A the real parts count. Here every positive definite
 * matrix is factored; there is no refusal of nearly singular ones.
 */
KRNUMER_API int32_t CxCholesky_head(KrHandle l, int32_t* err);

/**
 * Cholesky factorisation A = R^T R of a full matrix, with R upper triangular. The lower triangle of A is read; symmetry
 * is not tested.
 *
 * @param[in,out] a    2-D double, n by n; becomes R, with zeros below the diagonal; empty on failure
 * @param[out]    err  status: 0; -20003 when A is empty; -20040 when it is not square; -20071 as for Cholesky_head;
 *                     -20001 out of memory
 * @return             the status, too
 */
KRNUMER_API int32_t FullCholesky_head(KrHandle a, int32_t* err);

/** Complex form of FullCholesky_head, A = R^H R; -20071 as for CxCholesky_head. */
KRNUMER_API int32_t CxFullCholesky_head(KrHandle a, int32_t* err);

/**
 * QR decomposition by Householder reflectors, A = Q R, or with column pivoting A P = Q R.
 *
 * With k = min(m, n) the formats are 0: Q is m by m and R is m by n; 1: Q is m by k and R is k by n; 2: R is k by n and
 * Q is empty. The signs of the rows of R are those of LAPACK. NaN flows through.
 *
 * @param[in]  a         2-D double, m by n
 * @param[in]  pivoting  0 none; any other value moves columns so that the diagonal of R falls off in magnitude
 * @param[in]  format    0 to 2
 * @param[out] p         2-D int32, n by n: a 1 in each column, zeros elsewhere; empty without pivoting, and on failure
 * @param[out] q         2-D double, orthonormal columns; empty on failure
 * @param[out] r         2-D double, upper triangular; empty on failure
 * @return               0; -20003 when A is empty; -20061 for another format; -20001 out of memory
 */
KRNUMER_API int32_t QRDecH(KrHandle a, int32_t pivoting, int32_t format, KrHandle p, KrHandle q, KrHandle r);

/** Complex form of QRDecH; P is int32 here too. */
KRNUMER_API int32_t CxQRDecH(KrHandle a, int32_t pivoting, int32_t format, KrHandle p, KrHandle q, KrHandle r);

/**
 * QR decomposition A = Q R with square Q, by a choice of methods.
 *
 * Givens rotations drop what can only be rounding error: in column j, counted from 0, elements below
 * j |column| eps / sqrt(rows not yet finished). A column without a pivot then has its step of R to the right of the
 * diagonal.
 *
 * @param[in]  a       2-D double, m by n
 * @param[in]  method  0 Householder reflectors, 1 Givens rotations, 2 fast Givens rotations
 * @param[out] q       2-D double, m by m, orthogonal; empty on failure
 * @param[out] r       2-D double, m by n, upper triangular; empty on failure
 * @param[out] err     status: 0; -20003 when A is empty; -20061 for another method; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t qrd_head(KrHandle a, const int32_t* method, KrHandle q, KrHandle r, int32_t* err);

/**
 * Complex form of qrd_head, always by Householder reflectors.
 *
 * @param[in]  a       2-D complex, m by n
 * @param[in]  method  not read
 * @param[out] q       2-D complex, m by m, unitary; empty on failure
 * @param[out] r       2-D complex, m by n, upper triangular; empty on failure
 * @param[out] err     status: 0; -20003 when A is empty; -20068 when it holds NaN, an infinity or the largest double;
 *                     -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t Cxqrd_head(KrHandle a, const int32_t* method, KrHandle q, KrHandle r, int32_t* err);

#endif
