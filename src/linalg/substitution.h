// Substitution with a packed triangle, for right-hand sides that lie side by side in the rows of X (n by count). The
// packed columns are walked from end to end.
#pragma once

#include <cstddef>

#include "linalg/element.h"
#include "linalg/packed.h"

namespace krnumer::substitution {

// row -= factor * other.
template <class T>
inline void SubtractMultiple(T factor, const T* other, size_t count, T* row) {
    for (size_t c = 0; c < count; ++c) row[c] -= factor * other[c];
}

template <class T>
inline void DivideRow(T* row, size_t count, T divisor) {
    for (size_t c = 0; c < count; ++c) row[c] = row[c] / divisor;
}

// L X = B, lower.
template <class T>
void Forward(const T* lower, size_t n, T* x, size_t count) {
    for (size_t j = 0; j < n; ++j) {
        const T* const column = lower + (LowerDiagonal(j, n) - j);
        T* const solved = x + j * count;
        DivideRow(solved, count, column[j]);
        if (count == 1) {
            const T factor = *solved;
            for (size_t i = j + 1; i < n; ++i) x[i] -= column[i] * factor;
        } else {
            for (size_t i = j + 1; i < n; ++i) SubtractMultiple(column[i], solved, count, x + i * count);
        }
    }
}

// L^H X = B, lower.
template <class T>
void BackwardAdjoint(const T* lower, size_t n, T* x, size_t count) {
    for (size_t j = n; j-- > 0;) {
        const T* const column = lower + (LowerDiagonal(j, n) - j);
        T* const row = x + j * count;
        if (count == 1) {
            T rest = *row;
            for (size_t i = j + 1; i < n; ++i) rest -= Conjugate(column[i]) * x[i];
            *row = rest;
        } else {
            for (size_t i = j + 1; i < n; ++i) SubtractMultiple(Conjugate(column[i]), x + i * count, count, row);
        }
        DivideRow(row, count, Conjugate(column[j]));
    }
}

// U X = B, upper.
template <class T>
void Backward(const T* upper, size_t n, T* x, size_t count) {
    for (size_t j = n; j-- > 0;) {
        const T* const column = upper + (UpperDiagonal(j) - j);
        T* const solved = x + j * count;
        DivideRow(solved, count, column[j]);
        if (count == 1) {
            const T factor = *solved;
            for (size_t i = 0; i < j; ++i) x[i] -= column[i] * factor;
        } else {
            for (size_t i = 0; i < j; ++i) SubtractMultiple(column[i], solved, count, x + i * count);
        }
    }
}

}  // namespace krnumer::substitution
