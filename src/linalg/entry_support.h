// What the entry points of linear algebra have in common.
#pragma once

#include <cstdint>
#include <limits>

#include "frame/entry.h"

namespace krnumer {

template <class T>
bool IsEmpty(const ShapedView<T, 1>& vector) {
    return vector.size() < 1;
}
template <class T>
bool IsEmpty(const ShapedView<T, 2>& matrix) {
    return matrix.rows() < 1 || matrix.columns() < 1;
}

template <class T>
bool IsNegative(const ShapedView<T, 2>& matrix) {
    return matrix.rows() < 0 || matrix.columns() < 0;
}

template <class T>
bool IsSquare(const ShapedView<T, 2>& matrix) {
    return matrix.rows() == matrix.columns();
}

// -20003 for a matrix without elements, -20040 for one that is not square. Both are tested, and the latter wins.
template <class T>
int32_t CheckSquare(const ShapedView<T, 2>& matrix) {
    if (!IsSquare(matrix)) return kNotSquare;
    return IsEmpty(matrix) ? kEmptyInput : kOk;
}

// The same for the matrix of a system of equations with a matrix of right-hand sides, where the first fault ends the
// checks: sizes, square shape, and -20002 for right-hand sides of another length.
template <class A, class B>
int32_t CheckSquareSystem(const A& matrix, const B& right_sides) {
    if (IsEmpty(matrix) || right_sides.columns() < 1) return kEmptyInput;
    if (!IsSquare(matrix)) return kNotSquare;
    return right_sides.rows() == matrix.rows() ? kOk : kSizesDiffer;
}

// Makes complex elements of the doubles that a core left in the first half of their array.
inline void SpreadToComplex(Complex* elements, int32_t count) {
    const double* values = reinterpret_cast<const double*>(elements);
    for (int32_t i = count; i-- > 0;) elements[i] = {values[i], 0.0};
}

// The product of two sizes; false when it is none, or one that no dimension word holds.
inline bool MultiplySizes(int32_t a, int32_t b, int32_t* product) {
    const int64_t wide = int64_t{a} * b;
    if (wide < 0 || wide > std::numeric_limits<int32_t>::max()) return false;
    *product = static_cast<int32_t>(wide);
    return true;
}

}  // namespace krnumer
