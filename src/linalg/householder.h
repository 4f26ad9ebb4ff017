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
    if (count == 1) {  // no more than a change of sign
        const T image = -x[0];
        x[0] = x[0] / scale;
        const double h = -2.0 * SquaredModulus(x[0]);
        x[0] = x[0] * 2.0;
        return {image, h};
    }
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

// A block of a row-major matrix: its rows stand `stride` elements apart.
template <class T>
struct Block {
    T* elements;
    std::ptrdiff_t rows, columns, stride;

    T* Row(std::ptrdiff_t i) const { return elements + i * stride; }
};

// The elements of a vector, `stride` apart.
template <class T>
struct Spaced {
    const T* elements;
    std::ptrdiff_t stride;

    const T& operator[](std::ptrdiff_t i) const { return elements[i * stride]; }
};

// Each sum below is taken in the order of its terms, and no product is fused, so vector units make no difference.

// sums = v^H block.
template <class T>
void SumColumns(Spaced<T> v, const Block<T>& block, T* sums);

// block += v sums.
template <class T>
void AddProducts(Spaced<T> v, const T* sums, const Block<T>& block);

// block = block (I + r^H r / h) for a row vector r, given with scaled = r / h.
template <class T>
void ReflectRows(const T* r, const T* scaled, const Block<T>& block);

// AddProducts, then ReflectRows, a few rows at a time.
template <class T>
void AddProductsAndReflectRows(Spaced<T> v, const T* sums, const T* r, const T* scaled, const Block<T>& block);

// The row that (I + v v^H / h) adds to the rows of a block, once for each element of v: v^H block / h.
template <class T>
void FindReflection(Spaced<T> v, double h, const Block<T>& block, T* sums) {
    SumColumns(v, block, sums);
    for (std::ptrdiff_t j = 0; j < block.columns; ++j) sums[j] = sums[j] / h;
}

// block = (I + v v^H / h) block. v is not part of it. sums: work space for one row.
template <class T>
void ReflectColumns(Spaced<T> v, double h, const Block<T>& block, T* sums) {
    FindReflection(v, h, block, sums);
    AddProducts(v, sums, block);
}

}  // namespace krnumer
