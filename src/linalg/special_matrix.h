// Matrices made of a few vectors.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

enum SpecialMatrix : int32_t { kIdentity = 0, kDiagonal = 1, kToeplitz = 2, kVandermonde = 3, kCompanion = 4 };

struct Dimensions {
    int32_t rows, columns;
};

// What `kind` makes of the sizes: the identity and unknown kinds take `size`, the others the lengths of their vectors.
Dimensions SpecialMatrixDimensions(int32_t kind, int32_t size, int32_t xlen, int32_t ylen);

// -20006 for a companion matrix of fewer than two coefficients, -20003 for another size below 1.
int32_t CheckSpecialMatrix(int32_t kind, Dimensions dimensions);

//     identity
//     diagonal      x on the diagonal
//     Toeplitz      M[i][j] = x[i-j] from the diagonal down and y[j-i] above it, so y[0] is not used
//     Vandermonde   M[i][j] = x[i]^(n-1-j), by repeated multiplication
//     companion     of x[0] t^n + ... + x[n]: first row -x[j+1]/x[0], ones below the diagonal
//
// The failures of CheckSpecialMatrix, then -20061 for an unknown kind.
template <class T>
int32_t MakeSpecialMatrix(int32_t kind, int32_t size, const T* x, int32_t xlen, const T* y, int32_t ylen, T* m);

}  // namespace krnumer
