/*
 * Linear algebra: products, transposes, matrices made of vectors, packed triangles.
 */
#ifndef KRNUMER_LINALG_BASIC_H
#define KRNUMER_LINALG_BASIC_H

#include <krnumer/types.h>

#pragma pack(push, 1)
/** A packed triangle with the word that says which one it is. */
typedef struct KrTriangle {
    KrHandle elements; /**< 1-D double or complex: n(n+1)/2 elements, column by column */
    int32_t triangle;  /**< 0 lower, 1 upper, 2 symmetric (Hermitian) by its lower triangle */
} KrTriangle;
#pragma pack(pop)

/* ---- Products ----------------------------------------------------------------------------------------------- */

/**
 * Dot product, x[0] y[0] + ... + x[n-1] y[n-1], summed in index order.
 *
 * @param[in]  x    1-D double, n elements
 * @param[in]  y    1-D double, n elements
 * @param[out] dot  the sum; NaN on failure
 * @param[out] err  status: 0; -20003 when both vectors are empty; -20002 when their lengths differ
 * @return          0
 */
KRNUMER_API int32_t DotProduct_head(KrHandle x, KrHandle y, double* dot, int32_t* err);

/** Complex form of DotProduct_head. Bilinear: nothing is conjugated. NaN in both parts on failure. */
KRNUMER_API int32_t DotprodCx(KrHandle x, KrHandle y, KrComplex* dot, int32_t* err);

/**
 * Outer product, M[i][j] = x[i] y[j].
 *
 * @param[in]  x    1-D double, m elements
 * @param[in]  y    1-D double, n elements
 * @param[out] m    2-D double, m by n; empty on failure
 * @param[out] err  status: 0; -20003 when a vector is empty; -20001 out of memory
 * @return          0
 */
KRNUMER_API int32_t OuterProd_head(KrHandle x, KrHandle y, KrHandle m, int32_t* err);

/** Complex form of OuterProd_head: x times the transpose of y, without conjugation. */
KRNUMER_API int32_t OuterProdCx_head(KrHandle x, KrHandle y, KrHandle m, int32_t* err);

/**
 * Matrix product C = A B.
 *
 * Matrices without elements are multiplied as well: with inner dimension 0 every element of C is NaN, since a sum of
 * no terms is taken as unknown; with no rows in A or no columns in B, C has those dimensions and no elements.
 *
 * @param[in]  a    2-D double, m by k
 * @param[in]  b    2-D double, k by n
 * @param[out] c    2-D double, m by n; empty on failure
 * @param[out] err  status: 0; -20039 when the inner dimensions differ; -20003 when a dimension is negative; -20001 out
 *                  of memory
 * @return          0
 */
KRNUMER_API int32_t MatrixMul_head(KrHandle a, KrHandle b, KrHandle c, int32_t* err);

/** Complex form of MatrixMul_head. */
KRNUMER_API int32_t AxBCxCIN(KrHandle a, KrHandle b, KrHandle c, int32_t* err);

/**
 * Matrix times vector, y[i] = A[i][0] x[0] + ... + A[i][n-1] x[n-1], each sum in index order.
 *
 * With n = 0 and an empty x the result is m zeros; with m = 0 it is empty.
 *
 * @param[in]  a    2-D double, m by n
 * @param[in]  x    1-D double, n elements
 * @param[out] y    1-D double, m elements; empty on failure
 * @param[out] err  status: 0; -20002 when x does not have n elements; -20003 when a dimension is negative; -20001 out
 *                  of memory
 * @return          0
 */
KRNUMER_API int32_t AxVect_head(KrHandle a, KrHandle x, KrHandle y, int32_t* err);

/** Complex form of AxVect_head. */
KRNUMER_API int32_t AxVectorCx(KrHandle a, KrHandle x, KrHandle y, int32_t* err);

/**
 * Vector times matrix, y[j] = x[0] A[0][j] + ... + x[m-1] A[m-1][j].
 *
 * With m = 0 and an empty x the result is n times NaN, as for matrix products.
 *
 * @param[in]  x  1-D double, m elements
 * @param[in]  a  2-D double, m by n
 * @param[out] y  1-D double, n elements; empty on failure
 * @return        0; -20003 when a dimension is negative; -20002 when x does not have m elements; -20001 out of memory
 */
KRNUMER_API int32_t vectxA_head(KrHandle x, KrHandle a, KrHandle y);

/** Complex form of vectxA_head; x is not conjugated. */
KRNUMER_API int32_t CxVectxA_head(KrHandle x, KrHandle a, KrHandle y);

/**
 * Kronecker product, K[i p + k][j q + l] = A[i][j] B[k][l].
 *
 * @param[in]  a  2-D double, m by n
 * @param[in]  b  2-D double, p by q
 * @param[out] k  2-D double, m p by n q; empty on failure
 * @return        0; -20003 when a dimension is below 1; -20001 out of memory, or when K has too many elements
 */
KRNUMER_API int32_t KroneckerProd_H(KrHandle a, KrHandle b, KrHandle k);

/** Complex form of KroneckerProd_H. */
KRNUMER_API int32_t CxKroneckerProd_H(KrHandle a, KrHandle b, KrHandle k);

/* ---- Simple operations -------------------------------------------------------------------------------------- */

/**
 * Trace: the sum of the first min(m, n) diagonal elements, in index order.
 *
 * @param[in]  a      2-D double, m by n
 * @param[out] trace  the sum; NaN on failure
 * @param[out] err    status: 0, or -20003 when a dimension is below 1
 * @return            0
 */
KRNUMER_API int32_t Trace_head(KrHandle a, double* trace, int32_t* err);

/** Complex form of Trace_head; NaN in both parts on failure. */
KRNUMER_API int32_t CxTrace_head(KrHandle a, KrComplex* trace, int32_t* err);

/**
 * Transpose.
 *
 * @param[in]  a  2-D double, m by n
 * @param[out] b  2-D double, n by m; empty on failure
 * @return        0; -20003 when a dimension is below 1; -20001 out of memory
 */
KRNUMER_API int32_t Transpose_head(KrHandle a, KrHandle b);

/**
 * Conjugate transpose.
 *
 * @param[in]  a    2-D complex, m by n
 * @param[out] b    2-D complex, n by m; empty on failure
 * @param[out] err  status: 0; -20003 when a dimension is below 1; -20001 out of memory
 * @return          0
 */
KRNUMER_API int32_t CxTranspose_head(KrHandle a, KrHandle b, int32_t* err);

/**
 * A matrix of a special form.
 *
 *     kind               n by n for n =    elements
 *     0  identity        size
 *     1  diagonal        elements of x     x on the diagonal, zeros elsewhere
 *     2  Toeplitz        (see below)       x[i-j] where i >= j, y[j-i] where i < j
 *     3  Vandermonde     elements of x     x[i]^(n-1-j)
 *     4  companion       elements of x - 1 first row -x[j+1]/x[0], ones below the diagonal, zeros elsewhere
 *
 * A Toeplitz matrix has a row for each element of x and a column for each element of y; y[0] is not used. The companion
 * matrix has the roots of x[0] t^n + ... + x[n] as its eigenvalues; x[0] = 0 is no error, but the first row is then not
 * finite.
 *
 * @param[in]  kind  0 to 4
 * @param[in]  size  order of the identity; not used by the other kinds
 * @param[in]  x     1-D double
 * @param[in]  y     1-D double
 * @param[out] m     2-D double; empty on failure
 * @param[out] err   status: 0; -20006 when a companion matrix has fewer than two coefficients; -20003 when another size
 *                   is below 1; -20061 when `kind` is none of these (and `size` is at least 1); -20001 out of memory
 * @return           0
 */
KRNUMER_API int32_t SpecialMatrix_head(const int32_t* kind, const int32_t* size, KrHandle x, KrHandle y, KrHandle m,
                                       int32_t* err);

/** Complex form of SpecialMatrix_head. */
KRNUMER_API int32_t CxSpecialMatrix_head(const int32_t* kind, const int32_t* size, KrHandle x, KrHandle y, KrHandle m,
                                         int32_t* err);

/**
 * A matrix of zeros.
 *
 * @param[in]  rows     number of rows
 * @param[in]  columns  number of columns
 * @param[out] m        2-D double, rows by columns; empty on failure
 * @return              0; -20003 when a size is below 1; -20001 when so many elements cannot be had from the C run
 *                      time; the host's own status when it refuses the size
 */
KRNUMER_API int32_t InitialMatrixH(int32_t rows, int32_t columns, KrHandle m);

/** Complex form of InitialMatrixH. */
KRNUMER_API int32_t CxInitialMatrixH(int32_t rows, int32_t columns, KrHandle m);

/* ---- Packed triangles --------------------------------------------------------------------------------------- */

/**
 * Full matrix of a packed triangle.
 *
 * @param[in]  packed  the elements of the triangle and which one it is: 0 lower and 1 upper put zeros into the other
 *                     triangle, 2 mirrors the lower one
 * @param[out] m       2-D double, n by n; empty on failure
 * @param[out] err     status: 0; -20003 when there are no elements; -20040 when their number is not n(n+1)/2 for any n;
 *                     -20061 for another triangle; -20001 out of memory
 * @return             0
 */
KRNUMER_API int32_t Compact_to_Matrix_head(const KrTriangle* packed, KrHandle m, int32_t* err);

/** Complex form of Compact_to_Matrix_head. 2 gives a Hermitian matrix: the mirrored elements are conjugated. */
KRNUMER_API int32_t CxCompact_to_Matrix_head(const KrTriangle* packed, KrHandle m, int32_t* err);

/**
 * Packed triangle of a square matrix. What else the matrix holds is not looked at.
 *
 * @param[in]  a         2-D double, n by n
 * @param[in]  triangle  1 the upper triangle; 0 and 2 the lower one
 * @param[out] p         1-D double, n(n+1)/2 elements; empty on failure
 * @param[out] err       status: 0; -20040 when A is not square; -20003 when it is empty; -20061 for another triangle;
 *                       -20001 out of memory
 * @return               0
 */
KRNUMER_API int32_t Matrix_to_Compact_head(KrHandle a, const int32_t* triangle, KrHandle p, int32_t* err);

/** Complex form of Matrix_to_Compact_head; nothing is conjugated. */
KRNUMER_API int32_t CxMatrix_to_Compact_head(KrHandle a, const int32_t* triangle, KrHandle p, int32_t* err);

#endif
