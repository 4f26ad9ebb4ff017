// The rotations of one single-shift QR sweep, applied to many rows or columns at once.
#pragma once

#include <cstddef>

#include "frame/complex.h"

namespace krnumer {

// The unitary [conj(c), s; -s, c] on two consecutive rows.
struct ComplexRotation {
    Complex c;
    double s;
};

// Rotation k of `count` acts on rows k and k + 1.
struct RotationChain {
    const ComplexRotation* rotations;
    std::ptrdiff_t count;
};

// From the left, on rows of `width` elements, `stride` apart.
void RotateRowsByChain(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width);

// The inverse from the right, on columns that are kept as rows.
void RotateTransposedByChain(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width);

// The inverse from the right, on `height` rows, `stride` apart.
void RotateColumnsByChain(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t height);

}  // namespace krnumer
