#include "window/named.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "window/cosine_sum.h"
#include "window/dolph_chebyshev.h"
#include "window/generated.h"
#include "window/multiply.h"
#include "window/shaped.h"
#include "window/type.h"

namespace krnumer {

namespace {

bool HasOwnKernel(std::int32_t type) {
    return (type >= kWindowTriangle && type <= kWindowWelch) || (type >= kWindowKaiser && type <= kWindowGaussian);
}

// Windows that are no sums of cosines. `symmetric` counts for the two that have a symmetric form of their own.
std::int32_t OwnKernel(double* w, std::int32_t n, std::int32_t type, double parameter, bool symmetric) {
    switch (type) {
        case kWindowTriangle:
            return TriangleWindow(w, n);
        case kWindowBartlettHanning:
            return BartlettHanningWindow(w, n);
        case kWindowBohman:
            return BohmanWindow(w, n);
        case kWindowParzen:
            return ParzenWindow(w, n);
        case kWindowWelch:
            return WelchWindow(w, n);
        case kWindowKaiser:
            return KaiserWindow(w, n, parameter);
        case kWindowDolphChebyshev:
            return DolphChebyshevWindow(w, n, parameter, symmetric);
        case kWindowGaussian:
            return GaussianWindow(w, n, parameter, symmetric);
        default:
            return kBadSelector;
    }
}

template <class T>
std::int32_t ScaleByTable(T* x, std::int32_t n, std::int32_t type, WindowConstants& constants) {
    if (WinCosTerms(type).empty()) return kBadSelector;
    WinConstants(type, constants);
    return n < 1 ? kOk : NamedCosineWindow(x, n, type, true);
}

// `weights` are ones on entry.
template <class T>
std::int32_t ScaleByMeasurement(T* x, double* weights, std::int32_t n, std::int32_t type, double parameter,
                                WindowConstants& constants) {
    const std::int32_t status = OwnKernel(weights, n, type, parameter, false);
    if (status < 0) return status;
    MeasureWindow(weights, n, constants);
    const double gain = 1.0 / constants.coherentGain;
    for (std::int32_t i = 0; i < n; ++i) x[i] = weights[i] * x[i] * gain;
    return status;
}

// `w` are ones on entry.
std::int32_t SymmetricWeights(double* w, std::int32_t n, std::int32_t type, double parameter) {
    if (type == kWindowDolphChebyshev || type == kWindowGaussian) return OwnKernel(w, n, type, parameter, true);
    const std::int32_t status =
        HasOwnKernel(type) ? OwnKernel(w, n - 1, type, parameter, false) : NamedCosineWindow(w, n - 1, type, false);
    w[n - 1] = w[0];
    return status;
}

}  // namespace

template <class T>
std::int32_t ScaledWindow(T* x, std::int32_t n, std::int32_t type, double parameter, WindowConstants& constants) {
    if (n < 0) return kNegativeLength;
    std::int32_t status;
    if (HasOwnKernel(type)) {
        Scratch<double> weights(Count(n));
        if (!weights) return kOutOfMemory;
        std::fill_n(weights.data(), n, 1.0);
        status = ScaleByMeasurement(x, weights.data(), n, type, parameter, constants);
    } else {
        status = ScaleByTable(x, n, type, constants);
    }
    if (status < 0) constants = {kQuietNaN, kQuietNaN};
    return status;
}

template <class T>
std::int32_t SymmetricWindow(T* x, std::int32_t n, std::int32_t type, double parameter) {
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    Scratch<double> weights(Count(n));
    if (!weights) return kOutOfMemory;
    std::fill_n(weights.data(), n, 1.0);
    const std::int32_t status = SymmetricWeights(weights.data(), n, type, parameter);
    if (status < 0) return status;
    MultiplyByWeights(x, weights.data(), n);
    return kOk;
}

template std::int32_t ScaledWindow(double*, std::int32_t, std::int32_t, double, WindowConstants&);
template std::int32_t ScaledWindow(Complex*, std::int32_t, std::int32_t, double, WindowConstants&);
template std::int32_t SymmetricWindow(double*, std::int32_t, std::int32_t, double);
template std::int32_t SymmetricWindow(Complex*, std::int32_t, std::int32_t, double);

}  // namespace krnumer
