/*
 * Linear algebra: linear equations, each method under a name of its own.
 *
 * Sources: G. H. Golub and C. F. Van Loan, Matrix Computations; for band matrices LAPACK (DGBSV, ZGBSV).
 */
#ifndef KRNUMER_LINALG_SOLVE_H
#define KRNUMER_LINALG_SOLVE_H

#include <krnumer/linalg_basic.h>
#include <krnumer/types.h>

/* ---- Least squares by singular value decomposition ---------------------------------------------------------- */

/**
 * Solution of A x = b by least squares: the x of least norm among those that make |A x - b| smallest. Singular values
 * up to max(m, n) eps times the largest count as 0, with eps = 2.220446049250313e-16; a rank-deficient A is no failure.
 *
 * @param[in]  a    2-D double, m by n
 * @param[in]  b    1-D double, m elements
 * @param[out] x    1-D double, n elements; empty on failure
 * @param[out] err  status: 0; -20002 when b does not have m elements; -20003 when A is empty; -20068 when A or b holds
 *                  NaN, an infinity or the largest double; -20062 when the decomposition does not converge; -20001 out
 *                  of memory
 * @return          0
 */
KRNUMER_API int32_t GenLinEqs_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err);

/** Complex form of GenLinEqs_head. */
KRNUMER_API int32_t CxGenLinEqs_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err);

/**
 * GenLinEqs_head with a tolerance: singular values up to max(m, n) tol times the largest count as 0.
 *
 * @param[in]  a    2-D double, m by n
 * @param[in]  b    1-D double, m elements
 * @param[out] x    1-D double, n elements; empty on failure
 * @param[in]  tol  relative tolerance; eps when it is not above 0, or NaN
 * @param[out] err  status, as for GenLinEqs_head
 * @return          0
 */
KRNUMER_API int32_t GenLinEqs82_head(KrHandle a, KrHandle b, KrHandle x, double tol, int32_t* err);

/** Complex form of GenLinEqs82_head. */
KRNUMER_API int32_t CxGenLinEqs82_head(KrHandle a, KrHandle b, KrHandle x, double tol, int32_t* err);

/**
 * GenLinEqs_head for many right-hand sides, the columns of B.
 *
 * @param[in]  a  2-D double, m by n
 * @param[in]  b  2-D double, m by k
 * @param[out] x  2-D double, n by k; empty on failure
 * @return        0; +20001, with X valid, when singular values counted as 0; -20003 when A is empty or B has no
 *                columns; -20002 when B does not have m rows; -20068, -20062, -20001 as for GenLinEqs_head
 */
KRNUMER_API int32_t EqsSetBySVDDri_head(KrHandle a, KrHandle b, KrHandle x);

/** Complex form of EqsSetBySVDDri_head. */
KRNUMER_API int32_t CxEqsSetBySVDDri_head(KrHandle a, KrHandle b, KrHandle x);

/**
 * EqsSetBySVDDri_head with a tolerance.
 *
 * @param[in]  a    2-D double, m by n
 * @param[in]  b    2-D double, m by k
 * @param[out] x    2-D double, n by k; empty on failure
 * @param[in]  tol  relative tolerance, as for GenLinEqs82_head
 * @return          as of EqsSetBySVDDri_head
 */
KRNUMER_API int32_t EqsSetBySVDDri82_head(KrHandle a, KrHandle b, KrHandle x, double tol);

/** Complex form of EqsSetBySVDDri82_head. */
KRNUMER_API int32_t CxEqsSetBySVDDri82_head(KrHandle a, KrHandle b, KrHandle x, double tol);

/* ---- LU ----------------------------------------------------------------------------------------------------- */

/**
 * Solution of A x = b by LU factorisation with partial pivoting. NaN flows through.
 *
 * A matrix with more rows than columns is not refused: its first n n elements are read as an n by n matrix, and the
 * first n elements of b.
 *
 * @param[in]  a    2-D double, n by n
 * @param[in]  b    1-D double, as many elements as A has rows
 * @param[out] x    1-D double, n elements; empty on failure
 * @param[out] err  status: 0; -20002 when b has another length; -20003 when A is empty; -20040 when A has more columns
 *                  than rows; -20041 when it is singular; -20001 out of memory
 * @return          0
 */
KRNUMER_API int32_t EqsByLUDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err);

/** Complex form of EqsByLUDri_head. */
KRNUMER_API int32_t CxEqsByLUDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err);

/**
 * Declared, but not provided: whatever the system, the result is a failure and X is empty. Factor with LU_head and
 * solve with LULinEqs_head instead.
 *
 * @param[in]  a  2-D double, n by n
 * @param[in]  b  2-D double, n by k
 * @param[out] x  2-D double; empty
 * @return        -20003 when A is empty or B has no columns; -20040 when A is not square; -20002 when B does not have n
 *                rows; -20001 out of memory; -20078 otherwise
 */
KRNUMER_API int32_t EqsSetByLUDri_head(KrHandle a, KrHandle b, KrHandle x);

/** Complex form of EqsSetByLUDri_head. */
KRNUMER_API int32_t CxEqsSetByLUDri_head(KrHandle a, KrHandle b, KrHandle x);

/**
 * Solution of A x = b by the factors that LU_head gives.
 *
 * @param[in]     lu   2-D double, n by n: U on and above the diagonal, L without its unit diagonal below
 * @param[in]     p    1-D array of n elements, the exchanges as int32 in its first 4 n bytes
 * @param[in,out] b    1-D double, n elements; becomes x; empty on failure
 * @param[out]    err  status: 0; -20002 when p or b does not have n elements; -20040 when LU is not square; -20003 when
 *                     it is empty; -20017 when an exchange is with no row of the matrix; -20041 when the diagonal of U
 *                     holds a zero
 * @return             0
 */
KRNUMER_API int32_t LULinEqs_head(KrHandle lu, KrHandle p, KrHandle b, int32_t* err);

/** Complex form of LULinEqs_head. */
KRNUMER_API int32_t CxLULinEqs_head(KrHandle lu, KrHandle p, KrHandle b, int32_t* err);

/* ---- Cholesky ----------------------------------------------------------------------------------------------- */

/**
 * Solution of A x = b by Cholesky factorisation, with A symmetric positive definite. Its upper triangle is used; all of
 * its elements have to be finite.
 *
 * @param[in]  a    2-D double, n by n
 * @param[in]  b    1-D double, n elements
 * @param[out] x    1-D double, n elements; empty on failure
 * @param[out] err  status: 0; -20040 when A is not square; -20002 when b does not have n elements; -20003 when A is
 *                  empty; -20068 when A or b holds NaN, an infinity or the largest double; -20071 when A is not
 *                  positive definite, as for Cholesky_head; -20001 out of memory
 * @return          0
 */
KRNUMER_API int32_t EqsByCholeskyDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err);

/**
 * Complex form of EqsByCholeskyDri_head, with A Hermitian positive definite. A length of b other than the number of
 * rows goes before -20040; -20071 as for CxCholesky_head.
 */
KRNUMER_API int32_t CxEqsByCholeskyDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err);

/**
 * EqsByCholeskyDri_head for many right-hand sides, with a choice of the triangle of A.
 *
 * @param[in]  a         2-D double, n by n
 * @param[in]  triangle  0 the lower triangle of A is used, 1 the upper one
 * @param[in]  b         2-D double, n by k
 * @param[out] x         2-D double, n by k; empty on failure
 * @return               0; -20003 when A is empty or B has no columns; -20040 when A is not square; -20002 when B does
 *                       not have n rows; -20061 for another triangle; -20068, -20071, -20001 as for
 *                       EqsByCholeskyDri_head
 */
KRNUMER_API int32_t EqsSetByCholeskyDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x);

/** Complex form of EqsSetByCholeskyDri_head. */
KRNUMER_API int32_t CxEqsSetByCholeskyDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x);

/**
 * Solution of L L^T x = b by a packed factor, as Cholesky_head gives it. The diagonal of L is not tested: a zero gives
 * infinities or NaN.
 *
 * @param[in]     l    1-D double, n(n+1)/2 elements
 * @param[in,out] b    1-D double, n elements; becomes x; empty on failure
 * @param[out]    err  status: 0; -20002 when b does not have n elements, n being the order of the largest triangle in
 *                     L; -20040 when the length of L is not n(n+1)/2 for any n; -20003 when L is empty
 * @return             0
 */
KRNUMER_API int32_t CholeskyLinEqs_head(KrHandle l, KrHandle b, int32_t* err);

/** Complex form of CholeskyLinEqs_head, L L^H x = b. */
KRNUMER_API int32_t CxCholeskyLinEqs_head(KrHandle l, KrHandle b, int32_t* err);

/* ---- Triangular matrices ------------------------------------------------------------------------------------ */

/**
 * Solution of T x = b with a packed triangular matrix. It counts as singular when an element of its diagonal is, in
 * magnitude, at most eps times its largest element.
 *
 * @param[in]     t    the elements of T and which triangle they are: 0 lower, any other value upper
 * @param[in,out] b    1-D double, n elements; becomes x; empty on failure
 * @param[out]    err  status: 0; -20002 when b does not have n elements, n being the order of the largest triangle in
 *                     T; -20040 when the length of T is not n(n+1)/2 for any n; -20003 when T is empty; -20068 when T
 *                     or b holds NaN, an infinity or the largest double; -20041 when T is singular
 * @return             0
 */
KRNUMER_API int32_t TriLinEqs_head(const KrTriangle* t, KrHandle b, int32_t* err);

/**
 * Complex form of TriLinEqs_head. Here the triangle is 0 or 1, or the status is -20061 (unless a later check fails
 * too); and T counts as singular when the squared modulus of an element of its diagonal is at most eps times the
 * largest squared modulus of all.
 */
KRNUMER_API int32_t CxTriLinEqs_head(const KrTriangle* t, KrHandle b, int32_t* err);

/**
 * Solution of T X = B for many right-hand sides, T being a triangle of A. Singularity is judged as by TriLinEqs_head.
 *
 * @param[in]  a         2-D double, n by n
 * @param[in]  triangle  0 the lower triangle of A, 1 the upper one
 * @param[in]  b         2-D double, n by k
 * @param[out] x         2-D double, n by k; empty on failure
 * @return               0; -20003 when A is empty or B has no columns; -20040 when A is not square; -20002 when B does
 *                       not have n rows; -20061 for another triangle; -20068, -20041 as for TriLinEqs_head; -20001 out
 *                       of memory
 */
KRNUMER_API int32_t TriEqsSetDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x);

/** Complex form of TriEqsSetDri_head; singularity is judged as by CxTriLinEqs_head. */
KRNUMER_API int32_t CxTriEqsSetDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x);

/* ---- Band matrices ------------------------------------------------------------------------------------------ */

/**
 * Solution of A x = b with a band matrix of order n that has kl diagonals below and ku above the main one, by LU
 * factorisation with partial pivoting.
 *
 * @param[in]     ab  2-D double, kl + ku + 1 by n, a diagonal in each row: AB[ku + i - j][j] = A[i][j]
 * @param[in,out] b   1-D double, n elements; becomes x; empty on failure
 * @param[in]     kl  diagonals below the main one
 * @param[in]     ku  diagonals above the main one
 * @return            0; -20008 when AB does not have kl + ku + 1 rows, or kl or ku is negative, or kl + ku + 1 is above
 *                    n; -20070 when b does not have n elements; -20003 when AB has no columns; -20041 when A is
 *                    singular; -20001 out of memory
 */
KRNUMER_API int32_t BandEqsDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku);

/** Complex form of BandEqsDriH. */
KRNUMER_API int32_t CxBandEqsDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku);

/**
 * BandEqsDriH for many right-hand sides.
 *
 * @param[in]     ab  2-D double, kl + ku + 1 by n
 * @param[in,out] b   2-D double, n by k; becomes X; empty on failure
 * @param[in]     kl  diagonals below the main one
 * @param[in]     ku  diagonals above the main one
 * @return            as of BandEqsDriH; -20008 when B has no columns, too
 */
KRNUMER_API int32_t BandEqsSetDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku);

/** Complex form of BandEqsSetDriH. */
KRNUMER_API int32_t CxBandEqsSetDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku);

#endif
