/*
 * Matrix equations: Sylvester's op(A) X + sign X op(B) = scale C and Lyapunov's A X + X A^H = scale Q.
 *
 * Matrices are 2-D arrays of double, or of complex double for the functions with Cx in their name. The right-hand side
 * is overwritten by the solution X.
 *
 * Method: Schur decompositions of A and B, then substitution (R. H. Bartels and G. W. Stewart, Comm. ACM 15, 820,
 * 1972), by LAPACK's DGEES and DTRSYL, ZGEES and ZTRSYL. `scale`, from 0 to 1, is below 1 only where X would overflow.
 * An equation that is singular or nearly so is solved in the sense of least squares: below 1601 unknowns (801 complex
 * ones) as one system, giving the X of least norm; from there on column by column.
 *
 * A failure empties the right-hand side, sets `scale` to 1 and `singular` to 0.
 */
#ifndef KRNUMER_LINALG_EQUATIONS_H
#define KRNUMER_LINALG_EQUATIONS_H

#include <krnumer/types.h>

/**
 * Lyapunov equation, A X + X A^T = scale Q.
 *
 * @param[in]     a      matrix
 * @param[in,out] q      right-hand side, of the size of `a`; X on return
 * @param[in]     form   0 for any A, 1 for an A that is upper quasi-triangular already, as a Schur form is
 * @param[out]    scale  scale of the right-hand side; 1 on failure
 * @return               0; -20003 when `a` is empty; -20040 when it is not square; -20002 when `q` has another size;
 *                       -20061 for another `form`; -20068 for data that cannot be used; -20062 without convergence;
 *                       -20073 or -20074 when LAPACK reports a failed reordering, -20999 when it fails otherwise;
 *                       -20001 without memory
 */
KRNUMER_API int32_t Lyapunov_head(KrHandle a, KrHandle q, int32_t form, double* scale);

/** Lyapunov_head of complex matrices, A X + X A^H = scale Q; an A of form 1 is upper triangular. */
KRNUMER_API int32_t CxLyapunov_head(KrHandle a, KrHandle q, int32_t form, double* scale);

/**
 * Sylvester equation of matrices that are upper quasi-triangular already: Sylvester81_head with form 1.
 *
 * Full matrices are not reduced; what lies below their first subdiagonal has no part in the substitution.
 *
 * @param[in]     a         matrix
 * @param[in]     b         matrix
 * @param[in,out] c         right-hand side, with the rows of `a` and the columns of `b`; X on return
 * @param[in]     transA    0 for op(A) = A, 1 for its transpose
 * @param[in]     transB    0 for op(B) = B, 1 for its transpose
 * @param[in]     sign      1 or -1
 * @param[out]    scale     scale of the right-hand side; 1 on failure
 * @param[out]    singular  1 when op(A) and -sign op(B) have a common eigenvalue or nearly so, else 0; 0 on failure
 * @return                  0; the codes of Sylvester81_head
 */
KRNUMER_API int32_t Sylvester_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign,
                                   double* scale, int32_t* singular);

/** Sylvester_head of complex upper triangular matrices; 1 for transA or transB is the conjugate transpose. */
KRNUMER_API int32_t CxSylvester_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign,
                                     double* scale, int32_t* singular);

/**
 * Sylvester equation, op(A) X + sign X op(B) = scale C.
 *
 * @param[in]     a         matrix
 * @param[in]     b         matrix
 * @param[in,out] c         right-hand side, with the rows of `a` and the columns of `b`; X on return
 * @param[in]     transA    0 for op(A) = A, 1 for its transpose
 * @param[in]     transB    0 for op(B) = B, 1 for its transpose
 * @param[in]     sign      1 or -1
 * @param[in]     form      0 for any matrices, 1 when both are upper quasi-triangular already
 * @param[out]    scale     scale of the right-hand side; 1 when the equation is singular, and on failure
 * @param[out]    singular  1 when op(A) and -sign op(B) have a common eigenvalue or nearly so, else 0; 0 on failure
 * @return                  0; -20040 when `a` or `b` is not square; -20002 when `c` does not match them; -20003 when
 *                          they are empty; -20061 for another value of a selector; -20068 for data that cannot be used;
 *                          -20062 without convergence; -20073 or -20074 when LAPACK reports a failed reordering, -20999
 *                          when it fails otherwise; -20001 without memory
 */
KRNUMER_API int32_t Sylvester81_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign,
                                     int32_t form, double* scale, int32_t* singular);

/** Sylvester81_head of complex matrices; 1 for transA or transB is the conjugate transpose, form 1 upper triangular. */
KRNUMER_API int32_t CxSylvester81_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign,
                                       int32_t form, double* scale, int32_t* singular);

#endif
