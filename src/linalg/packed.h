// Packed triangles: a triangle of a matrix of order n in n(n+1)/2 elements, column by column, each column holding only
// its part of the triangle.
//
//     lower   column j from the diagonal down; its diagonal at j n - j(j-1)/2
//     upper   column j from the top to the diagonal; its diagonal at j(j+3)/2
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/complex.h"
#include "frame/numeric.h"

namespace krnumer {

// The selectors of a triangle. A symmetric (Hermitian) matrix goes by its lower one.
enum Triangle : int32_t { kLower = 0, kUpper = 1, kSymmetric = 2 };

// Elements of a triangle of order n.
constexpr size_t PackedCount(int32_t n) {
    return Count(n) * (Count(n) + 1) / 2;
}

// Where the diagonal element of column j stands.
constexpr size_t LowerDiagonal(size_t j, size_t n) {
    return j * (2 * n + 1 - j) / 2;
}
constexpr size_t UpperDiagonal(size_t j) {
    return j * (j + 3) / 2;
}

// The order of a packed array by its length: -20003 with order 0 when the length is below 1, -20040 when it is no
// triangular number, with the order of the largest triangle in it.
int32_t PackedOrder(int32_t length, int32_t* n);

// Takes a triangle out of a matrix; what else the matrix holds is not looked at. -20003 when n is below 1, then -20061
// for an unknown triangle.
template <class T>
int32_t PackTriangle(const T* a, int32_t n, int32_t triangle, T* packed);

// The full matrix of a packed triangle, with zeros in the other triangle or, by kSymmetric, the (conjugated) mirror
// elements. The same failures.
template <class T>
int32_t UnpackTriangle(const T* packed, int32_t n, int32_t triangle, T* a);

}  // namespace krnumer
