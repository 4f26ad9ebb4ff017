// Signals and coefficients of either kind: random ones, between -1 and 1 in both parts, and given real ones.
#pragma once

#include <cstddef>
#include <initializer_list>
#include <random>
#include <type_traits>
#include <vector>

#include "frame/complex.h"

namespace krnumer {

template <class T>
T Draw(std::mt19937& random) {
    std::uniform_real_distribution<double> uniform(-1.0, 1.0);
    if constexpr (std::is_same_v<T, double>) {
        return uniform(random);
    } else {
        const double re = uniform(random);
        return {re, uniform(random)};
    }
}

template <class T>
std::vector<T> DrawArray(std::size_t n, std::mt19937& random) {
    std::vector<T> values(n);
    for (T& value : values) value = Draw<T>(random);
    return values;
}

template <class T>
constexpr T FromReal(double value) {
    if constexpr (std::is_same_v<T, double>) {
        return value;
    } else {
        return {value, 0.0};
    }
}

template <class T>
std::vector<T> RealValues(std::initializer_list<double> values) {
    std::vector<T> elements;
    for (const double value : values) elements.push_back(FromReal<T>(value));
    return elements;
}

}  // namespace krnumer
