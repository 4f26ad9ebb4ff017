/*
 * Hessenberg form, balancing, Schur decomposition and pencils of square matrices, over LAPACK.
 *
 * Matrices are 2-D arrays of double, or of complex double for the functions with Cx in their name. Eigenvalues are
 * complex throughout. Every failure empties the output arrays, those that are input too among them.
 *
 * Orders of eigenvalues: 0 as they come, 1 real part ascending, 2 descending, 3 magnitude ascending, 4 descending.
 * Complex pairs of a real matrix stay together.
 */
#ifndef KRNUMER_LINALG_SCHUR_H
#define KRNUMER_LINALG_SCHUR_H

#include <krnumer/types.h>

/**
 * Hessenberg form, A = Q H Q^H, H upper Hessenberg between two rows.
 *
 * @param[in,out] a    n by n; H on return
 * @param[in]     ilo  first row of the part to reduce, from 0 on
 * @param[in]     ihi  last row of it, from ilo on
 * @param[out]    q    n by n, orthogonal or unitary
 * @return             0; -20040 when `a` is not square; -20003 when it is empty; -20017 unless 0 <= ilo <= ihi < n;
 *                     -20068 for data that cannot be used; -20001 without memory or when `q` cannot be sized
 */
KRNUMER_API int32_t Hessenberg_head(KrHandle a, int32_t ilo, int32_t ihi, KrHandle q);

/** Hessenberg_head of complex matrices. */
KRNUMER_API int32_t CxHessenberg_head(KrHandle a, int32_t ilo, int32_t ihi, KrHandle q);

/**
 * Balances a matrix (B. N. Parlett and C. Reinsch, Numer. Math. 13, 293, 1969).
 *
 * @param[in,out] a      matrix; balanced on return
 * @param[in]     job    0 nothing, 1 permutes, 2 scales, 3 does both
 * @param[out]    ilo    first row of the balanced part, from 0 on; not touched by a failure
 * @param[out]    ihi    last row of it; not touched by a failure
 * @param[out]    scale  factors, and outside ilo to ihi the rows exchanged, counted from 1, 1-D double
 * @return               0; -20003 when `a` is empty; -20040 when it is not square; -20061 for another `job`; -20999
 *                       when LAPACK refuses the data; -20001 without memory or when `scale` cannot be sized
 */
KRNUMER_API int32_t MatrixBalance_head(KrHandle a, int32_t job, int32_t* ilo, int32_t* ihi, KrHandle scale);

/** MatrixBalance_head of complex matrices. */
KRNUMER_API int32_t CxMatrixBalance_head(KrHandle a, int32_t job, int32_t* ilo, int32_t* ihi, KrHandle scale);

/**
 * Turns eigenvectors of a balanced matrix into those of the original.
 *
 * @param[in,out] v      eigenvectors as columns
 * @param[in]     job    that of MatrixBalance_head
 * @param[in]     side   above 0 for left eigenvectors, else right ones
 * @param[in]     ilo    from MatrixBalance_head; a value that fits no matrix leaves the vectors
 * @param[in]     ihi    from MatrixBalance_head, likewise
 * @param[in]     scale  from MatrixBalance_head
 * @return               0; -20040 when `v` is not square; -20003 when it is empty; -20002 when `scale` has another
 *                       length; -20061 for another `job`; -20017 when `scale` names a row that does not exist; -20001
 *                       without memory
 */
KRNUMER_API int32_t EigenVBack_head(KrHandle v, int32_t job, int32_t side, int32_t ilo, int32_t ihi, KrHandle scale);

/** EigenVBack_head of complex matrices. */
KRNUMER_API int32_t CxEigenVBack_head(KrHandle v, int32_t job, int32_t side, int32_t ilo, int32_t ihi, KrHandle scale);

/**
 * Schur decomposition, A = Z T Z^H.
 *
 * @param[in,out] a            matrix; T on return, quasi-triangular where it is real
 * @param[in]     wantVectors  not 0 for Z
 * @param[out]    z            orthogonal or unitary factor; empty when it is not wanted
 * @param[out]    w            eigenvalues, 1-D complex
 * @return                     0; -20003 when `a` is empty; -20040 when it is not square; -20068 for data that cannot be
 *                             used; -20062 without convergence; -20999 when LAPACK fails; -20001 without memory or when
 *                             an output cannot be sized
 */
KRNUMER_API int32_t Schur_head(KrHandle a, int32_t wantVectors, KrHandle z, KrHandle w);

/** Schur_head of complex matrices. */
KRNUMER_API int32_t CxSchur_head(KrHandle a, int32_t wantVectors, KrHandle z, KrHandle w);

/**
 * Schur_head with the eigenvalues in an order.
 *
 * The blocks are exchanged in pairs; eigenvalues move with them and are not computed anew.
 *
 * @param[in,out] a            matrix; T on return, quasi-triangular where it is real
 * @param[in]     wantVectors  not 0 for Z
 * @param[in]     order        0 to 4
 * @param[out]    z            orthogonal or unitary factor; empty when it is not wanted
 * @param[out]    w            eigenvalues, 1-D complex
 * @return                     0; -20003 when `a` is empty; -20040 when it is not square; -20061 for another order;
 *                             -20068 for data that cannot be used; -20062 without convergence; -20999 when LAPACK
 *                             fails; -20001 without memory or when an output cannot be sized
 */
KRNUMER_API int32_t Schur80_head(KrHandle a, int32_t wantVectors, int32_t order, KrHandle z, KrHandle w);

/** Schur80_head of complex matrices. */
KRNUMER_API int32_t CxSchur80_head(KrHandle a, int32_t wantVectors, int32_t order, KrHandle z, KrHandle w);

/**
 * QZ80_head with mode 0 and no order.
 *
 * @param[in,out] a      matrix; Q on return
 * @param[in,out] b      matrix; Z on return
 * @param[out]    alpha  numerators of the eigenvalues alpha / beta, 1-D complex
 * @param[out]    beta   denominators, 1-D of double, or complex
 * @param[out]    v      right eigenvectors as columns, 2-D complex; the largest |re| + |im| of each is 1
 * @return               0; -20040 when a matrix is not square; -20070 when they differ in size; -20003 when they are
 *                       empty; -20068 for data that cannot be used; -20062 without convergence; -20073 when pairs
 *                       cannot be exchanged; -20999 when LAPACK fails; -20001 without memory or when an output cannot
 *                       be sized
 */
KRNUMER_API int32_t QZ_head(KrHandle a, KrHandle b, KrHandle alpha, KrHandle beta, KrHandle v);

/** QZ_head of complex pencils. */
KRNUMER_API int32_t CxQZ_head(KrHandle a, KrHandle b, KrHandle alpha, KrHandle beta, KrHandle v);

/**
 * Generalised Schur decomposition, A = Q S Z^H and B = Q P Z^H (C. B. Moler and G. W. Stewart, SIAM J. Numer. Anal. 10,
 * 241, 1973).
 *
 * With `mode` 0, Q and Z are those of the Hessenberg-triangular stage before the iteration. Only `mode` 1 sorts;
 * infinite eigenvalues come last in ascending and first in descending orders. A pair that is 0/0 ends the sorting with
 * the warning 20005.
 *
 * @param[in,out] a      matrix; Q on return
 * @param[in,out] b      matrix; Z on return
 * @param[in]     mode   0 Hessenberg-triangular stage, 1 Schur form in `order`, else Schur form
 * @param[in]     order  0 to 4
 * @param[out]    alpha  numerators of the eigenvalues alpha / beta, 1-D complex
 * @param[out]    beta   denominators, 1-D of double, or complex
 * @param[out]    v      right eigenvectors as columns, 2-D complex; the largest |re| + |im| of each is 1
 * @return               0; -20040 when a matrix is not square; -20070 when they differ in size; -20003 when they are
 *                       empty; -20061 for another order; -20068 for data that cannot be used; -20062 without
 *                       convergence; -20073 when pairs cannot be exchanged; -20999 when LAPACK fails; -20001 without
 *                       memory or when an output cannot be sized
 */
KRNUMER_API int32_t QZ80_head(KrHandle a, KrHandle b, int32_t mode, int32_t order, KrHandle alpha, KrHandle beta,
                              KrHandle v);

/** QZ80_head of complex pencils. */
KRNUMER_API int32_t CxQZ80_head(KrHandle a, KrHandle b, int32_t mode, int32_t order, KrHandle alpha, KrHandle beta,
                                KrHandle v);

/**
 * Generalised Schur decomposition with all its parts, Q A Z = S and Q B Z = P. Here Q is the transpose of that of
 * QZ80_head, in the complex function without conjugation.
 *
 * @param[in,out] a      matrix; S on return
 * @param[in,out] b      matrix; P on return
 * @param[out]    q      left factor
 * @param[out]    z      right factor
 * @param[out]    alpha  numerators of the eigenvalues, 1-D complex
 * @param[out]    beta   denominators, 1-D of double, or complex
 * @param[in]     which  vectors: 0 none, 1 right, 2 left, 3 both
 * @param[out]    vr     right eigenvectors, or empty; those of a complex pair of a real pencil as real and imaginary
 *                       part in two columns
 * @param[out]    vl     left eigenvectors, or empty, likewise
 * @return               0; the codes of QZ80_head, -20061 for another `which`
 */
KRNUMER_API int32_t TmiQZ_head(KrHandle a, KrHandle b, KrHandle q, KrHandle z, KrHandle alpha, KrHandle beta,
                               int32_t which, KrHandle vr, KrHandle vl);

/** TmiQZ_head of complex pencils. */
KRNUMER_API int32_t CxTmiQZ_head(KrHandle a, KrHandle b, KrHandle q, KrHandle z, KrHandle alpha, KrHandle beta,
                                 int32_t which, KrHandle vr, KrHandle vl);

/**
 * Eigenvalues and right eigenvectors of a pencil, A v = w B v.
 *
 * Eigenvalues are quotients without a test: a singular B gives infinities and NaN.
 *
 * @param[in]  a            matrix
 * @param[in]  b            matrix
 * @param[in]  wantVectors  0 for eigenvalues only, 1 for eigenvectors too
 * @param[out] w            eigenvalues, 1-D complex
 * @param[out] v            right eigenvectors as columns, 2-D complex, the largest |re| + |im| of each 1; empty when
 *                          not wanted
 * @return                  0; -20040 when a matrix is not square; -20070 when they differ in size; -20003 when they are
 *                          empty; -20061 for another `wantVectors`; -20068 for data that cannot be used; -20062 without
 *                          convergence; -20999 when LAPACK fails; -20001 without memory or when an output cannot be
 *                          sized
 */
KRNUMER_API int32_t GenEigenEx_head(KrHandle a, KrHandle b, int32_t wantVectors, KrHandle w, KrHandle v);

/** GenEigenEx_head of complex pencils. */
KRNUMER_API int32_t CxGenEigenEx_head(KrHandle a, KrHandle b, int32_t wantVectors, KrHandle w, KrHandle v);

#endif
