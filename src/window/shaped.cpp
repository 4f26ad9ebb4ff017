#include "window/shaped.h"

#include <algorithm>
#include <cmath>
#include <type_traits>

#include "frame/numeric.h"
#include "frame/status.h"
#include "window/cosine_sum.h"
#include "window/multiply.h"
#include "window/type.h"

namespace krnumer {

namespace {

// I0 by its power series, ended after 25 terms or at a change of 1e-8, both being part of what this window is: a
// complete I0 gives other weights, visibly so from beta = 40 on.
double KaiserI0(double x) {
    const double square = x * x;
    double sum = 1.0, term = 1.0, k = 0.0;
    for (int terms = 0; terms < 25; ++terms) {
        k += 2.0;
        term *= square / (k * k);
        const double previous = sum;
        sum += term;
        if (sum - previous <= 1e-8) break;
    }
    return sum;
}

}  // namespace

template <class T>
std::int32_t TriangleWindow(T* x, std::int32_t n) {
    if (n < 1) return kEmptyInput;
    x[0] = T{};
    MultiplyPeriodicPairs(x, n, [n](double i) { return 2.0 * i / n; });
    return kOk;
}

template <class T>
std::int32_t CosineTaper(T* x, std::int32_t n, double fraction) {
    if (n < 1) return kEmptyInput;
    if (fraction <= 0.0 || n == 1) return kOk;
    if (fraction >= 1.0) return NamedCosineWindow(x, n, kWindowHann, false);
    const std::int32_t m = SaturateToInt32(n * fraction * 0.5);
    if (m < 1) return kOk;

    x[0] = x[n - 1] = T{};
    const double step = kPi / (2.0 * m);
    double angle = 0.0;
    for (std::int32_t i = 1; i < m; ++i) {
        if constexpr (std::is_same_v<T, Complex>)
            angle = i * kPi / (2.0 * m);
        else
            angle += step;
        const double sine = std::sin(angle);
        x[i] *= sine * sine;
        x[n - 1 - i] *= sine * sine;
    }
    return kOk;
}

template <class T>
std::int32_t ExponentialWindow(T* x, std::int32_t n, double final_value) {
    if (n < 2) return kFewerThanTwo;
    if (!(final_value > 0.0)) return kBadFinalValue;
    const double step = std::log(final_value) / (n - 1);
    double exponent = 0.0;
    for (std::int32_t i = 0; i < n; ++i) {
        x[i] *= std::exp(exponent);
        exponent += step;
    }
    return kOk;
}

template <class T>
std::int32_t ForceWindow(T* x, std::int32_t n, double duty) {
    if (n < 2) return kFewerThanTwo;
    const std::int32_t kept = std::clamp(SaturateToInt32(duty * 0.01 * n), 0, n);
    std::fill(x + kept, x + n, T{});
    return kOk;
}

template <class T>
std::int32_t KaiserWindow(T* x, std::int32_t n, double beta) {
    if (n < 1) return kEmptyInput;
    const double step = 2.0 / n;
    const double peak = KaiserI0(beta);
    x[0] *= KaiserI0(0.0) / peak;
    MultiplyPeriodicPairs(x, n, [=](double i) {
        const double u = 1.0 - i * step;
        return KaiserI0(beta * std::sqrt(1.0 - u * u)) / peak;
    });
    return kOk;
}

template <class T>
std::int32_t GaussianWindow(T* x, std::int32_t n, double sigma, bool symmetric) {
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    if (!(sigma > 0.0)) sigma = 0.2;

    const double length = symmetric ? n : n + 1.0;
    const double scale = -0.5 / (sigma * sigma * (length * length));
    const double centre = (symmetric ? n - 1.0 : n) * 0.5;
    const auto weight = [=](double i) {
        const double d = i - centre;
        return std::exp(d * d * scale);
    };
    if (symmetric) {
        for (std::int32_t i = 0; i < n / 2; ++i) {
            const double w = weight(i);
            x[i] *= w;
            x[n - 1 - i] *= w;
        }
    } else {
        x[0] *= weight(0);
        MultiplyPeriodicPairs(x, n, weight);
    }
    return kOk;
}

template std::int32_t TriangleWindow(double*, std::int32_t);
template std::int32_t TriangleWindow(Complex*, std::int32_t);
template std::int32_t CosineTaper(double*, std::int32_t, double);
template std::int32_t CosineTaper(Complex*, std::int32_t, double);
template std::int32_t ExponentialWindow(double*, std::int32_t, double);
template std::int32_t ExponentialWindow(Complex*, std::int32_t, double);
template std::int32_t ForceWindow(double*, std::int32_t, double);
template std::int32_t ForceWindow(Complex*, std::int32_t, double);
template std::int32_t KaiserWindow(double*, std::int32_t, double);
template std::int32_t KaiserWindow(Complex*, std::int32_t, double);
template std::int32_t GaussianWindow(double*, std::int32_t, double, bool);
template std::int32_t GaussianWindow(Complex*, std::int32_t, double, bool);

}  // namespace krnumer
