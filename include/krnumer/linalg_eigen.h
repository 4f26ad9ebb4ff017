/*
 * Linear algebra: eigenvalues and eigenvectors, characteristic polynomials, and matrices from eigenvalues.
 *
 * Methods: for general real matrices balancing, elimination to Hessenberg form, double-shift QR and back substitution;
 * for general complex matrices the same with unitary transformations and single shifts; for symmetric and Hermitian
 * matrices Householder tridiagonalisation and implicit QL (J. H. Wilkinson and C. Reinsch, Handbook for Automatic
 * Computation II, Linear Algebra, 1971; B. T. Smith et al., Matrix Eigensystem Routines: EISPACK Guide, 1976).
 *
 * Eigenvectors are the columns of a matrix and have Euclidean length 1.
 */
#ifndef KRNUMER_LINALG_EIGEN_H
#define KRNUMER_LINALG_EIGEN_H

#include <krnumer/types.h>

/**
 * Eigenvalues, and if wanted eigenvectors, of a general real matrix.
 *
 * Eigenvalues are not sorted: they stand where the iteration leaves them, those of a triangular matrix in the order of
 * its diagonal. Of a conjugate pair the one with positive imaginary part comes first.
 *
 * @param[in]  a             2-D double, n by n
 * @param[in]  want_vectors  0 eigenvalues only, 1 also eigenvectors
 * @param[out] w             1-D complex, n eigenvalues; empty on failure
 * @param[out] v             2-D complex, n by n, eigenvectors as columns in the order of `w`; empty when they are not
 *                           wanted and on failure
 * @param[out] err           status: 0; -20003 when `a` has no elements; -20040 when it is not square, 0 by n included;
 *                           -20061 when `want_vectors` is neither 0 nor 1; -20068 when an element is not finite or is
 *                           one of the extreme doubles that stand for a missing value; -20062 when an eigenvalue needs
 *                           more than 40 sweeps; -20001 out of memory
 * @return                   0
 */
KRNUMER_API int32_t EigenValueVector_head(KrHandle a, const int32_t* want_vectors, KrHandle w, KrHandle v,
                                          int32_t* err);

/**
 * Eigenvalues, and if wanted eigenvectors, of a complex matrix.
 *
 * @param[in,out] a             2-D complex, n by n; becomes the eigenvectors as columns in the order of `w`; empty when
 *                              they are not wanted and on failure
 * @param[in]     kind          0 general: eigenvalues where the iteration leaves them; 1 Hermitian: only the lower
 *                              triangle counts, and the eigenvalues are real and ascend
 * @param[in]     want_vectors  0 eigenvalues only, 1 also eigenvectors
 * @param[out]    w             1-D complex, n eigenvalues; empty on failure
 * @param[out]    err           status: 0; -20003 when `a` has no elements; -20040 when it is not square, 0 by n
 *                              included; -20061 when `kind` or `want_vectors` is neither 0 nor 1; -20068 when an
 *                              element is not finite or is one of the extreme doubles that stand for a missing value;
 *                              -20062 when an eigenvalue needs more than 30 sweeps; -20001 out of memory
 * @return                      0
 */
KRNUMER_API int32_t CxEigenValueVector_head(KrHandle a, const int32_t* kind, const int32_t* want_vectors, KrHandle w,
                                            int32_t* err);

/**
 * Eigenvalues, and if wanted eigenvectors, of a real symmetric matrix.
 *
 * Only the lower triangle counts; whether the matrix is symmetric is not looked at.
 *
 * @param[in,out] a             2-D double, n by n; becomes the eigenvectors as columns in the order of `w`; empty when
 *                              they are not wanted and on failure
 * @param[in]     want_vectors  0 eigenvalues only, 1 also eigenvectors
 * @param[out]    w             1-D double, n eigenvalues, ascending; empty on failure
 * @param[out]    err           status: 0; -20040 when `a` is not square, 0 by n included; -20003 when it has no
 *                              elements; -20061 when `want_vectors` is neither 0 nor 1; -20068 when an element, of
 *                              either triangle, is not finite or is one of the extreme doubles that stand for a missing
 *                              value; -20062 when an eigenvalue needs more than 30 sweeps; -20001 out of memory
 * @return                      0
 */
KRNUMER_API int32_t SymEvectorEvalue_head(KrHandle a, const int32_t* want_vectors, KrHandle w, int32_t* err);

/**
 * Characteristic polynomial, det(x I - A) = c[0] + c[1] x + ... + c[n] x^n, by way of the eigenvalues.
 *
 * @param[in]  a    2-D double, n by n
 * @param[out] c    1-D double, n + 1 coefficients, the last of them 1; empty on failure
 * @param[out] err  status: 0; -20003 when `a` has no elements; -20040 when it is not square, 0 by n included; -20068
 *                  when an element is not finite or is one of the extreme doubles that stand for a missing value;
 *                  -20062 when an eigenvalue needs more than 40 sweeps; -20001 out of memory
 * @return          0
 */
KRNUMER_API int32_t MatrixCharacteristicPoly_head(KrHandle a, KrHandle c, int32_t* err);

/**
 * Companion matrix with given eigenvalues: ones above the diagonal, and in the last row the negated coefficients of
 * (x - lambda[0]) ... (x - lambda[n-1]) in ascending powers.
 *
 * The matrix is real. Where the eigenvalues are not closed under conjugation, the imaginary parts of the coefficients
 * are lost and the matrix has other eigenvalues.
 *
 * @param[in]  lambda  1-D complex, n eigenvalues
 * @param[out] m       2-D double, n by n; empty on failure
 * @param[out] err     status: 0; -20003 when `lambda` is empty; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t CreateMatrixFromEVs_head(KrHandle lambda, KrHandle m, int32_t* err);

#endif
