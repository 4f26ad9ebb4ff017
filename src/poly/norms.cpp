#include "poly/norms.h"

#include <cmath>
#include <functional>

#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {

namespace {

double Magnitude(double x) {
    return std::fabs(x);
}
double Magnitude(Complex x) {
    return Modulus(x);
}

double Square(double x) {
    return x * x;
}
double Square(Complex x) {
    return x.re * x.re + x.im * x.im;
}

double Power(double x, double p) {
    return std::pow(std::fabs(x), p);
}
double Power(Complex x, double p) {
    return std::pow(Square(x), 0.5 * p);
}

template <class T, class Term>
double Sum(const T* x, int32_t n, Term term) {
    double sum = 0.0;
    for (int32_t i = 0; i < n; ++i) sum += term(x[i]);
    return sum;
}

// The magnitude that comes first.
template <class T, class Before>
double Extreme(const T* x, int32_t n, Before before) {
    double extreme = Magnitude(x[0]);
    for (int32_t i = 1; i < n; ++i) {
        const double magnitude = Magnitude(x[i]);
        if (before(magnitude, extreme)) extreme = magnitude;
    }
    return extreme;
}

template <class T>
double Norm(const T* x, int32_t n, double p) {
    if (p == -kInfinity) return Extreme(x, n, std::less<>());
    if (p == kInfinity) return Extreme(x, n, std::greater<>());
    if (p == 1.0) return Sum(x, n, [](T element) { return Magnitude(element); });
    if (p == 2.0) return std::sqrt(Sum(x, n, [](T element) { return Square(element); }));
    return std::pow(Sum(x, n, [p](T element) { return Power(element, p); }), 1.0 / p);
}

// Maps pairs, each output to the place of its input where it has none of its own.
template <class Function>
int32_t MapPairs(double* a, double* b, int32_t n, double* out_a, double* out_b, Function function) {
    if (n < 1) return kEmptyInput;
    if (out_a == nullptr) out_a = a;
    if (out_b == nullptr) out_b = b;
    for (int32_t i = 0; i < n; ++i) {
        const Complex pair = function(a[i], b[i]);
        out_a[i] = pair.re;
        out_b[i] = pair.im;
    }
    return kOk;
}

}  // namespace

template <class T>
int32_t UnitVectorCore(T* x, int32_t n, double p, double* norm, T* out) {
    if (n < 1) return kEmptyInput;
    if (std::isnan(p)) return kNotFinite;
    if (p == 0.0) return kZeroParameter;
    *norm = Norm(x, n, p);
    const double factor = *norm != 0.0 ? 1.0 / *norm : 1.0;
    T* const unit = out != nullptr ? out : x;
    for (int32_t i = 0; i < n; ++i) unit[i] = x[i] * factor;
    return kOk;
}

template int32_t UnitVectorCore(double*, int32_t, double, double*, double*);
template int32_t UnitVectorCore(Complex*, int32_t, double, double*, Complex*);

int32_t PolarToRect(double* r, double* theta, int32_t n, double* x, double* y) {
    return MapPairs(r, theta, n, x, y, [](double radius, double angle) {
        return Complex{radius * std::cos(angle), radius * std::sin(angle)};
    });
}

int32_t RectToPolar(double* x, double* y, int32_t n, double* r, double* theta) {
    return MapPairs(x, y, n, r, theta, [](double re, double im) {
        if (re == 0.0 && im == 0.0) return Complex{0.0, 0.0};
        return Complex{std::sqrt(re * re + im * im), std::atan2(im, re)};
    });
}

}  // namespace krnumer
