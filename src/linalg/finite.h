// The test of the data that iterative cores make before they start.
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// 1 when an element cannot be used, 0 otherwise. Besides NaN and the infinities these are the numbers that callers
// write for "no value": the largest double, and everything from -1.7976931348623e308 down.
int32_t CheckFiniteArray(const double* a, std::size_t count);

// The same on both parts of every element.
inline int32_t CheckFiniteCxArray(const Complex* a, std::size_t count) {
    return CheckFiniteArray(reinterpret_cast<const double*>(a), 2 * count);
}

// The same for templates over the element.
inline bool HasUnusable(const double* a, std::size_t count) {
    return CheckFiniteArray(a, count) != 0;
}
inline bool HasUnusable(const Complex* a, std::size_t count) {
    return CheckFiniteCxArray(a, count) != 0;
}

}  // namespace krnumer
