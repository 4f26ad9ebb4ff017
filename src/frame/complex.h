// Complex arithmetic in its settled forms. std::complex is another arithmetic: its product repairs NaNs and its
// quotient and modulus scale.
#pragma once

#include <cmath>

namespace krnumer {

struct Complex {
    double re, im;

    friend constexpr bool operator==(const Complex&, const Complex&) = default;
};

constexpr Complex operator+(Complex a, Complex b) {
    return {a.re + b.re, a.im + b.im};
}
constexpr Complex operator-(Complex a, Complex b) {
    return {a.re - b.re, a.im - b.im};
}
constexpr Complex operator-(Complex a) {
    return {-a.re, -a.im};
}
constexpr Complex operator*(Complex a, Complex b) {
    return {a.re * b.re - a.im * b.im, a.re * b.im + a.im * b.re};
}
constexpr Complex operator*(Complex a, double b) {
    return {a.re * b, a.im * b};
}
constexpr Complex operator*(double a, Complex b) {
    return {a * b.re, a * b.im};
}
constexpr Complex operator/(Complex a, double b) {
    return {a.re / b, a.im / b};
}
constexpr Complex& operator+=(Complex& a, Complex b) {
    return a = a + b;
}
constexpr Complex& operator-=(Complex& a, Complex b) {
    return a = a - b;
}
constexpr Complex& operator*=(Complex& a, Complex b) {
    return a = a * b;
}
constexpr Complex& operator*=(Complex& a, double b) {
    return a = a * b;
}

// Smith's quotient (R. L. Smith, Comm. ACM 5, 435, 1962): the smaller part of the divisor is divided by the larger.
inline Complex operator/(Complex a, Complex b) {
    if (std::fabs(b.re) >= std::fabs(b.im)) {
        const double ratio = b.im / b.re;
        const double divisor = b.re + b.im * ratio;
        return {(a.re + a.im * ratio) / divisor, (a.im - a.re * ratio) / divisor};
    }
    const double ratio = b.re / b.im;
    const double divisor = b.im + b.re * ratio;
    return {(a.re * ratio + a.im) / divisor, (a.im * ratio - a.re) / divisor};
}

constexpr Complex Conjugate(Complex a) {
    return {a.re, -a.im};
}

// Plain root of the sum of squares, without scaling against overflow.
inline double Modulus(Complex a) {
    return std::sqrt(a.re * a.re + a.im * a.im);
}

}  // namespace krnumer
