// Householder reflectors for the reductions to condensed form, walking row-major matrices by rows.
//
// A reflector is I + v v^H / h with h = -|v|^2 / 2. It turns the vector x that it was made of into a multiple of the
// first unit vector, whose phase is opposite to that of x[0] so that nothing cancels.
#pragma once

#include <cmath>
#include <cstddef>

#include "linalg/element.h"
#include "linalg/rotations.h"

namespace krnumer {

template <class T>
struct Reflector {
    T image{};       // what becomes of the first element of x
    double h = 0.0;  // 0 where x was 0 and there is nothing to reflect
};

// a / |a|, and 1 for 0. Its modulus is 1 even where that of a is subnormal and has few digits.
inline Complex Phase(Complex a) {
    const double larger = std::fmax(std::fabs(a.re), std::fabs(a.im));
    if (larger == 0.0) return {1.0, 0.0};
    const Complex scaled = a / larger;
    return scaled / Modulus(scaled);
}

// What a reflector's image contributes to a condensed form that has to be real. For a complex image that is its
// modulus, and `phase` is multiplied by the phase that it loses.
inline double RealImage(double image, double* /*phase*/) {
    return image;
}
inline double RealImage(Complex image, Complex* phase) {
    *phase = Phase(image) * *phase;
    return Hypotenuse(image.re, image.im);
}

// Overwrites x (count elements, `stride` apart) by v, scaled by the sum of magnitudes.
template <class T>
Reflector<T> MakeReflector(T* x, std::ptrdiff_t count, std::ptrdiff_t stride) {
    double scale = 0.0;
    for (std::ptrdiff_t k = 0; k < count; ++k) scale += SumOfParts(x[k * stride]);
    if (scale == 0.0) return {};
    double squares = 0.0;
    for (std::ptrdiff_t k = 0; k < count; ++k) {
        T& element = x[k * stride];
        element = element / scale;
        squares += SquaredModulus(element);
    }
    const double root = std::sqrt(squares);
    const T first = x[0];
    T image;
    double h;
    if constexpr (kIsComplex<T>) {
        const double modulus = Hypotenuse(first.re, first.im);
        image = Phase(first) * -root;
        h = -modulus * root - squares;
    } else {
        image = first < 0.0 ? root : -root;
        h = first * image - squares;
    }
    x[0] = first - image;
    return {image * scale, h};
}

// block = (I + v v^H / h) block for the rows by columns block with rows `row_stride` apart. v is not part of it.
// sums: work space for one row.
template <class T>
void ReflectColumns(const T* v, std::ptrdiff_t v_stride, double h, T* block, std::ptrdiff_t rows,
                    std::ptrdiff_t columns, std::ptrdiff_t row_stride, T* sums) {
    for (std::ptrdiff_t j = 0; j < columns; ++j) sums[j] = T{};
    for (std::ptrdiff_t k = 0; k < rows; ++k) {
        const T factor = Conjugate(v[k * v_stride]);
        const T* row = block + k * row_stride;
        for (std::ptrdiff_t j = 0; j < columns; ++j) sums[j] += factor * row[j];
    }
    for (std::ptrdiff_t j = 0; j < columns; ++j) sums[j] = sums[j] / h;
    for (std::ptrdiff_t k = 0; k < rows; ++k) {
        const T factor = v[k * v_stride];
        T* row = block + k * row_stride;
        for (std::ptrdiff_t j = 0; j < columns; ++j) row[j] += factor * sums[j];
    }
}

// block = block (I + r^H r / h) for a row vector r, given with scaled = r / h. Several rows at once, because each sum
// of products is a chain of additions.
template <int rows, class T>
void ReflectRowGroup(const T* r, const T* scaled, T* block, std::ptrdiff_t columns, std::ptrdiff_t row_stride) {
    T sums[rows] = {};
    for (std::ptrdiff_t k = 0; k < columns; ++k) {
        const T factor = Conjugate(r[k]);
        for (int j = 0; j < rows; ++j) sums[j] += block[j * row_stride + k] * factor;
    }
    for (int j = 0; j < rows; ++j) {
        T* row = block + j * row_stride;
        for (std::ptrdiff_t k = 0; k < columns; ++k) row[k] += sums[j] * scaled[k];
    }
}

template <class T>
void ReflectRows(const T* r, const T* scaled, T* block, std::ptrdiff_t rows, std::ptrdiff_t columns,
                 std::ptrdiff_t row_stride) {
    constexpr int kGroup = 8;
    std::ptrdiff_t j = 0;
    for (; j + kGroup <= rows; j += kGroup)
        ReflectRowGroup<kGroup>(r, scaled, block + j * row_stride, columns, row_stride);
    for (; j < rows; ++j) ReflectRowGroup<1>(r, scaled, block + j * row_stride, columns, row_stride);
}

}  // namespace krnumer
