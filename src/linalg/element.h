// What templates over double and Complex ask of their element: the operations on which the two differ by nature.
#pragma once

#include <cmath>
#include <type_traits>

#include "frame/complex.h"

namespace krnumer {

template <class T>
inline constexpr bool kIsComplex = std::is_same_v<T, Complex>;

// The element of real value a.
template <class T>
constexpr T FromReal(double a) {
    if constexpr (kIsComplex<T>) {
        return {a, 0.0};
    } else {
        return a;
    }
}

constexpr double Conjugate(double a) {
    return a;
}

constexpr double RealPart(double a) {
    return a;
}
constexpr double RealPart(Complex a) {
    return a.re;
}

// |a|^2, unscaled.
constexpr double SquaredModulus(double a) {
    return a * a;
}
constexpr double SquaredModulus(Complex a) {
    return a.re * a.re + a.im * a.im;
}

inline double Modulus(double a) {
    return std::fabs(a);
}

// |re| + |im|: a magnitude without products or roots.
inline double SumOfParts(double a) {
    return std::fabs(a);
}
inline double SumOfParts(Complex a) {
    return std::fabs(a.re) + std::fabs(a.im);
}

}  // namespace krnumer
