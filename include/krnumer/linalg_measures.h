/*
 * Linear algebra: determinant, rank, norms, condition number and the test for positive definiteness.
 */
#ifndef KRNUMER_LINALG_MEASURES_H
#define KRNUMER_LINALG_MEASURES_H

#include <krnumer/types.h>

/**
 * Determinant.
 *
 * A general matrix is factored by LU with partial pivoting, a positive definite one by Cholesky from its lower
 * triangle; that of a triangular one is the product of its diagonal, whatever stands elsewhere.
 *
 * @param[in]  a     2-D double, n by n
 * @param[in]  type  0 general, 1 positive definite, 2 lower triangular, 3 upper triangular
 * @param[out] det   the determinant, 0 for a singular general matrix; NaN on failure
 * @param[out] err   status: 0; -20003 when `a` has no elements; -20040 when it is not square, 0 by n included; -20061
 *                   when `type` is none of the above; -20071 when a matrix of type 1 is not positive definite; -20001
 *                   out of memory
 * @return           0
 */
KRNUMER_API int32_t Determinant_head(KrHandle a, const int32_t* type, double* det, int32_t* err);

/** Complex form of Determinant_head. NaN in both parts on failure; the imaginary part for type 1 is 0. */
KRNUMER_API int32_t CxDeterminant_head(KrHandle a, const int32_t* type, KrComplex* det, int32_t* err);

/**
 * Rank: the number of singular values above a tolerance.
 *
 * @param[in]  a     2-D double, m by n
 * @param[in]  tol   absolute tolerance, in the unit of the elements; negative or NaN: max(m, n) times the largest
 *                   singular value times 2.2e-16
 * @param[out] rank  the rank; -1 on failure
 * @param[out] err   status: 0; -20003 when `a` has no elements; -20068 when an element is not finite or is one of the
 *                   extreme doubles that stand for a missing value; -20062 when a singular value does not converge;
 *                   -20001 out of memory
 * @return           0
 */
KRNUMER_API int32_t Rank_head(KrHandle a, const double* tol, int32_t* rank, int32_t* err);

/** Complex form of Rank_head. */
KRNUMER_API int32_t CxRank_head(KrHandle a, const double* tol, int32_t* rank, int32_t* err);

/**
 * Norm.
 *
 * Squares are not scaled: elements beyond 1e154 give infinity in the Frobenius norm.
 *
 * @param[in]  a          2-D double, m by n
 * @param[in]  norm_type  0 two-norm (largest singular value), 1 one-norm (largest column sum of magnitudes), 2
 *                        Frobenius (root of the sum of squares), 3 infinity norm (largest row sum of magnitudes)
 * @param[out] norm       the norm, in the unit of the elements; NaN on failure
 * @param[out] err        status: 0; -20003 when `a` has no elements; -20068 when an element is not finite or is one of
 *                        the extreme doubles that stand for a missing value; -20061 when `norm_type` is none of the
 *                        above; -20062 when a singular value does not converge; -20001 out of memory
 * @return                0
 */
KRNUMER_API int32_t Norm_head(KrHandle a, const int32_t* norm_type, double* norm, int32_t* err);

/** Complex form of Norm_head. Magnitudes are plain sqrt(re^2 + im^2), without scaling in the other norms either. */
KRNUMER_API int32_t CxNorm_head(KrHandle a, const int32_t* norm_type, double* norm, int32_t* err);

/**
 * Condition number: the norm of the matrix times the norm of its inverse. With the two-norm it is the largest over the
 * smallest singular value, for matrices of any shape.
 *
 * @param[in]  a          2-D double, m by n; n by n unless `norm_type` is 0
 * @param[in]  norm_type  as in Norm_head
 * @param[out] cond       the condition number; infinity for a singular matrix, with the two-norm when the smallest
 *                        singular value is not above max(m, n) times the largest times 2.2e-16; NaN on failure
 * @param[out] err        status: 0; -20003 when `a` has no elements; -20068 when an element is not finite or is one of
 *                        the extreme doubles that stand for a missing value; -20061 when `norm_type` is none of the
 *                        above; -20040 when `a` is not square and `norm_type` is not 0; -20062 when a singular value
 *                        does not converge; -20001 out of memory
 * @return                0
 */
KRNUMER_API int32_t CondNumber_head(KrHandle a, const int32_t* norm_type, double* cond, int32_t* err);

/** Complex form of CondNumber_head. */
KRNUMER_API int32_t CxCondNumber_head(KrHandle a, const int32_t* norm_type, double* cond, int32_t* err);

/**
 * Tests whether a matrix is symmetric to the last bit and positive definite: all eigenvalues above 2.2e-16 times the
 * largest in magnitude.
 *
 * @param[in]  a     2-D double, n by n
 * @param[out] flag  1 when it is, 0 when it is not and on failure
 * @param[out] err   status: 0; -20003 when `a` has no elements; -20040 when it is not square, 0 by n included; -20068
 *                   when it is symmetric and an element is not finite or is one of the extreme doubles that stand for a
 *                   missing value; -20062 when an eigenvalue does not converge; -20001 out of memory
 * @return           0
 */
KRNUMER_API int32_t CheckPosdef_head(KrHandle a, int32_t* flag, int32_t* err);

/** Complex form of CheckPosdef_head: Hermitian instead of symmetric, so the diagonal has to be real. */
KRNUMER_API int32_t CxCheckPosdef_head(KrHandle a, int32_t* flag, int32_t* err);

#endif
