// Scalar measures of a matrix: norms, condition, rank, determinant, definiteness.
#pragma once

#include <cstdint>

namespace krnumer {

enum NormType : int32_t {
    kTwoNorm = 0,  // largest singular value
    kOneNorm = 1,  // largest column sum of magnitudes
    kFrobeniusNorm = 2,
    kInfinityNorm = 3,  // largest row sum of magnitudes
};

// -20003: m or n below 1; -20068: data that cannot be used; -20061: no such norm; -20062, -20001. Magnitudes and
// squares are not scaled: elements beyond 1e154 may give infinity, complex ones below 1e-162 may count as 0.
template <class T>
int32_t NormCore(const T* a, int32_t m, int32_t n, int32_t type, double* norm);

// The norm of A times that of its inverse; for the two-norm, of any shape, largest over smallest singular value.
// Infinity for a singular matrix. As NormCore, and behind its selector -20040: not square, and not the two-norm.
template <class T>
int32_t ConditionCore(const T* a, int32_t m, int32_t n, int32_t type, double* condition);

// The number of singular values above tolerance. A negative tolerance, or NaN, stands for
// max(m, n) * (largest singular value) * epsilon. Fails as SvdValuesCore.
template <class T>
int32_t RankCore(const T* a, int32_t m, int32_t n, double tolerance, int32_t* rank);

enum MatrixType : int32_t {
    kGeneralMatrix = 0,
    kPositiveDefinite = 1,
    kLowerTriangular = 2,
    kUpperTriangular = 3,
};

// By LU, of a positive definite matrix by Cholesky of its lower triangle, of a triangular one from the diagonal alone.
// -20003: n below 1; -20061: no such type; -20071: not positive definite; -20001.
template <class T>
int32_t DeterminantCore(const T* a, int32_t n, int32_t type, T* determinant);

// flag: whether A is symmetric (Hermitian) to the last bit and all its eigenvalues are positive, by more than epsilon
// times the largest. 0 on failure. -20003: n below 1; -20068: data that cannot be used, in a symmetric matrix; -20062,
// -20001.
template <class T>
int32_t PositiveDefiniteCore(const T* a, int32_t n, int32_t* flag);

}  // namespace krnumer
