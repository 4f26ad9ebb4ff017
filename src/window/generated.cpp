#include "window/generated.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "window/multiply.h"

namespace krnumer {

namespace {

// Weights out of cos(2 pi i / n) and sin(2 pi i / n), which turn from sample to sample without a call.
template <class Formula>
void GenerateTurning(double* w, std::int32_t n, Formula formula) {
    w[0] = 0.0;
    if (n == 2) {
        w[1] = 1.0;
        return;
    }
    const double angle = 2.0 * kPi / n;
    const double step_c = std::cos(angle), step_s = std::sin(angle);
    double c = step_c, s = step_s;
    for (std::int32_t i = 1; i <= n / 2; ++i) {
        w[i] = w[n - i] = formula(i, c, s);
        const double turned_c = step_c * c - step_s * s;
        s = step_s * c + step_c * s;
        c = turned_c;
    }
}

void GenerateBartlettHanning(double* w, std::int32_t n) {
    GenerateTurning(w, n, [n](double i, double c, double) { return 0.62 - 0.48 * std::fabs(i / n - 0.5) - 0.38 * c; });
}

void GenerateBohman(double* w, std::int32_t n) {
    constexpr double kInversePi = 0.3183098861837907;
    GenerateTurning(w, n, [n](double i, double c, double s) { return s * kInversePi - 2.0 * i / n * c; });
}

// Both halves of a window that is given left of its centre n/2, where it is 1.
template <class Formula>
void GenerateHalves(double* w, std::int32_t n, Formula formula) {
    w[0] = 0.0;
    for (std::int32_t i = 1; i <= (n - 1) / 2; ++i) w[i] = w[n - i] = formula(i);
    if (n % 2 == 0) w[n / 2] = 1.0;
}

void GenerateParzen(double* w, std::int32_t n) {
    const double half = n * 0.5;
    const double p = 6.0 / half / half;
    const double q = p / half;
    GenerateHalves(w, n, [=](double i) {
        const double d = std::fabs(i - half);
        if (d > half / 2.0) {
            const double t = 1.0 - d / half;
            return 2.0 * (t * t * t);
        }
        return 1.0 - d * d * p + d * d * d * q;
    });
}

void GenerateWelch(double* w, std::int32_t n) {
    const double half = n * 0.5;
    const double p = 1.0 / half / half;
    GenerateHalves(w, n, [=](double i) { return 1.0 - (i - half) * (i - half) * p; });
}

template <class T>
std::int32_t MultiplyByGenerated(T* x, std::int32_t n, void (*generate)(double*, std::int32_t)) {
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    Scratch<double> weights(Count(n));
    if (!weights) return kOutOfMemory;
    generate(weights.data(), n);
    MultiplyByWeights(x, weights.data(), n);
    return kOk;
}

}  // namespace

template <class T>
std::int32_t BartlettHanningWindow(T* x, std::int32_t n) {
    return MultiplyByGenerated(x, n, GenerateBartlettHanning);
}

template <class T>
std::int32_t BohmanWindow(T* x, std::int32_t n) {
    return MultiplyByGenerated(x, n, GenerateBohman);
}

template <class T>
std::int32_t ParzenWindow(T* x, std::int32_t n) {
    return MultiplyByGenerated(x, n, GenerateParzen);
}

template <class T>
std::int32_t WelchWindow(T* x, std::int32_t n) {
    return MultiplyByGenerated(x, n, GenerateWelch);
}

template std::int32_t BartlettHanningWindow(double*, std::int32_t);
template std::int32_t BartlettHanningWindow(Complex*, std::int32_t);
template std::int32_t BohmanWindow(double*, std::int32_t);
template std::int32_t BohmanWindow(Complex*, std::int32_t);
template std::int32_t ParzenWindow(double*, std::int32_t);
template std::int32_t ParzenWindow(Complex*, std::int32_t);
template std::int32_t WelchWindow(double*, std::int32_t);
template std::int32_t WelchWindow(Complex*, std::int32_t);

}  // namespace krnumer
