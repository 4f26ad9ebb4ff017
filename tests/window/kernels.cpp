#include "window/kernels.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <random>

#include "window/cosine_sum.h"
#include "window/dolph_chebyshev.h"
#include "window/generated.h"
#include "window/shaped.h"
#include "window/type.h"

namespace krnumer {

namespace {

Kernel Named(std::string name, int32_t type) {
    return {std::move(name), [=](auto* x, int32_t n) { return NamedCosineWindow(x, n, type, false); }};
}

Kernel Taper(std::string name, double fraction) {
    return {std::move(name), [=](auto* x, int32_t n) { return CosineTaper(x, n, fraction); }};
}

Kernel Exponential(std::string name, double final_value) {
    return {std::move(name), [=](auto* x, int32_t n) { return ExponentialWindow(x, n, final_value); }};
}

Kernel Kaiser(std::string name, double beta) {
    return {std::move(name), [=](auto* x, int32_t n) { return KaiserWindow(x, n, beta); }};
}

Kernel Gaussian(std::string name, double sigma, bool symmetric) {
    return {std::move(name), [=](auto* x, int32_t n) { return GaussianWindow(x, n, sigma, symmetric); }};
}

Kernel DolphChebyshev(std::string name, double ratio, bool symmetric) {
    return {std::move(name), [=](auto* x, int32_t n) { return DolphChebyshevWindow(x, n, ratio, symmetric); }};
}

}  // namespace

const std::vector<Kernel>& PeriodicKernels() {
    static const std::vector<Kernel> kernels = {
        Named("hann", kWindowHann),
        Named("hamming", kWindowHamming),
        Named("blackman-harris-3", kWindowBlackmanHarris3),
        Named("exact-blackman", kWindowExactBlackman),
        Named("blackman", kWindowBlackman),
        Named("flat-top", kWindowFlatTop),
        Named("blackman-harris-4", kWindowBlackmanHarris4),
        Named("blackman-harris-7", kWindowBlackmanHarris7),
        Named("low-side-lobe", kWindowLowSideLobe),
        Named("blackman-nuttall", kWindowBlackmanNuttall),
        {"triangle", [](auto* x, int32_t n) { return TriangleWindow(x, n); }},
        {"bartlett-hanning", [](auto* x, int32_t n) { return BartlettHanningWindow(x, n); }},
        {"bohman", [](auto* x, int32_t n) { return BohmanWindow(x, n); }},
        {"parzen", [](auto* x, int32_t n) { return ParzenWindow(x, n); }},
        {"welch", [](auto* x, int32_t n) { return WelchWindow(x, n); }},
        Kaiser("kaiser 0.5", 0.5),
        Kaiser("kaiser 6", 6.0),
        Kaiser("kaiser 40", 40.0),
        Kaiser("kaiser 60", 60.0),
        Gaussian("gaussian 0.15", 0.15, false),
        Gaussian("gaussian 0.6", 0.6, false),
        DolphChebyshev("dolph-chebyshev 31.6", 31.6, false),
        DolphChebyshev("dolph-chebyshev 1e4", 1e4, false),
    };
    return kernels;
}

const std::vector<Kernel>& OtherKernels() {
    static const std::vector<Kernel> kernels = {
        Taper("taper 0.2", 0.2),
        Taper("taper 0.75", 0.75),
        Exponential("exponential 0.01", 0.01),
        Exponential("exponential 3", 3.0),
        Gaussian("gaussian 0.15 symmetric", 0.15, true),
        DolphChebyshev("dolph-chebyshev 31.6 symmetric", 31.6, true),
        DolphChebyshev("dolph-chebyshev 1e4 symmetric", 1e4, true),
    };
    return kernels;
}

std::vector<Kernel> AllKernels() {
    std::vector<Kernel> all = PeriodicKernels();
    all.insert(all.end(), OtherKernels().begin(), OtherKernels().end());
    return all;
}

std::vector<double> Weights(const std::function<int32_t(double*, int32_t)>& kernel, int32_t n) {
    std::vector<double> w(static_cast<std::size_t>(n), 1.0);
    EXPECT_EQ(kernel(w.data(), n), 0) << "length " << n;
    return w;
}

std::vector<double> Samples(int32_t n, uint32_t seed) {
    std::mt19937 random(seed);
    std::uniform_real_distribution<double> uniform(-1.0, 1.0);
    std::vector<double> x(static_cast<std::size_t>(n));
    for (double& sample : x) sample = uniform(random);
    return x;
}

}  // namespace krnumer
