// Real numbers of 106 bits as sums of two doubles, for the constants of the butterflies: built from cosines by sums
// and small quotients, they lose digits that a double has not to spare.
// Source: T. J. Dekker, A floating-point technique for extending the available precision, Numer. Math. 18, 1971.
#pragma once

#include <cmath>

namespace krnumer::generator {

struct LongReal {
    double high = 0.0;
    double low = 0.0;

    LongReal() = default;
    LongReal(double value) : high(value) {}
    LongReal(double h, double l) : high(h + l), low(l - (high - h)) {}

    explicit operator double() const { return high; }

    friend LongReal operator-(LongReal a) { return {-a.high, -a.low}; }
    friend LongReal operator+(LongReal a, LongReal b) {
        const double sum = a.high + b.high;
        const double part = sum - a.high;
        const double error = (a.high - (sum - part)) + (b.high - part);
        return {sum, error + (a.low + b.low)};
    }
    friend LongReal operator-(LongReal a, LongReal b) { return a + -b; }
    friend LongReal operator*(LongReal a, LongReal b) {
        const double product = a.high * b.high;
        const double error = std::fma(a.high, b.high, -product);
        return {product, error + (a.high * b.low + a.low * b.high)};
    }
    friend LongReal operator/(LongReal a, LongReal b) {
        const double first = a.high / b.high;
        const LongReal rest = a - b * first;
        const double second = rest.high / b.high;
        const double third = (rest - b * second).high / b.high;
        return LongReal(first, second) + third;
    }
};

struct LongComplex {
    LongReal re, im;

    friend LongComplex operator+(LongComplex a, LongComplex b) { return {a.re + b.re, a.im + b.im}; }
    friend LongComplex operator*(LongComplex a, LongComplex b) {
        return {a.re * b.re - a.im * b.im, a.re * b.im + a.im * b.re};
    }
    friend LongComplex operator*(LongReal a, LongComplex b) { return {a * b.re, a * b.im}; }
};

// exp(-2 pi i k / n) by the power series of the n-th root and repeated multiplication.
inline LongComplex RootOfUnity(int n, int k) {
    const LongReal two_pi(6.283185307179586, 2.4492935982947064e-16);
    const LongReal angle = two_pi / LongReal(n);
    LongComplex root{1.0, 0.0};
    LongComplex term{1.0, 0.0};
    for (int i = 1; i < 60; ++i) {
        term = (angle / LongReal(i)) * (term * LongComplex{0.0, -1.0});
        root = root + term;
    }
    LongComplex power{1.0, 0.0};
    for (int i = 0; i < k; ++i) power = power * root;
    return power;
}

}  // namespace krnumer::generator
