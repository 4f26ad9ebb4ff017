// Checks of sizes as the entry points of linear algebra make them.
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

// The product of two sizes; false when it is none, or one that no dimension word holds.
inline bool MultiplySizes(int32_t a, int32_t b, int32_t* product) {
    const int64_t wide = int64_t{a} * b;
    if (wide < 0 || wide > std::numeric_limits<int32_t>::max()) return false;
    *product = static_cast<int32_t>(wide);
    return true;
}

}  // namespace krnumer
