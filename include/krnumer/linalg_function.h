/*
 * Functions of square matrices: exponential, logarithm, square root and integer powers.
 *
 * Matrices are 2-D arrays of double, or of complex double for the functions with Cx in their name. A failure empties
 * the output, also where it takes the place of the input. The warning 20006 leaves the result.
 */
#ifndef KRNUMER_LINALG_FUNCTION_H
#define KRNUMER_LINALG_FUNCTION_H

#include <krnumer/types.h>

/**
 * Matrix exponential, by scaling, a diagonal Pade approximant and squaring (C. B. Moler and C. F. Van Loan, SIAM Rev.
 * 20, 801, 1978). The order of the approximant is chosen for an error of 1e-8, and that is about what the result is
 * good to.
 *
 * @param[in,out] a    matrix; its exponential on return. Data that are not finite give NaN
 * @param[out]    err  status: 0; -20003 when `a` is empty; -20040 when it is not square, before -20003; -20001 without
 *                     memory
 * @return             0
 */
KRNUMER_API int32_t MatrixExp_head(KrHandle a, int32_t* err);

/** MatrixExp_head of a complex matrix. */
KRNUMER_API int32_t CxMatrixExp_head(KrHandle a, int32_t* err);

/**
 * Matrix logarithm, through eigenvectors. Where exp of the result, as MatrixExp_head has it, is not A to 1e-12, the
 * eigenvectors of a slightly perturbed A are taken and the result corrected at most twice.
 *
 * @param[in]  a    matrix
 * @param[out] l    logarithm, 2-D complex
 * @param[out] err  status: 0; the warning 20006 when the corrections did not converge, as a rule with a good result;
 *                  -20003 when `a` is empty; -20040 when it is not square, before -20003; -20068 for data that cannot
 *                  be used; -20060 for an eigenvalue of 0; -20041 for dependent eigenvectors; -20062 when eigenvalues
 *                  do not converge; -20001 without memory or when `l` cannot be sized
 * @return          0
 */
KRNUMER_API int32_t MatrixLn_head(KrHandle a, KrHandle l, int32_t* err);

/**
 * MatrixLn_head of a complex matrix, in place.
 *
 * @param[in,out] a    matrix; its logarithm on return
 * @param[out]    err  status: that of MatrixLn_head
 * @return             0
 */
KRNUMER_API int32_t CxMatrixLn_head(KrHandle a, int32_t* err);

/**
 * Real part of the principal square root of a matrix, see MatrixSqrtH.
 *
 * @param[in,out] a    matrix; the real part of its root on return
 * @param[out]    err  status: 0; the warning 20006 and the codes of MatrixSqrtH, -20040 before -20003
 * @return             0
 */
KRNUMER_API int32_t MatrixSqrt_head(KrHandle a, int32_t* err);

/** Principal square root of a complex matrix, in place; otherwise as MatrixSqrt_head. */
KRNUMER_API int32_t CxMatrixSqrt_head(KrHandle a, int32_t* err);

/**
 * Principal square root of a matrix, through the Schur form (A. Bjorck and S. Hammarling, Linear Algebra Appl. 52, 127,
 * 1983).
 *
 * @param[in]  a  matrix
 * @param[out] s  root, 2-D complex
 * @return        0; the warning 20006 when the second smallest eigenvalue is near 0, so that there may be no root;
 *                -20003 when `a` is empty; -20040 when it is not square; -20068 for data that cannot be used; -20062
 *                without convergence; -20999 when LAPACK fails; -20001 without memory or when `s` cannot be sized
 */
KRNUMER_API int32_t MatrixSqrtH(KrHandle a, KrHandle s);

/**
 * Integer power of a matrix, by squaring. Power 0 is the identity, negative powers are those of the pseudo-inverse.
 *
 * @param[in,out] a      matrix; its power on return
 * @param[in]     power  exponent
 * @return               0; -20003 when `a` is empty; -20040 when it is not square; for negative powers -20068 for data
 *                       that cannot be used and -20062 when singular values do not converge; -20001 without memory
 */
KRNUMER_API int32_t MatrixPower_head(KrHandle a, int32_t power);

/** MatrixPower_head of a complex matrix. */
KRNUMER_API int32_t CxMatrixPower_head(KrHandle a, int32_t power);

#endif
